#include "ShapeExpand.h"

#include "CurveFit.h"
#include "orbane/PolyLine.h"

#include <polyclipping/clipper.hpp>

#include <cmath>

namespace Orbane {

namespace {

// Image coordinates (0..1) become integers in millionths: finer than any
// viewer shows, far inside Clipper's integer range.
constexpr float64 kScale = 1e6;
// Samples per segment when flattening, enough that the offset outline's
// flats stay below the fitting tolerances used for feathers.
constexpr int32 kFlatten = 32;

ClipperLib::Path ToPath(const std::vector<OrbPoint> &pts)
{
    ClipperLib::Path path;
    for (const OrbPoint &p : pts)
        path.emplace_back(ClipperLib::cInt(std::llround(p.x * kScale)), ClipperLib::cInt(std::llround(p.y * kScale)));
    return path;
}

} // namespace

PolyLine *ShapeExpand::Expand(const PolyLine &shape, float64 amount, float64 tolerance)
{
    if (shape.GetCount() == 0 || !std::isfinite(amount) || !std::isfinite(tolerance))
        return nullptr;
    ClipperLib::ClipperOffset offset(2.0, std::max(1.0, tolerance * kScale / 4.0));
    const bool closed = shape.IsClosed() && shape.GetCount() > 2;
    offset.AddPath(ToPath(shape.GetSamplePoints(kFlatten)), ClipperLib::jtRound,
                   closed ? ClipperLib::etClosedPolygon : ClipperLib::etOpenRound);
    ClipperLib::Paths result;
    offset.Execute(result, amount * kScale);
    const ClipperLib::Path *largest = nullptr;
    for (const ClipperLib::Path &p : result)
        if (!largest || std::abs(ClipperLib::Area(p)) > std::abs(ClipperLib::Area(*largest)))
            largest = &p;
    if (!largest || largest->size() < 3)
        return nullptr;
    std::vector<OrbPoint> outline;
    for (const ClipperLib::IntPoint &p : *largest)
        outline.emplace_back(p.X / kScale, p.Y / kScale);
    outline.push_back(outline.front());
    auto *out = new PolyLine;
    for (const PolyPoint &p : CurveFit::KeyPoints(CurveFit::Fit(outline, tolerance), true))
        out->AddPoint(p);
    out->Close();
    return out;
}

} // namespace Orbane
