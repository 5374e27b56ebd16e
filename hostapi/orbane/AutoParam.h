#pragma once

#include "orbane/AutoRef.h"
#include "orbane/Input.h"
#include "orbane/Number.h"
#include "orbane/OrbIDParam.h"
#include "orbane/Point.h"
#include "orbane/ScriptValParam.h"
#include "orbane/Text.h"

namespace Orbane {

namespace Detail {
// Is a lone constructor argument something to hold rather than a value to
// make a new T from (a T pointer, another holder)?
template <class T, class... A> struct IsHandleArg : std::false_type
{
};
template <class T, class A>
struct IsHandleArg<T, A>
    : std::bool_constant<std::is_base_of_v<AutoRef<T>, std::decay_t<A>> || std::is_convertible_v<std::decay_t<A>, T *>>
{
};
} // namespace Detail

// Holds one reference to a value of kind T (Parameter for any kind):
//   AutoNumber n(0.5);           a new Number 0.5
//   AutoPoint p(0.2, 0.3);       a new Point
//   AutoNumber v(input, time);   the Input's value at `time`, held only where it is a Number
//   AutoParameter a(input->GetValue(time));   adopts a new reference
template <class T> class AutoParam : public AutoRef<T>
{
    template <class... A>
    static constexpr bool MakesNew = sizeof...(A) > 0 && std::is_constructible_v<T, A...> &&
                                     !Detail::IsHandleArg<T, A...>::value;

public:
    AutoParam() noexcept = default;
    AutoParam(std::nullptr_t) noexcept {}
    explicit AutoParam(T *adopt) noexcept : AutoRef<T>(adopt) {}
    // Holds what another holder holds (of this kind or a derived one).
    template <class U, class = std::enable_if_t<std::is_convertible_v<U *, T *>>>
    AutoParam(const AutoRef<U> &o) noexcept : AutoRef<T>(o)
    {
    }
    template <class U, class = std::enable_if_t<std::is_convertible_v<U *, T *>>>
    AutoParam(AutoRef<U> &&o) noexcept : AutoRef<T>(std::move(o))
    {
    }
    // Makes a new value from the arguments of one of T's constructors.
    template <class... A, std::enable_if_t<MakesNew<A...>, int> = 0>
    explicit AutoParam(A &&...args) : AutoRef<T>(new T(std::forward<A>(args)...))
    {
    }
    // The Input's value at `time` where it is of kind T; empty otherwise, and
    // for a null Input.
    AutoParam(Input *in, float64 time) : AutoRef<T>(Pick(in ? in->GetValue(time) : nullptr)) {}

private:
    static T *Pick(Parameter *p) noexcept
    {
        T *kind = dynamic_cast<T *>(p);
        if (!kind && p)
            p->DecRef();
        return kind;
    }
};

using AutoParameter = AutoParam<Parameter>;
using AutoNumber = AutoParam<Number>;
using AutoPoint = AutoParam<Point>;
using AutoText = AutoParam<Text>;
using AutoOrbIDParam = AutoParam<OrbIDParam>;
using AutoScriptValParam = AutoParam<ScriptValParam>;

} // namespace Orbane
