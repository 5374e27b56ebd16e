#pragma once

#include <string>

namespace Orbane {

class Operator;
class OrbaneDoc;
class ScriptVal;

// Builds tools and comps from their Lua descriptions.
//
// A tool file returns a table:
//   { type = "Demo", inputs = {
//       { id = "Invert", name = "Invert", type = "Number", default = 0,
//         control = "CheckboxControl",            -- or a list of classes: one control each
//         overlay = "CrosshairControl",            -- viewer overlays, likewise
//         overlayInputs = { "Height" },            -- further Inputs the overlays edit (index 1, ...)
//         label = "Invert", label2 = "Colours",    -- label texts (0x30040000, 0x30040001)
//         tags = { CBC_TriState = true },          -- named tags of the control and overlay classes;
//                                                  -- an Input-valued one takes an Input id of the
//                                                  -- tool (RCP_Center = "Center"); a tag with no
//                                                  -- script name goes by number ([0x10058000] = 1)
//         attrs = { [0x10050001] = 1 } },          -- any further Input attributes by number;
//                                                  -- { { 0x38040000, "A" }, { 0x38040001, "" } }
//                                                  -- gives them in this order (repeated tags);
//                                                  -- an object tag given stops { {pos, r, g, b [, a]}, ... }
//                                                  -- holds a Gradient
//       ... } }
// Data types: "Number", "Point" (default {x, y}), "Text", "ID", "ScriptVal", and "Image"
// (default: an image file's path, relative to the tool file).
// Named tags go through the same tag maps as orbane.Create, so a misspelt
// tag fails with a message naming the tool, the Input and the tag.
//
// A comp file returns { time = 0, tools = { { file = "tools/Demo.lua", name = "Demo1" }, ... } };
// file names are relative to the comp file. An optional `image = "images/x.png"`
// names the image the viewer shows (PREF_ViewerImage), and `pixelAspect = 2` the width of
// one of its pixels over its height (PREF_ViewerPixelAspect).
// A saved comp also says `version = 2` (a later version is refused) and holds each tool's
// work: `locked = true`, and `inputs = { <id> = <state>, ... }` where a state is
// { value = v } for a plain value, or { keys = { { time, v }, ... }, interpolation = "smooth" }
// for an animated one (interpolation "linear" where it is left out), plus an optional
// `expression = "..."`. Values are written as orbane.GetValue gives them. An Input the
// tool does not have, a key at a time that is not a finite number, a value of the wrong
// type: the comp is refused with a message naming the tool and Input, the document untouched.
class ToolLoader
{
public:
    // A new tool (one reference, the caller's) named `name`; null with `error` set.
    // Relative image paths start at `dir` (the current directory where empty).
    static Operator *FromTable(const ScriptVal &desc, const char *name, std::string *error,
                               const std::string &dir = std::string());
    static Operator *LoadTool(const std::string &path, const char *name, std::string *error);
    // Adds every tool of the comp, with its Inputs' state, to the document
    // and sets its time and image; all or nothing. Into a document without
    // tools the comp becomes the document: its path, unmodified.
    static bool LoadComp(OrbaneDoc &doc, const std::string &path, std::string *error);
    // Reads and checks the comp in full, and only then clears the document
    // (OrbaneDoc::Clear) and loads it: File > Open. A refused comp leaves
    // the document as it was; only expressions are checked after the clear
    // (they may name any tool of the comp), so a comp refused for one of
    // them leaves the document empty.
    static bool OpenComp(OrbaneDoc &doc, const std::string &path, std::string *error);
    // Writes the document as a comp, atomically (a temporary file renamed
    // over `path` once complete; a failed write leaves the old file). Leaves
    // the document's path and modified state alone: for autosave.
    static bool WriteComp(const OrbaneDoc &doc, const std::string &path, std::string *error);
    // WriteComp, then the document is `path` and unmodified: File > Save.
    static bool SaveComp(OrbaneDoc &doc, const std::string &path, std::string *error);
};

} // namespace Orbane
