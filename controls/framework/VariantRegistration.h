#pragma once

#include "framework/ClassRecord.h"
#include "framework/ControlDesc.h"

#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"

#include <optional>
#include <typeinfo>

namespace Orbane {

// A second class ID for control class T (an ID variant), described by
// ControlDesc::Variant: its own Registry and ScriptInfo with the same factory,
// and, where it has one, its own script type bound to T with the primary's
// tag table. It exports no casts of its own and has no hook: the host finds
// the primary's through the base class ID.
template <class T>
class VariantRegistration
{
public:
    explicit VariantRegistration(const ControlDesc &desc) : mRecord(desc)
    {
        if (!desc.ScriptName())
            return;
        mType.emplace(desc.ScriptName(), desc.ScriptName(), desc.ScriptBase(), -1, 0, nullptr);
        SetFFIType(typeid(T), &*mType);
        if (desc.Table())
            mTagMap.emplace(*mType, "Create", desc.MapName(), desc.Table());
    }

private:
    ClassRecord<T> mRecord;
    std::optional<FFITypeT<T>> mType;
    std::optional<FFITagMap> mTagMap;
};

} // namespace Orbane
