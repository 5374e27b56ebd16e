// The viewer panel and the overlay base it drives, through an overlay of the
// tests' own registered like any control class.
#include "TestOverlay.h"
#include "ViewerFixture.h"

#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"

#include <QToolBar>
#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

const OrbID kTestOverlayID("TestOverlay");

TagList OverlayAttrs(const TagList &more = TagList())
{
    TagList attrs{{INPA_PreviewControl, kTestOverlayID}};
    attrs.Append(more);
    return attrs;
}

TestOverlay *Overlay(const ViewerFixture &f, const Input *input, int index = 0)
{
    return dynamic_cast<TestOverlay *>(f.OverlayOf(input, index));
}

QColor Pixel(const QImage &image, QPoint at)
{
    return image.pixelColor(at);
}

void Wheel(QWidget *w, QPoint at, int delta)
{
    QWheelEvent event(QPointF(at), QPointF(w->mapToGlobal(at)), QPoint(), QPoint(0, delta), Qt::NoButton,
                      Qt::NoModifier, Qt::NoScrollPhase, false);
    QApplication::sendEvent(w, &event);
}

} // namespace

class ViewerPanelTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();

    void createsOverlaysInInputOrder();
    void unknownOverlayClassIsSkipped();
    void toolRemovalUnbindsAndDestroys();
    void attachToInput_data();
    void attachToInput();
    void detachStopsNotifications();
    void activationFollowsLinks();
    void hoverClaimsOnceAndRedrawsOnlyOnChange();
    void pressPicksHotAndDragsLinked();
    void pressFlagsReachOverlays();
    void pressOnNothingDragsNothing();
    void lockedToolRefusesWrites();
    void overlayOwnUndoGroupIsOneStep();
    void keysGoToClaimingOverlayAndEndOnce();
    void keyOwnerIsOverlayUnderMouse();
    void keyModifiersComeFromKeyboardState_data();
    void keyModifiersComeFromKeyboardState();
    void nudgeOffset_data();
    void nudgeOffset();
    void contextMenuToolbarAndTips();
    void inactiveOverlaysDrawInFirstPass();
    void followCursorEndsWithClick();
    void names();
    void wheelZoom_data();
    void wheelZoom();
    void wheelKeepsPointUnderMouse();
    void middleDragPans();
    void imageAndCheckerboard();

private:
    Registry mTestOverlayClass;
};

void ViewerPanelTest::initTestCase()
{
    mTestOverlayClass._Init(
        ClassRegistry, kTestOverlayID,
        TagList{{REG_Factory, &NewObject<TestOverlay>}, {REG_Kind, REGKIND_PreviewControl}, {REG_Name, "TestOverlay"}});
}

void ViewerPanelTest::createsOverlaysInInputOrder()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.2, 0.3, OverlayAttrs());
    f.AddPoint("B", 0.5, 0.5);
    TagList twice = OverlayAttrs();
    twice.Add(INPA_PreviewControl, kTestOverlayID);
    Input *c = f.AddPoint("C", 0.7, 0.4, twice);
    QVERIFY(f.Show());

    const auto &overlays = f.viewer.Overlays();
    QCOMPARE(int(overlays.size()), 3);
    QCOMPARE(overlays[0]->GetMainInput(), a);
    QCOMPARE(overlays[1]->GetMainInput(), c);
    QCOMPARE(overlays[2]->GetMainInput(), c);
    TestOverlay *first = Overlay(f, a);
    const std::vector<std::string> start(first->calls.begin(), first->calls.begin() + 4);
    QCOMPARE(start, (std::vector<std::string>{"AddInput", "SetAttrs", "Notify", "SetActive"}));
    // The current value arrives before anything is drawn.
    QCOMPARE(first->at, OrbPoint(0.2, 0.3));
    QVERIFY(first->IsActive());
    QCOMPARE(first->GetDoc(), &f.doc);
}

void ViewerPanelTest::unknownOverlayClassIsSkipped()
{
    ViewerFixture f;
    f.AddPoint("A", 0.2, 0.3, TagList{{INPA_PreviewControl, OrbID("NoSuchOverlay")}});
    f.AddPoint("B", 0.5, 0.5, OverlayAttrs());
    QTest::ignoreMessage(QtWarningMsg, QRegularExpression("NoSuchOverlay.*unknown"));
    QVERIFY(f.Show());
    QCOMPARE(int(f.viewer.Overlays().size()), 1);
}

void ViewerPanelTest::toolRemovalUnbindsAndDestroys()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.2, 0.3, OverlayAttrs());
    f.AddPoint("B", 0.6, 0.3, OverlayAttrs());
    QVERIFY(f.Show());
    // Held past the panel, to see what it did before letting go.
    TestOverlay *kept = Overlay(f, a);
    kept->IncRef();
    const int before = TestOverlay::destroyed;
    f.doc.RemoveTool(f.tool);
    QVERIFY(f.viewer.Overlays().empty());
    QCOMPARE(f.viewer.GetTool(), static_cast<Operator *>(nullptr));
    QCOMPARE(TestOverlay::destroyed, before + 1);
    QCOMPARE(kept->Count("RemoveInput"), 1);
    QVERIFY(kept->Inputs().empty());
    kept->DecRef();
    QCOMPARE(TestOverlay::destroyed, before + 2);
}

void ViewerPanelTest::attachToInput_data()
{
    QTest::addColumn<QString>("how");
    QTest::addColumn<bool>("found");
    QTest::newRow("by id") << "id" << true;
    QTest::newRow("by Input object") << "object" << true;
    QTest::newRow("unknown id") << "unknown" << false;
    QTest::newRow("not named") << "none" << false;
}

void ViewerPanelTest::attachToInput()
{
    QFETCH(QString, how);
    QFETCH(bool, found);
    ViewerFixture f;
    Input *target = f.AddPoint("Target", 0.1, 0.1);
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    // Given as a script's SetAttrs would: an Input object may be one of them.
    TagList link;
    if (how == "id")
        link.Set(TestOverlay::TO_Link, OrbID("Target"));
    else if (how == "object")
        link.Set(TestOverlay::TO_LinkObject, static_cast<void *>(static_cast<ScriptObject *>(target)));
    else if (how == "unknown")
        link.Set(TestOverlay::TO_Link, OrbID("Nope"));
    TestOverlay *o = Overlay(f, a);
    o->SetAttrsTagList(a, link);
    QCOMPARE(o->linked, found);
    QCOMPARE(o->link, found ? target : nullptr);

    // A linked Input's changes reach the overlay.
    const AutoPoint moved(0.4, 0.4);
    target->SetValue(moved.get(), 0.0);
    QCOMPARE(o->Count("NotifyLink"), found ? 1 : 0);
}

void ViewerPanelTest::detachStopsNotifications()
{
    ViewerFixture f;
    Input *target = f.AddPoint("Target", 0.1, 0.1);
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs(TagList{{TestOverlay::TO_Link, OrbID("Target")}}));
    QVERIFY(f.Show());
    TestOverlay *o = Overlay(f, a);
    const int refs = target->RefCount();
    o->DetachFromInput(o->link);
    QCOMPARE(o->link, static_cast<Input *>(nullptr));
    QCOMPARE(target->RefCount(), refs - 1);
    const AutoPoint moved(0.4, 0.4);
    target->SetValue(moved.get(), 0.0);
    QCOMPARE(o->Count("NotifyLink"), 0);
}

void ViewerPanelTest::activationFollowsLinks()
{
    ViewerFixture f;
    Input *b = f.AddPoint("B", 0.3, 0.5, OverlayAttrs());
    Input *a = f.AddPoint("A", 0.6, 0.5, OverlayAttrs(TagList{{TestOverlay::TO_Link, OrbID("B")}}));
    QVERIFY(f.Show());
    TestOverlay *oa = Overlay(f, a), *ob = Overlay(f, b);
    oa->SetInactive(nullptr);
    ob->SetInactive(nullptr);
    ob->SetActive(1, nullptr);
    QVERIFY(!oa->IsActive()); // B links to nothing
    ob->SetInactive(nullptr);
    oa->SetActive(1, nullptr);
    QVERIFY(oa->IsActive());
    QVERIFY(ob->IsActive());
}

void ViewerPanelTest::hoverClaimsOnceAndRedrawsOnlyOnChange()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    Input *b = f.AddPoint("B", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    QApplication::processEvents();
    const int paints = f.viewer.PaintCount();

    f.Hover(f.At({0.5, 0.5}, QPoint(2, 0)));
    // The later Input lies above: it claims; the other is told so.
    QVERIFY(Overlay(f, b)->hover);
    QVERIFY(!Overlay(f, a)->hover);
    QCOMPARE(f.viewer.HoverControl(), f.OverlayOf(b));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), paints + 1);

    f.Hover(f.At({0.5, 0.5}, QPoint(3, 1)));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), paints + 1);

    f.Hover(f.At({0.5, 0.5}, QPoint(40, 0)));
    QCOMPARE(f.viewer.HoverControl(), static_cast<PreviewControl *>(nullptr));
    QApplication::processEvents();
    QCOMPARE(f.viewer.PaintCount(), paints + 2);
}

void ViewerPanelTest::pressPicksHotAndDragsLinked()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.25, 0.5, OverlayAttrs());
    Input *b = f.AddPoint("B", 0.75, 0.5, OverlayAttrs(TagList{{TestOverlay::TO_Link, OrbID("A")}}));
    QVERIFY(f.Show());
    TestOverlay *oa = Overlay(f, a), *ob = Overlay(f, b);

    const QPoint from = f.At({0.25, 0.5}, QPoint(2, 1));
    f.Press(from);
    QCOMPARE(f.viewer.HotControl(), static_cast<PreviewControl *>(oa));
    QCOMPARE(oa->IsDragging(), DRAG_Handle);
    QCOMPARE(ob->IsDragging(), DRAG_Linked);
    f.Move(from + QPoint(20, 0));
    f.Move(from + QPoint(40, -10));
    QCOMPARE(ob->Count("MoveLinked"), 2);
    f.Release(from + QPoint(40, -10));

    QCOMPARE(oa->IsDragging(), DRAG_None);
    QCOMPARE(ob->IsDragging(), DRAG_None);
    QCOMPARE(f.viewer.HotControl(), static_cast<PreviewControl *>(nullptr));
    QVERIFY(Near(f.PointOf(a), {0.25 + 40 / 400.0, 0.5 + 10 / 200.0}));
    QCOMPARE(f.PointOf(b), OrbPoint(0.75, 0.5));
    QCOMPARE(f.doc.UndoNames(), QStringList{"Change A"});
    QVERIFY(f.doc.Undo());
    QCOMPARE(f.PointOf(a), OrbPoint(0.25, 0.5));
    QCOMPARE(oa->at, OrbPoint(0.25, 0.5));
}

void ViewerPanelTest::pressFlagsReachOverlays()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    f.Press(f.At({0.5, 0.5}));
    f.Release(f.At({0.5, 0.5}));
    QCOMPARE(Overlay(f, a)->pressFlags, int64(0));
    f.viewer.SetPressFlags(PEF_StartGrab);
    f.Press(f.At({0.5, 0.5}));
    f.Release(f.At({0.5, 0.5}));
    QCOMPARE(Overlay(f, a)->pressFlags, int64(PEF_StartGrab));
}

void ViewerPanelTest::pressOnNothingDragsNothing()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    f.Drag(f.At({0.2, 0.2}), f.At({0.4, 0.4}));
    QCOMPARE(f.viewer.HotControl(), static_cast<PreviewControl *>(nullptr));
    QCOMPARE(Overlay(f, a)->Count("Move"), 0);
    QCOMPARE(f.PointOf(a), OrbPoint(0.5, 0.5));
    QCOMPARE(f.UndoSteps(), 0);
}

void ViewerPanelTest::lockedToolRefusesWrites()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    f.tool->SetLocked(true);
    f.Drag(f.At({0.5, 0.5}), f.At({0.6, 0.6}));
    QCOMPARE(Overlay(f, a)->Count("Move"), 4);
    QCOMPARE(f.PointOf(a), OrbPoint(0.5, 0.5));
    QCOMPARE(f.UndoSteps(), 0);
    QVERIFY(!Overlay(f, a)->IsUndoOpen());
}

void ViewerPanelTest::overlayOwnUndoGroupIsOneStep()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.1, 0.1);
    Input *b = f.AddPoint("B", 0.2, 0.2);
    auto *o = dynamic_cast<TestOverlay *>(ClassRegistry.New(kTestOverlayID, ScriptVal(), TagList()));
    QVERIFY(o);
    QVERIFY(o->AddInput(a, nullptr));
    QVERIFY(o->AddInput(b, nullptr));
    QVERIFY(!o->AddInput(a, nullptr));
    f.doc.StartUndo("Adjust Test");
    o->SetUndo(1, nullptr);
    const AutoPoint pa(0.3, 0.3), pb(0.4, 0.4);
    QVERIFY(o->SetInputs(pa.get(), 0.0, 0, nullptr));
    QVERIFY(o->SetInputs(pb.get(), 0.0, 1, nullptr));
    QVERIFY(!o->SetInputs(pb.get(), 0.0, 2, nullptr));
    QCOMPARE(f.UndoSteps(), 0);
    o->ResetUndo(nullptr);
    QVERIFY(!o->IsUndoOpen());
    QCOMPARE(f.doc.UndoNames(), QStringList{"Adjust Test"});
    QVERIFY(f.doc.Undo());
    QCOMPARE(f.PointOf(a), OrbPoint(0.1, 0.1));
    QCOMPARE(f.PointOf(b), OrbPoint(0.2, 0.2));
    o->RemoveInput(a, nullptr);
    o->RemoveInput(b, nullptr);
    o->DecRef();
}

void ViewerPanelTest::keysGoToClaimingOverlayAndEndOnce()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    TestOverlay *o = Overlay(f, a);

    QTest::keyClick(&f.viewer, Qt::Key_A);
    QCOMPARE(o->Count("CCMD_KeyDown"), 0);
    QCOMPARE(f.viewer.KeyControl(), static_cast<PreviewControl *>(nullptr));

    // Shift goes down first and comes up last: the keys end with it.
    QTest::keyPress(&f.viewer, Qt::Key_Space, Qt::ShiftModifier);
    QTest::keyPress(&f.viewer, Qt::Key_Space, Qt::ShiftModifier);
    QCOMPARE(o->Count("CCMD_KeyDown"), 2);
    QCOMPARE(f.viewer.KeyControl(), static_cast<PreviewControl *>(o));
    QTest::keyRelease(&f.viewer, Qt::Key_Space, Qt::NoModifier);
    QCOMPARE(o->Count("CCMD_KeyUp"), 1);
    QCOMPARE(o->Count("CCMD_KeyUpAll"), 0);
    QTest::keyRelease(&f.viewer, Qt::Key_Shift, Qt::NoModifier);
    QCOMPARE(o->Count("CCMD_KeyUpAll"), 1);
    QCOMPARE(f.viewer.KeyControl(), static_cast<PreviewControl *>(nullptr));
}

void ViewerPanelTest::keyOwnerIsOverlayUnderMouse()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.25, 0.5, OverlayAttrs());
    Input *b = f.AddPoint("B", 0.75, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    f.Hover(f.At({0.25, 0.5}));
    QTest::keyClick(&f.viewer, Qt::Key_Space);
    QCOMPARE(Overlay(f, a)->Count("CCMD_KeyDown"), 1);
    QCOMPARE(Overlay(f, b)->Count("CCMD_KeyDown"), 0);
    // Away from both: the one pressed last.
    f.Press(f.At({0.75, 0.5}));
    f.Release(f.At({0.75, 0.5}));
    f.Hover(f.At({0.5, 0.1}));
    QTest::keyClick(&f.viewer, Qt::Key_Space);
    QCOMPARE(Overlay(f, b)->Count("CCMD_KeyDown"), 1);
    QCOMPARE(Overlay(f, a)->Count("CCMD_KeyDown"), 1);
}

void ViewerPanelTest::keyModifiersComeFromKeyboardState_data()
{
    QTest::addColumn<int>("mods");
    QTest::newRow("none") << int(Qt::NoModifier);
    QTest::newRow("shift") << int(Qt::ShiftModifier);
    QTest::newRow("control") << int(Qt::ControlModifier);
    QTest::newRow("both") << int(Qt::ShiftModifier | Qt::ControlModifier);
}

void ViewerPanelTest::keyModifiersComeFromKeyboardState()
{
    QFETCH(int, mods);
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    QTest::keyClick(&f.viewer, Qt::Key_Space, Qt::KeyboardModifiers(mods));
    TestOverlay *o = Overlay(f, a);
    QCOMPARE(int(o->modifiers.size()), 1);
    QCOMPARE(int(o->modifiers.front()), mods);
}

void ViewerPanelTest::nudgeOffset_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<double>("dx");
    QTest::addColumn<double>("dy");
    QTest::newRow("right") << int(Qt::Key_Right) << int(Qt::NoModifier) << 0.01 << 0.0;
    QTest::newRow("left with shift: ten") << int(Qt::Key_Left) << int(Qt::ShiftModifier) << -0.1 << 0.0;
    QTest::newRow("up with control: a tenth") << int(Qt::Key_Up) << int(Qt::ControlModifier) << 0.0 << 0.002;
    QTest::newRow("down with both: one") << int(Qt::Key_Down) << int(Qt::ShiftModifier | Qt::ControlModifier) << 0.0
                                         << -0.02;
    QTest::newRow("not an arrow") << int(Qt::Key_A) << int(Qt::ShiftModifier) << 0.0 << 0.0;
}

void ViewerPanelTest::nudgeOffset()
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(double, dx);
    QFETCH(double, dy);
    const OrbPoint d = PreviewControl::NudgeOffset(uint64(key), 0.01, 0.02, Qt::KeyboardModifiers(mods));
    QVERIFY(std::fabs(d.x - dx) < 1e-12);
    QVERIFY(std::fabs(d.y - dy) < 1e-12);
    QCOMPARE(PreviewControl::IsArrowKey(uint64(key)), key != Qt::Key_A);
}

void ViewerPanelTest::contextMenuToolbarAndTips()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.25, 0.5, OverlayAttrs());
    Input *b = f.AddPoint("B", 0.75, 0.5, OverlayAttrs());
    QVERIFY(f.Show());

    QMenu menu;
    f.viewer.FillContextMenu(&menu);
    QCOMPARE(menu.actions().size(), 2);
    QAction *ofB = menu.actions().at(0); // the topmost overlay fills first
    QCOMPARE(ofB->text(), QString("Test B"));
    QVERIFY(f.viewer.TriggerMenuAction(ofB));
    QCOMPARE(Overlay(f, b)->menuIDs, std::vector<int32>{TestOverlay::kMenuID});
    QVERIFY(Overlay(f, a)->menuIDs.empty());

    QToolBar *bar = f.viewer.OverlayToolBar();
    QVERIFY(bar->isVisible());
    QCOMPARE(bar->actions().size(), 2);
    bar->actions().at(0)->trigger();
    QCOMPARE(Overlay(f, a)->events, std::vector<std::string>{"TestEvent"});
    QVERIFY(Overlay(f, b)->events.empty());

    QCOMPARE(f.viewer.TipAt(f.At({0.75, 0.5}, QPoint(1, 1))), QString("tip of B"));
    QCOMPARE(f.viewer.TipAt(f.At({0.5, 0.2})), QString());
}

void ViewerPanelTest::inactiveOverlaysDrawInFirstPass()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.25, 0.5, OverlayAttrs());
    Input *b = f.AddPoint("B", 0.75, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    Overlay(f, a)->SetInactive(nullptr);
    Overlay(f, a)->passes.clear();
    Overlay(f, b)->passes.clear();
    const QImage shot = f.Grab();
    QCOMPARE(Overlay(f, a)->passes, std::vector<int32>{1});
    QCOMPARE(Overlay(f, b)->passes, std::vector<int32>{2});
    QCOMPARE(Pixel(shot, f.At({0.25, 0.5})), QColor(Qt::red));
    QCOMPARE(Pixel(shot, f.At({0.75, 0.5})), QColor(Qt::red));
    QCOMPARE(Pixel(shot, f.At({0.5, 0.5})), QColor(Qt::black));
    // Switched off, it takes no clicks.
    f.Press(f.At({0.25, 0.5}));
    QCOMPARE(f.viewer.HotControl(), static_cast<PreviewControl *>(nullptr));
    f.Release(f.At({0.25, 0.5}));
}

void ViewerPanelTest::followCursorEndsWithClick()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    TestOverlay *o = Overlay(f, a);
    QVERIFY(!f.viewer.BeginFollowCursor(nullptr, TagList()));
    QVERIFY(f.viewer.BeginFollowCursor(o, TagList()));
    QCOMPARE(o->IsDragging(), DRAG_Linked);
    f.Hover(f.At({0.3, 0.3}));
    f.Hover(f.At({0.35, 0.3}));
    QCOMPARE(o->Count("MoveLinked"), 2);
    f.Press(f.At({0.35, 0.3}));
    QCOMPARE(o->Count("Down"), 0);
    f.Release(f.At({0.35, 0.3}));
    QCOMPARE(o->Count("Up"), 1);
    QCOMPARE(o->IsDragging(), DRAG_None);
    QCOMPARE(f.viewer.Follower(), static_cast<PreviewControl *>(nullptr));
}

void ViewerPanelTest::names()
{
    ViewerFixture f;
    Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
    QVERIFY(f.Show());
    char name[64] = {};
    f.OverlayOf(a)->GetName(name, sizeof name, nullptr);
    QCOMPARE(QString(name), QString("TestOverlay"));
    f.OverlayOf(a)->GetFullName(name, sizeof name, nullptr, nullptr);
    QCOMPARE(QString(name), QString("Tool1.A (TestOverlay)"));
    QCOMPARE(f.OverlayOf(a)->GetOperator(nullptr), f.tool);
}

void ViewerPanelTest::wheelZoom_data()
{
    QTest::addColumn<double>("zoom");
    QTest::addColumn<int>("delta");
    QTest::addColumn<double>("expected");
    QTest::newRow("one notch in") << 1.0 << 120 << 1.25;
    QTest::newRow("one notch out") << 1.0 << -120 << 0.8;
    QTest::newRow("half a notch") << 2.0 << 60 << 2.0 * std::sqrt(1.25);
    QTest::newRow("in past the limit") << 60.0 << 240 << 64.0;
    QTest::newRow("out past the limit") << 1.0 / 64 << -120 << 1.0 / 64;
}

void ViewerPanelTest::wheelZoom()
{
    QFETCH(double, zoom);
    QFETCH(int, delta);
    QFETCH(double, expected);
    QVERIFY(std::fabs(ViewerPanel::WheelZoom(zoom, delta) - expected) < 1e-12);
}

void ViewerPanelTest::wheelKeepsPointUnderMouse()
{
    ViewerFixture f;
    QVERIFY(f.Show());
    const QPoint at(120, 80);
    const OrbPoint under = f.viewer.WidgetToImage(at);
    Wheel(&f.viewer, at, 120);
    QCOMPARE(f.viewer.Mapping().Zoom(), 1.25);
    const OrbPoint after = f.viewer.WidgetToImage(at);
    QVERIFY(std::fabs(after.x - under.x) < 1e-12);
    QVERIFY(std::fabs(after.y - under.y) < 1e-12);
    // The view stays where the user put it when the window changes size.
    f.viewer.resize(ViewerFixture::kViewWidth + 100, ViewerFixture::kViewHeight);
    QCOMPARE(f.viewer.Mapping().Zoom(), 1.25);
}

void ViewerPanelTest::middleDragPans()
{
    ViewerFixture f;
    QVERIFY(f.Show());
    const QPoint from(200, 100), to(230, 140);
    const OrbPoint grabbed = f.viewer.WidgetToImage(from);
    f.Press(from, Qt::NoModifier, Qt::MiddleButton);
    QMouseEvent move(QEvent::MouseMove, to, f.viewer.mapToGlobal(to), Qt::NoButton, Qt::MiddleButton, Qt::NoModifier);
    QApplication::sendEvent(&f.viewer, &move);
    f.Release(to, Qt::NoModifier, Qt::MiddleButton);
    const OrbPoint now = f.viewer.WidgetToImage(to);
    QVERIFY(std::fabs(now.x - grabbed.x) < 1e-12);
    QVERIFY(std::fabs(now.y - grabbed.y) < 1e-12);
    QCOMPARE(f.viewer.Mapping().Zoom(), 1.0);
}

void ViewerPanelTest::imageAndCheckerboard()
{
    ViewerFixture f;
    QVERIFY(f.Show());
    QVERIFY(!f.viewer.LoadImage("/no/such/image.png"));
    QCOMPARE(f.viewer.ImageSize(), QSize(400, 200));

    QImage red(64, 32, QImage::Format_RGB32);
    red.fill(Qt::red);
    f.viewer.SetImage(red);
    QCOMPARE(f.viewer.ImageSize(), QSize(64, 32));
    // A new image is fitted to the viewer.
    QCOMPARE(f.viewer.Mapping().SpanX(), double(ViewerFixture::kViewWidth));
    QImage shot = f.Grab();
    QCOMPARE(Pixel(shot, QPoint(250, 150)), QColor(Qt::red));
    QCOMPARE(Pixel(shot, QPoint(250, 5)), QColor(36, 36, 36));

    f.viewer.SetImage(QImage());
    QVERIFY(!f.viewer.HasImage());
    QCOMPARE(f.viewer.ImageSize(), QSize(1920, 1080));
    f.viewer.SetView(1.0);
    shot = f.Grab();
    // Neighbouring cells of 32 image pixels differ.
    const QPoint centre = f.At({0.5, 0.5});
    QVERIFY(Pixel(shot, centre + QPoint(-16, -16)) != Pixel(shot, centre + QPoint(16, -16)));
    QCOMPARE(Pixel(shot, centre + QPoint(-16, -16)), Pixel(shot, centre + QPoint(16, 16)));
}

QTEST_MAIN(ViewerPanelTest)
#include "ViewerPanelTest.moc"
