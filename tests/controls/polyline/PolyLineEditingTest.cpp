#include "../overlays/OverlayProbe.h"
#include "PolyLineTestShapes.h"
#include "ViewerFixture.h"

#include "orbane/PolyLine.h"

#include <QtTest>

#include <cmath>
#include <vector>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

using Indices = std::vector<int>;

constexpr Tag PLC_DrawMode = 0x10058000;

// Four corners along the bottom and up to the right. The viewer shows the
// 400 x 200 image at zoom 1: one image pixel is 1/400 across, 1/200 up.
const Points kCorners{{0.2, 0.2}, {0.4, 0.2}, {0.6, 0.2}, {0.8, 0.6}};

// What a hand does in a row of a table.
enum Act
{
    A_Click,      // on point `index`
    A_ClickEmpty, // far from everything
    A_Box,        // a drag from empty space round points 1 and 2
};

struct Rig
{
    ViewerFixture f;
    Input *shape = nullptr;
    PreviewControl *overlay = nullptr;

    explicit Rig(const PolyLine *value, int mode = 4)
    {
        shape = AddShapeValue(f, value, TagList{{PLC_DrawMode, mode}});
    }
    bool Show()
    {
        overlay = f.Show() ? f.OverlayOf(shape) : nullptr;
        return overlay != nullptr;
    }
    void ClickWith(QPoint at, Qt::KeyboardModifiers mods)
    {
        HeldKeys held(&f.viewer, mods);
        f.Click(at);
    }
    // Selects exactly `indices` by clicks: the first alone, the rest with Shift.
    void SelectByHand(const Indices &indices)
    {
        for (std::size_t n = 0; n < indices.size(); ++n)
            ClickWith(f.At(kCorners[std::size_t(indices[n])]), n ? Qt::ShiftModifier : Qt::NoModifier);
    }
    Indices Selected() const { return ListOf(overlay, "selected"); }
};

bool NearPt(OrbPoint a, OrbPoint b, double eps = 1e-9)
{
    return std::fabs(a.x - b.x) <= eps && std::fabs(a.y - b.y) <= eps;
}

// A corner shape whose point 1 is smooth, handles 0.05 to each side.
AutoRef<PolyLine> WithHandles()
{
    AutoRef<PolyLine> s = MakeShape(kCorners);
    PolyPoint p = *s->GetPoint(1);
    p.InX = 0.35, p.OutX = 0.45;
    s->SetPoint(1, p);
    return s;
}

} // namespace

class PolyLineEditingTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void selection_data();
    void selection();
    void drags_data();
    void drags();
    void clickOnTheCurve_data();
    void clickOnTheCurve();
    void undoDuringADrag();
};

void PolyLineEditingTest::initTestCase()
{
    std::string why;
    QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
}

void PolyLineEditingTest::selection_data()
{
    QTest::addColumn<Indices>("before");
    QTest::addColumn<int>("act");
    QTest::addColumn<int>("index");
    QTest::addColumn<int>("mods");
    QTest::addColumn<Indices>("after");
    const int none = Qt::NoModifier, shift = Qt::ShiftModifier, ctrl = Qt::ControlModifier;
    QTest::newRow("a click selects one") << Indices{0, 2} << int(A_Click) << 1 << none << Indices{1};
    QTest::newRow("shift-click adds") << Indices{0} << int(A_Click) << 2 << shift << Indices{0, 2};
    QTest::newRow("shift-click on a selected one keeps it")
        << Indices{0, 2} << int(A_Click) << 2 << shift << Indices{0, 2};
    QTest::newRow("ctrl-click takes one off") << Indices{0, 2} << int(A_Click) << 2 << ctrl << Indices{0};
    QTest::newRow("ctrl-click puts one on") << Indices{0} << int(A_Click) << 3 << ctrl << Indices{0, 3};
    QTest::newRow("a click on one of several selected: it alone")
        << Indices{0, 2} << int(A_Click) << 2 << none << Indices{2};
    QTest::newRow("a box selects what is inside") << Indices{3} << int(A_Box) << 0 << none << Indices{1, 2};
    QTest::newRow("shift-box adds") << Indices{3} << int(A_Box) << 0 << shift << Indices{1, 2, 3};
    QTest::newRow("ctrl-box toggles") << Indices{1} << int(A_Box) << 0 << ctrl << Indices{2};
    QTest::newRow("a click on nothing empties") << Indices{0, 1} << int(A_ClickEmpty) << 0 << none << Indices{};
    QTest::newRow("shift-click on nothing keeps") << Indices{0, 1} << int(A_ClickEmpty) << 0 << shift << Indices{0, 1};
}

void PolyLineEditingTest::selection()
{
    QFETCH(Indices, before);
    QFETCH(int, act);
    QFETCH(int, index);
    QFETCH(int, mods);
    Rig r(MakeShape(kCorners).get());
    QVERIFY(r.Show());
    r.SelectByHand(before);
    QCOMPARE(r.Selected(), before);
    if (act == A_Click) {
        r.ClickWith(r.f.At(kCorners[std::size_t(index)]), Qt::KeyboardModifiers(mods));
    } else if (act == A_ClickEmpty) {
        r.ClickWith(r.f.At({0.5, 0.8}), Qt::KeyboardModifiers(mods));
    } else {
        HeldKeys held(&r.f.viewer, Qt::KeyboardModifiers(mods));
        r.f.Drag(r.f.At({0.3, 0.1}), r.f.At({0.7, 0.3}));
    }
    QTEST(r.Selected(), "after");
    // Selecting is no edit of the document.
    QCOMPARE(r.f.UndoSteps(), 0);
}

void PolyLineEditingTest::drags_data()
{
    QTest::addColumn<bool>("handles");   // point 1 smooth
    QTest::addColumn<Indices>("select"); // by hand first
    QTest::addColumn<OrbPoint>("press"); // image point
    QTest::addColumn<int>("mods");
    QTest::addColumn<QPoint>("by"); // viewer pixels, Y up
    QTest::addColumn<int>("index"); // the point checked
    QTest::addColumn<OrbPoint>("pos");
    QTest::addColumn<OrbPoint>("in");
    QTest::addColumn<OrbPoint>("out");
    QTest::addColumn<OrbPoint>("other"); // point 2 afterwards
    QTest::addColumn<QStringList>("undo");
    const int none = Qt::NoModifier;
    // The out handle of point 1 pulled 20 pixels up: the in handle turns to
    // stay opposite and keeps its length of 0.05.
    const OrbPoint arm(0.05, 0.1);
    const OrbPoint turned = OrbPoint(0.4, 0.2) - arm * (0.05 / arm.Length());
    QTest::newRow("one point") << false << Indices{} << kCorners[1] << none << QPoint(40, 20) << 1 << OrbPoint(0.5, 0.3)
                               << OrbPoint(0.5, 0.3) << OrbPoint(0.5, 0.3) << kCorners[2] << QStringList{"Move Point"};
    QTest::newRow("several selected move together")
        << false << Indices{1, 2} << kCorners[1] << none << QPoint(40, 0) << 1 << OrbPoint(0.5, 0.2)
        << OrbPoint(0.5, 0.2) << OrbPoint(0.5, 0.2) << OrbPoint(0.7, 0.2) << QStringList{"Move points"};
    QTest::newRow("a handle turns its partner")
        << true << Indices{1} << OrbPoint(0.45, 0.2) << none << QPoint(0, 20) << 1 << kCorners[1] << turned
        << OrbPoint(0.45, 0.3) << kCorners[2] << QStringList{"Tensioning"};
    QTest::newRow("ctrl breaks the tangent")
        << true << Indices{1} << OrbPoint(0.45, 0.2) << int(Qt::ControlModifier) << QPoint(0, 20) << 1 << kCorners[1]
        << OrbPoint(0.35, 0.2) << OrbPoint(0.45, 0.3) << kCorners[2] << QStringList{"Tensioning"};
    // The middle of the first segment pulled 20 pixels up: both handles of
    // the segment move 4/3 of that, so the curve's middle follows the mouse.
    QTest::newRow("a segment is shaped") << false << Indices{} << OrbPoint(0.3, 0.2) << none << QPoint(0, 20) << 0
                                         << kCorners[0] << kCorners[0] << OrbPoint(0.2, 0.2 + 0.4 / 3.0) << kCorners[2]
                                         << QStringList{"Shape points"};
}

void PolyLineEditingTest::drags()
{
    QFETCH(bool, handles);
    QFETCH(Indices, select);
    QFETCH(OrbPoint, press);
    QFETCH(int, mods);
    QFETCH(QPoint, by);
    QFETCH(int, index);
    Rig r(handles ? WithHandles().get() : MakeShape(kCorners).get());
    QVERIFY(r.Show());
    const AutoParam<PolyLine> before = ShapeOf(r.f, r.shape);
    r.SelectByHand(select);
    {
        HeldKeys held(&r.f.viewer, Qt::KeyboardModifiers(mods));
        r.f.Drag(r.f.At(press), r.f.At(press, by));
    }
    const AutoParam<PolyLine> after = ShapeOf(r.f, r.shape);
    const PolyPoint &p = *after->GetPoint(index);
    QFETCH(OrbPoint, pos);
    QFETCH(OrbPoint, in);
    QFETCH(OrbPoint, out);
    QFETCH(OrbPoint, other);
    QCOMPARE(p.Pos(), pos);
    QVERIFY2(NearPt(p.In(), in), qPrintable(toString(p.In())));
    QVERIFY2(NearPt(p.Out(), out), qPrintable(toString(p.Out())));
    QVERIFY(NearPt(after->GetPoint(2)->Pos(), other));
    QTEST(r.f.doc.UndoNames(), "undo");
    if (QTest::currentDataTag() == QByteArray("a segment is shaped"))
        QVERIFY(NearPt(after->ValueAt(0.5), {0.3, 0.3}));
    // Undo brings the exact shape back.
    QVERIFY(r.f.doc.Undo());
    QVERIFY(ShapeOf(r.f, r.shape)->Equals(*before));
}

void PolyLineEditingTest::clickOnTheCurve_data()
{
    QTest::addColumn<int>("mode");
    QTest::addColumn<int>("points");
    QTest::addColumn<Indices>("selected");
    QTest::addColumn<QStringList>("undo");
    QTest::newRow("insert and modify: a point there") << 3 << 5 << Indices{1} << QStringList{"InsertAndModify"};
    QTest::newRow("modify only: nothing") << 4 << 4 << Indices{} << QStringList{};
}

void PolyLineEditingTest::clickOnTheCurve()
{
    QFETCH(int, mode);
    Rig r(MakeShape(kCorners).get(), mode);
    QVERIFY(r.Show());
    r.f.Click(r.f.At({0.3, 0.2}, QPoint(0, 2)));
    const AutoParam<PolyLine> after = ShapeOf(r.f, r.shape);
    QTEST(after->GetCount(), "points");
    QTEST(r.Selected(), "selected");
    QTEST(r.f.doc.UndoNames(), "undo");
    if (after->GetCount() == 5)
        QVERIFY(NearPt(after->GetPoint(1)->Pos(), {0.3, 0.2}));
}

// Undo is refused while a drag holds its step open; an undo that comes
// between the press and the first move ends the drag instead of letting it
// write the old shape back.
void PolyLineEditingTest::undoDuringADrag()
{
    Rig r(MakeShape(kCorners).get());
    QVERIFY(r.Show());
    const QPoint at = r.f.At(kCorners[1]);
    r.f.Press(at);
    r.f.Move(at + QPoint(10, 0));
    QVERIFY(!r.f.doc.Undo());
    r.f.Move(at + QPoint(20, 0));
    r.f.Release(at + QPoint(20, 0));
    QCOMPARE(r.f.doc.UndoNames(), QStringList{"Move Point"});
    const OrbPoint moved = ShapeOf(r.f, r.shape)->GetPoint(1)->Pos();
    QVERIFY(NearPt(moved, {0.45, 0.2}));

    r.f.Press(r.f.At(moved));
    QVERIFY(r.f.doc.Undo());
    r.f.Move(r.f.At(moved) + QPoint(30, 0));
    r.f.Release(r.f.At(moved) + QPoint(30, 0));
    QVERIFY(ShapeOf(r.f, r.shape)->Equals(*MakeShape(kCorners)));
    QCOMPARE(r.f.doc.UndoNames(), QStringList());
    QCOMPARE(r.f.doc.RedoNames(), QStringList{"Move Point"});
}

QTEST_MAIN(PolyLineEditingTest)
#include "PolyLineEditingTest.moc"
