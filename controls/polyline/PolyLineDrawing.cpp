#include "polyline/PolyLineDrawing.h"

#include "orbane/BSplinePolyLine.h"
#include "orbane/GPainter.h"
#include "orbane/PolyLine.h"
#include "orbane/SelMask.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace Orbane {

using Graphics::GPainter;

namespace {

// The flattened curve strays at most this many viewer pixels from the true
// one: below what a one-pixel line shows.
constexpr float64 kFlatness = 0.25;
// No segment is cut into more steps than this, however large on screen.
constexpr int32 kMaxSteps = 256;
// A pattern of two pixels on, two off for draw style 2.
constexpr uint16 kDotted = 0xCCCC;
constexpr uint16 kDashed = 0xF0F0;
// The selection states whose handles are not drawn: a point picked
// without its handles (1) and one whose handles are locked away (4).
constexpr uint8 kNoHandleStates[] = {1, 4};

OrbPoint Cubic(const OrbPoint c[4], float64 t) noexcept
{
    const float64 u = 1.0 - t;
    const float64 a = u * u * u, b = 3 * u * u * t, d = 3 * u * t * t, e = t * t * t;
    return {a * c[0].x + b * c[1].x + d * c[2].x + e * c[3].x, a * c[0].y + b * c[1].y + d * c[2].y + e * c[3].y};
}

void Push(std::vector<float64> &xyz, OrbPoint p)
{
    xyz.push_back(p.x);
    xyz.push_back(p.y);
    xyz.push_back(0.0);
}

bool DrawsHandles(const SelMask &selection, int32 index)
{
    const uint8 state = selection[index];
    return state != 0 &&
           std::find(std::begin(kNoHandleStates), std::end(kNoHandleStates), state) == std::end(kNoHandleStates);
}

// A square of half side `half` about `at`, as four lines of a GP_Lines batch.
void SquareLines(GPainter &p, OrbPoint at, OrbPoint half)
{
    const float64 x1 = at.x - half.x, x2 = at.x + half.x, y1 = at.y - half.y, y2 = at.y + half.y;
    p.Vertex(x1, y1), p.Vertex(x2, y1);
    p.Vertex(x2, y1), p.Vertex(x2, y2);
    p.Vertex(x2, y2), p.Vertex(x1, y2);
    p.Vertex(x1, y2), p.Vertex(x1, y1);
}

// A square's outline as one line loop: the painter strokes it in one call,
// where it strokes each line of a GP_Lines batch alone.
void SquareLoop(GPainter &p, OrbPoint at, OrbPoint half)
{
    p.Begin(Graphics::GP_LineLoop);
    p.Vertex(at.x - half.x, at.y - half.y), p.Vertex(at.x + half.x, at.y - half.y);
    p.Vertex(at.x + half.x, at.y + half.y), p.Vertex(at.x - half.x, at.y + half.y);
    p.End();
}

void FilledSquare(GPainter &p, OrbPoint at, OrbPoint half)
{
    p.Rectangle(at.x - half.x, at.y - half.y, at.x + half.x, at.y + half.y);
}

} // namespace

uint16 PolyLineDrawing::StippleFor(uint16 flags) noexcept
{
    if (flags & PLD_Dash)
        return kDashed;
    return (flags & PLD_Style2) ? kDotted : 0;
}

float64 PolyLineDrawing::MarkerSide(float64 controlSize) noexcept
{
    return 4.0 * std::max(controlSize, 2.0) * 4.0 / 5.0;
}

int32 PolyLineDrawing::StepsFor(const OrbPoint hull[4]) noexcept
{
    const OrbPoint d1 = hull[0] - hull[1] * 2.0 + hull[2], d2 = hull[1] - hull[2] * 2.0 + hull[3];
    const float64 m = std::max(d1.Length(), d2.Length());
    const float64 steps = std::ceil(std::sqrt(0.75 * m / kFlatness));
    return std::isfinite(steps) ? std::clamp(int32(steps), 1, kMaxSteps) : 1;
}

void PolyLineDrawing::Flatten(const PolyLine &shape, OrbPoint span, std::vector<float64> &xyz,
                              std::vector<int32> &starts)
{
    xyz.clear();
    starts.clear();
    const int32 segments = shape.GetSegmentsCount();
    const auto *bspline = dynamic_cast<const BSplinePolyLine *>(&shape);
    if (shape.GetCount() == 1) {
        starts.push_back(0);
        Push(xyz, shape.First()->Pos());
    }
    bool open = false; // a strip is running
    for (int32 seg = 0; seg < segments; ++seg) {
        if (shape.GetPoint(seg)->Flags & PPF_Discontinual) {
            open = false;
            continue;
        }
        OrbPoint hull[4], screen[4];
        shape.SegmentHull(seg, hull);
        for (int i = 0; i < 4; ++i)
            screen[i] = OrbPoint(hull[i].x * span.x, hull[i].y * span.y);
        const int32 steps = StepsFor(screen);
        if (!open) {
            starts.push_back(int32(xyz.size() / 3));
            Push(xyz, bspline ? bspline->ValueAt(seg) : hull[0]);
            open = true;
        }
        for (int32 i = 1; i <= steps; ++i) {
            const float64 t = float64(i) / steps;
            Push(xyz, bspline ? bspline->ValueAt(seg + t) : Cubic(hull, t));
        }
    }
}

void PolyLineDrawing::UpdateCurve(const PolyLine &shape, OrbPoint span)
{
    if (mCurveOf.get() == &shape && mCurveSpan == span)
        return;
    Flatten(shape, span, mCurve, mStarts);
    mCurveOf = AutoRef<PolyLine>::Share(const_cast<PolyLine *>(&shape));
    mCurveSpan = span;
}

void PolyLineDrawing::DrawStrips(GPainter &p, const std::vector<float64> &xyz, const std::vector<int32> &starts)
{
    const int32 count = int32(xyz.size() / 3);
    if (count < 2)
        return;
    p.SetVertexArray(xyz.data(), count);
    for (std::size_t i = 0; i < starts.size(); ++i) {
        const int32 end = i + 1 < starts.size() ? starts[i + 1] : count;
        p.DrawArrays(Graphics::GP_LineStrip, starts[i], end - starts[i]);
    }
    p.SetVertexArray(nullptr, 0);
}

void PolyLineDrawing::DrawCurve(GPainter &p, const PolyLine &shape, OrbPoint span)
{
    std::vector<float64> xyz;
    std::vector<int32> starts;
    Flatten(shape, span, xyz, starts);
    DrawStrips(p, xyz, starts);
}

void PolyLineDrawing::DrawStrip(GPainter &p, const std::vector<OrbPoint> &points)
{
    p.Begin(Graphics::GP_LineStrip);
    for (const OrbPoint &at : points)
        p.Vertex(at.x, at.y);
    p.End();
}

// The curve (unless hidden or Null), then what the flags show of the points:
// handles of the selected points, the key points, the tagged ids, and the
// single selected point once more on top.
void PolyLineDrawing::Draw(GPainter &p, const PolyLine &shape, const SelMask &selection, const PolyLineStyle &style)
{
    if (shape.GetCount() == 0)
        return;
    p.PushAttrib();
    if (style.stipple) {
        p.LineStipple(1, style.stipple);
        p.Enable(Graphics::GC_LineStipple);
    }
    if ((style.flags & PLD_Curve) && !(style.flags & PLD_Null)) {
        UpdateCurve(shape, style.span);
        p.Color(style.curve, style.shadow);
        DrawStrips(p, mCurve, mStarts);
    }
    const bool points = style.flags & PLD_KeyPoints, handles = style.flags & PLD_Handles;
    if (points || handles) {
        if (handles)
            DrawHandles(p, shape, selection, style);
        p.Disable(Graphics::GC_LineStipple);
        if (points)
            DrawMarkers(p, shape, selection, style, false);
        if (style.flags & PLD_TaggedIDs)
            DrawTaggedIDs(p, shape, style);
    } else if ((style.flags & PLD_SelectedWhenHidden) && style.pending) {
        p.Disable(Graphics::GC_LineStipple);
        DrawMarkers(p, shape, selection, style, true);
    }
    p.PopAttrib();
}

void PolyLineDrawing::DrawHandles(GPainter &p, const PolyLine &shape, const SelMask &selection,
                                  const PolyLineStyle &style)
{
    if (selection.GetSetCount() == 0)
        return;
    const int32 count = shape.GetCount();
    p.Color(style.handle, style.shadow);
    p.Begin(Graphics::GP_Lines);
    for (int32 i = 0; i < count; ++i)
        if (DrawsHandles(selection, i)) {
            const PolyPoint &pt = *shape.GetPoint(i);
            p.Vertex(pt.X, pt.Y), p.Vertex(pt.InX, pt.InY);
            p.Vertex(pt.X, pt.Y), p.Vertex(pt.OutX, pt.OutY);
        }
    p.End();
    p.Disable(Graphics::GC_LineStipple);
    for (int32 i = 0; i < count; ++i)
        if (DrawsHandles(selection, i)) {
            const PolyPoint &pt = *shape.GetPoint(i);
            for (auto [part, at] : {std::pair{2u, pt.In()}, {4u, pt.Out()}}) {
                const bool hot = style.hot == HandleHit{part, i};
                p.Color(hot ? style.hover : style.handle, style.shadow);
                p.Begin(Graphics::GP_Lines);
                SquareLines(p, at, style.half);
                p.End();
            }
        }
}

// Unselected points as outlines in one batch, selected ones filled, the
// point under the pointer in the hover colour, and the single selected
// point last, in the active colour.
void PolyLineDrawing::DrawMarkers(GPainter &p, const PolyLine &shape, const SelMask &selection,
                                  const PolyLineStyle &style, bool selectedOnly)
{
    const int32 count = shape.GetCount();
    const HandleHit hotPoint = style.hot.part == 1 ? style.hot : HandleHit{};
    if (!selectedOnly) {
        p.Color(style.keyPoint, style.shadow);
        OrbPoint last(-1e300, -1e300);
        for (int32 i = 0; i < count; ++i) {
            const OrbPoint at = shape.GetPoint(i)->Pos();
            // A marker within half a side of the last one drawn would hide
            // under it and show no point apart: a dense shape seen from afar
            // draws a marker each half side along it, as many as can show.
            const bool hidden = std::fabs(at.x - last.x) < style.half.x && std::fabs(at.y - last.y) < style.half.y;
            if (selection.IsSet(i) || hotPoint.item == i || hidden)
                continue;
            SquareLoop(p, at, style.half);
            last = at;
        }
    }
    p.Color(style.keyPoint, style.shadow);
    for (int32 i = 0; i < count; ++i)
        if (selection.IsSet(i) && hotPoint.item != i)
            FilledSquare(p, shape.GetPoint(i)->Pos(), style.half);
    if (hotPoint && hotPoint.item < count && (!selectedOnly || selection.IsSet(hotPoint.item))) {
        p.Color(style.hover, style.shadow);
        FilledSquare(p, shape.GetPoint(hotPoint.item)->Pos(), style.half);
    }
    const int32 single = selection.GetSetItem(-1);
    if (single >= 0 && single < count && !(style.flags & PLD_NoSingleHighlight)) {
        p.Color(style.active, style.shadow);
        FilledSquare(p, shape.GetPoint(single)->Pos(), style.half);
    }
}

void PolyLineDrawing::DrawTaggedIDs(GPainter &p, const PolyLine &shape, const PolyLineStyle &style)
{
    p.Color(style.keyPoint, style.shadow);
    char text[16];
    for (const PolyPoint &pt : shape.Points())
        if (pt.Flags & PPF_Tagged) {
            std::snprintf(text, sizeof text, "%d", int(pt.TagID));
            // Beside the marker, up and to the right by a marker's side.
            p.Text(pt.X + 3 * style.half.x, pt.Y + 3 * style.half.y, text);
        }
}

} // namespace Orbane
