#pragma once

#include <cstdint>

// Fixed-width names used across the host contract, so that signal signatures
// such as "2ValueChanged(float64)" read the same in every library.
using int8 = std::int8_t;
using uint8 = std::uint8_t;
using int16 = std::int16_t;
using uint16 = std::uint16_t;
using int32 = std::int32_t;
using uint32 = std::uint32_t;
using int64 = std::int64_t;
using uint64 = std::uint64_t;
using float32 = float;
using float64 = double;

namespace Orbane {

// A position or time that is not set.
constexpr float64 TIME_UNDEFINED = -1000000000.0;
// The time at which a control writes its cached value when it is unbound.
constexpr float64 TIME_DISCONNECT = -2000000000.0;

} // namespace Orbane
