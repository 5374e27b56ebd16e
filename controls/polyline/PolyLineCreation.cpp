#include "polyline/PolyLineCreation.h"

#include "orbane/PolyLine.h"
#include "orbane/ViewMapping.h"

#include <cmath>

namespace Orbane {

namespace {

// A new shape of `shape`'s kind and closure holding `points`.
AutoRef<PolyLine> Rebuilt(const PolyLine &shape, const std::vector<PolyPoint> &points)
{
    AutoRef<PolyLine> out(static_cast<PolyLine *>(shape.Clone()));
    out->DeleteAllPoints();
    for (const PolyPoint &p : points)
        out->AddPoint(p);
    if (shape.IsClosed())
        out->Close();
    return out;
}

// The stroke in viewer pixels fitted with Bezier key points (still in
// pixels), or every sample a corner where the tolerance is 0.
std::vector<PolyPoint> Fit(const std::vector<OrbPoint> &pixels, float64 tolerance)
{
    std::vector<PolyPoint> corners;
    for (const OrbPoint &p : pixels)
        corners.emplace_back(p.x, p.y);
    return corners;
}

// The pen values of the sample nearest `at` (viewer pixels), as asked.
void Record(PolyPoint &p, OrbPoint at, const std::vector<PolyLineCreation::Sample> &stroke,
            const std::vector<OrbPoint> &pixels, uint32 record)
{
    std::size_t best = 0;
    for (std::size_t i = 1; i < pixels.size(); ++i)
        if ((pixels[i] - at).Length() < (pixels[best] - at).Length())
            best = i;
    if (record & PLR_Time)
        p.Time = stroke[best].time;
    if (record & PLR_Pressure)
        p.Pressure = stroke[best].pressure;
}

bool Valid(const PolyLine &shape, int32 index)
{
    return index >= 0 && index < shape.GetCount();
}

} // namespace

AutoRef<PolyLine> PolyLineCreation::Appended(const PolyLine *shape, OrbPoint at)
{
    AutoRef<PolyLine> out(shape ? static_cast<PolyLine *>(shape->Clone()) : new PolyLine);
    if (!out->AddPoint(PolyPoint(at.x, at.y)))
        return {};
    return out;
}

AutoRef<PolyLine> PolyLineCreation::Pulled(const PolyLine &shape, int32 index, OrbPoint to)
{
    if (!Valid(shape, index))
        return {};
    std::vector<PolyPoint> points = shape.Points();
    PolyPoint &p = points[std::size_t(index)];
    p.OutX = to.x;
    p.OutY = to.y;
    p.InX = 2 * p.X - to.x;
    p.InY = 2 * p.Y - to.y;
    p.Flags &= ~uint32(PPF_Linear);
    return Rebuilt(shape, points);
}

AutoRef<PolyLine> PolyLineCreation::Closed(const PolyLine &shape)
{
    AutoRef<PolyLine> out(static_cast<PolyLine *>(shape.Clone()));
    if (!out->Close())
        return {};
    return out;
}

AutoRef<PolyLine> PolyLineCreation::Moved(const PolyLine &shape, int32 index, uint32 part, OrbPoint to)
{
    if (!Valid(shape, index))
        return {};
    std::vector<PolyPoint> points = shape.Points();
    PolyPoint &p = points[std::size_t(index)];
    if (part == 2) {
        p.InX = to.x, p.InY = to.y;
    } else if (part == 4) {
        p.OutX = to.x, p.OutY = to.y;
    } else {
        p.Offset(to.x - p.X, to.y - p.Y);
    }
    return Rebuilt(shape, points);
}

void PolyLineCreation::BeginStroke(const Sample &first)
{
    mStroke.assign(1, first);
}

bool PolyLineCreation::AddSample(const Sample &s, OrbPoint minStep)
{
    if (!mStroke.empty()) {
        const OrbPoint d = s.at - mStroke.back().at;
        if (std::fabs(d.x) < minStep.x && std::fabs(d.y) < minStep.y)
            return false;
    }
    mStroke.push_back(s);
    return true;
}

std::vector<OrbPoint> PolyLineCreation::StrokePoints() const
{
    std::vector<OrbPoint> points;
    points.reserve(mStroke.size());
    for (const Sample &s : mStroke)
        points.push_back(s.at);
    return points;
}

AutoRef<PolyLine> PolyLineCreation::WithStroke(const PolyLine *shape, const ViewMapping &view, float64 tolerance,
                                               uint32 record) const
{
    if (mStroke.empty())
        return {};
    std::vector<OrbPoint> pixels;
    for (const Sample &s : mStroke)
        pixels.push_back(view.ToViewer(s.at));
    AutoRef<PolyLine> out(shape ? static_cast<PolyLine *>(shape->Clone()) : new PolyLine);
    for (PolyPoint p : Fit(pixels, tolerance)) {
        Record(p, p.Pos(), mStroke, pixels, record);
        const OrbPoint at = view.ToImage(p.Pos()), in = view.ToImage(p.In()), outHandle = view.ToImage(p.Out());
        p.X = at.x, p.Y = at.y, p.InX = in.x, p.InY = in.y, p.OutX = outHandle.x, p.OutY = outHandle.y;
        out->AddPoint(p);
    }
    return out;
}

} // namespace Orbane
