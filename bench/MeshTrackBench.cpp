// The mesh and tracker overlays' hot paths.
//
// A 100 x 100 warp mesh drawn by the mesh overlay in a viewer repaint, against
// a naive QPainter drawing the same row and column polylines and vertex
// squares, each with its shadow. The goal: a whole repaint inside one frame
// of a 120 Hz display, 8.3 ms.
//
// One point tracked over 100 HD frames: the tracker's engine over frames in
// memory, against only turning each whole frame grey (what a tracker that
// looks at the whole frame pays before it starts); and the whole run through
// the overlay, reading the frames from disk (binary PGM, so that decoding is
// cheap and the figure is the tracker's), writing a key per frame. The goal:
// under 2 s.
#include "BenchModule.h"
#include "BenchViewer.h"

#include "overlays/PatternTracker.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptVal.h"
#include "orbane/ViewerPanel.h"

#include <benchmark/benchmark.h>

#include <QApplication>
#include <QPainter>
#include <QTemporaryDir>

#include <cmath>
#include <vector>

namespace {

using namespace Orbane;

constexpr int Width = BenchViewer::Width, Height = BenchViewer::Height;
constexpr int ImageWidth = BenchViewer::ImageWidth, ImageHeight = BenchViewer::ImageHeight;

// An n x n mesh over the image with a gentle wave, as a warp is.
std::vector<OrbPoint> MeshPoints(int n)
{
    std::vector<OrbPoint> points;
    for (int r = 0; r < n; ++r)
        for (int c = 0; c < n; ++c) {
            const double x = 0.05 + 0.9 * c / (n - 1), y = 0.05 + 0.9 * r / (n - 1);
            points.emplace_back(x + 0.005 * std::sin(y * 20), y + 0.005 * std::sin(x * 20));
        }
    return points;
}

ScriptVal MeshValue(int n)
{
    ScriptVal t = ScriptVal::NewTable(), list = ScriptVal::NewTable();
    t.SetKey(ScriptVal("cols"), ScriptVal(n));
    t.SetKey(ScriptVal("rows"), ScriptVal(n));
    for (const OrbPoint &p : MeshPoints(n)) {
        list.Append(ScriptVal(p.x));
        list.Append(ScriptVal(p.y));
    }
    t.SetKey(ScriptVal("points"), list);
    return t;
}

void BM_Viewer_DrawMesh(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    BenchViewer rig("Warp1", "Warp");
    const TagList attrs{{INPA_PreviewControl, OrbID("MeshControl")}};
    rig.tool->AddInput(OrbID("Mesh"), nullptr, CLSID_DataType_ScriptVal, attrs,
                       AutoScriptValParam(MeshValue(int(state.range(0)))).get());
    rig.Show();
    rig.Repaints(state);
}

// The same picture drawn straight: the image, one polyline per row and per
// column, and a square on every vertex, a shadow pass and a light one.
void BM_NaiveQPainter_DrawMesh(benchmark::State &state)
{
    const int n = int(state.range(0));
    const QImage image = BenchViewer::Backdrop();
    const double zoom = std::min(double(Width) / ImageWidth, double(Height) / ImageHeight);
    const QPointF origin((Width - ImageWidth * zoom) / 2, (Height - ImageHeight * zoom) / 2);
    std::vector<QPointF> at;
    for (const OrbPoint &p : MeshPoints(n))
        at.emplace_back(origin.x() + p.x * ImageWidth * zoom, origin.y() + (1 - p.y) * ImageHeight * zoom);
    std::vector<QPolygonF> lines;
    for (int k = 0; k < n; ++k) {
        QPolygonF row, column;
        for (int j = 0; j < n; ++j) {
            row << at[std::size_t(k * n + j)];
            column << at[std::size_t(j * n + k)];
        }
        lines.push_back(row);
        lines.push_back(column);
    }
    QImage target(Width, Height, QImage::Format_ARGB32_Premultiplied);
    const QColor light(230, 230, 230), shadow(0, 0, 0, 160);
    for (auto _ : state) {
        QPainter p(&target);
        p.fillRect(target.rect(), QColor(36, 36, 36));
        p.drawImage(QRectF(origin, QSizeF(ImageWidth * zoom, ImageHeight * zoom)), image);
        for (const QPointF &offset : {QPointF(1, 1), QPointF(0, 0)}) {
            const QColor c = offset.x() > 0 ? shadow : light;
            p.setPen(c);
            for (const QPolygonF &line : lines)
                p.drawPolyline(line.translated(offset));
            for (const QPointF &v : at)
                p.fillRect(QRectF(v + offset - QPointF(3.5, 3.5), QSizeF(7, 7)), c);
        }
        p.end();
        benchmark::DoNotOptimize(target.bits());
    }
    state.SetItemsProcessed(state.iterations() * n * n);
}

BENCHMARK(BM_Viewer_DrawMesh)->Arg(100)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_NaiveQPainter_DrawMesh)->Arg(100)->Unit(benchmark::kMillisecond);

// --- tracking ---

constexpr int HDWidth = 1920, HDHeight = 1080;

QPointF FeatureAt(int frame)
{
    return {600.0 + 3.3 * frame, 500.0 + 1.7 * frame};
}

// A grey HD frame with a fixed texture and a feature of soft blobs at
// FeatureAt(frame), drawn only where it lies.
QImage HDFrame(const QImage &ground, int frame)
{
    QImage image = ground.copy();
    const QPointF at = FeatureAt(frame);
    for (int y = int(at.y()) - 20; y <= int(at.y()) + 20; ++y)
        for (int x = int(at.x()) - 20; x <= int(at.x()) + 20; ++x) {
            const QPointF d1 = QPointF(x, y) - at, d2 = d1 - QPointF(6, -4), d3 = d1 - QPointF(-5, 5);
            auto blob = [](QPointF d) { return std::exp(-(d.x() * d.x() + d.y() * d.y()) / 12.5); };
            const int v = qGray(image.pixel(x, y)) + int(150 * (blob(d1) + 0.7 * blob(d2) + 0.5 * blob(d3)));
            image.setPixel(x, y, qRgb(std::min(v, 255), std::min(v, 255), std::min(v, 255)));
        }
    return image;
}

QImage Ground()
{
    QImage ground(HDWidth, HDHeight, QImage::Format_RGB32);
    for (int y = 0; y < HDHeight; ++y)
        for (int x = 0; x < HDWidth; ++x) {
            const int v = 40 + int(20 * std::sin(x * 0.05) * std::cos(y * 0.07));
            ground.setPixel(x, y, qRgb(v, v, v));
        }
    return ground;
}

const std::vector<QImage> &HDFrames(int count)
{
    static std::vector<QImage> frames;
    if (int(frames.size()) != count) {
        const QImage ground = Ground();
        frames.clear();
        for (int f = 0; f < count; ++f)
            frames.push_back(HDFrame(ground, f));
    }
    return frames;
}

void BM_Track_HDFrames(benchmark::State &state)
{
    const std::vector<QImage> &frames = HDFrames(int(state.range(0)));
    PatternTracker::Settings settings;
    settings.pattern = QSizeF(31, 31);
    settings.search = QSizeF(71, 71);
    for (auto _ : state) {
        PatternTracker tracker;
        if (!tracker.Start(frames[0], FeatureAt(0), settings))
            return state.SkipWithError("the tracker did not start");
        for (std::size_t f = 1; f < frames.size(); ++f)
            if (!tracker.Step(frames[f]))
                return state.SkipWithError("the feature was lost");
        benchmark::DoNotOptimize(tracker.Position());
    }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

void BM_GreyWholeFrames_HDFrames(benchmark::State &state)
{
    const std::vector<QImage> &frames = HDFrames(int(state.range(0)));
    for (auto _ : state)
        for (const QImage &frame : frames) {
            const QImage grey = frame.convertToFormat(QImage::Format_Grayscale8);
            benchmark::DoNotOptimize(grey.constBits());
        }
    state.SetItemsProcessed(state.iterations() * state.range(0));
}

// The whole run as a user starts it: the overlay reads each frame from disk,
// tracks it and writes its key; undone between iterations.
void BM_Tracker_HDSequence(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    QTemporaryDir dir;
    const int count = int(state.range(0));
    const std::vector<QImage> &frames = HDFrames(count);
    for (int f = 0; f < count; ++f)
        frames[std::size_t(f)].convertToFormat(QImage::Format_Grayscale8)
            .save(dir.filePath(QString("hd.%1.pgm").arg(f + 1, 4, 10, QChar('0'))), "PGM");
    BenchViewer rig("Tracker1", "Tracker");
    rig.doc.SetPref(PREF_ViewerImage, dir.filePath("hd.####.pgm").toStdString());
    rig.doc.SetCurrentTime(1);
    const QPointF start = FeatureAt(0);
    const TagList attrs{{INPA_PreviewControl, OrbID("TrackerControl")},
                        {INPA_OverlayInput, OrbID("Pattern")},
                        {INPA_OverlayInput, OrbID("Search")}};
    Input *track = rig.tool->AddInput(
        OrbID("Track"), nullptr, CLSID_DataType_Point, attrs,
        AutoPoint((start.x() + 0.5) / HDWidth, 1.0 - (start.y() + 0.5) / HDHeight, 0.0).get());
    rig.tool->AddInput(OrbID("Pattern"), nullptr, CLSID_DataType_Point, TagList(),
                       AutoPoint(31.0 / HDWidth, 31.0 / HDHeight, 0.0).get());
    rig.tool->AddInput(OrbID("Search"), nullptr, CLSID_DataType_Point, TagList(),
                       AutoPoint(71.0 / HDWidth, 71.0 / HDHeight, 0.0).get());
    rig.Show();
    PreviewControl *overlay = rig.viewer.OverlaysOf(track).front();
    const TagList tags{{PCA_FromScript, 1}};
    for (auto _ : state) {
        overlay->HandleEvent(OrbID("TrackForward"), &rig.viewer.Info(), &tags);
        state.PauseTiming();
        if (track->KeyTimes().size() != std::size_t(count))
            return state.SkipWithError("the run did not track every frame");
        rig.doc.Undo();
        state.ResumeTiming();
    }
    state.SetItemsProcessed(state.iterations() * count);
}

BENCHMARK(BM_Track_HDFrames)->Arg(100)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_GreyWholeFrames_HDFrames)->Arg(100)->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Tracker_HDSequence)->Arg(100)->Unit(benchmark::kMillisecond);

} // namespace
