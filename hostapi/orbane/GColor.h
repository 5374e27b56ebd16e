#pragma once

#include "orbane/OrbColor.h"

namespace Orbane {
namespace Graphics {

// A painter colour: straight (not premultiplied) RGBA in 0..1, so overlays
// can fade a colour by multiplying its alpha. Alpha 0 draws nothing; a
// shadow of alpha 0 means "no shadow pass".
class GColor
{
public:
    float32 r = 0.0f;
    float32 g = 0.0f;
    float32 b = 0.0f;
    float32 a = 0.0f;

    constexpr GColor() noexcept = default;
    constexpr GColor(float32 red, float32 green, float32 blue, float32 alpha = 1.0f) noexcept
        : r(red), g(green), b(blue), a(alpha)
    {
    }

    // OrbColor's "no colour" gives a fully transparent colour.
    static constexpr GColor FromOrb(OrbColor c) noexcept
    {
        if (c.IsNone())
            return {};
        return {c.R() / 255.0f, c.G() / 255.0f, c.B() / 255.0f, c.A() / 255.0f};
    }

    constexpr GColor WithAlpha(float32 alpha) const noexcept { return {r, g, b, alpha}; }
    constexpr GColor Faded(float32 factor) const noexcept { return {r, g, b, a * factor}; }
    // The colour scaled towards black, alpha kept ("dimmed" handles).
    constexpr GColor Darker(float32 factor) const noexcept { return {r * factor, g * factor, b * factor, a}; }
    constexpr bool IsVisible() const noexcept { return a > 0.0f; }

    constexpr bool operator==(const GColor &o) const noexcept { return r == o.r && g == o.g && b == o.b && a == o.a; }
    constexpr bool operator!=(const GColor &o) const noexcept { return !(*this == o); }
};

} // namespace Graphics
} // namespace Orbane
