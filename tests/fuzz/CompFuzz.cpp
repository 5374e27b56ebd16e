// Comp and tool files as they arrive from outside: the input is the file,
// loaded as a comp and as a tool through the sandbox.
#include "FuzzInput.h"

#include "orbane/AutoRef.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ToolLoader.h"

#include <QTemporaryDir>

#include <cstdio>
#include <cstdlib>

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
        // What loads must save, and what it saves must load again.
        OrbaneDoc doc;
        const std::string saved = dir.filePath("saved.lua").toStdString();
        OrbaneDoc again;
        if (ToolLoader::LoadComp(doc, path, &error) &&
            !(ToolLoader::WriteComp(doc, saved, &error) && ToolLoader::OpenComp(again, saved, &error))) {
            std::fprintf(stderr, "a loaded comp did not save and load again: %s\n", error.c_str());
            std::abort();
        }
    }
    AutoRef<Operator> tool(ToolLoader::LoadTool(path, "Fuzz1", &error));
    return 0;
}
