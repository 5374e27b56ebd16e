#include "orbane/PolyLine.h"

#include "Bezier.h"
#include "CurveMeasure.h"
#include "SegmentIndex.h"
#include "orbane/ClassIDs.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace Orbane {

namespace {

bool Finite(const PolyPoint &p)
{
    return std::isfinite(p.X) && std::isfinite(p.Y) && std::isfinite(p.InX) && std::isfinite(p.InY) &&
           std::isfinite(p.OutX) && std::isfinite(p.OutY) && std::isfinite(p.Weight) && p.Weight > 0.0;
}

float64 Mix(float64 a, float64 b, float64 t)
{
    return a + (b - a) * t;
}

// Times that are unset stay unset: a blend with the sentinel means nothing.
float64 SegmentDist2To(const OrbPoint &a, const OrbPoint &b, const OrbPoint &p)
{
    const OrbPoint ab = b - a;
    const float64 len2 = ab.LengthSquared();
    const float64 t = len2 > 0.0 ? std::clamp((p - a).Dot(ab) / len2, 0.0, 1.0) : 0.0;
    return (a + ab * t - p).LengthSquared();
}

bool InTriangle(const OrbPoint &a, const OrbPoint &b, const OrbPoint &c, const OrbPoint &p)
{
    auto side = [&p](const OrbPoint &u, const OrbPoint &v) {
        return (v.x - u.x) * (p.y - u.y) - (v.y - u.y) * (p.x - u.x);
    };
    const float64 s1 = side(a, b), s2 = side(b, c), s3 = side(c, a);
    return (s1 >= 0 && s2 >= 0 && s3 >= 0) || (s1 <= 0 && s2 <= 0 && s3 <= 0);
}

// The squared distance from `p` to the convex hull of four points: zero
// inside (inside one of the triangles of three of them), else the distance
// to the nearest of the six segments between them, whose outer ones are the
// hull's edges.
float64 HullDist2(const OrbPoint h[4], const OrbPoint &p)
{
    if (InTriangle(h[0], h[1], h[2], p) || InTriangle(h[0], h[1], h[3], p) || InTriangle(h[0], h[2], h[3], p) ||
        InTriangle(h[1], h[2], h[3], p))
        return 0.0;
    float64 d = std::numeric_limits<float64>::infinity();
    for (int i = 0; i < 4; ++i)
        for (int j = i + 1; j < 4; ++j)
            d = std::min(d, SegmentDist2To(h[i], h[j], p));
    return d;
}

float64 MixTime(float64 a, float64 b, float64 t)
{
    return a == TIME_UNDEFINED || b == TIME_UNDEFINED ? a : Mix(a, b, t);
}

PolyPoint MixPoint(const PolyPoint &a, const PolyPoint &b, float64 t)
{
    PolyPoint p = a;
    p.X = Mix(a.X, b.X, t), p.Y = Mix(a.Y, b.Y, t);
    p.InX = Mix(a.InX, b.InX, t), p.InY = Mix(a.InY, b.InY, t);
    p.OutX = Mix(a.OutX, b.OutX, t), p.OutY = Mix(a.OutY, b.OutY, t);
    p.Weight = Mix(a.Weight, b.Weight, t), p.Pressure = Mix(a.Pressure, b.Pressure, t);
    p.Time = MixTime(a.Time, b.Time, t);
    p.Height = Mix(a.Height, b.Height, t), p.AngleXY = Mix(a.AngleXY, b.AngleXY, t);
    p.AngleZ = Mix(a.AngleZ, b.AngleZ, t), p.Rotation = Mix(a.Rotation, b.Rotation, t);
    p.DispX = Mix(a.DispX, b.DispX, t), p.DispY = Mix(a.DispY, b.DispY, t);
    return p;
}

} // namespace

PolyLine::PolyLine(const PolyLine &o) : Parameter(), mPoints(o.mPoints), mIndex(o.mIndex), mClosed(o.mClosed)
{
    Adopt();
}

PolyLine &PolyLine::operator=(const PolyLine &o)
{
    if (this != &o)
        Copy(o);
    return *this;
}

PolyLine::~PolyLine() = default;

const OrbID &PolyLine::DataType() const noexcept
{
    return CLSID_DataType_Polyline;
}

std::size_t PolyLine::Footprint() const noexcept
{
    return kSmallFootprint + mPoints.capacity() * sizeof(PolyPoint);
}

Parameter *PolyLine::Clone() const
{
    return new PolyLine(*this);
}

bool PolyLine::Equals(const Parameter &o) const
{
    const auto *p = dynamic_cast<const PolyLine *>(&o);
    return p && p->DataType() == DataType() && *p == *this;
}

Parameter *PolyLine::Interpolate(const Parameter &to, float64 t) const
{
    const auto *p = dynamic_cast<const PolyLine *>(&to);
    if (!p || p->DataType() != DataType())
        return Parameter::Interpolate(to, t);
    PolyLine *mixed = InterpolateWith(*p, t);
    mixed->mFromSplineList = true;
    return mixed;
}

PolyPoint *PolyLine::First(uint32) const
{
    return GetPoint(0);
}

PolyPoint *PolyLine::Last(uint32) const
{
    return GetPoint(GetCount() - 1);
}

PolyPoint *PolyLine::GetPoint(int32 index) const
{
    if (index < 0 || index >= GetCount())
        return nullptr;
    // The points are only handed out for walking and reading; a shape held
    // by an Input is edited through a copy.
    return const_cast<PolyPoint *>(&mPoints[std::size_t(index)]);
}

int32 PolyLine::GetIndex(const PolyPoint *p) const noexcept
{
    if (mPoints.empty() || p < mPoints.data() || p >= mPoints.data() + mPoints.size())
        return -1;
    return int32(p - mPoints.data());
}

int32 PolyLine::GetSegmentsCount() const noexcept
{
    const int32 n = GetCount();
    if (n < 2)
        return 0;
    return mClosed ? n : n - 1;
}

void PolyLine::SegmentOf(float64 par, int32 &seg, float64 &t) const
{
    const int32 segs = GetSegmentsCount();
    if (segs == 0 || !(par > 0.0)) {
        seg = 0, t = 0.0;
        return;
    }
    if (par >= segs) {
        seg = segs - 1, t = 1.0;
        return;
    }
    seg = int32(std::floor(par));
    t = par - seg;
}

void PolyLine::SegmentHull(int32 seg, OrbPoint hull[4]) const
{
    const PolyPoint &a = mPoints[std::size_t(seg)];
    const PolyPoint &b = mPoints[std::size_t((seg + 1) % GetCount())];
    hull[0] = a.Pos(), hull[1] = a.Out(), hull[2] = b.In(), hull[3] = b.Pos();
}

bool PolyLine::CalcXYZ(float64 par, float64 &x, float64 &y, float64 &z) const
{
    if (mPoints.empty())
        return false;
    z = 0.0;
    if (GetSegmentsCount() == 0) {
        x = mPoints[0].X, y = mPoints[0].Y;
        return true;
    }
    int32 seg;
    float64 t;
    SegmentOf(par, seg, t);
    OrbPoint c[4];
    SegmentHull(seg, c);
    const OrbPoint p = Bezier::Eval(c, t);
    x = p.x, y = p.y;
    return true;
}

OrbPoint PolyLine::ValueAt(float64 par) const
{
    float64 x = 0.0, y = 0.0, z = 0.0;
    CalcXYZ(par, x, y, z);
    return {x, y};
}

OrbPoint PolyLine::TangentAt(float64 par) const
{
    if (GetSegmentsCount() == 0)
        return {};
    int32 seg;
    float64 t;
    SegmentOf(par, seg, t);
    OrbPoint c[4];
    SegmentHull(seg, c);
    return Bezier::Deriv(c, t);
}

std::vector<OrbPoint> PolyLine::GetSamplePoints(int32 perSegment) const
{
    std::vector<OrbPoint> out;
    const int32 segs = GetSegmentsCount();
    if (segs == 0) {
        if (!mPoints.empty())
            out.push_back(mPoints[0].Pos());
        return out;
    }
    perSegment = std::max(1, perSegment);
    out.reserve(std::size_t(segs * perSegment + 1));
    for (int32 s = 0; s < segs; ++s)
        for (int32 i = 0; i < perSegment; ++i)
            out.push_back(ValueAt(s + float64(i) / perSegment));
    if (!mClosed)
        out.push_back(ValueAt(segs));
    return out;
}

std::vector<PolyPoint> PolyLine::GetDigitalPoints(float64 spacing) const
{
    std::vector<PolyPoint> out;
    const int32 segs = GetSegmentsCount();
    if (segs == 0 || !(spacing > 0.0)) {
        out.assign(mPoints.begin(), mPoints.end());
        return out;
    }
    for (int32 s = 0; s < segs; ++s) {
        const PolyPoint &a = mPoints[std::size_t(s)], &b = mPoints[std::size_t((s + 1) % GetCount())];
        const int32 steps = std::max(1, int32(std::ceil(Distance(s, s + 1) / spacing)));
        const bool last = s == segs - 1 && !mClosed;
        for (int32 i = 0; i < steps + (last ? 1 : 0); ++i) {
            const float64 t = float64(i) / steps;
            const OrbPoint at = ValueAt(s + t);
            PolyPoint p = MixPoint(a, b, t);
            p.X = p.InX = p.OutX = at.x;
            p.Y = p.InY = p.OutY = at.y;
            p.Flags = 0, p.TagID = 0, p.FollowIndex = -1;
            out.push_back(p);
        }
    }
    return out;
}

const SegmentIndex &PolyLine::Index() const
{
    if (!mIndex) {
        std::vector<SegmentIndex::Box> boxes(static_cast<std::size_t>(GetSegmentsCount()));
        for (int32 s = 0; s < GetSegmentsCount(); ++s) {
            OrbPoint h[4];
            SegmentHull(s, h);
            SegmentIndex::Box &b = boxes[std::size_t(s)];
            b = {h[0].x, h[0].y, h[0].x, h[0].y};
            for (const OrbPoint &q : h)
                b = {std::min(b.x0, q.x), std::min(b.y0, q.y), std::max(b.x1, q.x), std::max(b.y1, q.y)};
        }
        mIndex = std::make_shared<const SegmentIndex>(std::move(boxes));
    }
    return *mIndex;
}

// Samples the segment, then solves (C(t) - p) . C'(t) = 0 near the best
// sample by secant steps kept inside the samples on either side; the
// samples are dense enough that a cubic piece has one minimum between two.
float64 PolyLine::SegmentDist2(int32 seg, const OrbPoint &p, float64 &t, float64 bound) const
{
    // The curve lies in its hull: a hull no nearer than `bound` needs no
    // closer look.
    OrbPoint hull[4];
    SegmentHull(seg, hull);
    if (const float64 lower = HullDist2(hull, p); lower >= bound)
        return lower;
    constexpr int32 kSamples = 16;
    constexpr int32 kSteps = 8;
    auto d2 = [&](float64 u) { return (ValueAt(seg + u) - p).LengthSquared(); };
    // On the segment's own piece: at u = 1 the parameter names the next one.
    auto slope = [&](float64 u) { return (ValueAt(seg + u) - p).Dot(TangentAt(seg + std::min(u, 1.0 - 1e-9))); };
    int32 best = 0;
    float64 bestD = d2(0.0);
    for (int32 i = 1; i <= kSamples; ++i)
        if (const float64 d = d2(float64(i) / kSamples); d < bestD)
            bestD = d, best = i;
    const float64 lo = std::max(0.0, (best - 1.0) / kSamples), hi = std::min(1.0, (best + 1.0) / kSamples);
    float64 a = lo, b = hi, fa = slope(a), fb = slope(b);
    for (int32 i = 0; i < kSteps && fa != fb; ++i) {
        const float64 c = std::clamp(b - fb * (b - a) / (fb - fa), lo, hi);
        a = b, fa = fb, b = c, fb = slope(c);
    }
    t = b;
    const float64 refined = d2(t);
    if (bestD <= refined) {
        t = float64(best) / kSamples;
        return bestD;
    }
    return refined;
}

float64 PolyLine::CalcClosestPar(float64 x, float64 y, float64 *distance) const
{
    float64 px, py, par = -1.0;
    const float64 d = CalcClosestPoint(x, y, px, py, &par);
    if (distance)
        *distance = d;
    return par;
}

float64 PolyLine::CalcClosestPoint(float64 x, float64 y, float64 &px, float64 &py, float64 *par) const
{
    if (mPoints.empty())
        return -1.0;
    const OrbPoint p(x, y);
    float64 t = 0.0, d2 = (mPoints[0].Pos() - p).LengthSquared();
    int32 seg = 0;
    if (GetSegmentsCount() > 0)
        seg = Index().Nearest(
            p, [&](int32 s, float64 bound) { return SegmentDist2(s, p, t, bound); }, d2);
    // The search leaves t at the last segment tried: find it again.
    if (GetSegmentsCount() > 0)
        d2 = SegmentDist2(seg, p, t, std::numeric_limits<float64>::infinity());
    const OrbPoint at = ValueAt(seg + t);
    px = at.x, py = at.y;
    if (par)
        *par = seg + t;
    return std::sqrt(d2);
}

float64 PolyLine::Distance(float64 par0, float64 par1) const
{
    if (par1 < par0)
        return -Distance(par1, par0);
    const int32 segs = GetSegmentsCount();
    par0 = std::clamp(par0, 0.0, float64(segs)), par1 = std::clamp(par1, 0.0, float64(segs));
    float64 sum = 0.0;
    for (int32 s = int32(std::floor(par0)); s < segs && s < par1; ++s) {
        const float64 from = std::max(par0, float64(s)) - s, to = std::min(par1, s + 1.0) - s;
        sum += CurveMeasure::Length([&](float64 u) { return TangentAt(s + u); }, from, to);
    }
    return sum;
}

float64 PolyLine::CalcLength() const
{
    return Distance(0.0, GetSegmentsCount());
}

OrbPoint PolyLine::GetPointOnPath(float64 distance, float64 *par) const
{
    constexpr int32 kBisections = 50;
    const int32 segs = GetSegmentsCount();
    float64 at = 0.0, left = std::max(0.0, distance);
    for (int32 s = 0; s < segs; ++s, at = s) {
        const float64 len = Distance(s, s + 1);
        if (left > len && s < segs - 1) {
            left -= len;
            continue;
        }
        float64 lo = 0.0, hi = 1.0;
        for (int32 i = 0; i < kBisections && left < len; ++i) {
            const float64 mid = 0.5 * (lo + hi);
            (Distance(s, s + mid) < left ? lo : hi) = mid;
        }
        at = s + (left < len ? 0.5 * (lo + hi) : 1.0);
        break;
    }
    if (par)
        *par = at;
    return ValueAt(at);
}

bool PolyLine::AddPoint(const PolyPoint &p)
{
    return InsertPoint(GetCount(), p);
}

bool PolyLine::InsertPoint(int32 index, const PolyPoint &p)
{
    if (index < 0 || index > GetCount() || !Finite(p))
        return false;
    const PolyPoint *before = mPoints.data();
    mPoints.insert(mPoints.begin() + index, p);
    mIndex.reset();
    // Appending without moving the others tells only the new point its
    // shape, so building a shape point by point stays linear.
    if (mPoints.data() == before && index == GetCount() - 1)
        mPoints.back().mOwner = this;
    else
        Adopt();
    return true;
}

int32 PolyLine::InsertPointAt(float64 par)
{
    if (GetSegmentsCount() == 0 || !std::isfinite(par))
        return -1;
    int32 seg;
    float64 t;
    SegmentOf(par, seg, t);
    OrbPoint c[4], left[4], right[4];
    SegmentHull(seg, c);
    Bezier::Split(c, t, left, right);
    PolyPoint mid(left[3].x, left[3].y);
    mid.InX = left[2].x, mid.InY = left[2].y, mid.OutX = right[1].x, mid.OutY = right[1].y;
    PolyPoint &a = mPoints[std::size_t(seg)];
    a.OutX = left[1].x, a.OutY = left[1].y;
    PolyPoint &b = mPoints[std::size_t((seg + 1) % GetCount())];
    b.InX = right[2].x, b.InY = right[2].y;
    mid.Time = MixTime(a.Time, b.Time, t), mid.Pressure = Mix(a.Pressure, b.Pressure, t);
    mPoints.insert(mPoints.begin() + seg + 1, mid);
    Changed();
    return seg + 1;
}

bool PolyLine::MovePoints(const uint8 *selected, float64 dx, float64 dy)
{
    if (!std::isfinite(dx) || !std::isfinite(dy) || (dx == 0.0 && dy == 0.0))
        return false;
    bool moved = false;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (!selected || selected[i]) {
            mPoints[i].Offset(dx, dy);
            moved = true;
        }
    if (moved)
        Changed();
    return moved;
}

bool PolyLine::DeletePoints(const uint8 *selected)
{
    std::size_t kept = 0;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        if (selected && !selected[i])
            mPoints[kept++] = mPoints[i];
    if (kept == mPoints.size())
        return false;
    mPoints.resize(kept);
    Changed();
    return true;
}

bool PolyLine::DeleteAllPoints()
{
    if (mPoints.empty())
        return false;
    mPoints.clear();
    Changed();
    return true;
}

bool PolyLine::Close()
{
    if (mClosed)
        return false;
    mClosed = true;
    Changed();
    return true;
}

bool PolyLine::Open()
{
    if (!mClosed)
        return false;
    mClosed = false;
    Changed();
    return true;
}

void PolyLine::Copy(const PolyLine &from)
{
    mPoints = from.mPoints;
    mClosed = from.mClosed;
    Changed();
}

PolyLine *PolyLine::InterpolateWith(const PolyLine &to, float64 t) const
{
    auto *out = static_cast<PolyLine *>((t >= 1.0 ? to : *this).Clone());
    if (to.GetCount() != GetCount() || t <= 0.0 || t >= 1.0)
        return out;
    for (std::size_t i = 0; i < mPoints.size(); ++i)
        out->mPoints[i] = MixPoint(mPoints[i], to.mPoints[i], t);
    out->Changed();
    return out;
}

bool PolyLine::operator==(const PolyLine &o) const
{
    return mClosed == o.mClosed && mPoints == o.mPoints;
}

void PolyLine::Changed()
{
    mIndex.reset();
    Adopt();
}

void PolyLine::Adopt()
{
    for (PolyPoint &p : mPoints)
        p.mOwner = this;
}

} // namespace Orbane
