#pragma once

#include "orbane/Types.h"

namespace Orbane {

// 8 bits per channel, packed 0xAABBGGRR. All 32 bits set means "no colour".
class OrbColor
{
public:
    static constexpr uint32 None = 0xFFFFFFFFu;

    constexpr OrbColor() noexcept = default;
    constexpr explicit OrbColor(uint32 packed) noexcept : mPacked(packed) {}
    constexpr OrbColor(uint8 r, uint8 g, uint8 b, uint8 a = 255) noexcept
        : mPacked(uint32(r) | uint32(g) << 8 | uint32(b) << 16 | uint32(a) << 24)
    {}

    constexpr uint8 R() const noexcept { return uint8(mPacked); }
    constexpr uint8 G() const noexcept { return uint8(mPacked >> 8); }
    constexpr uint8 B() const noexcept { return uint8(mPacked >> 16); }
    constexpr uint8 A() const noexcept { return uint8(mPacked >> 24); }
    constexpr uint32 Packed() const noexcept { return mPacked; }
    constexpr bool IsNone() const noexcept { return mPacked == None; }

    constexpr bool operator==(OrbColor o) const noexcept { return mPacked == o.mPacked; }
    constexpr bool operator!=(OrbColor o) const noexcept { return mPacked != o.mPacked; }

private:
    uint32 mPacked = None;
};

} // namespace Orbane
