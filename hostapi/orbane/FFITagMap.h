#pragma once

#include "orbane/OrbString.h"
#include "orbane/TagMapEntry.h"

#include <vector>

namespace Orbane {

class FFIType;

// The table through which scripts pass a class's tags by name to one method
// ("Create"). `mapName` is "InputControl.Create" or "PreviewControl.Create".
class FFITagMap
{
public:
    FFITagMap(FFIType &type, const char *method, const char *mapName, const TagMapEntry *table);
    ~FFITagMap();
    FFITagMap(const FFITagMap &) = delete;
    FFITagMap &operator=(const FFITagMap &) = delete;

    FFIType &Type() const noexcept { return mType; }
    const char *Method() const noexcept { return mMethod.c_str(); }
    const char *MapName() const noexcept { return mMapName.c_str(); }
    const TagMapEntry *Table() const noexcept { return mTable; }
    // Rows before the terminating null name.
    int32 Count() const noexcept;

    static const std::vector<FFITagMap *> &All();
    // The map of a script type, or null.
    static const FFITagMap *ForType(const FFIType *type);

private:
    FFIType &mType;
    OrbString mMethod, mMapName;
    const TagMapEntry *mTable;
};

} // namespace Orbane
