// Editing a large shape by hand: one mouse move of a dragged key point of a
// 10,000-point shape with the viewer's repaint that shows it (goal: 2 ms,
// well inside a frame), and a selection box drawn over 100,000 points, from
// press to release, without the repaint that then shows the selection
// (goal: 5 ms).
#include "BenchModule.h"
#include "BenchViewer.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/PolyLine.h"
#include "orbane/ViewerPanel.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QMouseEvent>

#include <cmath>

namespace {

using namespace Orbane;

constexpr Tag PLC_DrawMode = 0x10058000;

// A closed wavy ring of corner points round the image's middle.
AutoRef<PolyLine> Ring(int count)
{
    AutoRef<PolyLine> shape(new PolyLine);
    for (int i = 0; i < count; ++i) {
        const double a = 2 * M_PI * i / count, r = 0.3 + 0.05 * std::sin(a * 40.0);
        shape->AddPoint(PolyPoint(0.5 + r * std::cos(a) * 9.0 / 16.0, 0.5 + r * std::sin(a)));
    }
    shape->Close();
    return shape;
}

struct EditRig : BenchViewer
{
    explicit EditRig(int count) : BenchViewer("Roto1", "Roto")
    {
        const TagList attrs{{INPA_PreviewControl, OrbID("PolylineControl")}, {PLC_DrawMode, 4}};
        mask = tool->AddInput(OrbID("Mask"), nullptr, CLSID_DataType_Polyline, attrs, Ring(count).get());
        Show();
    }
    void Send(QEvent::Type type, QPointF at, Qt::MouseButton button, Qt::MouseButtons held)
    {
        QMouseEvent event(type, at, viewer.mapToGlobal(at.toPoint()), button, held, Qt::NoModifier);
        QApplication::sendEvent(&viewer, &event);
    }
    QPointF At(OrbPoint image) const { return viewer.ImageToWidget(image); }
    Input *mask = nullptr;
};

void BM_Viewer_DragPolyLinePoint(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    EditRig rig(int(state.range(0)));
    const AutoParam<PolyLine> shape(rig.mask, 0.0);
    const QPointF from = rig.At(shape->GetPoint(0)->Pos());
    rig.Send(QEvent::MouseButtonPress, from, Qt::LeftButton, Qt::LeftButton);
    QImage target(BenchViewer::Width, BenchViewer::Height, QImage::Format_ARGB32_Premultiplied);
    int step = 0;
    for (auto _ : state) {
        rig.Send(QEvent::MouseMove, from + QPointF(10 + (step++ % 2) * 10, 0), Qt::NoButton, Qt::LeftButton);
        rig.viewer.render(&target);
        benchmark::DoNotOptimize(target.bits());
    }
    rig.Send(QEvent::MouseButtonRelease, from, Qt::LeftButton, Qt::NoButton);
    if (rig.doc.UndoNames().size() != 1)
        state.SkipWithError("the drag moved nothing");
}

void BM_Viewer_BoxSelect(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    EditRig rig(int(state.range(0)));
    // From the top-left corner of the image over its left half.
    const QPointF from = rig.At({0.02, 0.98}), to = rig.At({0.5, 0.02});
    for (auto _ : state) {
        // The repaint that shows the last selection is not the selecting.
        state.PauseTiming();
        rig.viewer.repaint();
        state.ResumeTiming();
        rig.Send(QEvent::MouseButtonPress, from, Qt::LeftButton, Qt::LeftButton);
        rig.Send(QEvent::MouseMove, (from + to) / 2, Qt::NoButton, Qt::LeftButton);
        rig.Send(QEvent::MouseButtonRelease, to, Qt::LeftButton, Qt::NoButton);
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

BENCHMARK(BM_Viewer_DragPolyLinePoint)->Arg(10000)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Viewer_BoxSelect)->Arg(100000)->Unit(benchmark::kMillisecond);

} // namespace
