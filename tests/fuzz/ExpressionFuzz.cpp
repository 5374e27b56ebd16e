// Expressions as a user types them into a value field: evaluated once by the
// parser, and kept live on an Input of a document, where they name the time
// and other Inputs (and may name themselves).
#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Parser.h"

#include <cstddef>
#include <cstdint>
#include <string>

namespace {

void Live(const std::string &text)
{
    using namespace Orbane;
    OrbaneDoc doc;
    AutoRef<Operator> tool(new Operator("Blur1", "Tool"));
    Input *size = tool->AddInput("Size", "Size", CLSID_DataType_Number, {}, AutoNumber(1.0));
    Input *gain = tool->AddInput("Gain", "Gain", CLSID_DataType_Number, {}, AutoNumber(2.0));
    doc.AddTool(tool);
    gain->SetExpression("Size * 2");
    if (size->SetExpression(text.c_str()))
        doc.SetCurrentTime(12.0);
    doc.Undo();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, std::size_t size)
{
    const std::string text(reinterpret_cast<const char *>(data), size);
    Orbane::Parser parser;
    parser.SetVar("x", 0.5);
    parser.SetVar("time", 24.0);
    if (parser.SetExpression(text.c_str()))
        parser.Evaluate();
    Live(text);
    return 0;
}
