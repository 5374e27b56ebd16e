#include "TestOverlay.h"
#include "ViewerFixture.h"

#include "orbane/Input.h"
#include "orbane/Operator.h"

#include <QtTest>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

PreviewControl *const None = nullptr;

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

} // namespace

class ViewerPanelTest : public QObject
{
    Q_OBJECT

private slots:
    void createsOverlaysInInputOrder()
    {
        ViewerFixture f;
        Input *a = f.AddPoint("A", 0.2, 0.3, OverlayAttrs());
        f.AddPoint("B", 0.5, 0.5);
        f.AddPoint("Unknown", 0.5, 0.5, TagList{{INPA_PreviewControl, OrbID("NoSuchOverlay")}});
        TagList twice = OverlayAttrs();
        twice.Add(INPA_PreviewControl, kTestOverlayID);
        Input *c = f.AddPoint("C", 0.7, 0.4, twice);
        QTest::ignoreMessage(QtWarningMsg, QRegularExpression("NoSuchOverlay.*unknown"));
        QVERIFY(f.Show());

        const auto &overlays = f.viewer.Overlays();
        QCOMPARE(int(overlays.size()), 3);
        QCOMPARE(overlays[0]->GetMainInput(), a);
        QCOMPARE(overlays[1]->GetMainInput(), c);
        QCOMPARE(overlays[2]->GetMainInput(), c);
        TestOverlay *first = Overlay(f, a);
        const std::vector<std::string> start(first->calls.begin(), first->calls.begin() + 4);
        QCOMPARE(start, (std::vector<std::string>{"AddInput", "SetAttrs", "Notify", "SetActive"}));
        QCOMPARE(first->at, OrbPoint(0.2, 0.3)); // the value arrives before anything is drawn
        QCOMPARE(first->GetDoc(), &f.doc);
    }

    void toolRemovalUnbindsAndDestroys()
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

    void attachToInputObjectAndDetach()
    {
        ViewerFixture f;
        Input *target = f.AddPoint("Target", 0.1, 0.1);
        Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
        QVERIFY(f.Show());
        TestOverlay *o = Overlay(f, a);
        TagList link;
        link.Set(TestOverlay::TO_Link, OrbID("Nope"));
        o->SetAttrsTagList(a, link);
        QVERIFY(!o->linked);
        // A script's SetAttrs may give the Input object itself.
        link.Set(TestOverlay::TO_LinkObject, static_cast<void *>(static_cast<ScriptObject *>(target)));
        o->SetAttrsTagList(a, link);
        QCOMPARE(o->link, target);

        const AutoPoint moved(0.4, 0.4), back(0.1, 0.1);
        target->SetValue(moved.get(), 0.0);
        QCOMPARE(o->Count("NotifyLink"), 1);
        const int refs = target->RefCount();
        o->DetachFromInput(o->link);
        QCOMPARE(target->RefCount(), refs - 1);
        target->SetValue(back.get(), 0.0);
        QCOMPARE(o->Count("NotifyLink"), 1);
    }

    // Repainting only on a change is checked with a real overlay
    // (RectangleControlTest); here, which of two overlays on one spot claims.
    void topmostOverlayClaimsTheHover()
    {
        ViewerFixture f;
        Input *a = f.AddPoint("A", 0.5, 0.5, OverlayAttrs());
        Input *b = f.AddPoint("B", 0.5, 0.5, OverlayAttrs());
        QVERIFY(f.Show());
        f.Hover(f.At({0.5, 0.5}, QPoint(2, 0)));
        // The later Input lies above: it claims (bit 0); the other is told so.
        QVERIFY(Overlay(f, b)->hover && !Overlay(f, a)->hover);
        QCOMPARE(f.viewer.HoverControl(), f.OverlayOf(b));
        f.Hover(f.At({0.5, 0.5}, QPoint(40, 0)));
        QCOMPARE(f.viewer.HoverControl(), None);
    }

    void pressPicksHotAndDragsAndActivatesLinked()
    {
        ViewerFixture f;
        Input *a = f.AddPoint("A", 0.25, 0.5, OverlayAttrs());
        Input *b = f.AddPoint("B", 0.75, 0.5, OverlayAttrs(TagList{{TestOverlay::TO_Link, OrbID("A")}}));
        QVERIFY(f.Show());
        TestOverlay *oa = Overlay(f, a), *ob = Overlay(f, b);
        f.Drag(f.At({0.5, 0.2}), f.At({0.5, 0.4})); // on nothing
        QCOMPARE(f.viewer.HotControl(), None);
        QCOMPARE(oa->Count("Move"), 0);
        QCOMPARE(f.UndoSteps(), 0);

        const QPoint from = f.At({0.25, 0.5}, QPoint(2, 1));
        f.Press(from);
        QCOMPARE(f.viewer.HotControl(), static_cast<PreviewControl *>(oa));
        QCOMPARE(oa->IsDragging(), DRAG_Handle);
        QCOMPARE(ob->IsDragging(), DRAG_Linked);
        QCOMPARE(oa->pressFlags, int64(0));
        f.Move(from + QPoint(20, 0));
        f.Move(from + QPoint(40, -10));
        QCOMPARE(ob->Count("MoveLinked"), 2);
        f.Release(from + QPoint(40, -10));

        QCOMPARE(oa->IsDragging(), DRAG_None);
        QCOMPARE(ob->IsDragging(), DRAG_None);
        QCOMPARE(f.viewer.HotControl(), None);
        QVERIFY(Near(f.PointOf(a), {0.25 + 40 / 400.0, 0.5 + 10 / 200.0}));
        QCOMPARE(f.PointOf(b), OrbPoint(0.75, 0.5));
        QCOMPARE(f.doc.UndoNames(), QStringList{"Change A"});
        QVERIFY(f.doc.Undo());
        QCOMPARE(oa->at, OrbPoint(0.25, 0.5));

        // Activating B activates A, which it links to; A links to nothing.
        oa->SetInactive(nullptr);
        ob->SetInactive(nullptr);
        oa->SetActive(1, nullptr);
        QVERIFY(!ob->IsActive());
        oa->SetInactive(nullptr);
        ob->SetActive(1, nullptr);
        QVERIFY(oa->IsActive());
    }

    void lockedToolRefusesWrites()
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

    void keysGoToTheOverlayUnderTheMouseAndEndOnce()
    {
        ViewerFixture f;
        Input *a = f.AddPoint("A", 0.25, 0.5, OverlayAttrs());
        Input *b = f.AddPoint("B", 0.75, 0.5, OverlayAttrs());
        QVERIFY(f.Show());
        TestOverlay *oa = Overlay(f, a), *ob = Overlay(f, b);
        f.Hover(f.At({0.25, 0.5}));
        f.Key(Qt::Key_A); // not needed by the overlay
        QCOMPARE(oa->Count("CCMD_KeyDown"), 0);
        QCOMPARE(f.viewer.KeyControl(), None);

        // Shift goes down first and comes up last: the keys end with it.
        QTest::keyPress(&f.viewer, Qt::Key_Space, Qt::ShiftModifier);
        QTest::keyPress(&f.viewer, Qt::Key_Space, Qt::ShiftModifier);
        QCOMPARE(oa->Count("CCMD_KeyDown"), 2);
        QCOMPARE(ob->Count("CCMD_KeyDown"), 0);
        // The modifiers come from the keyboard state of the key event.
        QCOMPARE(oa->modifiers, std::vector<Qt::KeyboardModifiers>(2, Qt::ShiftModifier));
        QCOMPARE(f.viewer.KeyControl(), static_cast<PreviewControl *>(oa));
        QTest::keyRelease(&f.viewer, Qt::Key_Space, Qt::NoModifier);
        QCOMPARE(oa->Count("CCMD_KeyUp"), 1);
        QCOMPARE(oa->Count("CCMD_KeyUpAll"), 0);
        QTest::keyRelease(&f.viewer, Qt::Key_Shift, Qt::NoModifier);
        QCOMPARE(oa->Count("CCMD_KeyUpAll"), 1);
        QCOMPARE(f.viewer.KeyControl(), None);

        // Away from both: the one pressed last.
        f.Click(f.At({0.75, 0.5}));
        f.Hover(f.At({0.5, 0.1}));
        f.Key(Qt::Key_Space, Qt::ControlModifier | Qt::ShiftModifier);
        QCOMPARE(ob->modifiers, std::vector<Qt::KeyboardModifiers>{Qt::ControlModifier | Qt::ShiftModifier});
        QCOMPARE(oa->Count("CCMD_KeyDown"), 2);
    }

    void contextMenuGoesToTheOverlayThatFilledIt()
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
    }

    void inactiveOverlaysDrawInFirstPass()
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
        QCOMPARE(shot.pixelColor(f.At({0.25, 0.5})), QColor(Qt::red));
        QCOMPARE(shot.pixelColor(f.At({0.75, 0.5})), QColor(Qt::red));
        QCOMPARE(shot.pixelColor(f.At({0.5, 0.5})), QColor(Qt::black));
        // Switched off, it takes no clicks.
        f.Press(f.At({0.25, 0.5}));
        QCOMPARE(f.viewer.HotControl(), None);
        f.Release(f.At({0.25, 0.5}));
    }

    void wheelZoomsAndMiddleDragPans()
    {
        ViewerFixture f;
        QVERIFY(f.Show());
        const QPoint at(120, 80);
        const OrbPoint under = f.viewer.WidgetToImage(at);
        QWheelEvent wheel(QPointF(at), QPointF(f.viewer.mapToGlobal(at)), QPoint(), QPoint(0, 120), Qt::NoButton,
                          Qt::NoModifier, Qt::NoScrollPhase, false);
        QApplication::sendEvent(&f.viewer, &wheel);
        QCOMPARE(f.viewer.Mapping().Zoom(), 1.25);
        QVERIFY(Near(f.viewer.WidgetToImage(at), under));

        const QPoint to(230, 140);
        f.Press(at, Qt::MiddleButton);
        f.Move(to, Qt::MiddleButton);
        f.Release(to, Qt::MiddleButton);
        QVERIFY(Near(f.viewer.WidgetToImage(to), under));
        f.viewer.resize(ViewerFixture::kViewWidth + 100, ViewerFixture::kViewHeight);
        QCOMPARE(f.viewer.Mapping().Zoom(), 1.25);
    }

    void imageAndCheckerboard()
    {
        ViewerFixture f;
        QVERIFY(f.Show());
        QImage red(64, 32, QImage::Format_RGB32);
        red.fill(Qt::red);
        f.viewer.SetImage(red);
        QCOMPARE(f.viewer.ImageSize(), QSize(64, 32));
        QCOMPARE(f.viewer.Mapping().SpanX(), double(ViewerFixture::kViewWidth)); // fitted
        QImage shot = f.Grab();
        QCOMPARE(shot.pixelColor(250, 150), QColor(Qt::red));
        QCOMPARE(shot.pixelColor(250, 5), QColor(36, 36, 36));

        f.viewer.SetImage(QImage());
        QVERIFY(!f.viewer.HasImage());
        QCOMPARE(f.viewer.ImageSize(), QSize(1920, 1080));
        f.viewer.SetView(1.0);
        shot = f.Grab();
        // Neighbouring cells of 32 image pixels differ.
        const QPoint centre = f.At({0.5, 0.5});
        QVERIFY(shot.pixelColor(centre + QPoint(-16, -16)) != shot.pixelColor(centre + QPoint(16, -16)));
        QCOMPARE(shot.pixelColor(centre + QPoint(-16, -16)), shot.pixelColor(centre + QPoint(16, 16)));
    }

private:
    TestOverlayClass mTestOverlayClass;
};

QTEST_MAIN(ViewerPanelTest)
#include "ViewerPanelTest.moc"
