#pragma once

#include "orbane/OrbID.h"
#include "orbane/ScriptVal.h"
#include "orbane/Types.h"

#include <QString>

#include <mutex>
#include <unordered_map>
#include <unordered_set>

namespace Orbane {

// The look pack: one folder of Lua files that describe layouts and other
// look data, and of skin images, all addressed by item name. It is loaded
// once per process, on first use.
//
// Folder: $ORBANE_LOOKS where set, else <application dir>/../share/orbane/
// looks/default, else the source tree's looks/default.
//
// Items: every *.lua file directly in the folder, read in file-name order,
// returns a table of items, { ["Controls.CheckBox.Layout"] = { ... }, ... };
// a later file replaces an earlier file's item of the same name. The files
// run in a Lua state of their own with only the base, table, string and
// math libraries, so a look pack can compute but not reach the system.
//
// Images: "<folder>/<item name>.svg", else "<folder>/<item name>.png" (with
// an optional "<item name>@2x.png" for high-density screens).
class LookPack
{
public:
    // The process's look pack, from LocateFolder(), loaded on first use.
    static const LookPack &Get();
    // A look pack read from `folder` now (tools and tests; the host uses Get).
    explicit LookPack(const QString &folder);

    const QString &Folder() const { return mFolder; }
    // The item's value; nil (and one warning per name) where there is none.
    const ScriptVal &FindItem(const OrbID &name) const;
    bool HasItem(const OrbID &name) const { return mItems.count(name) != 0; }
    int32 ItemCount() const { return int32(mItems.size()); }
    // The image file of an item, or an empty string.
    QString FindImageFile(const OrbID &name) const;

    // The folder the environment and installation point at (see above).
    static QString LocateFolder();

    LookPack(const LookPack &) = delete;
    LookPack &operator=(const LookPack &) = delete;

private:
    void LoadFolder();
    bool LoadFile(const QString &path);
    void WarnMissing(const OrbID &name) const;

    QString mFolder;
    std::unordered_map<OrbID, ScriptVal> mItems;
    mutable std::mutex mWarnLock;
    mutable std::unordered_set<OrbID> mWarned;
};

} // namespace Orbane
