#pragma once

#include "framework/ControlDesc.h"
#include "framework/FFICasts.h"

#include "orbane/FFIFunc.h"
#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"

#include <optional>
#include <typeinfo>

namespace Orbane {

// The script side of a scriptable class T: the declarations of its exported
// cast pair, its script type (bound to T) and its "Create" tag map. The two
// functions are made before the type they refer to; they only keep the
// reference, which the script layer follows once loading is over.
template <class T>
class ScriptBinding
{
public:
    explicit ScriptBinding(const ControlDesc &desc)
        : mCast(mType, "_cast", "_cast", FFICastSymbol(desc.Name()).c_str(), FFICastDeclaration(desc.Name()).c_str(),
                "obj", nullptr, FFICastResult(desc.Name()).c_str(), 0),
          mUncast(mType, "_uncast", "_uncast", FFIUncastSymbol(desc.Name()).c_str(),
                  FFIUncastDeclaration(desc.Name()).c_str(), "self", nullptr, "ScriptObject *", 0),
          mType(desc.ScriptName(), desc.Name(), desc.ScriptBase(), -1, 0, nullptr)
    {
        SetFFIType(typeid(T), &mType);
        if (desc.Table())
            mTagMap.emplace(mType, "Create", desc.MapName(), desc.Table());
    }

private:
    FFIFunc mCast, mUncast;
    FFITypeT<T> mType;
    std::optional<FFITagMap> mTagMap;
};

} // namespace Orbane
