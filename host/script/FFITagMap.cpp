#include "orbane/FFITagMap.h"

#include <algorithm>
#include <cstring>

namespace Orbane {

namespace {

std::vector<FFITagMap *> &Maps()
{
    static std::vector<FFITagMap *> maps;
    return maps;
}

} // namespace

FFITagMap::FFITagMap(FFIType &type, const char *method, const char *mapName, const TagMapEntry *table)
    : mType(type), mMethod(method), mMapName(mapName), mTable(table)
{
    Maps().push_back(this);
}

FFITagMap::~FFITagMap()
{
    auto &maps = Maps();
    maps.erase(std::remove(maps.begin(), maps.end(), this), maps.end());
}

int32 FFITagMap::Count() const noexcept
{
    int32 n = 0;
    while (mTable && mTable[n].name)
        ++n;
    return n;
}

const std::vector<FFITagMap *> &FFITagMap::All()
{
    return Maps();
}

const FFITagMap *FFITagMap::ForType(const FFIType *type)
{
    // A type may one day carry maps for several methods; "Create" describes it.
    const FFITagMap *found = nullptr;
    for (const FFITagMap *map : Maps()) {
        if (&map->Type() != type)
            continue;
        if (std::strcmp(map->Method(), "Create") == 0)
            return map;
        if (!found)
            found = map;
    }
    return found;
}

} // namespace Orbane
