#pragma once

#include "orbane/ScriptObject.h"
#include "orbane/Types.h"

#include <array>
#include <memory>
#include <vector>

namespace Orbane {

// The colour spaces in which a gradient interpolates between its stops.
enum GradientColorSpace : int32
{
    GCS_RGB = 0, // straight red, green, blue
    GCS_HSV = 1, // hue (shortest way round), saturation, value
    GCS_HLS = 2, // hue (shortest way round), lightness, saturation
    GCS_Count
};

// A colour with float channels, nominally 0..1 (values outside are kept).
struct GradientColor
{
    float64 R = 0.0, G = 0.0, B = 0.0, A = 1.0;
};

// A colour ramp: colours at positions 0..1, shared by reference count (it
// travels in tag lists as an object). Evaluate interpolates exactly;
// QuickEvaluate reads a table built once per colour space after each change,
// for painting a ramp column by column.
class Gradient : public RefObject
{
public:
    struct Stop
    {
        float64 Pos;
        GradientColor Color;
    };
    static constexpr int32 TableSize = 1024;

    Gradient();

    const char *ScriptTypeName() const override { return "Gradient"; }

    // Adds a stop, keeping stops ordered by position (equal positions keep
    // the order they were added in, which gives a hard edge).
    void AddStop(float64 pos, const GradientColor &colour);
    void Clear();
    int32 Count() const noexcept { return int32(mStops.size()); }
    const Stop &GetStop(int32 index) const { return mStops[size_t(index)]; }
    // Bumped on every change, so that painters can tell their cache is stale.
    uint32 Serial() const noexcept { return mSerial; }

    // The colour at `pos` (clamped to 0..1) interpolated in `space`; an
    // unknown space interpolates in RGB. No stops give transparent black.
    GradientColor Evaluate(float64 pos, int32 space = GCS_RGB) const;
    GradientColor QuickEvaluate(float64 pos, int32 space = GCS_RGB) const;

protected:
    ~Gradient() override;

private:
    using Table = std::vector<GradientColor>;
    const Table &TableFor(int32 space) const;

    std::vector<Stop> mStops;
    uint32 mSerial = 0;
    mutable std::array<std::unique_ptr<Table>, GCS_Count> mTables;
};

} // namespace Orbane
