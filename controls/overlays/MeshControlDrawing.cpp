// MeshControl: drawing the wireframe, the vertices, the selection box and
// the labels.
#include "overlays/MeshControl.h"

#include "framework/OverlayValue.h"

#include "orbane/GPainter.h"
#include "orbane/PreviewInfo.h"

#include <algorithm>
#include <cmath>
#include <string>

namespace Orbane {

using Graphics::GColor;
using Graphics::GPainter;
using OV = OverlayValue;

namespace {

// The rest mesh is drawn this faint, under the mesh.
constexpr float32 kRestAlpha = 0.5f;
// Stipples of MSC_LineStyle: dashes of 6 pixels, dots of 2.
constexpr uint16 kDash = 0x0FC0;
constexpr uint16 kDot = 0x3333;
// Row and column lines are drawn at least this far apart, viewer pixels.
constexpr float64 kMinLineGap = 8.0;

GColor ColorOr(const PreviewInfo &info, OrbColor c, GColor fallback)
{
    return c.IsNone() ? fallback : info.GetColor(c);
}

} // namespace

void MeshControl::DrawControls(PreviewInfo *info, const TagList *tags)
{
    GPainter *p = info->GetPainter();
    if (p && info->DrawPass != 3 && Shows()) {
        p->PushAttrib();
        const GColor overlay = info->GetColor(OrbColor());
        if (mLook.showRest && mRestInput && mRest.Count() > 0) {
            GColor rest = ColorOr(*info, mLook.rest, GColor{0.6f, 0.6f, 0.6f});
            rest.a *= kRestAlpha;
            DrawMesh(*p, *info, mRest, rest, true);
        }
        const bool dragging = mDragType == DRAG_Handle;
        if (!(mLook.hideWhileDragging && dragging))
            DrawMesh(*p, *info, mMesh, ColorOr(*info, mLook.line, overlay), false);
        else
            DrawMesh(*p, *info, mMesh, GColor{0, 0, 0, 0}, false);
        DrawBox(*p, *info);
        p->PopAttrib();
    }
    HandleOverlay::DrawControls(info, tags);
}

// The lines of `mesh` in `line` (nothing where it is clear), then, for the
// mesh itself, its vertices and labels.
void MeshControl::DrawMesh(GPainter &p, const PreviewInfo &info, const MeshGrid &mesh, GColor line, bool rest) const
{
    std::vector<OrbPoint> at(mesh.points.size());
    for (std::size_t i = 0; i < at.size(); ++i)
        at[i] = ViewerPoint(info, mesh.points[i]);
    if (line.a > 0.0f) {
        p.Enable(Graphics::GC_Blend);
        line.a *= float32(mLook.opacity);
        p.Color(line, rest ? GColor{0, 0, 0, 0} : HandleShadow(info));
        p.LineWidth(float32(mLook.lineWidth));
        if (mLook.lineStyle != 0) {
            p.Enable(Graphics::GC_LineStipple);
            p.LineStipple(1, mLook.lineStyle == 1 ? kDash : kDot);
        }
        DrawLines(p, at, mesh, mLook.showDiagonals && !rest);
        p.Disable(Graphics::GC_LineStipple);
        if (mLook.showBorder && !rest) {
            GColor border = ColorOr(info, mLook.border, line);
            border.a = line.a;
            p.Color(border, HandleShadow(info));
            p.LineWidth(float32(mLook.borderWidth));
            p.Begin(Graphics::GP_LineLoop);
            auto vertex = [&](int32 c, int32 r) {
                const OrbPoint &v = at[std::size_t(mesh.Index(c, r))];
                p.Vertex(v.x, v.y);
            };
            for (int32 c = 0; c < mesh.cols; ++c)
                vertex(c, 0);
            for (int32 r = 1; r < mesh.rows; ++r)
                vertex(mesh.cols - 1, r);
            for (int32 c = mesh.cols - 2; c >= 0; --c)
                vertex(c, mesh.rows - 1);
            for (int32 r = mesh.rows - 2; r > 0; --r)
                vertex(0, r);
            p.End();
        }
    }
    if (!rest) {
        DrawVertices(p, info, at);
        DrawLabels(p, info, at);
    }
}

// Row lines, column lines (every n-th inner one) and the cells' diagonals,
// one strip per line so that a dashed style runs along it. The rest mesh
// shows no diagonals: they would only clutter the mesh over it.
void MeshControl::DrawLines(GPainter &p, const std::vector<OrbPoint> &at, const MeshGrid &mesh, bool diagonals) const
{
    // Lines closer on screen than kMinLineGap make a grey mass, not a
    // wireframe: a dense mesh shows every n-th line until it is zoomed in.
    const OrbPoint cell = CellSizes(at, mesh);
    const int32 everyRow = std::max(mLook.lineEvery, int32(std::ceil(kMinLineGap / std::max(cell.y, 1e-9))));
    const int32 everyColumn = std::max(mLook.lineEvery, int32(std::ceil(kMinLineGap / std::max(cell.x, 1e-9))));
    auto drawn = [](int32 n, int32 count, int32 every) { return n == 0 || n == count - 1 || n % every == 0; };
    auto strip = [&](int32 count, auto index) {
        p.Begin(Graphics::GP_LineStrip);
        for (int32 k = 0; k < count; ++k) {
            const OrbPoint &v = at[std::size_t(index(k))];
            p.Vertex(v.x, v.y);
        }
        p.End();
    };
    if (mLook.showRows)
        for (int32 r = 0; r < mesh.rows; ++r)
            if (drawn(r, mesh.rows, std::min(everyRow, mesh.rows)))
                strip(mesh.cols, [&](int32 c) { return mesh.Index(c, r); });
    if (mLook.showColumns)
        for (int32 c = 0; c < mesh.cols; ++c)
            if (drawn(c, mesh.cols, std::min(everyColumn, mesh.cols)))
                strip(mesh.rows, [&](int32 r) { return mesh.Index(c, r); });
    if (diagonals) {
        p.Begin(Graphics::GP_Lines);
        for (int32 r = 0; r + 1 < mesh.rows; ++r)
            for (int32 c = 0; c + 1 < mesh.cols; ++c) {
                const OrbPoint &a = at[std::size_t(mesh.Index(c, r))], &b = at[std::size_t(mesh.Index(c + 1, r + 1))];
                p.Vertex(a.x, a.y);
                p.Vertex(b.x, b.y);
            }
        p.End();
    }
}

// Idle vertices in one batch, then the selected ones, then the one under
// the mouse, so that the highlight lies on top.
void MeshControl::DrawVertices(GPainter &p, const PreviewInfo &info, const std::vector<OrbPoint> &at) const
{
    if (!mLook.showVertices || mLook.readOnly)
        return;
    // Where the cells are smaller than the handles, the handles would only
    // cover the lines and each other: such a mesh shows its lines with only
    // the selected vertices and the one under the mouse.
    const OrbPoint cell = CellSizes(at, mMesh);
    const bool dense = std::min(cell.x, cell.y) < 2.0 * mLook.vertexSize * info.HandleScale + 2.0;
    std::vector<int32> idle, selected;
    idle.reserve(dense ? 0 : at.size());
    for (std::size_t i = 0; i < at.size(); ++i)
        if (mSelected[i])
            selected.push_back(int32(i));
        else if (!dense)
            idle.push_back(int32(i));
    const GColor shadow = HandleShadow(info);
    const GColor normal = ColorOr(info, mLook.handle, info.GetColor(OrbColor()));
    p.Color(normal.Faded(Fade()), shadow);
    DrawVertexSet(p, info, at, idle);
    p.Color(ColorOr(info, mLook.selected, HandleSet::Highlight).Faded(Fade()), shadow);
    DrawVertexSet(p, info, at, selected);
    const HandleHit poised = Handles().PoisedHit();
    if (poised.part == 1 && poised.item >= 0 && poised.item < int32(at.size())) {
        p.Color(HandleSet::Highlight, shadow);
        DrawVertexSet(p, info, at, {poised.item});
    }
}

// An average cell's sides on screen (viewer units): across, up.
OrbPoint MeshControl::CellSizes(const std::vector<OrbPoint> &at, const MeshGrid &mesh)
{
    OrbPoint lo(HUGE_VAL, HUGE_VAL), hi(-HUGE_VAL, -HUGE_VAL);
    for (const OrbPoint &p : at) {
        lo = {std::min(lo.x, p.x), std::min(lo.y, p.y)};
        hi = {std::max(hi.x, p.x), std::max(hi.y, p.y)};
    }
    return {(hi.x - lo.x) / std::max(mesh.cols - 1, 1), (hi.y - lo.y) / std::max(mesh.rows - 1, 1)};
}

void MeshControl::DrawVertexSet(GPainter &p, const PreviewInfo &info, const std::vector<OrbPoint> &at,
                                const std::vector<int32> &which) const
{
    if (which.empty())
        return;
    const float64 s = mLook.vertexSize * info.HandleScale;
    if (mLook.vertexShape == 0) {
        // Squares are points: one batch however many there are.
        p.PointSize(float32(2.0 * s + 1.0));
        p.Begin(Graphics::GP_Points);
        for (const int32 i : which)
            if (OV::OnScreen(at[std::size_t(i)]))
                p.Vertex(at[std::size_t(i)].x, at[std::size_t(i)].y);
        p.End();
        return;
    }
    // Discs as octagons, diamonds as turned squares: triangles of one batch.
    const int32 sides = mLook.vertexShape == 1 ? 8 : 4;
    p.Begin(Graphics::GP_Triangles);
    for (const int32 i : which) {
        const OrbPoint c = at[std::size_t(i)];
        if (!OV::OnScreen(c))
            continue;
        for (int32 k = 0; k < sides; ++k) {
            const float64 a0 = 2 * M_PI * k / sides, a1 = 2 * M_PI * (k + 1) / sides;
            p.Vertex(c.x, c.y);
            p.Vertex(c.x + s * std::cos(a0), c.y + s * std::sin(a0));
            p.Vertex(c.x + s * std::cos(a1), c.y + s * std::sin(a1));
        }
    }
    p.End();
}

void MeshControl::DrawBox(GPainter &p, const PreviewInfo &info) const
{
    if (!mBoxing)
        return;
    const OrbPoint a = info.TransformOut(mBoxFrom), b = info.TransformOut(mBoxTo);
    p.Color(ColorOr(info, mLook.box, HandleSet::Highlight), HandleShadow(info));
    p.LineWidth(1.0f);
    p.Enable(Graphics::GC_LineStipple);
    p.LineStipple(1, kDash);
    p.Begin(Graphics::GP_LineLoop);
    p.Vertex(a.x, a.y);
    p.Vertex(b.x, a.y);
    p.Vertex(b.x, b.y);
    p.Vertex(a.x, b.y);
    p.End();
    p.Disable(Graphics::GC_LineStipple);
}

// The label at the top-left vertex; with MSC_ShowLabels each selected
// vertex's number (as OverlayState's `selection` counts them) beside it.
void MeshControl::DrawLabels(GPainter &p, const PreviewInfo &info, const std::vector<OrbPoint> &at) const
{
    const GColor color = info.GetColor(OrbColor());
    p.Color(color, HandleShadow(info));
    const float64 gap = (mLook.vertexSize + 3.0) * info.HandleScale;
    if (!mLook.label.empty()) {
        const OrbPoint &corner = at[std::size_t(mMesh.Index(0, mMesh.rows - 1))];
        if (OV::OnScreen(corner))
            p.Text(corner.x, corner.y + gap, mLook.label.c_str());
    }
    if (!mLook.showLabels)
        return;
    for (std::size_t i = 0; i < at.size(); ++i)
        if (mSelected[i] && OV::OnScreen(at[i]))
            p.Text(at[i].x + gap, at[i].y + gap, std::to_string(i + 1).c_str());
}

} // namespace Orbane
