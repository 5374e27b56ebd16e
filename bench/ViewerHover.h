#pragma once

#include <benchmark/benchmark.h>

#include <QPointF>

#include <vector>

namespace Orbane {
class Operator;
class ViewerPanel;
} // namespace Orbane

// What the viewer hover benchmarks share: a viewer showing a tool over a
// plain image, and a mouse that walks a fixed path across it, over handles
// and between them.
class ViewerHover
{
public:
    // Shows `tool` in `viewer` (`width` x `height` logical pixels) over a
    // plain image of the given size, fitted, and lets the first paint run.
    static void Show(Orbane::ViewerPanel &viewer, Orbane::Operator *tool, int imageWidth, int imageHeight, int width,
                     int height);
    // 256 points spread over a viewer of `width` x `height`.
    static std::vector<QPointF> Path(int width, int height);
    // One hover move per iteration along `path`; the repaints the moves ask
    // for are left to the event loop every 64 moves, outside the timing.
    static void Run(benchmark::State &state, Orbane::ViewerPanel &viewer, const std::vector<QPointF> &path);
};
