// The polyline overlay's dialogs in a real viewer, filled through their
// widgets as a person fills them: the point editor, the number dialogs,
// the keyframe list, the edits of the animation and the onion skins.
#include "../overlays/OverlayProbe.h"
#include "PolyLineTestShapes.h"
#include "ViewerFixture.h"

#include "orbane/ControlCommands.h"
#include "orbane/Number.h"
#include "orbane/PolyLine.h"
#include "orbane/PreviewControl.h"

#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMenu>
#include <QPushButton>
#include <QtTest>

#include <functional>

using namespace Orbane;
using namespace Orbane::Test;

namespace {

constexpr Tag PLC_DrawMode = 0x10058000;
const Points kCorners{{0.2, 0.2}, {0.4, 0.2}, {0.6, 0.2}, {0.8, 0.6}};
// Far from every point and curve: the menu there is the shape's own.
const OrbPoint kAway{0.5, 0.9};

// Point 1 smooth, its handles 0.05 to each side.
AutoRef<PolyLine> WithHandles()
{
    AutoRef<PolyLine> s = MakeShape(kCorners);
    PolyPoint p = *s->GetPoint(1);
    p.InX = 0.35, p.OutX = 0.45;
    s->SetPoint(1, p);
    return s;
}

// The corners moved right by `dx`.
AutoRef<PolyLine> Moved(float64 dx, float64 dy = 0.0)
{
    AutoRef<PolyLine> s = MakeShape(kCorners);
    for (int32 i = 0; i < s->GetCount(); ++i) {
        PolyPoint p = *s->GetPoint(i);
        p.Offset(dx, dy);
        s->SetPoint(i, p);
    }
    return s;
}

QString N(float64 v)
{
    return QString::number(v, 'g', 6);
}

// Every point as "x y", joined by ";".
QString Places(const PolyLine &s)
{
    QStringList out;
    for (const PolyPoint &p : s.Points())
        out << N(p.X) + " " + N(p.Y);
    return out.join(';');
}

// "count | box | middle": enough to tell made and smoothed shapes apart.
QString Summary(const PolyLine &s)
{
    float64 x0 = 1e9, y0 = 1e9, x1 = -1e9, y1 = -1e9, cx = 0.0, cy = 0.0;
    for (const PolyPoint &p : s.Points()) {
        x0 = std::min(x0, p.X), y0 = std::min(y0, p.Y), x1 = std::max(x1, p.X), y1 = std::max(y1, p.Y);
        cx += p.X / s.GetCount(), cy += p.Y / s.GetCount();
    }
    return QString("%1 | %2 %3 %4 %5 | %6 %7").arg(s.GetCount()).arg(N(x0), N(y0), N(x1), N(y1), N(cx), N(cy));
}

// Runs the menu entry at `at` whose path ("Create>Rectangle…") is `entry`.
bool Choose(ViewerFixture &f, OrbPoint at, const QString &entry)
{
    f.Hover(f.At(at));
    QMenu menu;
    f.viewer.FillContextMenu(&menu);
    QAction *found = nullptr;
    std::function<void(QMenu *, QString)> walk = [&](QMenu *m, QString path) {
        for (QAction *a : m->actions())
            if (a->menu())
                walk(a->menu(), path + a->text() + ">");
            else if (!found && path + a->text() == entry)
                found = a;
    };
    walk(&menu, "");
    return found && f.viewer.TriggerMenuAction(found);
}

// Types into the dialog field `name` over what it holds, as a hand does.
void Fill(ViewerFixture &f, const QString &name, const QString &text)
{
    auto *edit = f.viewer.findChild<QLineEdit *>(name);
    QVERIFY2(edit && edit->isVisible(), qPrintable(name));
    edit->selectAll();
    QTest::keyClick(edit, Qt::Key_Backspace);
    QTest::keyClicks(edit, text);
}

void Press(ViewerFixture &f, const char *button)
{
    auto *b = f.viewer.findChild<QPushButton *>(button);
    QVERIFY2(b && b->isVisible(), button);
    QTest::mouseClick(b, Qt::LeftButton);
}

QString TextOf(ViewerFixture &f, const char *name)
{
    if (auto *label = f.viewer.findChild<QLabel *>(name))
        return label->text();
    auto *edit = f.viewer.findChild<QLineEdit *>(name);
    return edit ? edit->text() : QString("-");
}

void ClickRow(QListWidget *list, int row, Qt::KeyboardModifiers mods = Qt::NoModifier)
{
    QTest::mouseClick(list->viewport(), Qt::LeftButton, mods, list->visualItemRect(list->item(row)).center());
}

// A shape animated with its keys at `times`, each of `shapes`.
Input *Animated(ViewerFixture &f, const std::vector<float64> &times, const std::vector<AutoRef<PolyLine>> &shapes)
{
    Input *input = AddShapeValue(f, shapes.front().get(), TagList{{PLC_DrawMode, 4}});
    input->SetAnimated(true);
    for (std::size_t i = 0; i < times.size(); ++i)
        input->SetValue(shapes[i].get(), times[i], SETVALUE_NoUndo);
    return input;
}

} // namespace

class PolyLineDialogTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void pointEditorWrites_data();
    void pointEditorWrites();
    void numberDialogsWrite_data();
    void numberDialogsWrite();
    void keyListJumpsAndDeletes();
    void animationEdits_data();
    void animationEdits();
    void conversions();
    void onionSettingsApplyLive();
};

void PolyLineDialogTest::initTestCase()
{
    std::string why;
    QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
}

void PolyLineDialogTest::pointEditorWrites_data()
{
    QTest::addColumn<int>("select"); // a point by a click, -1 all by "Select All"
    QTest::addColumn<QString>("field");
    QTest::addColumn<QString>("shown"); // what the field shows at first
    QTest::addColumn<QString>("typed");
    QTest::addColumn<QString>("places"); // every point after Apply
    QTest::addColumn<double>("outX");    // point 1's out handle, from the point
    QTest::addColumn<QString>("info");   // the info line after Apply
    const QString before = "0.2 0.2;0.4 0.2;0.6 0.2;0.8 0.6";
    QTest::newRow("one point's place") << 1 << "pointX"
                                       << "0.4"
                                       << "0.3"
                                       << "0.2 0.2;0.3 0.2;0.6 0.2;0.8 0.6" << 0.05 << "Point 2";
    QTest::newRow("one point's handle") << 1 << "pointOutX"
                                        << "0.05"
                                        << "0.1" << before << 0.1 << "Point 2";
    QTest::newRow("differing values blank") << -1 << "pointY"
                                            << ""
                                            << "0.4"
                                            << "0.2 0.4;0.4 0.4;0.6 0.4;0.8 0.4" << 0.05 << "4 points";
    QTest::newRow("not a number") << 1 << "pointY"
                                  << "0.2"
                                  << "abc" << before << 0.05 << "Y: \"abc\" is not a number";
}

// E opens the editor on the selection; Apply writes every selected point
// as one undo step, "Edit Point", that undo takes back exactly.
void PolyLineDialogTest::pointEditorWrites()
{
    QFETCH(int, select);
    QFETCH(QString, field);
    QFETCH(QString, shown);
    QFETCH(QString, typed);
    QFETCH(QString, places);
    QFETCH(double, outX);
    QFETCH(QString, info);
    ViewerFixture f;
    Input *input = AddShapeValue(f, WithHandles().get(), TagList{{PLC_DrawMode, 4}});
    QVERIFY(f.Show());
    if (select >= 0)
        f.Click(f.At(kCorners[std::size_t(select)]));
    else
        QVERIFY(Choose(f, kAway, "Select All"));
    f.Key(Qt::Key_E);
    QCOMPARE(TextOf(f, field.toUtf8().constData()), shown);
    const QString original = Places(*ShapeOf(f, input));
    const int steps = f.UndoSteps();
    Fill(f, field, typed);
    Press(f, "pointApply");
    const AutoParam<PolyLine> after = ShapeOf(f, input);
    QCOMPARE(Places(*after), places);
    QCOMPARE(after->GetPoint(1)->OutX - after->GetPoint(1)->X, outX);
    QCOMPARE(TextOf(f, "pointInfo"), info);
    const bool written = places != original || outX != 0.05;
    QCOMPARE(f.UndoSteps(), steps + (written ? 1 : 0));
    if (written) {
        QCOMPARE(f.doc.UndoNames().last(), QString("Edit Point"));
        QVERIFY(f.doc.Undo());
        QCOMPARE(Places(*ShapeOf(f, input)), original);
        QCOMPARE(ShapeOf(f, input)->GetPoint(1)->OutX, 0.45);
    }
}

void PolyLineDialogTest::numberDialogsWrite_data()
{
    QTest::addColumn<QString>("entry");
    QTest::addColumn<QStringList>("fields"); // "name=text", typed in order
    QTest::addColumn<QString>("summary");    // of the shape after OK
    QTest::addColumn<QString>("undo");       // the step made, "" for none
    QTest::addColumn<QString>("message");    // what the dialog says
    const QString corners = "4 | 0.2 0.2 0.8 0.6 | 0.5 0.3";
    QTest::newRow("rectangle") << "Create>Rectangle…" << QStringList{"rectangleWidth=0.2", "rectangleHeight=0.4"}
                               << "4 | 0.4 0.3 0.6 0.7 | 0.5 0.5"
                               << "Create Rectangle"
                               << "";
    QTest::newRow("ellipse of six") << "Create>Ellipse…" << QStringList{"ellipsePoints=6", "ellipseX=0.4"}
                                    << "6 | 0.15 0.283494 0.65 0.716506 | 0.4 0.5"
                                    << "Create Ellipse"
                                    << "";
    QTest::newRow("smooth every point") << "Smooth Points>Dialog…" << QStringList{"smoothAmount=1"}
                                        << "4 | 0.2 0.2 0.8 0.6 | 0.5 0.35"
                                        << "Smooth Points"
                                        << "";
    QTest::newRow("out of range") << "Create>Rectangle…" << QStringList{"rectangleWidth=-1"} << corners << ""
                                  << "Width: give a number from 1e-06 to 20";
    QTest::newRow("reduce, a wide tolerance")
        << "Reduce Points…" << QStringList{"reduceTolerance=40"} << "2 | 0.2 0.2 0.8 0.6 | 0.5 0.4"
        << "Reduce Points"
        << "";
}

// The entries that ask for numbers open a dialog of the window; OK writes
// one undo step, a value out of range keeps it open and says why.
void PolyLineDialogTest::numberDialogsWrite()
{
    QFETCH(QString, entry);
    QFETCH(QStringList, fields);
    QFETCH(QString, summary);
    QFETCH(QString, undo);
    QFETCH(QString, message);
    ViewerFixture f;
    Input *input = AddShape(f, kCorners, TagList{{PLC_DrawMode, 4}});
    QVERIFY(f.Show());
    const int steps = f.UndoSteps();
    QVERIFY(Choose(f, kAway, entry));
    QCOMPARE(f.UndoSteps(), steps);
    for (const QString &field : fields)
        Fill(f, field.section('=', 0, 0), field.section('=', 1));
    Press(f, "numbersOk");
    QCOMPARE(Summary(*ShapeOf(f, input)), summary);
    QCOMPARE(f.UndoSteps(), steps + (undo.isEmpty() ? 0 : 1));
    if (!undo.isEmpty())
        QCOMPARE(f.doc.UndoNames().last(), undo);
    else
        QCOMPARE(TextOf(f, "numbersMessage"), message);
}

// The list shows the keys; Go To sets the time; Delete removes the chosen
// keys as one step, and removing all of them ends the animation.
void PolyLineDialogTest::keyListJumpsAndDeletes()
{
    ViewerFixture f;
    Input *input = Animated(f, {0.0, 10.0, 20.0}, {Moved(0.0), Moved(0.1), Moved(0.0, -0.1)});
    QVERIFY(f.Show());
    QVERIFY(Choose(f, kAway, "Polygon Keyframe List..."));
    auto *list = f.viewer.findChild<QListWidget *>("keyList");
    QVERIFY(list && list->isVisible());
    QCOMPARE(list->count(), 3);
    QCOMPARE(list->item(0)->text(), QString("0  (now)"));
    ClickRow(list, 1);
    Press(f, "keyJump");
    QCOMPARE(f.doc.GetCurrentTime(), 10.0);
    QCOMPARE(list->item(1)->text(), QString("10  (now)"));
    const int steps = f.UndoSteps();
    ClickRow(list, 0);
    ClickRow(list, 2, Qt::ControlModifier);
    Press(f, "keyDelete");
    QCOMPARE(input->KeyTimes(), std::vector<float64>{10.0});
    QCOMPARE(list->count(), 1);
    QCOMPARE(f.UndoSteps(), steps + 1);
    QCOMPARE(f.doc.UndoNames().last(), QString("Delete Keyframes"));
    QVERIFY(f.doc.Undo());
    QCOMPARE(input->KeyTimes(), (std::vector<float64>{0.0, 10.0, 20.0}));
    QCOMPARE(list->count(), 3);
    list->selectAll();
    Press(f, "keyDelete");
    QVERIFY(!input->IsAnimated());
    QCOMPARE(Places(*ShapeOf(f, input)), Places(*Moved(0.1)));
    QCOMPARE(TextOf(f, "keyInfo"), QString("The shape is not animated"));
    QVERIFY(f.doc.Undo());
    QVERIFY(input->IsAnimated());
    QCOMPARE(input->KeyTimes().size(), std::size_t(3));
}

void PolyLineDialogTest::animationEdits_data()
{
    QTest::addColumn<QString>("entry");
    QTest::addColumn<QString>("value");  // what a script gives, "" for none
    QTest::addColumn<double>("middleX"); // point 0 of the key at 5 after
    QTest::addColumn<QString>("undo");   // "" where refused
    // Keys at 0, 5 and 20: the shape goes 0.2 right by 5 and back by 20.
    QTest::newRow("smooth, the default") << "Smooth Animation>Default"
                                         << "" << 0.3 << "Smooth Animation";
    QTest::newRow("smooth all the way") << "Smooth Animation>Dialog…"
                                        << "1 1" << 0.2 << "Smooth Animation";
    // The key at 5 is a quarter of the way; eased it shows the motion at
    // 20 * 0.15625 = 3.125, 0.625 of the way to the key at 5.
    QTest::newRow("ease in and out") << "Ease In / Out…"
                                     << "1 1" << 0.325 << "Ease In / Out";
    QTest::newRow("no easing changes nothing") << "Ease In / Out…"
                                               << "0 0" << 0.4 << "";
    QTest::newRow("a bad value") << "Smooth Animation>Dialog…"
                                 << "2 1" << 0.4 << "";
}

// The edits of the motion write every key they change as one undo step.
void PolyLineDialogTest::animationEdits()
{
    QFETCH(QString, entry);
    QFETCH(QString, value);
    QFETCH(double, middleX);
    QFETCH(QString, undo);
    ViewerFixture f;
    Input *input = Animated(f, {0.0, 5.0, 20.0}, {Moved(0.0), Moved(0.2), Moved(0.0)});
    QVERIFY(f.Show());
    const int steps = f.UndoSteps();
    TagList tags{{PCA_FromScript, 1}};
    if (!value.isEmpty())
        tags.Set(PCA_CommandValue, OrbString(value.toUtf8().constData()));
    f.viewer.SetCommandTags(tags);
    QCOMPARE(Choose(f, kAway, entry), !undo.isEmpty());
    f.viewer.SetCommandTags(TagList());
    const AutoParam<PolyLine> middle(static_cast<PolyLine *>(input->GetKey(5.0)));
    QVERIFY(std::fabs(middle->GetPoint(0)->X - middleX) < 1e-9);
    QCOMPARE(f.UndoSteps(), steps + (undo.isEmpty() ? 0 : 1));
    if (undo.isEmpty())
        return;
    QCOMPARE(f.doc.UndoNames().last(), undo);
    QVERIFY(f.doc.Undo());
    QCOMPARE(AutoParam<PolyLine>(static_cast<PolyLine *>(input->GetKey(5.0)))->GetPoint(0)->X, 0.4);
}

// "Cardinal to Bezier" gives every point the Catmull-Rom handles through
// its neighbours; "Convert to XYPath" makes the X and Y animation of the
// key points, one frame apart.
void PolyLineDialogTest::conversions()
{
    ViewerFixture f;
    Input *input = AddShape(f, kCorners, TagList{{PLC_DrawMode, 4}});
    QVERIFY(f.Show());
    QVERIFY(Choose(f, kAway, "Cardinal to Bezier"));
    QCOMPARE(f.doc.UndoNames().last(), QString("Cardinal to Bezier"));
    const AutoParam<PolyLine> smooth = ShapeOf(f, input);
    QVERIFY(std::fabs(smooth->GetPoint(1)->InX - (0.4 - 0.4 / 6)) < 1e-12);
    QVERIFY(std::fabs(smooth->GetPoint(2)->OutY - (0.2 + 0.4 / 6)) < 1e-12);
    QVERIFY(std::fabs(smooth->GetPoint(0)->OutX - (0.2 + 0.2 / 3)) < 1e-12);
    QVERIFY(Choose(f, kAway, "Convert to XYPath"));
    QCOMPARE(f.doc.UndoNames().last(), QString("Convert to XYPath"));
    Input *x = f.tool->FindInput(OrbID("ShapeX")), *y = f.tool->FindInput(OrbID("ShapeY"));
    QVERIFY(x && y && x->IsAnimated());
    QCOMPARE(x->KeyTimes(), (std::vector<float64>{0.0, 1.0, 2.0, 3.0}));
    QCOMPARE(AutoNumber(x, 2.0)->Value, 0.6);
    QCOMPARE(AutoNumber(y, 3.0)->Value, 0.6);
    QVERIFY(f.doc.Undo());
    QVERIFY(!x->IsAnimated());
}

// The settings show at once and make no undo step; a value that does not
// fit is refused with the reason.
void PolyLineDialogTest::onionSettingsApplyLive()
{
    ViewerFixture f;
    Input *input = Animated(f, {0.0, 10.0}, {Moved(0.0), Moved(0.0, -0.1)});
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(input);
    const QPoint skin = f.At({0.4, 0.1});
    QCOMPARE(f.viewer.TipAt(skin), QString("Time : 10.00"));
    const int steps = f.UndoSteps();
    QVERIFY(Choose(f, kAway, "Onion Skin>Onion skin settings…"));
    QCOMPARE(TextOf(f, "onionAfter"), QString("5"));
    Fill(f, "onionAfter", "0");
    QTest::keyClick(f.viewer.findChild<QLineEdit *>("onionAfter"), Qt::Key_Return);
    QCOMPARE(StateOf(overlay, "onionAfter"), 0.0);
    QVERIFY(f.viewer.TipAt(skin) != QString("Time : 10.00"));
    Fill(f, "onionStipple", "00FF");
    QTest::keyClick(f.viewer.findChild<QLineEdit *>("onionStipple"), Qt::Key_Return);
    QCOMPARE(StateOf(overlay, "onionStipple"), double(0x00FF));
    Fill(f, "onionBefore", "many");
    QTest::keyClick(f.viewer.findChild<QLineEdit *>("onionBefore"), Qt::Key_Return);
    QCOMPARE(StateOf(overlay, "onionBefore"), 5.0);
    QCOMPARE(TextOf(f, "onionBefore"), QString("5"));
    QVERIFY(TextOf(f, "onionInfo").contains("whole number"));
    QCOMPARE(f.UndoSteps(), steps);
}

QTEST_MAIN(PolyLineDialogTest)
#include "PolyLineDialogTest.moc"
