// Expressions as a user types them into a value field.
#include "orbane/Parser.h"

#include <cstddef>
#include <cstdint>
#include <string>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, std::size_t size)
{
    const std::string text(reinterpret_cast<const char *>(data), size);
    Orbane::Parser parser;
    parser.SetVar("x", 0.5);
    parser.SetVar("time", 24.0);
    if (parser.SetExpression(text.c_str()))
        parser.Evaluate();
    return 0;
}
