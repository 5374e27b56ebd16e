#pragma once

#include "orbane/OrbPointT.h"

namespace Orbane {

// An axis-aligned rectangle given by two corners. Nothing here assumes which
// way Y points: image and viewer coordinates both run Y up, widget
// coordinates Y down, and the same type serves all of them.
template <typename T> class OrbRectT
{
public:
    T x1 = T();
    T y1 = T();
    T x2 = T();
    T y2 = T();

    constexpr OrbRectT() noexcept = default;
    constexpr OrbRectT(T ax1, T ay1, T ax2, T ay2) noexcept : x1(ax1), y1(ay1), x2(ax2), y2(ay2) {}
    constexpr OrbRectT(const OrbPointT<T> &a, const OrbPointT<T> &b) noexcept : x1(a.x), y1(a.y), x2(b.x), y2(b.y) {}

    constexpr OrbPointT<T> Corner1() const noexcept { return {x1, y1}; }
    constexpr OrbPointT<T> Corner2() const noexcept { return {x2, y2}; }
    constexpr T Width() const noexcept { return x2 - x1; }
    constexpr T Height() const noexcept { return y2 - y1; }
    constexpr OrbPointT<T> Center() const noexcept { return {T((x1 + x2) / 2), T((y1 + y2) / 2)}; }

    // The same rectangle with x1 <= x2 and y1 <= y2.
    constexpr OrbRectT Normalized() const noexcept
    {
        return {x1 < x2 ? x1 : x2, y1 < y2 ? y1 : y2, x1 < x2 ? x2 : x1, y1 < y2 ? y2 : y1};
    }
    // Edges included, on a normalised rectangle.
    constexpr bool Contains(const OrbPointT<T> &p) const noexcept
    {
        return p.x >= x1 && p.x <= x2 && p.y >= y1 && p.y <= y2;
    }

    constexpr bool operator==(const OrbRectT &o) const noexcept
    {
        return x1 == o.x1 && y1 == o.y1 && x2 == o.x2 && y2 == o.y2;
    }
    constexpr bool operator!=(const OrbRectT &o) const noexcept { return !(*this == o); }
};

using OrbRect = OrbRectT<float64>;

} // namespace Orbane
