#include "PolyLineTestShapes.h"
#include "RecordingPainter.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/BSplinePolyLine.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/PolyLine.h"
#include "orbane/PreviewInfo.h"
#include "orbane/ScriptVal.h"

#include <QtTest>

#include <cmath>
#include <vector>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

using RP = RecordingPainter;

constexpr Tag PLC_DrawMode = 0x10058000, PLC_ShowKeyPoints = 0x10058009, PLC_ShowHandles = 0x1005800A;
constexpr Tag PLC_HandleColor = 0x1005800D, PLC_ShowPolyLine = 0x1005800F, PLC_DrawStyle = 0x10058010;
constexpr Tag PLC_ShowTaggedPointIDs = 0x10058015, PLC_SelectedWhenHidden = 0x10058013;
constexpr Tag PLC_PairFromAttach = 0x10058011, PLC_KeyPointColor = 0x10058014, PCA_Color = 0x1003000F;
constexpr Tag PLCID_Center = 0x80058000, PLCID_Displacement = 0x80058003, PLCID_InPolyLine2 = 0x80058008;
constexpr Tag PLCID_InPolyLine = 0x8005800F, TOOL_FollowInner = 0x10030005;

// A tool of its own in place of the fixture's, with tool attributes.
void ReplaceTool(ViewerFixture &f, const TagList &attrs)
{
    f.doc.RemoveTool(f.tool);
    f.tool = new Operator("Roto1", "Roto", attrs);
    f.doc.AddTool(f.tool);
    f.tool->DecRef();
}

double Field(const PreviewControl *overlay, const char *key)
{
    const ScriptVal state = StateOf(overlay);
    const ScriptVal *v = state.FindKeyConst(ScriptVal(key));
    return v ? (v->IsBool() ? double(v->GetBool()) : v->GetNumber()) : -1.0;
}

// What the overlay draws in one ordinary pass of the viewer's view.
void Record(ViewerFixture &f, PreviewControl *overlay, RecordingPainter &painter)
{
    PreviewInfo info = f.viewer.Info();
    info.SetPainter(&painter);
    info.DrawPass = 2;
    overlay->DrawControls(&info, nullptr);
}

Graphics::GColor Overlay(ViewerFixture &f, OrbColor c = OrbColor())
{
    return f.viewer.Info().GetColor(c);
}

bool NearPoint(OrbPoint a, OrbPoint b, double eps = 1e-9)
{
    return std::fabs(a.x - b.x) <= eps && std::fabs(a.y - b.y) <= eps;
}

OrbPoint ImageAt(const ViewerFixture &f, QPoint widget)
{
    return f.viewer.WidgetToImage(QPointF(widget));
}

// The farthest, in widget pixels, that a stroke's point lies from the shape.
double Stray(const ViewerFixture &f, const PolyLine &shape, const std::vector<QPoint> &stroke)
{
    std::vector<QPointF> curve;
    const int32 segments = shape.GetSegmentsCount();
    for (int i = 0; i <= segments * 200; ++i)
        curve.push_back(f.viewer.ImageToWidget(shape.ValueAt(i / 200.0)));
    double worst = 0;
    for (const QPoint &s : stroke) {
        double best = 1e9;
        for (const QPointF &c : curve)
            best = std::min(best, std::hypot(c.x() - s.x(), c.y() - s.y()));
        worst = std::max(worst, best);
    }
    return worst;
}

} // namespace

class PolyLineControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();

    void setUp_data();
    void setUp();
    void hidingPointsAndHandlesEmptiesTheSelection();
    void drawing_data();
    void drawing();
    void onionSkinsOfTheOtherKeyframes();
    void bsplineCurveAndClicks();
    void hoverLightsAPointAndADragMovesIt();
    void appendTakesAnyPress_data();
    void appendTakesAnyPress();
    void clickAppendAddsClosesAndUndoes();
    void clickDragPullsSmoothHandles();
    void drawAppend_data();
    void drawAppend();
};

void PolyLineControlTest::initTestCase()
{
    std::string why;
    QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
}

void PolyLineControlTest::setUp_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<TagList>("then"); // a script's SetAttrs afterwards
    QTest::addColumn<bool>("followInner");
    QTest::addColumn<int>("flags");
    QTest::addColumn<int>("mode");
    QTest::addColumn<int>("cursor");
    QTest::addColumn<int>("attach");
    QTest::addColumn<int>("pairing");
    const TagList none;
    const int arrow = Qt::ArrowCursor, cross = Qt::CrossCursor;
    QTest::newRow("defaults") << none << none << false << 0x87 << 0 << arrow << 0 << 1;
    QTest::newRow("draw append: the cross")
        << TagList{{PLC_DrawMode, 2}} << none << false << 0x87 << 2 << cross << 0 << 1;
    QTest::newRow("click append: the append cursor, an arrow")
        << TagList{{PLC_DrawMode, 2}} << TagList{{PLC_DrawMode, 1}} << false << 0x87 << 1 << arrow << 0 << 1;
    QTest::newRow("the high nibble is no mode")
        << TagList{{PLC_DrawMode, 0x34}} << none << false << 0x87 << 4 << arrow << 0 << 1;
    QTest::newRow("points and handles hidden")
        << TagList{{PLC_ShowKeyPoints, 0}, {PLC_ShowHandles, 0}} << none << false << 0x84 << 0 << arrow << 0 << 1;
    QTest::newRow("selected shown when hidden")
        << TagList{{PLC_SelectedWhenHidden, 1}} << none << false << 0x8F << 0 << arrow << 0 << 1;
    QTest::newRow("dash") << TagList{{PLC_DrawStyle, 1}} << none << false << 0x97 << 0 << arrow << 0 << 1;
    QTest::newRow("style 2") << TagList{{PLC_DrawStyle, 2}} << none << false << 0xA7 << 0 << arrow << 0 << 1;
    QTest::newRow("null is 5") << TagList{{PLC_DrawStyle, 5}} << none << false << 0xC7 << 0 << arrow << 0 << 1;
    QTest::newRow("3 keeps the dash") << TagList{{PLC_DrawStyle, 1}} << TagList{{PLC_DrawStyle, 3}} << false << 0x97
                                      << 0 << arrow << 0 << 1;
    QTest::newRow("4 keeps null") << TagList{{PLC_DrawStyle, 5}} << TagList{{PLC_DrawStyle, 4}} << false << 0xC7 << 0
                                  << arrow << 0 << 1;
    QTest::newRow("0 is solid again") << TagList{{PLC_DrawStyle, 2}} << TagList{{PLC_DrawStyle, 0}} << false << 0x87
                                      << 0 << arrow << 0 << 1;
    QTest::newRow("displacement: 1") << TagList{{PLCID_Displacement, OrbID("Disp")}} << none << false << 0x87 << 0
                                     << arrow << 1 << 1;
    QTest::newRow("a misnamed displacement adds nothing")
        << TagList{{PLCID_Displacement, OrbID("Nowhere")}} << none << false << 0x87 << 0 << arrow << 0 << 1;
    QTest::newRow("inner polyline: 2") << TagList{{PLCID_InPolyLine, OrbID("Inner")}} << none << false << 0x87 << 0
                                       << arrow << 2 << 1;
    QTest::newRow("outer polyline, free: state 2")
        << TagList{{PLCID_InPolyLine2, OrbID("Outer")}} << none << false << 0x87 << 0 << arrow << 4 << 2;
    QTest::newRow("outer polyline, following the inner: state 1")
        << TagList{{PLCID_InPolyLine2, OrbID("Outer")}} << none << true << 0x87 << 0 << arrow << 4 << 1;
    QTest::newRow("pairing from the attach result: an outer itself, 0")
        << TagList{{PLC_PairFromAttach, 1}, {PLCID_InPolyLine, OrbID("Inner")}} << none << false << 0x87 << 0 << arrow
        << 2 << 0;
    QTest::newRow("pairing from the attach result: alone, 3")
        << TagList{{PLC_PairFromAttach, 1}} << none << false << 0x87 << 0 << arrow << 0 << 3;
}

void PolyLineControlTest::setUp()
{
    QFETCH(TagList, attrs);
    QFETCH(TagList, then);
    QFETCH(bool, followInner);
    ViewerFixture f;
    ReplaceTool(f, TagList{{TOOL_FollowInner, followInner}});
    Input *shape = AddShape(f, {{0.2, 0.2}, {0.8, 0.3}}, attrs);
    f.tool->AddInput(OrbID("Disp"), "Disp", CLSID_DataType_Number, TagList(), AutoNumber(0.0));
    AddShape(f, {}, TagList(), "Inner");
    AddShape(f, {}, TagList(), "Outer");
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(shape);
    QVERIFY(overlay);
    if (!then.IsEmpty())
        overlay->SetAttrsTagList(then);
    QTEST(int(Field(overlay, "displayFlags")), "flags");
    QTEST(int(Field(overlay, "mode")), "mode");
    QTEST(int(Field(overlay, "cursor")), "cursor");
    QTEST(int(Field(overlay, "attachResult")), "attach");
    QTEST(int(Field(overlay, "pairing")), "pairing");
}

// A point selected by a click, then points and handles hidden: nothing of
// the selection stays.
void PolyLineControlTest::hidingPointsAndHandlesEmptiesTheSelection()
{
    ViewerFixture f;
    Input *shape = AddShape(f, {}, TagList{{PLC_DrawMode, 1}});
    QVERIFY(f.Show());
    f.Click(f.At({0.4, 0.4}));
    PreviewControl *overlay = f.OverlayOf(shape);
    QCOMPARE(StateOf(overlay).FindKeyConst(ScriptVal("selected"))->Length(), 1);
    overlay->SetAttrsTagList(TagList{{PLC_ShowKeyPoints, 0}});
    QCOMPARE(StateOf(overlay).FindKeyConst(ScriptVal("selected"))->Length(), 1);
    overlay->SetAttrsTagList(TagList{{PLC_ShowHandles, 0}});
    QCOMPARE(StateOf(overlay).FindKeyConst(ScriptVal("selected"))->Length(), 0);
}

void PolyLineControlTest::drawing_data()
{
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<int>("points");
    QTest::addColumn<bool>("locked");
    QTest::addColumn<int>("curves");      // line strips drawn from the flattened curve
    QTest::addColumn<uint>("curveColor"); // OrbColor packed; none: the viewer's overlay colour
    QTest::addColumn<int>("stipple");     // of the curve
    QTest::addColumn<int>("markers");     // key point outlines drawn in keyColor
    QTest::addColumn<uint>("keyColor");
    QTest::addColumn<int>("centre"); // the magenta centre marker
    QTest::addColumn<int>("labels"); // tagged point ids (the second point is tagged 7)
    const TagList centre{{PLCID_Center, OrbID("Center")}, {PLC_DrawMode, 4}};
    const uint none = OrbColor::None, grey = OrbColor(192, 192, 192).Packed();
    const uint yellow = OrbColor(192, 192, 0).Packed();
    auto with = [&centre](const TagList &more) {
        TagList t = centre;
        t.Append(more);
        return t;
    };
    QTest::newRow("empty: nothing, not even the centre")
        << centre << 0 << false << 0 << none << 0 << 0 << yellow << 0 << 0;
    QTest::newRow("one point: its marker and the centre")
        << centre << 1 << false << 0 << none << 0 << 1 << yellow << 1 << 0;
    QTest::newRow("three points, modify only") << centre << 3 << false << 1 << none << 0 << 3 << yellow << 1 << 1;
    QTest::newRow("done draws grey") << TagList{{PLCID_Center, OrbID("Center")}} << 3 << false << 1 << grey << 0 << 3
                                     << yellow << 1 << 1;
    QTest::newRow("a locked tool draws grey") << centre << 3 << true << 1 << grey << 0 << 3 << yellow << 1 << 1;
    QTest::newRow("points and handles hidden: the curve alone")
        << with({{PLC_ShowKeyPoints, 0}, {PLC_ShowHandles, 0}}) << 3 << false << 1 << none << 0 << 0 << yellow << 1
        << 0;
    QTest::newRow("dash") << with({{PLC_DrawStyle, 1}}) << 3 << false << 1 << none << 0xF0F0 << 3 << yellow << 1 << 1;
    QTest::newRow("null: no curve") << with({{PLC_DrawStyle, 5}}) << 3 << false << 0 << none << 0 << 3 << yellow << 1
                                    << 1;
    QTest::newRow("curve hidden") << with({{PLC_ShowPolyLine, 0}}) << 3 << false << 0 << none << 0 << 3 << yellow << 1
                                  << 1;
    QTest::newRow("handle colour") << with({{PLC_HandleColor, OrbColor(255, 0, 0).Packed()}}) << 3 << false << 1 << none
                                   << 0 << 3 << OrbColor(255, 0, 0).Packed() << 1 << 1;
    QTest::newRow("key point colour before the handle colour")
        << with({{PLC_HandleColor, OrbColor(255, 0, 0).Packed()}, {PLC_KeyPointColor, OrbColor(0, 255, 0).Packed()}})
        << 3 << false << 1 << none << 0 << 3 << OrbColor(0, 255, 0).Packed() << 1 << 1;
    QTest::newRow("tagged ids off") << with({{PLC_ShowTaggedPointIDs, 0}}) << 3 << false << 1 << none << 0 << 3
                                    << yellow << 1 << 0;
    QTest::newRow("spline colour") << with({{PCA_Color, OrbColor(0, 0, 255).Packed()}}) << 3 << false << 1
                                   << OrbColor(0, 0, 255).Packed() << 0 << 3 << yellow << 1 << 1;
}

void PolyLineControlTest::drawing()
{
    QFETCH(TagList, attrs);
    QFETCH(int, points);
    QFETCH(bool, locked);
    QFETCH(uint, curveColor);
    QFETCH(uint, keyColor);
    ViewerFixture f;
    const Points all{{0.2, 0.2}, {0.8, 0.3}, {0.5, 0.8}};
    AutoRef<PolyLine> drawnShape(new PolyLine);
    for (int i = 0; i < points; ++i) {
        PolyPoint p(all[std::size_t(i)].x, all[std::size_t(i)].y);
        if (i == 1) {
            p.Flags |= PPF_Tagged;
            p.TagID = 7;
        }
        drawnShape->AddPoint(p);
    }
    Input *shape = AddShapeValue(f, drawnShape.get(), attrs);
    f.AddPoint("Center", 0.5, 0.5);
    QVERIFY(f.Show());
    f.tool->SetLocked(locked);
    RecordingPainter drawn;
    Record(f, f.OverlayOf(shape), drawn);
    const Graphics::GColor curve = Overlay(f, OrbColor(curveColor));
    QTEST(drawn.Count(RP::Arrays, curve, Graphics::GP_LineStrip), "curves");
    QCOMPARE(drawn.Count(RP::Arrays), drawn.Count(RP::Arrays, curve));
    if (const RP::Call *c = drawn.First(RP::Arrays))
        QTEST(int(c->stipple), "stipple");
    QTEST(drawn.Count(RP::Primitive, Graphics::GColor::FromOrb(OrbColor(keyColor)), Graphics::GP_LineLoop), "markers");
    QTEST(drawn.Count(RP::Primitive, {1, 0, 1, 1}, Graphics::GP_Lines), "centre");
    QTEST(drawn.Count(RP::Label), "labels");
    if (const RP::Call *label = drawn.First(RP::Label))
        QCOMPARE(label->text, std::string("7"));
    // Nothing is selected: no filled marker, no handle.
    QCOMPARE(drawn.Count(RP::Filled), 0);
}

// An animated shape shows its other keyframes dotted, in their own colour.
void PolyLineControlTest::onionSkinsOfTheOtherKeyframes()
{
    ViewerFixture f;
    Input *shape = AddShape(f, {{0.2, 0.2}, {0.8, 0.3}, {0.5, 0.8}}, TagList{{PLC_DrawMode, 4}});
    shape->SetAnimated(true);
    shape->SetValue(MakeShape({{0.3, 0.2}, {0.7, 0.3}, {0.5, 0.6}}).get(), 10.0);
    shape->SetValue(MakeShape({{0.1, 0.2}, {0.7, 0.3}, {0.5, 0.6}}).get(), 20.0);
    QVERIFY(f.Show());
    RecordingPainter drawn;
    Record(f, f.OverlayOf(shape), drawn);
    int skins = 0;
    for (const RP::Call &c : drawn.calls)
        skins += c.kind == RP::Arrays && c.stipple == 0x0F0F;
    QCOMPARE(skins, 2);
    QCOMPARE(drawn.Count(RP::Arrays, Overlay(f)), 1);
}

// In "Modify Only" the point under the mouse lights up yellow; dragging it
// moves it and its handles, one step "Move Point".
void PolyLineControlTest::hoverLightsAPointAndADragMovesIt()
{
    ViewerFixture f;
    Input *shape = AddShape(f, {{0.2, 0.2}, {0.5, 0.5}, {0.8, 0.3}}, TagList{{PLC_DrawMode, 4}});
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(shape);
    const QPoint at = f.At({0.5, 0.5});
    f.Hover(at + QPoint(3, 2));
    QCOMPARE(Field(overlay, "hover"), 1.0);
    QCOMPARE(Field(overlay, "hoverPart"), 1.0);
    RecordingPainter drawn;
    Record(f, overlay, drawn);
    QCOMPARE(drawn.Count(RP::Filled, {1, 1, 0, 1}), 1);
    f.Hover(at + QPoint(9, 0));
    QCOMPARE(Field(overlay, "hover"), 0.0);

    f.Drag(at + QPoint(3, 2), at + QPoint(43, -18));
    const AutoParam<PolyLine> moved = ShapeOf(f, shape);
    QVERIFY(NearPoint(moved->GetPoint(1)->Pos(), ImageAt(f, at + QPoint(40, -20)), 1e-3));
    QVERIFY(NearPoint(moved->GetPoint(1)->Out(), moved->GetPoint(1)->Pos()));
    QVERIFY(NearPoint(moved->GetPoint(0)->Pos(), {0.2, 0.2}));
    QCOMPARE(f.doc.UndoNames(), QStringList({"Move Point"}));
    QCOMPARE(StateOf(overlay).FindKeyConst(ScriptVal("selected"))->Length(), 1);
    QVERIFY(f.doc.Undo());
    QVERIFY(NearPoint(ShapeOf(f, shape)->GetPoint(1)->Pos(), {0.5, 0.5}));
}

// A B-spline draws the curve its control points shape, and a click-drag
// adds a control point without pulling handles it has none of.
void PolyLineControlTest::bsplineCurveAndClicks()
{
    ViewerFixture f;
    AutoRef<PolyLine> spline(new BSplinePolyLine);
    for (const OrbPoint &p : Points{{0.2, 0.2}, {0.8, 0.2}, {0.8, 0.8}, {0.2, 0.8}})
        spline->AddPoint(PolyPoint(p.x, p.y));
    spline->Close();
    const TagList attrs{{INPA_PreviewControl, OrbID("PolylineControl")}, {PLC_DrawMode, 1}};
    Input *shape = f.tool->AddInput(OrbID("Spline"), "Spline", CLSID_DataType_BSplinePolyline, attrs, spline.get());
    QVERIFY(f.Show());
    RecordingPainter drawn;
    Record(f, f.OverlayOf(shape), drawn);
    const RP::Call *curve = drawn.First(RP::Arrays);
    QVERIFY(curve && curve->count > 8);
    // Along the bottom the curve runs a fortyeighth of the side's rise
    // above the control polygon's edge (y = 0.225, five image pixels up),
    // not on it.
    const QImage image = f.Grab();
    QVERIFY(qGray(image.pixel(f.At({0.5, 0.225}))) > 60);
    QCOMPARE(qGray(image.pixel(f.At({0.5, 0.2}))), 0);
    f.Drag(f.At({0.5, 0.5}), f.At({0.5, 0.5}, QPoint(30, 0)));
    const AutoParam<PolyLine> after = ShapeOf(f, shape);
    QCOMPARE(after->DataType(), CLSID_DataType_BSplinePolyline);
    QCOMPARE(after->GetCount(), 5);
    QVERIFY(NearPoint(after->GetPoint(4)->Out(), after->GetPoint(4)->Pos()));
}

void PolyLineControlTest::appendTakesAnyPress_data()
{
    QTest::addColumn<int>("mode");
    QTest::addColumn<bool>("locked");
    QTest::addColumn<bool>("taken");
    QTest::newRow("click append") << 1 << false << true;
    QTest::newRow("draw append") << 2 << false << true;
    QTest::newRow("modify only, off the shape: a selection box") << 4 << false << true;
    QTest::newRow("done") << 0 << false << false;
    QTest::newRow("click append on a locked tool") << 1 << true << false;
}

// Far from every point, in the corner of the image.
void PolyLineControlTest::appendTakesAnyPress()
{
    QFETCH(int, mode);
    QFETCH(bool, locked);
    ViewerFixture f;
    Input *shape = AddShape(f, {{0.5, 0.5}}, TagList{{PLC_DrawMode, mode}});
    QVERIFY(f.Show());
    f.tool->SetLocked(locked);
    f.Press(f.At({0.05, 0.05}));
    QTEST(f.viewer.HotControl() == f.OverlayOf(shape), "taken");
    f.Release(f.At({0.05, 0.05}));
    // A press without a move adds a point in both append modes.
    QCOMPARE(ShapeOf(f, shape)->GetCount(), 1 + ((mode == 1 || mode == 2) && !locked));
}

// Three clicks add three corners, one step each; a click on the first point
// closes the shape and leaves the append mode; undo takes it all back.
void PolyLineControlTest::clickAppendAddsClosesAndUndoes()
{
    ViewerFixture f;
    Input *shape = AddShape(f, {}, TagList{{PLC_DrawMode, 1}});
    QVERIFY(f.Show());
    const QPoint at[3] = {f.At({0.3, 0.3}), f.At({0.7, 0.3}), f.At({0.5, 0.7})};
    for (const QPoint &p : at)
        f.Click(p);
    AutoParam<PolyLine> drawn = ShapeOf(f, shape);
    QCOMPARE(drawn->GetCount(), 3);
    for (int i = 0; i < 3; ++i) {
        QVERIFY(NearPoint(drawn->GetPoint(i)->Pos(), ImageAt(f, at[i])));
        QVERIFY(NearPoint(drawn->GetPoint(i)->Out(), ImageAt(f, at[i])));
    }
    QCOMPARE(f.doc.UndoNames(), QStringList({"Add Point", "Add Point", "Add Point"}));
    // The last point added is the single selected one, drawn on top, cyan.
    RecordingPainter drawn3;
    Record(f, f.OverlayOf(shape), drawn3);
    QCOMPARE(drawn3.Count(RP::Filled, {0, 1, 1, 1}), 1);

    f.Click(at[0] + QPoint(2, -1));
    drawn = ShapeOf(f, shape);
    QVERIFY(drawn->IsClosed());
    QCOMPARE(drawn->GetCount(), 3);
    QCOMPARE(f.doc.UndoNames().last(), QString("Close polygon"));
    QCOMPARE(Field(f.OverlayOf(shape), "mode"), 3.0);

    QVERIFY(f.doc.Undo());
    QVERIFY(!ShapeOf(f, shape)->IsClosed());
    for (int i = 0; i < 3; ++i)
        QVERIFY(f.doc.Undo());
    QCOMPARE(ShapeOf(f, shape)->GetCount(), 0);
    QCOMPARE(Field(f.OverlayOf(shape), "points"), 0.0);
}

// A press that drags pulls the new point's handles out: the out handle at
// the mouse, the in handle mirrored, in the same one step.
void PolyLineControlTest::clickDragPullsSmoothHandles()
{
    ViewerFixture f;
    Input *shape = AddShape(f, {{0.2, 0.5}}, TagList{{PLC_DrawMode, 1}});
    QVERIFY(f.Show());
    const QPoint from = f.At({0.5, 0.5}), to = from + QPoint(30, -20);
    f.Drag(from, to, 6);
    const AutoParam<PolyLine> drawn = ShapeOf(f, shape);
    QCOMPARE(drawn->GetCount(), 2);
    const PolyPoint &p = *drawn->GetPoint(1);
    QVERIFY(NearPoint(p.Pos(), ImageAt(f, from)));
    QVERIFY(NearPoint(p.Out(), ImageAt(f, to)));
    QVERIFY(NearPoint(p.In(), p.Pos() * 2.0 - ImageAt(f, to)));
    QCOMPARE(f.doc.UndoNames(), QStringList({"Add Point"}));
    // The selected point shows its two handle lines (four vertices), and
    // the other point none.
    int handleLines = 0;
    RecordingPainter pulled;
    Record(f, f.OverlayOf(shape), pulled);
    for (const RP::Call &c : pulled.calls)
        handleLines += c.kind == RP::Primitive && c.mode == Graphics::GP_Lines && c.count == 4;
    QCOMPARE(handleLines, 1);
    QVERIFY(f.doc.Undo());
    QCOMPARE(ShapeOf(f, shape)->GetCount(), 1);
}

void PolyLineControlTest::drawAppend_data()
{
    QTest::addColumn<double>("turn"); // of the circle drawn, in turns
    QTest::addColumn<bool>("closed");
    QTest::newRow("half a circle: open") << 0.5 << false;
    QTest::newRow("a whole circle: closed on its start") << 1.0 << true;
}

// A freehand stroke through real mouse moves: a few key points that keep
// to every sample within the tolerance, one undo step.
void PolyLineControlTest::drawAppend()
{
    QFETCH(double, turn);
    QFETCH(bool, closed);
    ViewerFixture f;
    Input *shape = AddShape(f, {}, TagList{{PLC_DrawMode, 2}});
    QVERIFY(f.Show());
    f.Hover(f.At({0.5, 0.5}));
    QCOMPARE(f.viewer.cursor().shape(), Qt::CrossCursor);
    std::vector<QPoint> stroke;
    const int samples = int(96 * turn);
    for (int i = 0; i <= samples; ++i) {
        const double a = 2 * M_PI * i / 96.0;
        stroke.push_back(
            f.At({0.5, 0.5}, QPoint(int(std::lround(80 * std::cos(a))), int(std::lround(60 * std::sin(a))))));
    }
    f.Press(stroke.front());
    for (std::size_t i = 1; i < stroke.size(); ++i)
        f.Move(stroke[i]);
    f.Release(stroke.back());
    const AutoParam<PolyLine> drawn = ShapeOf(f, shape);
    QVERIFY2(drawn->GetCount() >= 2 && drawn->GetCount() <= 16, qPrintable(QString::number(drawn->GetCount())));
    QCOMPARE(drawn->IsClosed(), closed);
    // The tolerance is 2 pixels; the samples are whole pixels, half a pixel off.
    const double stray = Stray(f, *drawn, stroke);
    QVERIFY2(stray <= 2.5, qPrintable(QString::number(stray)));
    QCOMPARE(f.doc.UndoNames(), QStringList({"Freehand Add Points"}));
    QVERIFY(f.doc.Undo());
    QCOMPARE(ShapeOf(f, shape)->GetCount(), 0);
}

QTEST_MAIN(PolyLineControlTest)
#include "PolyLineControlTest.moc"
