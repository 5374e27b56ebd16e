// Hovering over a viewer full of the 3D overlays: 100 each of the cube,
// the camera and the light, small and turned, on a grid on the image
// plane, seen through the default view; one mouse event at a time along a
// fixed path. Each hover projects the handles through the viewer's camera.
// The goal: under 0.5 ms per mouse event.
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

namespace {

using namespace Orbane;

constexpr int Width = 800, Height = 450;
constexpr int ImageWidth = 1600, ImageHeight = 900;
constexpr Tag CCD_Far = 0x20068003, CCD_BodySize = 0x20068006, LC_LightType = 0x10068000;

// Cell i of a 10 x 10 grid on the image plane, in world units (the image's
// width across, its centre at the origin), moved on by `shift`.
OrbVec3 GridAt(int i, double shift)
{
    const double x = 0.05 + shift + 0.09 * (i % 10), y = 0.05 + shift + 0.09 * (i / 10 % 10);
    return {x - 0.5, (y - 0.5) * ImageHeight / ImageWidth, 0.0};
}

struct SceneRig
{
    explicit SceneRig(int each) : viewer(&doc)
    {
        tool = new Operator("Scene1", "Scene");
        doc.AddTool(tool);
        tool->DecRef();
        for (int i = 0; i < each; ++i)
            AddSet(i);
        ViewerHover::Show(viewer, tool, ImageWidth, ImageHeight, Width, Height);
    }

    void Number(const std::string &id, double value)
    {
        tool->AddInput(OrbID(id.c_str()), nullptr, CLSID_DataType_Number, TagList(), AutoNumber(value));
    }
    void Point(const std::string &id, OrbVec3 p, const TagList &attrs = TagList())
    {
        tool->AddInput(OrbID(id.c_str()), nullptr, CLSID_DataType_Point, attrs, AutoPoint(p.x, p.y, p.z));
    }
    static TagList Overlay(const char *cls, const std::string &n, std::initializer_list<const char *> roles)
    {
        TagList tags{{INPA_PreviewControl, OrbID(cls)}};
        for (const char *role : roles)
            tags.Add(INPA_OverlayInput, OrbID((role + n).c_str()));
        return tags;
    }

    // One of each about the grid's cell i, each small and turned.
    void AddSet(int i)
    {
        const std::string n = std::to_string(i);
        Point("B" + n, GridAt(i, 0.0), Overlay("CubeControl", n, {"SX", "SY", "SZ", "RX", "RY", "RZ"}));
        for (const char *size : {"SX", "SY", "SZ"})
            Number(size + n, 0.02);
        Number("RX" + n, 10.0 + i);
        Number("RY" + n, 3.0 * i);
        Number("RZ" + n, 0.0);

        TagList camera = Overlay("CameraControl", n, {"TX", "TY", "TZ", "F"});
        camera.Add(CCD_Far, 0.03);
        camera.Add(CCD_BodySize, 0.01);
        Point("C" + n, GridAt(i, 0.03), camera);
        Number("TX" + n, -5.0);
        Number("TY" + n, 4.0 * i);
        Number("TZ" + n, 0.0);
        Number("F" + n, 35.0);

        TagList light = Overlay("LightControl", n, {"LA", "LC"});
        light.Add(LC_LightType, 2);
        Point("L" + n, GridAt(i, 0.06), light);
        Point("LA" + n, GridAt(i, 0.06) + OrbVec3(0.01, -0.01, -0.03));
        Number("LC" + n, 30.0);
    }

    OrbaneDoc doc;
    Operator *tool = nullptr;
    ViewerPanel viewer;
};

void BM_Viewer_Hover3D(benchmark::State &state)
{
    if (!LoadControlModule())
        return state.SkipWithError("the control library did not load");
    SceneRig rig(int(state.range(0)));
    ViewerHover::Run(state, rig.viewer, ViewerHover::Path(Width, Height));
}

// Argument: overlays of each class.
BENCHMARK(BM_Viewer_Hover3D)->Arg(100)->Unit(benchmark::kMicrosecond);

} // namespace
