// The project's performance goals: adding one is adding a line here.
#include "Goal.h"

const std::vector<Goal> &Goals()
{
    static const std::vector<Goal> goals{
        {"P1", "inspector build, 500 sliders", "BM_Inspector_Build/500", "BM_StockRows_Build/500", 1.0,
         "stock Qt rows"},
        {"P1", "inspector build, 2000 sliders", "BM_Inspector_Build/2000", "BM_Inspector_Build/500", 4.4,
         "the time for 500"},
        {"P1b", "inspector teardown, 2000 sliders", "BM_Inspector_Teardown/2000", "BM_Inspector_Teardown/500", 4.4,
         "the time for 500"},
        {"P1c", "switch to a tool of 10,000 Inputs and back", "BM_Inspector_SwitchLarge/10000", nullptr, 1000.0, ""},
        {"P2", "slider repaint after a value change", "BM_CustomSlider_ValueUpdate", "BM_QSlider_ValueUpdate", 0.5,
         "a stock QSlider", "BM_Unpainted_ValueUpdate"},
        {"P3", "drag move to three bound controls", "BM_SliderControl_Drag/3", "BM_QSliderSpinBox_Drag/3", 2.0,
         "a QSlider to QDoubleSpinBox signal"},
        {"P5", "load the control library and register every class", "BM_ControlLibrary_Load", nullptr, 2.0, ""},
        {"P1d", "inspector build, 500 mixed file, font, clip, range and slider controls", "BM_Inspector_BuildMixed/500",
         "BM_StockRows_Build/500", 1.0, "stock Qt rows"},
        {"V1", "hover over 100 rectangles and 100 angle dials, one mouse event", "BM_Viewer_HoverShapes/100/100",
         nullptr, 0.5, ""},
        {"P1e", "inspector build, 500 button rows, lists, check lists, offsets, screws and labels",
         "BM_Inspector_BuildChoices/500", "BM_StockChoiceRows_Build/500", 1.0, "stock Qt rows"},
        {"S3", "repaint a viewer with a closed polyline of 10,000 points", "BM_Viewer_DrawPolyLine/10000", nullptr, 8.3,
         ""},
        {"S1", "freehand reduction, 5,000-sample stroke", "BM_PolyLine_Reduce/5000", nullptr, 10.0, ""},
        {"S2", "closest point among 100,000 points", "BM_PolyLine_Closest/100000", "BM_NaiveScan_Closest/100000", 0.05,
         "a scan of every point"},
        {"V2", "hover over 100 each of six layer overlays (transform to image), one mouse event",
         "BM_Viewer_HoverLayers/100", nullptr, 0.5, ""},
        {"T1", "fill a script table of 50,000 keys and find each", "BM_ScriptVal_FillAndFind/50000",
         "BM_StdMap_FillAndFind/50000", 3.0, "a std::unordered_map of the same strings"},
        {"X1", "time change re-evaluating 1000 expression Inputs", "BM_Expressions_TimeChange/1000",
         "BM_PlainSetValue_TimeChange/1000", 2.0, "1000 plain SetValue calls"},
        {"E1", "drag one point of a 10,000-point shape: one mouse move with the repaint",
         "BM_Viewer_DragPolyLinePoint/10000", nullptr, 2.0, ""},
        {"E2", "select by box among 100,000 points, press to release", "BM_Viewer_BoxSelect/100000", nullptr, 5.0, ""},
        {"H1", "histogram of a 4K RGBA float image", "BM_Histogram_4K", nullptr, 10.0, ""},
        {"H2", "curve graph repaint while a point is dragged", "BM_CurveGraph_DragRepaint", nullptr, 1.0, ""},
        {"C1", "inspector build, 200 colour controls (four channel Inputs each)", "BM_Inspector_BuildColours/200",
         "BM_StockColourRows_Build/200", 1.0, "stock Qt rows"},
        {"M1", "repaint a viewer with a 100 x 100 warp mesh", "BM_Viewer_DrawMesh/100", nullptr, 8.3, ""},
        {"K1", "track one point over 100 HD frames read from disk, a key per frame", "BM_Tracker_HDSequence/100",
         nullptr, 2000.0, ""},
    };
    return goals;
}
