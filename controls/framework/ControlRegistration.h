#pragma once

#include "framework/ClassRecord.h"
#include "framework/ControlDesc.h"
#include "framework/ScriptBinding.h"

#include "orbane/InputControl.h"
#include "orbane/PreviewControl.h"
#include "orbane/ScriptInfo.h"

#include <optional>
#include <type_traits>
#include <typeinfo>

namespace Orbane {

// The host base class of a control family, as the script layer knows it.
template <class T>
using FamilyBase = std::conditional_t<std::is_base_of_v<InputControl, T>, InputControl, PreviewControl>;

// Everything that registering the primary ID of control class T makes, in the
// order the host expects: the inheritance for the script layer, the class ID,
// the Registry, the ScriptInfo, then, where the class is scriptable, its cast
// declarations, script type and tag map. Lives as a static of the library and
// is torn down in reverse order at unload.
template <class T, class Base = FamilyBase<T>>
class ControlRegistration
{
    static_assert(std::is_base_of_v<Base, T>, "a control registers under a base it derives from");

public:
    explicit ControlRegistration(const ControlDesc &desc) : mRecord(desc)
    {
        if (desc.ScriptName())
            mScript.emplace(desc);
    }

private:
    struct TypeLink
    {
        TypeLink() { SetTypeInfo(typeid(T), typeid(Base)); }
    };

    TypeLink mLink;
    ClassRecord<T> mRecord;
    std::optional<ScriptBinding<T>> mScript;
};

} // namespace Orbane
