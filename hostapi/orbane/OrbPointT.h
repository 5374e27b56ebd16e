#pragma once

#include "orbane/Types.h"

#include <cmath>

namespace Orbane {

// A 2D point or offset. Overlays pass these by value on every mouse move, so
// the type stays a plain pair with constexpr arithmetic.
template <typename T> class OrbPointT
{
public:
    T x = T();
    T y = T();

    constexpr OrbPointT() noexcept = default;
    constexpr OrbPointT(T px, T py) noexcept : x(px), y(py) {}

    // Converting between element types is explicit: int <-> double loses or
    // invents precision, and that should show at the call site.
    template <typename U> constexpr explicit OrbPointT(const OrbPointT<U> &o) noexcept : x(T(o.x)), y(T(o.y)) {}

    constexpr OrbPointT operator+(const OrbPointT &o) const noexcept { return {T(x + o.x), T(y + o.y)}; }
    constexpr OrbPointT operator-(const OrbPointT &o) const noexcept { return {T(x - o.x), T(y - o.y)}; }
    constexpr OrbPointT operator-() const noexcept { return {T(-x), T(-y)}; }
    constexpr OrbPointT operator*(T s) const noexcept { return {T(x * s), T(y * s)}; }
    constexpr OrbPointT operator/(T s) const noexcept { return {T(x / s), T(y / s)}; }
    // Component-wise product and quotient: scaling by per-axis spans.
    constexpr OrbPointT Mul(const OrbPointT &o) const noexcept { return {T(x * o.x), T(y * o.y)}; }
    constexpr OrbPointT Div(const OrbPointT &o) const noexcept { return {T(x / o.x), T(y / o.y)}; }

    constexpr OrbPointT &operator+=(const OrbPointT &o) noexcept { return *this = *this + o; }
    constexpr OrbPointT &operator-=(const OrbPointT &o) noexcept { return *this = *this - o; }
    constexpr OrbPointT &operator*=(T s) noexcept { return *this = *this * s; }
    constexpr OrbPointT &operator/=(T s) noexcept { return *this = *this / s; }

    constexpr bool operator==(const OrbPointT &o) const noexcept { return x == o.x && y == o.y; }
    constexpr bool operator!=(const OrbPointT &o) const noexcept { return !(*this == o); }

    constexpr T Dot(const OrbPointT &o) const noexcept { return x * o.x + y * o.y; }
    constexpr T LengthSquared() const noexcept { return Dot(*this); }
    float64 Length() const noexcept { return std::hypot(float64(x), float64(y)); }
};

template <typename T> constexpr OrbPointT<T> operator*(T s, const OrbPointT<T> &p) noexcept
{
    return p * s;
}

using OrbPoint = OrbPointT<float64>;
using OrbPointI = OrbPointT<int32>;

} // namespace Orbane
