// Shape files as they arrive from outside: the input is read both as the
// project's text shape file and as SVG path data, and whatever shape comes
// out is written back in both forms.
#include "orbane/AutoRef.h"
#include "orbane/PolyLine.h"
#include "orbane/ShapeFile.h"
#include "orbane/SvgPath.h"

#include <QTemporaryDir>

#include <cstdio>

namespace {

std::string WriteInput(const QTemporaryDir &dir, const char *name, const uint8_t *data, std::size_t size)
{
    const std::string path = dir.filePath(name).toStdString();
    if (FILE *file = std::fopen(path.c_str(), "wb")) {
        std::fwrite(data, 1, size, file);
        std::fclose(file);
    }
    return path;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t *data, std::size_t size)
{
    using namespace Orbane;
    static QTemporaryDir dir;
    for (const char *name : {"shape.txt", "shape.svg"}) {
        std::string error;
        AutoRef<PolyLine> shape(ShapeFile::Import(WriteInput(dir, name, data, size), &error));
        if (!shape)
            continue;
        ShapeFile::Text(*shape);
        SvgPath::PathData(*shape, 640, 480);
    }
    return 0;
}
