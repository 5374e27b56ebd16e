#include "OverlayProbe.h"
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QtTest>

#include <cmath>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag MSC_ShowRows = 0x10058003, MSC_ShowColumns = 0x10058004, MSC_LockBorder = 0x1005800a;
constexpr Tag MSC_SlideBorder = 0x1005800c, MSC_SnapToPixels = 0x1005800d, MSC_MirrorX = 0x1005801b;
constexpr Tag MSC_BoxSelect = 0x10058010, MSC_ClampToImage = 0x1005800f, MSCD_Falloff = 0x20058005;
constexpr Tag MSCID_Visible = 0x80058002;

// A 5 x 3 mesh from (0.1, 0.2) to (0.9, 0.8): at zoom 1 its vertices lie on
// widget columns 90, 170, 250, 330, 410 and rows 210, 150, 90 (bottom up).
constexpr int kCols = 5, kRows = 3;

OrbPoint Rest(int i)
{
    return {0.1 + 0.2 * (i % kCols), 0.2 + 0.3 * (i / kCols)};
}

ScriptVal MeshValue(int cols, int rows)
{
    ScriptVal t = ScriptVal::NewTable();
    t.SetKey(ScriptVal("cols"), ScriptVal(cols));
    t.SetKey(ScriptVal("rows"), ScriptVal(rows));
    ScriptVal points = ScriptVal::NewTable();
    for (int i = 0; i < cols * rows; ++i) {
        points.Append(ScriptVal(Rest(i).x));
        points.Append(ScriptVal(Rest(i).y));
    }
    t.SetKey(ScriptVal("points"), points);
    return t;
}

Input *AddMesh(ViewerFixture &f, const TagList &more = TagList(), ScriptVal value = MeshValue(kCols, kRows))
{
    TagList attrs{{INPA_PreviewControl, OrbID("MeshControl")}};
    attrs.Append(more);
    return f.tool->AddInput(OrbID("Mesh"), "Mesh", CLSID_DataType_ScriptVal, attrs,
                            AutoScriptValParam(std::move(value)).get());
}

// Vertex `i` as the Input holds it now.
OrbPoint VertexOf(const ViewerFixture &f, Input *mesh, int i)
{
    const AutoScriptValParam v(mesh, f.doc.GetCurrentTime());
    const ScriptVal *points = v ? v->Value.FindKeyConst(ScriptVal("points")) : nullptr;
    if (!points)
        return {-1, -1};
    const ScriptVal *x = points->FindKeyConst(ScriptVal(2 * i + 1)), *y = points->FindKeyConst(ScriptVal(2 * i + 2));
    return {x ? x->GetNumber() : -1, y ? y->GetNumber() : -1};
}

// The overlay's selection, as numbers from 1.
QList<int> SelectionOf(const PreviewControl *overlay)
{
    ScriptVal state = ScriptVal::NewTable();
    overlay->GetState(state);
    QList<int> out;
    if (const ScriptVal *sel = state.FindKeyConst(ScriptVal("selection")))
        for (const auto &entry : sel->GetEntries())
            out << int(entry.second.GetNumber());
    return out;
}

// Gestures by a short text each: "click 7" (a vertex, from 0), "shift 8"
// (Shift-click), "box 130,120 290,170" (a drag between widget points),
// "shiftbox ...", "clickat 130,120" (a click between vertices).
void Act(ViewerFixture &f, const QString &gesture)
{
    const QStringList w = gesture.split(' ');
    auto point = [](const QString &xy) { return QPoint(xy.section(',', 0, 0).toInt(), xy.section(',', 1, 1).toInt()); };
    const bool shift = w[0].startsWith("shift");
    HeldKeys keys(&f.viewer, shift ? Qt::ShiftModifier : Qt::NoModifier);
    if (w[0] == "click" || w[0] == "shift")
        f.Click(f.At(Rest(w[1].toInt())));
    else if (w[0] == "clickat")
        f.Click(point(w[1]));
    else
        f.Drag(point(w[1]), point(w[2]), 4);
}

} // namespace

class MeshControlTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase()
    {
        std::string why;
        QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
    }

    void selection_data()
    {
        QTest::addColumn<QStringList>("gestures");
        QTest::addColumn<bool>("boxSelect");
        QTest::addColumn<QList<int>>("selected"); // from 1
        QTest::newRow("click picks one") << QStringList{"click 7"} << true << QList<int>{8};
        QTest::newRow("a second click replaces") << QStringList{"click 7", "click 3"} << true << QList<int>{4};
        QTest::newRow("shift adds") << QStringList{"click 7", "shift 3", "shift 11"} << true << QList<int>{4, 8, 12};
        QTest::newRow("shift on a selected one takes it out")
            << QStringList{"click 7", "shift 3", "shift 7"} << true << QList<int>{4};
        QTest::newRow("box") << QStringList{"box 130,120 290,170"} << true << QList<int>{7, 8};
        QTest::newRow("box from either corner") << QStringList{"box 290,214 130,120"} << true << QList<int>{2, 3, 7, 8};
        QTest::newRow("shift box adds") << QStringList{"click 14", "shiftbox 130,120 290,170"} << true
                                        << QList<int>{7, 8, 15};
        QTest::newRow("a click between clears") << QStringList{"click 7", "clickat 130,120"} << true << QList<int>{};
        QTest::newRow("no box: a drag between only clears")
            << QStringList{"click 7", "box 130,120 290,170"} << false << QList<int>{};
    }
    // Selecting changes no value and makes no undo step.
    void selection()
    {
        QFETCH(QStringList, gestures);
        QFETCH(bool, boxSelect);
        QFETCH(QList<int>, selected);
        ViewerFixture f;
        Input *mesh = AddMesh(f, TagList{{MSC_BoxSelect, int32(boxSelect)}});
        QVERIFY(f.Show());
        for (const QString &g : gestures)
            Act(f, g);
        QCOMPARE(SelectionOf(f.OverlayOf(mesh)), selected);
        QCOMPARE(f.UndoSteps(), 0);
    }

    void drag_data()
    {
        QTest::addColumn<int>("rule");      // a tag, or 0
        QTest::addColumn<double>("amount"); // its value
        QTest::addColumn<QStringList>("select");
        QTest::addColumn<int>("grab");
        QTest::addColumn<QPoint>("move"); // widget pixels, Y down
        QTest::addColumn<int>("mods");
        QTest::addColumn<double>("zoom");
        QTest::addColumn<QPointF>("moved"); // of the grabbed vertex, image pixels, Y up
        QTest::addColumn<int>("other");
        QTest::addColumn<QPointF>("otherMoved");
        const QPointF still;
        QTest::newRow("one vertex") << 0 << 1.0 << QStringList{} << 7 << QPoint(20, -10) << 0 << 1.0 << QPointF(20, 10)
                                    << 8 << still;
        QTest::newRow("zoom 2: half as far")
            << 0 << 1.0 << QStringList{} << 7 << QPoint(20, -10) << 0 << 2.0 << QPointF(10, 5) << 6 << still;
        QTest::newRow("the selection moves together")
            << 0 << 1.0 << QStringList{"click 8", "shift 7"} << 7 << QPoint(20, 10) << 0 << 1.0 << QPointF(20, -10) << 8
            << QPointF(20, -10);
        QTest::newRow("Ctrl: a tenth") << 0 << 1.0 << QStringList{} << 7 << QPoint(40, 0) << int(Qt::ControlModifier)
                                       << 1.0 << QPointF(4, 0) << 8 << still;
        QTest::newRow("locked border stays") << int(MSC_LockBorder) << 1.0 << QStringList{"click 2", "shift 7"} << 7
                                             << QPoint(20, -20) << 0 << 1.0 << QPointF(20, 20) << 2 << still;
        QTest::newRow("sliding border keeps to its side")
            << int(MSC_SlideBorder) << 1.0 << QStringList{} << 2 << QPoint(20, -20) << 0 << 1.0 << QPointF(20, 0) << 7
            << still;
        QTest::newRow("snapped to whole pixels") << int(MSC_SnapToPixels) << 1.0 << QStringList{} << 7 << QPoint(3, 0)
                                                 << 0 << 4.0 << QPointF(1, 0) << 8 << still;
        QTest::newRow("mirrored across the middle") << int(MSC_MirrorX) << 1.0 << QStringList{} << 6 << QPoint(10, -10)
                                                    << 0 << 1.0 << QPointF(10, 10) << 8 << QPointF(-10, 10);
        QTest::newRow("soft selection: a neighbour follows a little")
            << int(MSCD_Falloff) << 100.0 << QStringList{} << 7 << QPoint(20, 0) << 0 << 1.0 << QPointF(20, 0) << 8
            << QPointF(20 * 0.104, 0); // 80 pixels off: weight 0.2^2 (3 - 0.4)
        QTest::newRow("clamped to the image") << int(MSC_ClampToImage) << 1.0 << QStringList{} << 14 << QPoint(60, 0)
                                              << 0 << 1.0 << QPointF(40, 0) << 13 << still;
    }
    // A drag moves the selection as the rules allow, one undo step that
    // puts every vertex back.
    void drag()
    {
        QFETCH(int, rule);
        QFETCH(double, amount);
        QFETCH(QStringList, select);
        QFETCH(int, grab);
        QFETCH(QPoint, move);
        QFETCH(int, mods);
        QFETCH(double, zoom);
        QFETCH(QPointF, moved);
        QFETCH(int, other);
        QFETCH(QPointF, otherMoved);
        ViewerFixture f;
        TagList rules;
        if (rule)
            rules.Set(Tag(rule), TagTypeOf(Tag(rule)) == TAGTYPE_Double ? TagValue(amount) : TagValue(int32(amount)));
        Input *mesh = AddMesh(f, rules);
        QVERIFY(f.Show());
        f.viewer.SetView(zoom);
        QApplication::processEvents();
        for (const QString &g : select)
            Act(f, g);
        {
            HeldKeys keys(&f.viewer, Qt::KeyboardModifiers(mods));
            const QPoint from = f.At(Rest(grab));
            f.Drag(from, from + move, 4);
        }
        auto near = [&](int i, QPointF pixels) {
            const OrbPoint want = Rest(i) + OrbPoint(pixels.x() / 400, pixels.y() / 200);
            const OrbPoint got = VertexOf(f, mesh, i);
            return std::fabs(got.x - want.x) < 1e-9 && std::fabs(got.y - want.y) < 1e-9;
        };
        QVERIFY2(near(grab, moved), toString(VertexOf(f, mesh, grab)));
        QVERIFY2(near(other, otherMoved), toString(VertexOf(f, mesh, other)));
        QCOMPARE(f.doc.UndoNames(), QStringList{"Move Mesh Points"});
        QVERIFY(f.doc.Undo());
        for (int i = 0; i < kCols * kRows; ++i)
            QVERIFY(Near(VertexOf(f, mesh, i), Rest(i)));
    }

    // A vertex under the mouse lights up; between vertices the mesh takes a
    // press but claims no hover.
    void hover()
    {
        ViewerFixture f;
        Input *mesh = AddMesh(f);
        QVERIFY(f.Show());
        f.Hover(f.At(Rest(7), QPoint(2, -2)));
        QCOMPARE(StateOf(f.OverlayOf(mesh), "hoverPart"), 1.0);
        f.Hover(QPoint(130, 120));
        QCOMPARE(StateOf(f.OverlayOf(mesh), "hoverPart"), 0.0);
    }

    // Arrow keys nudge the selection; a run of them is one step.
    void nudges()
    {
        ViewerFixture f;
        Input *mesh = AddMesh(f);
        QVERIFY(f.Show());
        Act(f, "click 7");
        f.Key(Qt::Key_Right);
        f.Key(Qt::Key_Up, Qt::ShiftModifier);
        QVERIFY(Near(VertexOf(f, mesh, 7), Rest(7) + OrbPoint(1.0 / 400, 10.0 / 200)));
        QVERIFY(Near(VertexOf(f, mesh, 6), Rest(6)));
        QCOMPARE(f.doc.UndoNames(), QStringList({"Nudge Mesh Points", "Nudge Mesh Points"}));
    }

    void look_data()
    {
        QTest::addColumn<Tag>("tag");
        QTest::addColumn<bool>("rowLine");
        QTest::addColumn<bool>("columnLine");
        QTest::newRow("both") << Tag(0) << true << true;
        QTest::newRow("no rows") << MSC_ShowRows << false << true;
        QTest::newRow("no columns") << MSC_ShowColumns << true << false;
    }
    // Row lines run between vertices of a row, column lines up a column.
    void look()
    {
        QFETCH(Tag, tag);
        QFETCH(bool, rowLine);
        QFETCH(bool, columnLine);
        ViewerFixture f;
        AddMesh(f, tag ? TagList{{tag, 0}} : TagList());
        QVERIFY(f.Show());
        const QImage shot = f.Grab();
        const QPoint rowMid = f.At((Rest(6) + Rest(7)) * 0.5), columnMid = f.At((Rest(7) + Rest(12)) * 0.5);
        QCOMPARE(Lit(shot, rowMid), rowLine);
        QCOMPARE(Lit(shot, columnMid), columnLine);
    }

    // A mesh without vertices, or hidden by its switch, draws nothing,
    // takes no press and says why; Reset Mesh gives an even grid.
    void nothingToDraw()
    {
        ViewerFixture f;
        f.tool->AddInput(OrbID("Visible"), "Visible", CLSID_DataType_Number, TagList(), AutoNumber(1.0));
        Input *mesh = AddMesh(f, TagList{{MSCID_Visible, OrbID("Visible")}}, ScriptVal::NewTable());
        QVERIFY(f.Show());
        PreviewControl *overlay = f.OverlayOf(mesh);
        ScriptVal state = ScriptVal::NewTable();
        overlay->GetState(state);
        QVERIFY(QString(state.FindKeyConst(ScriptVal("status"))->GetString()).contains("no vertices"));
        SweepDrags(f);
        QVERIFY(Dark(f.Grab(), f.At({0.5, 0.5}), 60));
        QCOMPARE(f.UndoSteps(), 0);

        QVERIFY(overlay->HandleEvent(OrbID("ResetMesh"), &f.viewer.Info(), nullptr));
        QCOMPARE(StateOf(overlay, "vertices"), 25.0);
        QVERIFY(Near(VertexOf(f, mesh, 24), {1.0, 1.0}));
        QCOMPARE(f.doc.UndoNames(), QStringList{"Reset Mesh"});
        f.tool->FindInput(OrbID("Visible"))->SetValue(AutoNumber(0.0).get(), 0.0);
        QApplication::processEvents();
        QVERIFY(Dark(f.Grab(), f.At({0.5, 0.5}), 60));
    }
};

QTEST_MAIN(MeshControlTest)
#include "MeshControlTest.moc"
