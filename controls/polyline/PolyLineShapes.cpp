#include "polyline/PolyLineShapes.h"

#include "orbane/AutoParam.h"
#include "orbane/BSplinePolyLine.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/PolyLine.h"
#include "orbane/SelMask.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <cstring>
#include <limits>

namespace Orbane {

namespace {

// Segment shaping takes t from [kShapeReach, 1 - kShapeReach]: nearer an
// end the handle that moves the curve there would have to fly far off.
constexpr float64 kShapeReach = 0.1;

bool IsOn(const uint8 *selected, std::size_t i)
{
    return !selected || selected[i];
}

// Replaces the points, keeping the closure (appending is linear).
void Rebuild(PolyLine &shape, const std::vector<PolyPoint> &points)
{
    const bool closed = shape.IsClosed();
    shape.DeleteAllPoints();
    for (const PolyPoint &p : points)
        shape.AddPoint(p);
    if (closed)
        shape.Close();
}

OrbPoint Map(const QTransform &t, OrbPoint p)
{
    const QPointF q = t.map(QPointF(p.x, p.y));
    return {q.x(), q.y()};
}

// The number of a point Input's id ("Point12" is 12), 0 for any other.
int32 PointNumberOf(const OrbID &id)
{
    const char *s = id.c_str();
    if (std::strncmp(s, "Point", 5) != 0 || !s[5])
        return 0;
    char *end = nullptr;
    const long n = std::strtol(s + 5, &end, 10);
    return *end == '\0' && n > 0 ? int32(n) : 0;
}

} // namespace

std::vector<uint8> PolyLineShapes::Movable(const PolyLine &shape, const SelMask &selection)
{
    std::vector<uint8> movable(std::size_t(shape.GetCount()), 0);
    for (int32 i = 0; i < shape.GetCount(); ++i)
        movable[std::size_t(i)] = selection.IsSet(i) && !(shape.GetPoint(i)->Flags & PPF_Locked);
    return movable;
}

bool PolyLineShapes::Transform(PolyLine &shape, const uint8 *selected, const QTransform &t)
{
    std::vector<PolyPoint> points = shape.Points();
    bool changed = false;
    for (std::size_t i = 0; i < points.size(); ++i) {
        if (!IsOn(selected, i))
            continue;
        PolyPoint &p = points[i];
        const OrbPoint pos = Map(t, p.Pos()), in = Map(t, p.In()), out = Map(t, p.Out());
        changed = changed || pos != p.Pos() || in != p.In() || out != p.Out();
        p.X = pos.x, p.Y = pos.y, p.InX = in.x, p.InY = in.y, p.OutX = out.x, p.OutY = out.y;
    }
    if (changed)
        Rebuild(shape, points);
    return changed;
}

bool PolyLineShapes::Flip(PolyLine &shape, const uint8 *selected, bool acrossX)
{
    float64 lo = std::numeric_limits<float64>::max(), hi = -lo;
    for (std::size_t i = 0; i < shape.Points().size(); ++i)
        if (IsOn(selected, i)) {
            const float64 v = acrossX ? shape.Points()[i].X : shape.Points()[i].Y;
            lo = std::min(lo, v), hi = std::max(hi, v);
        }
    if (lo > hi)
        return false;
    const float64 mid = (lo + hi) / 2.0;
    const QTransform t = acrossX ? QTransform(-1, 0, 0, 1, 2 * mid, 0) : QTransform(1, 0, 0, -1, 0, 2 * mid);
    // A single point flipped about itself keeps its place but turns its handles.
    return Transform(shape, selected, t);
}

bool PolyLineShapes::ToggleTags(PolyLine &shape, const uint8 *selected)
{
    std::vector<PolyPoint> points = shape.Points();
    bool allTagged = true;
    for (std::size_t i = 0; i < points.size(); ++i)
        allTagged = allTagged && (!IsOn(selected, i) || (points[i].Flags & PPF_Tagged));
    for (std::size_t i = 0; i < points.size(); ++i) {
        if (!IsOn(selected, i))
            continue;
        points[i].Flags = allTagged ? points[i].Flags & ~uint32(PPF_Tagged) : points[i].Flags | PPF_Tagged;
        if (!allTagged && points[i].TagID == 0)
            points[i].TagID = int32(i) + 1;
    }
    Rebuild(shape, points);
    return !points.empty();
}

bool PolyLineShapes::SetFlag(PolyLine &shape, const uint8 *selected, uint32 flag, bool on)
{
    std::vector<PolyPoint> points = shape.Points();
    bool changed = false;
    for (std::size_t i = 0; i < points.size(); ++i)
        if (IsOn(selected, i) && bool(points[i].Flags & flag) != on) {
            points[i].Flags = on ? points[i].Flags | flag : points[i].Flags & ~flag;
            changed = true;
        }
    if (changed)
        Rebuild(shape, points);
    return changed;
}

bool PolyLineShapes::Subdivide(PolyLine &shape)
{
    const auto *spline = dynamic_cast<const BSplinePolyLine *>(&shape);
    const int32 n = shape.GetCount();
    if (!spline || n < 2)
        return false;
    // Control point k of the curve, homogeneous; the open ends' phantoms too.
    auto at = [spline](int32 k, float64 c[3]) { spline->ControlPoint(k, c[0], c[1], c[2]); };
    auto point = [&shape](const float64 c[3], int32 like) {
        PolyPoint p = *shape.GetPoint(like);
        const PolyPoint made(c[0] / c[2], c[1] / c[2]);
        p.X = p.InX = p.OutX = made.X;
        p.Y = p.InY = p.OutY = made.Y;
        p.Weight = c[2];
        p.Flags &= ~uint32(PPF_Published | PPF_Tagged);
        return p;
    };
    std::vector<PolyPoint> refined;
    const int32 edges = shape.IsClosed() ? n : n - 1;
    for (int32 i = 0; i < n; ++i) {
        float64 prev[3], self[3], next[3], v[3], e[3];
        at(i - 1, prev), at(i, self), at(i + 1, next);
        for (int c = 0; c < 3; ++c)
            v[c] = (prev[c] + 6.0 * self[c] + next[c]) / 8.0, e[c] = (self[c] + next[c]) / 2.0;
        PolyPoint vertex = point(v, i);
        vertex.Flags = shape.GetPoint(i)->Flags, vertex.TagID = shape.GetPoint(i)->TagID;
        refined.push_back(vertex);
        if (i < edges)
            refined.push_back(point(e, i));
    }
    Rebuild(shape, refined);
    return true;
}

AutoRef<PolyLine> PolyLineShapes::Selected(const PolyLine &shape, const uint8 *selected)
{
    AutoRef<PolyLine> out(static_cast<PolyLine *>(shape.Clone()));
    std::vector<PolyPoint> kept;
    for (std::size_t i = 0; i < shape.Points().size(); ++i)
        if (IsOn(selected, i))
            kept.push_back(shape.Points()[i]);
    Rebuild(*out, kept);
    out->Open();
    return out;
}

bool PolyLineShapes::Append(PolyLine &shape, const PolyLine &more)
{
    const bool empty = shape.GetCount() == 0;
    bool changed = false;
    for (const PolyPoint &p : more.Points())
        changed = shape.AddPoint(p) || changed;
    if (empty && more.IsClosed())
        shape.Close();
    return changed;
}

bool PolyLineShapes::ShapeSegment(PolyLine &shape, int32 segment, float64 t, OrbPoint delta)
{
    const int32 n = shape.GetCount();
    if (segment < 0 || segment >= shape.GetSegmentsCount() || n < 2)
        return false;
    PolyPoint a = *shape.GetPoint(segment), b = *shape.GetPoint((segment + 1) % n);
    if (shape.DataType() == CLSID_DataType_BSplinePolyline) {
        // Control points have no handles: the two that shape it move along.
        a.Offset(delta.x, delta.y), b.Offset(delta.x, delta.y);
    } else {
        t = std::clamp(t, kShapeReach, 1.0 - kShapeReach);
        // The curve's point at t moves by 3(1-t)^2 t d1 + 3(1-t) t^2 d2; with
        // d1 = k(1-t) delta and d2 = k t delta that is delta for this k.
        const float64 k = 1.0 / (3.0 * t * (1.0 - t) * ((1.0 - t) * (1.0 - t) + t * t));
        a.OutX += k * (1.0 - t) * delta.x, a.OutY += k * (1.0 - t) * delta.y;
        b.InX += k * t * delta.x, b.InY += k * t * delta.y;
        a.Flags &= ~uint32(PPF_Linear), b.Flags &= ~uint32(PPF_Linear);
    }
    const bool one = shape.SetPoint(segment, a);
    return shape.SetPoint((segment + 1) % n, b) || one;
}

bool PolyLineShapes::MoveHandle(PolyLine &shape, int32 index, uint32 part, OrbPoint to, bool breakTangent)
{
    const PolyPoint *at = shape.GetPoint(index);
    if (!at || (part != 2 && part != 4))
        return false;
    PolyPoint p = *at;
    OrbPoint moved = to, other = part == 2 ? p.Out() : p.In();
    const OrbPoint arm = to - p.Pos();
    const float64 reach = (other - p.Pos()).Length(), len = arm.Length();
    if (!breakTangent && reach > 0.0 && len > 0.0)
        other = p.Pos() - arm * (reach / len);
    const OrbPoint in = part == 2 ? moved : other, out = part == 2 ? other : moved;
    p.InX = in.x, p.InY = in.y, p.OutX = out.x, p.OutY = out.y;
    p.Flags &= ~uint32(PPF_Linear);
    return shape.SetPoint(index, p);
}

AutoRef<PolyLine> PolyLineShapes::OuterOf(const PolyLine &inner, float64 distance)
{
    AutoRef<PolyLine> outer(static_cast<PolyLine *>(inner.Clone()));
    std::vector<PolyPoint> points = inner.Points();
    const int32 n = inner.GetCount();
    // Out is to the right of the direction of travel on an anticlockwise
    // shape (Y up); a clockwise one turns it round.
    float64 area = 0.0;
    for (int32 i = 0; i < n; ++i) {
        const OrbPoint a = points[std::size_t(i)].Pos(), b = points[std::size_t((i + 1) % n)].Pos();
        area += a.x * b.y - b.x * a.y;
    }
    const float64 side = area >= 0.0 ? 1.0 : -1.0;
    for (int32 i = 0; i < n; ++i) {
        const bool closed = inner.IsClosed();
        const int32 before = closed ? (i + n - 1) % n : std::max(0, i - 1);
        const int32 after = closed ? (i + 1) % n : std::min(n - 1, i + 1);
        const OrbPoint prev = inner.Points()[std::size_t(before)].Pos();
        const OrbPoint next = inner.Points()[std::size_t(after)].Pos();
        const OrbPoint along = next - prev;
        const float64 len = along.Length();
        if (len <= 0.0)
            continue;
        points[std::size_t(i)].Offset(side * along.y / len * distance, -side * along.x / len * distance);
        points[std::size_t(i)].Flags &= ~uint32(PPF_Published);
    }
    Rebuild(*outer, points);
    return outer;
}

int32 PolyLineShapes::FirstFreePointNumber(const Operator &tool)
{
    int32 highest = 0;
    for (const Input *in : tool.Inputs())
        highest = std::max(highest, PointNumberOf(in->GetID()));
    return highest + 1;
}

bool PolyLineShapes::FollowPublished(PolyLine &shape, const uint8 *selected, const Operator &tool, float64 time)
{
    // The numbers this shape publishes itself are no one to follow.
    std::vector<int32> own;
    for (const PolyPoint &p : shape.Points())
        if (p.Flags & PPF_Published)
            own.push_back(p.TagID);
    std::vector<std::pair<int32, OrbPoint>> targets;
    for (Input *in : tool.Inputs()) {
        const int32 number = PointNumberOf(in->GetID());
        const AutoPoint at(number ? in : nullptr, time);
        if (at && std::find(own.begin(), own.end(), number) == own.end())
            targets.push_back({number, OrbPoint(at->X, at->Y)});
    }
    if (targets.empty())
        return false;
    std::vector<PolyPoint> points = shape.Points();
    for (std::size_t i = 0; i < points.size(); ++i) {
        if (!IsOn(selected, i) || (points[i].Flags & PPF_Published))
            continue;
        const auto nearest = std::min_element(targets.begin(), targets.end(), [&](const auto &a, const auto &b) {
            return (a.second - points[i].Pos()).LengthSquared() < (b.second - points[i].Pos()).LengthSquared();
        });
        points[i].Offset(nearest->second.x - points[i].X, nearest->second.y - points[i].Y);
        points[i].Flags |= PPF_Published;
        points[i].TagID = nearest->first;
    }
    Rebuild(shape, points);
    return true;
}

void PolyLineShapes::AnimatePath(Operator &tool, Input &shape, int32 index, int32 number,
                                 const std::vector<float64> &times, bool xy)
{
    const OrbID id = PolyLine::PublishedPointInputID(number);
    Input *point = tool.FindInput(id);
    Input *x = nullptr, *y = nullptr;
    if (xy) {
        const std::string base = id.c_str();
        for (auto [slot, suffix] : {std::pair{&x, "X"}, {&y, "Y"}}) {
            const OrbID part((base + suffix).c_str());
            *slot = tool.FindInput(part);
            if (!*slot)
                *slot = tool.AddInput(part, part.c_str(), CLSID_DataType_Number, TagList(), AutoNumber(0.0).get());
        }
    }
    for (Input *in : {point, x, y})
        if (in)
            in->SetAnimated(true);
    for (const float64 time : times) {
        const AutoParam<PolyLine> s(&shape, time);
        const PolyPoint *p = s ? s->GetPoint(index) : nullptr;
        if (!p)
            continue;
        if (point && !xy)
            point->SetValue(AutoPoint(p->X, p->Y).get(), time);
        if (x && y) {
            x->SetValue(AutoNumber(p->X).get(), time);
            y->SetValue(AutoNumber(p->Y).get(), time);
        }
    }
}

} // namespace Orbane
