// The point-editing half of PolyLine: handles, pen values, publishing and
// following. Geometry and walking are in PolyLine.cpp.
#include "CurveFit.h"
#include "ShapeConvert.h"
#include "ShapeExpand.h"
#include "ShapeMaker.h"
#include "orbane/AutoParam.h"
#include "orbane/BSplinePolyLine.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/PolyLine.h"

#include <algorithm>
#include <cmath>
#include <string>

namespace Orbane {

namespace {

bool AllFinite(std::initializer_list<float64> values)
{
    for (float64 v : values)
        if (!std::isfinite(v))
            return false;
    return true;
}

bool IsSelected(const uint8 *selected, std::size_t i)
{
    return !selected || selected[i];
}

// Sets a point's handles; true where that changed them.
bool SetHandles(PolyPoint &p, const OrbPoint &in, const OrbPoint &out)
{
    if (p.In() == in && p.Out() == out)
        return false;
    p.InX = in.x, p.InY = in.y, p.OutX = out.x, p.OutY = out.y;
    return true;
}

} // namespace

void PolyLine::SmoothHandles(int32 i, OrbPoint &in, OrbPoint &out) const
{
    const int32 n = GetCount();
    const OrbPoint p = mPoints[std::size_t(i)].Pos();
    const bool hasPrev = mClosed || i > 0, hasNext = mClosed || i < n - 1;
    const OrbPoint prev = hasPrev ? mPoints[std::size_t((i - 1 + n) % n)].Pos() : p;
    const OrbPoint next = hasNext ? mPoints[std::size_t((i + 1) % n)].Pos() : p;
    const OrbPoint chord = next - prev;
    const float64 len = chord.Length();
    if (n < 2 || len == 0.0) {
        in = out = p;
        return;
    }
    const OrbPoint dir = chord / len;
    in = p - dir * ((p - prev).Length() / 3.0);
    out = p + dir * ((next - p).Length() / 3.0);
}

bool PolyLine::Linear(const uint8 *selected)
{
    bool changed = false;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (IsSelected(selected, i)) {
            PolyPoint &p = mPoints[i];
            changed = SetHandles(p, p.Pos(), p.Pos()) || !(p.Flags & PPF_Linear) || changed;
            p.Flags |= PPF_Linear;
        }
    if (changed)
        Changed();
    return changed;
}

bool PolyLine::Smooth(const uint8 *selected)
{
    return Shaping(selected, 1.0);
}

bool PolyLine::Tensioning(const uint8 *selected, float64 factor)
{
    if (!std::isfinite(factor) || factor < 0.0)
        return false;
    bool changed = false;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (IsSelected(selected, i)) {
            PolyPoint &p = mPoints[i];
            changed =
                SetHandles(p, p.Pos() + (p.In() - p.Pos()) * factor, p.Pos() + (p.Out() - p.Pos()) * factor) || changed;
        }
    if (changed)
        Changed();
    return changed;
}

bool PolyLine::Shaping(const uint8 *selected, float64 amount)
{
    if (!std::isfinite(amount))
        return false;
    amount = std::clamp(amount, 0.0, 1.0);
    // The smooth handles of every point come from the unchanged shape.
    std::vector<std::pair<OrbPoint, OrbPoint>> target(mPoints.size());
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (IsSelected(selected, i))
            SmoothHandles(int32(i), target[i].first, target[i].second);
    bool changed = false;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (IsSelected(selected, i)) {
            PolyPoint &p = mPoints[i];
            const OrbPoint in = p.In() + (target[i].first - p.In()) * amount;
            const OrbPoint out = p.Out() + (target[i].second - p.Out()) * amount;
            changed = SetHandles(p, in, out) || changed;
            if (amount > 0.0)
                p.Flags &= ~uint32(PPF_Linear);
        }
    if (changed)
        Changed();
    return changed;
}

bool PolyLine::ResetAttrib(const uint8 *selected)
{
    bool changed = false;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (IsSelected(selected, i)) {
            PolyPoint &p = mPoints[i];
            PolyPoint reset = p;
            reset.Weight = 1.0, reset.Time = TIME_UNDEFINED, reset.Pressure = 1.0;
            reset.Height = reset.AngleXY = reset.AngleZ = reset.Rotation = 0.0;
            changed = changed || reset != p;
            p = reset;
        }
    if (changed)
        Changed();
    return changed;
}

bool PolyLine::SetDiscontinualSegementMask(const uint8 *selected)
{
    bool changed = false;
    for (std::size_t i = 0; i < mPoints.size(); ++i) {
        const uint32 flags = IsSelected(selected, i) ? mPoints[i].Flags | PPF_Discontinual
                                                     : mPoints[i].Flags & ~uint32(PPF_Discontinual);
        changed = changed || flags != mPoints[i].Flags;
        mPoints[i].Flags = flags;
    }
    if (changed)
        Changed();
    return changed;
}

bool PolyLine::IsDiscontinual(int32 seg) const
{
    const PolyPoint *p = GetPoint(seg);
    return p && (p->Flags & PPF_Discontinual);
}

int32 PolyLine::PublishPoints(const uint8 *selected, int32 firstID)
{
    int32 next = std::max(1, firstID);
    for (const PolyPoint &p : mPoints)
        if (p.Flags & PPF_Published)
            next = std::max(next, p.TagID + 1);
    int32 published = 0;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (IsSelected(selected, i) && !(mPoints[i].Flags & PPF_Published)) {
            mPoints[i].Flags |= PPF_Published;
            mPoints[i].TagID = next++;
            ++published;
        }
    if (published)
        Changed();
    return published;
}

bool PolyLine::UnpublishPoints(const uint8 *selected)
{
    bool changed = false;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (IsSelected(selected, i) && (mPoints[i].Flags & PPF_Published)) {
            mPoints[i].Flags &= ~uint32(PPF_Published);
            mPoints[i].TagID = 0;
            changed = true;
        }
    if (changed)
        Changed();
    return changed;
}

int32 PolyLine::GetPublishedPoint(int32 id) const
{
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if ((mPoints[i].Flags & PPF_Published) && mPoints[i].TagID == id)
            return int32(i);
    return -1;
}

int32 PolyLine::GetSelectedPublishedPoint(const uint8 *selected) const
{
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (IsSelected(selected, i) && (mPoints[i].Flags & PPF_Published))
            return mPoints[i].TagID;
    return 0;
}

OrbID PolyLine::PublishedPointInputID(int32 id)
{
    return OrbID(("Point" + std::to_string(id)).c_str());
}

int32 PolyLine::UpdatePublishedPointInputs(Operator &tool, float64 time) const
{
    int32 written = 0;
    for (const PolyPoint &p : mPoints) {
        Input *in = (p.Flags & PPF_Published) ? tool.FindInput(PublishedPointInputID(p.TagID)) : nullptr;
        if (!in || in->GetDataType() != CLSID_DataType_Point)
            continue;
        AutoPoint value(p.X, p.Y);
        written += in->SetValue(value.get(), time) ? 1 : 0;
    }
    return written;
}

bool PolyLine::UpdatePublish(const Operator &tool, float64 time)
{
    bool changed = false;
    for (PolyPoint &p : mPoints) {
        const AutoPoint value((p.Flags & PPF_Published) ? tool.FindInput(PublishedPointInputID(p.TagID)) : nullptr,
                              time);
        if (!value || !std::isfinite(value->X) || !std::isfinite(value->Y) || (value->X == p.X && value->Y == p.Y))
            continue;
        p.Offset(value->X - p.X, value->Y - p.Y);
        changed = true;
    }
    if (changed)
        Changed();
    return changed;
}

int32 PolyLine::FindExternFollowingPoint(const PolyLine &master, int32 index) const
{
    const PolyPoint *p = GetPoint(index);
    int32 best = -1;
    float64 bestD = 0.0;
    for (int32 i = 0; p && i < master.GetCount(); ++i)
        if (const float64 d = (master.mPoints[std::size_t(i)].Pos() - p->Pos()).LengthSquared(); best < 0 || d < bestD)
            best = i, bestD = d;
    return best;
}

bool PolyLine::SetFollowing(const PolyLine &master, const uint8 *selected)
{
    bool changed = false;
    for (std::size_t i = 0; i < mPoints.size(); ++i) {
        const int32 m = IsSelected(selected, i) ? FindExternFollowingPoint(master, int32(i)) : -1;
        if (m < 0)
            continue;
        mPoints[i].Flags |= PPF_Following;
        mPoints[i].FollowIndex = m;
        changed = true;
    }
    if (changed) {
        RecalcDisplacements(master);
        Changed();
    }
    return changed;
}

bool PolyLine::SetFollowingPointsOrg(const PolyLine &master)
{
    if (master.GetCount() != GetCount() || mPoints.empty())
        return false;
    for (std::size_t i = 0; i < mPoints.size(); ++i) {
        mPoints[i].Flags |= PPF_Following;
        mPoints[i].FollowIndex = int32(i);
    }
    RecalcDisplacements(master);
    Changed();
    return true;
}

bool PolyLine::RecalcDisplacements(const PolyLine &master)
{
    bool changed = false;
    for (PolyPoint &p : mPoints) {
        const PolyPoint *m = (p.Flags & PPF_Following) ? master.GetPoint(p.FollowIndex) : nullptr;
        if (!m)
            continue;
        const float64 dx = p.X - m->X, dy = p.Y - m->Y;
        changed = changed || dx != p.DispX || dy != p.DispY;
        p.DispX = dx, p.DispY = dy;
    }
    if (changed)
        Changed();
    return changed;
}

bool PolyLine::UpdateShape(const PolyLine &master)
{
    bool changed = false;
    for (PolyPoint &p : mPoints) {
        const PolyPoint *m = (p.Flags & PPF_Following) ? master.GetPoint(p.FollowIndex) : nullptr;
        if (!m)
            continue;
        const float64 dx = m->X + p.DispX - p.X, dy = m->Y + p.DispY - p.Y;
        if (dx != 0.0 || dy != 0.0) {
            p.Offset(dx, dy);
            changed = true;
        }
    }
    if (changed)
        Changed();
    return changed;
}

bool PolyLine::SetPoint(int32 index, const PolyPoint &p)
{
    if (!GetPoint(index) || !AllFinite({p.X, p.Y, p.InX, p.InY, p.OutX, p.OutY}) || !(p.Weight > 0.0))
        return false;
    mPoints[std::size_t(index)] = p;
    Changed();
    return true;
}

bool PolyLine::SetReducedPoints(const std::vector<PolyPoint> &samples, float64 tolerancePx, float64 pixelW,
                                float64 pixelH, bool closed)
{
    if (samples.empty() || !AllFinite({tolerancePx, pixelW, pixelH}) || !(pixelW > 0.0) || !(pixelH > 0.0))
        return false;
    // Fitted in viewer pixels, so the tolerance means the same on every axis.
    std::vector<OrbPoint> px;
    for (const PolyPoint &s : samples) {
        if (!AllFinite({s.X, s.Y}))
            return false;
        px.emplace_back(s.X / pixelW, s.Y / pixelH);
    }
    if (closed && px.size() > 2 && px.back() != px.front())
        px.push_back(px.front());
    const std::vector<CurveFit::Key> keys = CurveFit::Fit(px, tolerancePx);
    std::vector<PolyPoint> pts = CurveFit::KeyPoints(keys, closed);
    for (std::size_t i = 0; i < pts.size(); ++i) {
        const PolyPoint fitted = pts[i];
        pts[i] = samples[std::size_t(keys[i].sample) % samples.size()];
        pts[i].X = fitted.X * pixelW, pts[i].Y = fitted.Y * pixelH;
        pts[i].InX = fitted.InX * pixelW, pts[i].InY = fitted.InY * pixelH;
        pts[i].OutX = fitted.OutX * pixelW, pts[i].OutY = fitted.OutY * pixelH;
    }
    mPoints = std::move(pts);
    mClosed = closed && mPoints.size() > 2;
    Changed();
    return true;
}

bool PolyLine::ReducePoints(float64 tolerancePx, float64 pixelW, float64 pixelH)
{
    if (GetSegmentsCount() == 0 || !(pixelW > 0.0) || !(pixelH > 0.0))
        return false;
    // Samples a quarter of the tolerance apart follow the curve closely
    // enough that the fit sees its shape, not its sampling.
    const float64 spacing = std::max(1e-9, 0.25 * tolerancePx * std::min(pixelW, pixelH));
    std::vector<PolyPoint> samples = GetDigitalPoints(spacing);
    return SetReducedPoints(samples, tolerancePx, pixelW, pixelH, mClosed);
}

namespace {

bool Replace(std::vector<PolyPoint> &points, std::vector<PolyPoint> made)
{
    if (made.empty())
        return false;
    points = std::move(made);
    return true;
}

} // namespace

bool PolyLine::MakeEllipse(float64 cx, float64 cy, float64 rx, float64 ry, int32 points)
{
    if (!AllFinite({cx, cy, rx, ry}) || !Replace(mPoints, ShapeMaker::Ellipse(cx, cy, rx, ry, points)))
        return false;
    mClosed = true;
    Changed();
    return true;
}

bool PolyLine::MakeRectangle(float64 cx, float64 cy, float64 w, float64 h)
{
    if (!AllFinite({cx, cy, w, h}) || !Replace(mPoints, ShapeMaker::Rectangle(cx, cy, w, h)))
        return false;
    mClosed = true;
    Changed();
    return true;
}

bool PolyLine::MakeArrow(float64 x0, float64 y0, float64 x1, float64 y1, float64 shaftWidth, float64 headWidth,
                         float64 headLength)
{
    if (!AllFinite({x0, y0, x1, y1, shaftWidth, headWidth, headLength}) ||
        !Replace(mPoints, ShapeMaker::Arrow({x0, y0}, {x1, y1}, shaftWidth, headWidth, headLength)))
        return false;
    mClosed = true;
    Changed();
    return true;
}

bool PolyLine::MakeSpiral(float64 cx, float64 cy, float64 r0, float64 r1, float64 turns, int32 pointsPerTurn)
{
    if (!AllFinite({cx, cy, r0, r1, turns}) || !(turns > 0.0) ||
        !Replace(mPoints, ShapeMaker::Spiral(cx, cy, r0, r1, turns, pointsPerTurn)))
        return false;
    mClosed = false;
    Changed();
    return true;
}

PolyLine *PolyLine::Convert(const OrbID &dataType) const
{
    if (dataType == DataType())
        return static_cast<PolyLine *>(Clone());
    if (dataType == CLSID_DataType_BSplinePolyline)
        return ShapeConvert::ToBSpline(*this);
    if (const auto *bspline = dynamic_cast<const BSplinePolyLine *>(this);
        bspline && dataType == CLSID_DataType_Polyline)
        return ShapeConvert::ToBezier(*bspline);
    return nullptr;
}

PolyLine *PolyLine::Expand(float64 amount, float64 tolerance) const
{
    return ShapeExpand::Expand(*this, amount, tolerance);
}

} // namespace Orbane
