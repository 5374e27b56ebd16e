#include "polyline/PolyLineCreation.h"

#include "orbane/PolyLine.h"

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

AutoRef<PolyLine> PolyLineCreation::WithStroke(const PolyLine *shape, OrbPoint pixel, float64 tolerance, uint32 record,
                                               bool closed) const
{
    if (mStroke.empty())
        return {};
    std::vector<PolyPoint> samples;
    samples.reserve(mStroke.size());
    for (const Sample &s : mStroke) {
        PolyPoint p(s.at.x, s.at.y);
        if (record & PLR_Time)
            p.Time = s.time;
        if (record & PLR_Pressure)
            p.Pressure = s.pressure;
        samples.push_back(p);
    }
    // A closed fit only where the stroke is the whole shape.
    closed = closed && (!shape || shape->GetCount() == 0);
    AutoRef<PolyLine> fit(new PolyLine);
    const bool fitted =
        tolerance > 0.0 && samples.size() > 2 && fit->SetReducedPoints(samples, tolerance, pixel.x, pixel.y, closed);
    AutoRef<PolyLine> out(shape ? static_cast<PolyLine *>(shape->Clone()) : new PolyLine);
    for (const PolyPoint &p : fitted ? fit->Points() : samples)
        out->AddPoint(p);
    if (fitted && fit->IsClosed())
        out->Close();
    return out;
}

} // namespace Orbane
