#pragma once

#include "orbane/Types.h"

#include <string>

namespace Orbane {

class OrbaneDoc;
class ScriptObject;

// The script a button runs when pressed, in the host's Lua state. The text
// is first mapped with the document's path map: where that names a file,
// the file runs; otherwise the text itself is the chunk. A button script
// comes with a tool or comp file, so it is content: it runs in the sandbox
// with `tool`, `self` and `modifiers` in its environment, which is fresh for
// every press. Errors come back as "chunk:line: message".
class ButtonScript
{
public:
    ButtonScript(std::string text, std::string chunkName);

    bool Run(OrbaneDoc *doc, ScriptObject *tool, ScriptObject *self, uint64 modifiers, std::string *error) const;

private:
    bool Load(OrbaneDoc *doc, std::string *error) const;
    void SetEnvironment(ScriptObject *tool, ScriptObject *self, uint64 modifiers) const;

    std::string mText;
    std::string mChunkName;
};

} // namespace Orbane
