// A closed shape of 10,000 smooth key points (a wavy ring, as a traced
// outline is) drawn by the polyline overlay in a viewer repaint, against a
// naive QPainter that strokes the same Bezier path and the same key point
// squares, each with its shadow. The goal: a whole repaint inside one frame
// of a 120 Hz display, 8.3 ms.
#include "BenchModule.h"
#include "BenchViewer.h"

#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/PolyLine.h"
#include "orbane/ViewerPanel.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QPainter>
#include <QPainterPath>

#include <cmath>

namespace {

using namespace Orbane;

constexpr int Width = BenchViewer::Width, Height = BenchViewer::Height;
constexpr int ImageWidth = BenchViewer::ImageWidth, ImageHeight = BenchViewer::ImageHeight;
constexpr Tag PLC_DrawMode = 0x10058000;

OrbPoint RingAt(double t)
{
    const double a = 2 * M_PI * t, r = 0.3 + 0.05 * std::sin(a * 40.0);
    return {0.5 + r * std::cos(a) * ImageHeight / ImageWidth, 0.5 + r * std::sin(a)};
}

// Smooth points: each handle a third of the way to its neighbour's place.
AutoRef<PolyLine> Ring(int count)
{
    AutoRef<PolyLine> shape(new PolyLine);
    for (int i = 0; i < count; ++i) {
        const OrbPoint at = RingAt(double(i) / count), next = RingAt(double(i + 1) / count);
        const OrbPoint prev = RingAt(double(i - 1) / count), tangent = (next - prev) / 6.0;
        PolyPoint p(at.x, at.y);
        p.InX = at.x - tangent.x, p.InY = at.y - tangent.y;
        p.OutX = at.x + tangent.x, p.OutY = at.y + tangent.y;
        shape->AddPoint(p);
    }
    shape->Close();
    return shape;
}

struct ShapeRig : BenchViewer
{
    explicit ShapeRig(int count) : BenchViewer("Roto1", "Roto")
    {
        const TagList attrs{{INPA_PreviewControl, OrbID("PolylineControl")}, {PLC_DrawMode, 4}};
        tool->AddInput(OrbID("Mask"), nullptr, CLSID_DataType_Polyline, attrs, Ring(count).get());
        Show();
    }
};

void BM_Viewer_DrawPolyLine(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    ShapeRig rig(int(state.range(0)));
    rig.Repaints(state);
}

// The same picture drawn straight: the image, the shape as a QPainterPath
// of cubics, and a square on every key point, a shadow pass and a light one.
void BM_NaiveQPainter_DrawPolyLine(benchmark::State &state)
{
    const AutoRef<PolyLine> ring = Ring(int(state.range(0)));
    const QImage image = BenchViewer::Backdrop();
    const double zoom = std::min(double(Width) / ImageWidth, double(Height) / ImageHeight);
    const QPointF origin((Width - ImageWidth * zoom) / 2, (Height - ImageHeight * zoom) / 2);
    auto widget = [&](OrbPoint p) {
        return QPointF(origin.x() + p.x * ImageWidth * zoom, origin.y() + (1 - p.y) * ImageHeight * zoom);
    };
    QPainterPath path(widget(ring->First()->Pos()));
    const std::vector<PolyPoint> &points = ring->Points();
    for (std::size_t i = 0; i < points.size(); ++i) {
        const PolyPoint &a = points[i], &b = points[(i + 1) % points.size()];
        path.cubicTo(widget(a.Out()), widget(b.In()), widget(b.Pos()));
    }
    QImage target(Width, Height, QImage::Format_ARGB32_Premultiplied);
    const QPen light(QColor(230, 230, 230)), shadow(QColor(0, 0, 0, 160));
    for (auto _ : state) {
        QPainter p(&target);
        p.fillRect(target.rect(), QColor(36, 36, 36));
        p.drawImage(QRectF(origin, QSizeF(ImageWidth * zoom, ImageHeight * zoom)), image);
        p.setRenderHint(QPainter::Antialiasing);
        for (const QPointF &offset : {QPointF(1, 1), QPointF(0, 0)}) {
            p.setPen(offset.x() > 0 ? shadow : light);
            p.drawPath(path.translated(offset));
            for (const PolyPoint &pt : points)
                p.drawRect(QRectF(widget(pt.Pos()) + offset - QPointF(3.2, 3.2), QSizeF(6.4, 6.4)));
        }
        p.end();
        benchmark::DoNotOptimize(target.bits());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK(BM_Viewer_DrawPolyLine)->Arg(10000)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_NaiveQPainter_DrawPolyLine)->Arg(10000)->Unit(benchmark::kMillisecond);

} // namespace
