#pragma once

#include "orbane/OrbaneDoc.h"
#include "orbane/ViewerPanel.h"

#include <QImage>

namespace Orbane {
class Operator;
} // namespace Orbane

namespace benchmark {
class State;
} // namespace benchmark

// The viewer the overlay benchmarks draw and hover in: a document with one
// tool, shown over a plain image of 1600 x 900 in a viewer of 800 x 450.
// The benchmark adds the tool's Inputs, then calls Show.
class BenchViewer
{
public:
    static constexpr int Width = 800, Height = 450;
    static constexpr int ImageWidth = 1600, ImageHeight = 900;

    BenchViewer(const char *toolName, const char *toolType);

    // Shows the tool in the viewer, on screen, with its overlays made.
    void Show();
    // Repaints the whole viewer into an image once an iteration; items are
    // the benchmark's first argument (the overlays or points drawn).
    void Repaints(benchmark::State &state);
    // The image behind the overlays.
    static QImage Backdrop();

    Orbane::OrbaneDoc doc;
    Orbane::Operator *tool; // the document's
    Orbane::ViewerPanel viewer;
};
