// Comp and tool files as they arrive from outside: the input is the file,
// loaded as a comp and as a tool through the sandbox.
#include "FuzzInput.h"

#include "orbane/AutoRef.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ToolLoader.h"

#include <QTemporaryDir>

#include <cstdio>

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, std::size_t size)
{
    using namespace Orbane;
    Fuzz::SmallLimits();
    static QTemporaryDir dir;
    const std::string path = dir.filePath("comp.lua").toStdString();
    if (FILE *file = std::fopen(path.c_str(), "wb")) {
        std::fwrite(data, 1, size, file);
        std::fclose(file);
    }
    std::string error;
    {
        OrbaneDoc doc;
        ToolLoader::LoadComp(doc, path, &error);
    }
    AutoRef<Operator> tool(ToolLoader::LoadTool(path, "Fuzz1", &error));
    return 0;
}
