#pragma once

#include <string>

namespace Orbane {

class OrbaneDoc;

// Writes a document as a comp: a Lua file returning one table that names
// each tool's file and holds every Input's state, the time and the viewer
// image (see ToolLoader.h for the format).
class CompWriter
{
public:
    // The version this build writes; a reader refuses later ones.
    static constexpr int kVersion = 2;

    // The comp's text, paths relative to `folder`; false with `error` set
    // where the document holds what a comp cannot (a tool made from no file,
    // a script value that is an object).
    static bool Text(const OrbaneDoc &doc, const std::string &folder, std::string &out, std::string *error);
    // Text, written atomically: into a temporary file beside `path`, renamed
    // over it only once all is written, so a failed save leaves the old file.
    static bool Write(const OrbaneDoc &doc, const std::string &path, std::string *error);
};

} // namespace Orbane
