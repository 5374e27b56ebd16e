// Hovering over a viewer full of the layer overlays: 100 each of the
// transform, ellipse, crop, offset arrow, positioner and image overlay on
// a grid, one mouse event at a time along a fixed path. The viewer asks only
// the overlays whose hover bounds hold the mouse. The goal: under 0.5 ms
// per mouse event.
#include "BenchModule.h"
#include "ViewerHover.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ViewerPanel.h"

#include <benchmark/benchmark.h>


#include <string>
#include <vector>

namespace {

using namespace Orbane;

constexpr int Width = 800, Height = 450;
constexpr int ImageWidth = 1600, ImageHeight = 900;
constexpr Tag TCD_FrameWidth = 0x20058000, TCD_FrameHeight = 0x20058001;
constexpr Tag PSD_Width = 0x20058000, PSD_Height = 0x20058001, XOP_Center = 0x60058000;

OrbPoint GridAt(int i, double shift)
{
    return {0.05 + shift + 0.09 * (i % 10), 0.05 + shift + 0.09 * (i / 10 % 10)};
}

struct LayerRig
{
    explicit LayerRig(int each) : viewer(&doc)
    {
        tool = new Operator("Layers1", "Layers");
        doc.AddTool(tool);
        tool->DecRef();
        for (int i = 0; i < each; ++i)
            AddSet(i);
        ViewerHover::Show(viewer, tool, ImageWidth, ImageHeight, Width, Height);
    }

    Input *Number(const std::string &id, double value)
    {
        return tool->AddInput(OrbID(id.c_str()), nullptr, CLSID_DataType_Number, TagList(), AutoNumber(value));
    }
    Input *Point(const std::string &id, OrbPoint p, const TagList &attrs = TagList())
    {
        return tool->AddInput(OrbID(id.c_str()), nullptr, CLSID_DataType_Point, attrs, AutoPoint(p.x, p.y, 0.0));
    }

    // One of each overlay about the grid's cell i, each small and turned.
    void AddSet(int i)
    {
        const std::string n = std::to_string(i);
        TagList transform{
            {INPA_PreviewControl, OrbID("TransformControl")}, {TCD_FrameWidth, 0.04}, {TCD_FrameHeight, 0.02}};
        for (const char *role : {"A", "XS", "YS"})
            transform.Add(INPA_OverlayInput, OrbID((role + n).c_str()));
        Point("T" + n, GridAt(i, 0.0), transform);
        Number("A" + n, 7.0 * i);
        Number("XS" + n, 1.0);
        Number("YS" + n, 1.0);

        TagList ellipse{{INPA_PreviewControl, OrbID("EllipseControl")}};
        for (const char *role : {"RX", "RY", "EA", "SO"})
            ellipse.Add(INPA_OverlayInput, OrbID((role + n).c_str()));
        Point("E" + n, GridAt(i, 0.02), ellipse);
        Number("RX" + n, 0.015);
        Number("RY" + n, 0.01);
        Number("EA" + n, 5.0 * i);
        Number("SO" + n, 0.004);

        Point(
            "C" + n, GridAt(i, 0.03),
            TagList{{INPA_PreviewControl, CLSID_PreviewControl_Crop}, {INPA_OverlayInput, OrbID(("CS" + n).c_str())}});
        Point("CS" + n, {0.02, 0.02});

        Input *centre = Point("O" + n, GridAt(i, 0.045));
        Point("OF" + n, {0.01, 0.01},
              TagList{{INPA_PreviewControl, OrbID("XYOffsetControl")},
                      {XOP_Center, static_cast<void *>(static_cast<ScriptObject *>(centre))}});

        Point("P" + n, GridAt(i, 0.06),
              TagList{{INPA_PreviewControl, OrbID("PositionerControl")}, {PSD_Width, 0.02}, {PSD_Height, 0.01}});

        Point("I" + n, GridAt(i, 0.075),
              TagList{{INPA_PreviewControl, OrbID("ImgOverlayControl")},
                      {INPA_OverlayInput, OrbID(("A" + n).c_str())},
                      {TCD_FrameWidth, 0.02},
                      {TCD_FrameHeight, 0.02}});
    }

    OrbaneDoc doc;
    Operator *tool = nullptr;
    ViewerPanel viewer;
};

void BM_Viewer_HoverLayers(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    LayerRig rig(int(state.range(0)));
    ViewerHover::Run(state, rig.viewer, ViewerHover::Path(Width, Height));
}

// Argument: overlays of each class.
BENCHMARK(BM_Viewer_HoverLayers)->Arg(100)->Unit(benchmark::kMicrosecond);

} // namespace
