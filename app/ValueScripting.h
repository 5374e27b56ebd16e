#pragma once

namespace Orbane {

class OrbaneDoc;

// Script functions for values beyond reading and writing one: keyframes of
// any animatable Input (SetKey, Keys, RemoveKey), locking a tool
// (SetToolLocked), and shapes to and from files (ImportShape, ExportShape).
// docs/scripting.md describes them.
class ValueScripting
{
public:
    static void Install(OrbaneDoc *doc);
};

} // namespace Orbane
