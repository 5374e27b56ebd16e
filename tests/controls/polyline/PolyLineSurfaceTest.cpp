// The polyline overlay's command surface through a real viewer: its context
// menu, the keys it claims and what they do, its toolbar and its tips.
#include "ViewerFixture.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/ControlCommands.h"
#include "orbane/Input.h"
#include "orbane/PolyLine.h"
#include "orbane/ScriptVal.h"

#include <QAction>
#include <QMenu>
#include <QPushButton>
#include <QToolBar>
#include <QtTest>

#include <set>

using namespace Orbane;
using namespace Orbane::Test;

Q_DECLARE_METATYPE(Orbane::TagList)

namespace {

constexpr Tag PLC_DrawMode = 0x10058000, PLC_CanPublishPoints = 0x10058007, PLC_PairFromAttach = 0x10058011;
constexpr Tag PLCID_InPolyLine2 = 0x80058008, PLCID_InPolyLine = 0x8005800F, TOOL_FollowInner = 0x10030005;

// Four corners with their handles off the points, so smoothing and making
// linear both change them.
AutoRef<PolyLine> MakeShape(int count, bool closed = false)
{
    AutoRef<PolyLine> shape(new PolyLine);
    const OrbPoint at[] = {{0.3, 0.3}, {0.7, 0.3}, {0.7, 0.7}, {0.3, 0.7}};
    for (int i = 0; i < count; ++i) {
        PolyPoint p(at[i].x, at[i].y);
        p.InX = p.X - 0.05, p.OutX = p.X + 0.02, p.OutY = p.Y + 0.03;
        shape->AddPoint(p);
    }
    if (closed)
        shape->Close();
    return shape;
}

Input *AddShape(ViewerFixture &f, int count, const TagList &more = TagList(), const char *id = "Shape")
{
    TagList attrs{{INPA_PreviewControl, OrbID("PolylineControl")}, {PLC_DrawMode, 3}};
    attrs.Append(more);
    return f.tool->AddInput(OrbID(id), id, CLSID_DataType_Polyline, attrs, MakeShape(count).get());
}

const ScriptVal *Field(const ScriptVal &state, const char *key)
{
    return state.FindKeyConst(ScriptVal(key));
}

ScriptVal StateOf(const PreviewControl *overlay)
{
    ScriptVal state = ScriptVal::NewTable();
    overlay->GetState(state);
    return state;
}

// A state field as text, so that one table column holds numbers, flags and
// messages alike.
QString FieldText(const PreviewControl *overlay, const char *key)
{
    const ScriptVal state = StateOf(overlay);
    const ScriptVal *v = Field(state, key);
    if (!v)
        return "-";
    if (v->IsBool())
        return v->GetBool() ? "true" : "false";
    if (v->IsString())
        return QString::fromUtf8(v->GetString());
    if (v->IsTable()) {
        int n = 0;
        while (v->FindKeyConst(ScriptVal(n + 1)))
            ++n;
        return QString("#%1").arg(n);
    }
    return QString::number(v->GetNumber());
}

// Every entry of the menu as "Path>Text=id,arg,flags" (separators "-"),
// the flags read from the action as the user sees it.
void Flatten(const QMenu *menu, const QString &path, QStringList &out)
{
    for (const QAction *a : menu->actions()) {
        if (a->isSeparator()) {
            out << path + "-";
        } else if (a->menu()) {
            Flatten(a->menu(), path + a->text() + ">", out);
        } else {
            const int flags = (a->isEnabled() ? 0 : 1) | (a->isChecked() ? 8 : 0) | (a->isCheckable() ? 0x400 : 0);
            out << QString("%1%2=%3,%4,%5")
                       .arg(path, a->text())
                       .arg(a->property("menuId").toInt(), 0, 16)
                       .arg(a->property("menuArg").toInt())
                       .arg(flags, 0, 16);
            QCOMPARE(a->property("menuFlags").toUInt(), uint(flags));
        }
    }
}

QStringList MenuAt(ViewerFixture &f, OrbPoint at)
{
    f.Hover(f.At(at));
    QMenu menu;
    f.viewer.FillContextMenu(&menu);
    QStringList out;
    Flatten(&menu, "", out);
    return out;
}

// Runs the entry of the menu at `at` whose flattened text starts with `entry`.
bool Choose(ViewerFixture &f, OrbPoint at, const QString &entry)
{
    f.Hover(f.At(at));
    QMenu menu;
    f.viewer.FillContextMenu(&menu);
    std::vector<QAction *> all;
    std::function<void(QMenu *, QString)> walk = [&](QMenu *m, QString path) {
        for (QAction *a : m->actions()) {
            if (a->menu())
                walk(a->menu(), path + a->text() + ">");
            else if ((path + a->text()) == entry)
                all.push_back(a);
        }
    };
    walk(&menu, "");
    return !all.empty() && f.viewer.TriggerMenuAction(all.front());
}

// Records the key presses the viewer lets through to its parent: the keys
// no overlay claimed.
class KeyCatcher : public QWidget
{
public:
    std::set<int> passed;

protected:
    void keyPressEvent(QKeyEvent *e) override { passed.insert(e->key()); }
};

const OrbPoint kAway{0.05, 0.95};

} // namespace

class PolyLineSurfaceTest : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void menuEntriesInOrder();
    void menuConditions_data();
    void menuConditions();
    void keyClaims_data();
    void keyClaims();
    void keyActions_data();
    void keyActions();
    void toolbar();
    void tips();
    void menuCommandsAct();
};

void PolyLineSurfaceTest::initTestCase()
{
    std::string why;
    QVERIFY2(ViewerFixture::LoadControls(&why), why.c_str());
}

// The whole menu of an open four-point shape in "Insert and Modify", with
// publishing offered: every entry's text, id, argument and flags in order.
void PolyLineSurfaceTest::menuEntriesInOrder()
{
    ViewerFixture f;
    AddShape(f, 4, TagList{{PLC_CanPublishPoints, 1}});
    QVERIFY(f.Show());
    const bool tracking = qEnvironmentVariableIntValue("ORBANE_ROTO_TRACKING") == 1;
    QStringList expected{"Shape: Insert and Modify>Click Append=2000e,0,400",
                         "Shape: Insert and Modify>Draw Append=2000f,0,400",
                         "Shape: Insert and Modify>Insert and Modify=20010,0,408",
                         "Shape: Insert and Modify>Modify Only=20011,0,400",
                         "Shape: Insert and Modify>Done=20012,0,400",
                         "Set Focus=2004e,0,0",
                         "Closed=20008,0,400",
                         "-",
                         "Copy=20020,0,0",
                         "Copy Path Value=2001f,0,0",
                         "Cut Path Points=20021,0,0",
                         "Paste=20022,0,0",
                         "Paste With Offset=20023,0,0",
                         "-",
                         "Delete Points=20002,0,0",
                         "Lock Points=20013,0,400",
                         "Lock Point Pairs=2005f,0,0",
                         "Edit Point\tE=2001c,0,0",
                         "Linear=20004,0,0",
                         "Smooth=20003,0,0",
                         "Smooth Points>Default=20005,1,0",
                         "Smooth Points>Dialog…=20005,0,0",
                         "Smooth Animation>Default=20006,1,0",
                         "Smooth Animation>Dialog…=20006,0,0",
                         "Ease In / Out…=20007,0,0",
                         "Create>Ellipse…=20052,0,0",
                         "Create>Rectangle…=20051,0,0",
                         "Create>Arrow…=20054,0,0",
                         "-",
                         "Make Outer Polyline=2005c,0,0",
                         "-",
                         "Bezier to B-Spline=20055,0,0",
                         "B-Spline to Bezier=20056,0,0",
                         "Cardinal to Bezier=20058,0,0",
                         "Convert to XYPath=2005b,0,0",
                         "Shape Box=2000b,0,0",
                         "Shape Box Both Polylines=2000b,1,0",
                         "Draw Style>Solid=20062,0,408",
                         "Draw Style>Dash=20062,1,400",
                         "Draw Style>Null=20062,5,400",
                         "Draw Style>-",
                         "Draw Style>Custom Spline Color…=2000c,0,0",
                         "Draw Style>Custom Key Point Color…=2004f,0,0",
                         "Draw Style>Custom Handle Color…=20050,0,0",
                         "Reduce Points…=2000a,0,400",
                         "Publish>Publish Points=20047,0,0",
                         "Publish>Unpublish Points=20048,0,0",
                         "Publish>Publish All Points=20049,0,0",
                         "Publish>Make Points Follow Nearby Published Points=2004a,0,0",
                         "Publish>Stop Points Following=2004b,0,0",
                         "Publish To>Publish To Path=2004d,0,0",
                         "Publish To>Publish To XYPath=2004d,1,0",
                         "Publish To>Publish To IntelliTrack Tracker=2004d,2,0",
                         "Publish To>Publish To Point Tracker=2004d,3,0",
                         "-",
                         "Point Numbers=20014,0,400",
                         "Current Time Only=2001b,0,400",
                         "Select All=20001,0,0",
                         "Lock Point Selection=20024,0,400",
                         "Publishing Path Points Enabled=20031,0,400",
                         "Show>Key Points=20025,0,408",
                         "Show>Handles=20026,0,408",
                         "Show>Convex Hull Polygon=20026,1,400",
                         "Show>Polygon=20061,0,408",
                         "Show>Show Tagged Point IDs=20027,0,408",
                         "Polygon Keyframe List...=20028,0,0",
                         "-",
                         "Onion Skin>Enable=2002a,0,408",
                         "Onion Skin>Onion skin settings…=2002b,0,0",
                         "Onion Skin>Onion skin click to Set Current Time=2002d,0,400",
                         "Onion Skin>Reset onion skin anchor=2002e,0,0",
                         "Onion Skin>Set prev skin color=2002f,0,0",
                         "Onion Skin>Reset prev skin color=20030,0,0",
                         "Roto Assist>Enable=2006a,0,400"};
    if (tracking)
        expected << "Roto Assist>Track Points=2006b,0,400";
    expected << "Roto Assist>Roto Assist Multiple Points=2006d,0,400"
             << "Roto Assist>Distance 5…=2006e,0,0";
    if (tracking)
        expected << "Roto Assist>Frame Skip=2006c,0,0";
    expected << "Roto Assist>Create Track Points=2006f,0,0"
             << "Roto Assist>Reset=20070,0,0"
             << "Roto Assist>Show Tracker Area=20071,0,400"
             << "Roto Assist>Track Pattern Edit Mode=20072,0,400"
             << "Roto Assist>Reset Track Pattern to PolyLine Points=20073,0,0"
             << "Edit Multiple Polylines=20063,0,400"
             << "Edit Multiple Frames>None=20064,0,408"
             << "Edit Multiple Frames>Prev=20064,1,400"
             << "Edit Multiple Frames>Next=20064,2,400"
             << "Edit Multiple Frames>All=20064,3,400"
             << "Stop Rendering=20032,0,400"
             << "-"
             << "Record>Time=20015,0,400"
             << "Record>Pressure=20016,0,400"
             << "Record>Height=20017,0,400"
             << "Record>Angle XY=20018,0,400"
             << "Record>Angle Z=20019,0,400"
             << "Record>Rotation=2001a,0,400"
             << "Export…=2003e,0,0"
             << "Import>Import LightWave MOT…=20040,0,0"
             << "Import>Import Motion Path…=2003f,0,0"
             << "Import>Import Shape…=20041,0,0"
             << "Import>Import SSF Shapes…=20042,0,0"
             << "Import>Import FXS (Silhouette) Shapes…=20043,0,0"
             << "Import>Import Nuke Shapes…=20044,0,0"
             << "Import>Import Boujou Path…=20045,0,0";
    const QStringList menu = MenuAt(f, kAway);
    for (int i = 0; i < std::min(menu.size(), expected.size()); ++i)
        QCOMPARE(menu[i], expected[i]);
    QCOMPARE(menu.size(), expected.size());
}

// Entries that come, go, check or disable with the shape's state.
void PolyLineSurfaceTest::menuConditions_data()
{
    QTest::addColumn<int>("points");
    QTest::addColumn<TagList>("attrs");
    QTest::addColumn<TagList>("toolAttrs");
    QTest::addColumn<QStringList>("present");
    QTest::addColumn<QStringList>("absent");
    const TagList none;
    QTest::newRow("three points: reduce enabled")
        << 3 << none << none
        << QStringList{"Reduce Points…=2000a,0,400", "Make Outer Polyline=2005c,0,0", "Create>Arrow…=20054,0,0"}
        << QStringList{"Remove Outer Polyline=2005c,0,0", "Subdivide…=2000d,0,0", "Publish>Publish Points=20047,0,0"};
    QTest::newRow("two points: reduce disabled")
        << 2 << none << none << QStringList{"Reduce Points…=2000a,0,401"} << QStringList{"Reduce Points…=2000a,0,400"};
    QTest::newRow("empty: no outer entries") << 0 << none << none << QStringList{"Reduce Points…=2000a,0,401"}
                                             << QStringList{"Make Outer Polyline=2005c,0,0"};
    QTest::newRow("read-only: arrow and reduce disabled")
        << 4 << TagList{{INPA_ReadOnly, 1}} << none
        << QStringList{"Create>Arrow…=20054,0,1", "Reduce Points…=2000a,0,401", "Create>Ellipse…=20052,0,0"}
        << QStringList{"Create>Arrow…=20054,0,0"};
    QTest::newRow("current time only: reduce disabled")
        << 4 << TagList{{0x10058008, 1}} << none
        << QStringList{"Reduce Points…=2000a,0,401", "Current Time Only=2001b,0,408"} << QStringList{};
    QTest::newRow("pairing 2: remove and reset")
        << 4 << TagList{{PLCID_InPolyLine2, OrbID("Outer")}} << TagList{{TOOL_FollowInner, 0}}
        << QStringList{"Remove Outer Polyline=2005c,0,0", "Reset Outer Point Positions=2005e,0,0"}
        << QStringList{"Make Outer Polyline=2005c,0,0", "Follow Inner Polyline=20060,0,0"};
    QTest::newRow("pairing 1: make") << 4 << TagList{{PLCID_InPolyLine2, OrbID("Outer")}}
                                     << TagList{{TOOL_FollowInner, 1}} << QStringList{"Make Outer Polyline=2005c,0,0"}
                                     << QStringList{"Remove Outer Polyline=2005c,0,0",
                                                    "Enable Outer Polyline=2005d,0,0"};
    QTest::newRow("pairing 3: enable and make")
        << 4 << TagList{{PLC_PairFromAttach, 1}} << none
        << QStringList{"Enable Outer Polyline=2005d,0,0", "Make Outer Polyline=2005c,0,0"}
        << QStringList{"Remove Outer Polyline=2005c,0,0", "Enable Polyline=2005d,0,0"};
    QTest::newRow("pairing 0: the outer shape's own entries")
        << 4 << TagList{{PLC_PairFromAttach, 1}, {PLCID_InPolyLine, OrbID("Outer")}} << none
        << QStringList{"Make Outer Polyline=2005c,0,0", "Follow Inner Polyline=20060,0,0",
                       "Reset Outer Point Positions=2005e,0,0", "Enable Polyline=2005d,0,0"}
        << QStringList{"Remove Outer Polyline=2005c,0,0", "Enable Outer Polyline=2005d,0,0"};
    QTest::newRow("pairing 0 and empty: none")
        << 0 << TagList{{PLC_PairFromAttach, 1}, {PLCID_InPolyLine, OrbID("Outer")}} << none << QStringList{}
        << QStringList{"Make Outer Polyline=2005c,0,0", "Follow Inner Polyline=20060,0,0", "Enable Polyline=2005d,0,0"};
}

void PolyLineSurfaceTest::menuConditions()
{
    QFETCH(int, points);
    QFETCH(TagList, attrs);
    QFETCH(TagList, toolAttrs);
    QFETCH(QStringList, present);
    QFETCH(QStringList, absent);
    ViewerFixture f;
    f.doc.RemoveTool(f.tool);
    f.tool = new Operator("Roto1", "Roto", toolAttrs);
    f.doc.AddTool(f.tool);
    f.tool->DecRef();
    TagList more = attrs;
    more.Set(PLC_DrawMode, 3);
    f.tool->AddInput(OrbID("Outer"), "Outer", CLSID_DataType_Polyline, TagList(), MakeShape(points).get());
    TagList shapeAttrs{{INPA_PreviewControl, OrbID("PolylineControl")}};
    shapeAttrs.Append(more);
    f.tool->AddInput(OrbID("Shape"), "Shape", CLSID_DataType_Polyline, shapeAttrs, MakeShape(points).get());
    QVERIFY(f.Show());
    const QStringList menu = MenuAt(f, kAway);
    for (const QString &entry : present)
        QVERIFY2(menu.contains(entry), qPrintable("missing " + entry));
    for (const QString &entry : absent)
        QVERIFY2(!menu.contains(entry), qPrintable("present " + entry));
}

// Which keys the viewer keeps for the shape, over every letter and the
// claimed special keys, with each combination of Shift, Control and Alt:
// a key the overlay does not claim passes on to the viewer's parent.
void PolyLineSurfaceTest::keyClaims_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<QString>("claimedWith"); // the combinations of "SCA" that claim it, "none" for no modifier
    const QString all = "none,S,C,A,SC,SA,CA,SCA";
    auto row = [](const char *name, int key, const QString &with) { QTest::newRow(name) << key << with; };
    for (char c = 'A'; c <= 'Z'; ++c) {
        const QString letter(c);
        QString with;
        if (QString("OX").contains(letter))
            with = all;
        else if (QString("EVY").contains(letter))
            with = "none";
        else if (QString("ABCDFHIKLMNPST").contains(letter))
            with = "S";
        else if (letter == "R")
            with = "S,C,SC,SA,CA,SCA";
        row(qPrintable(letter), Qt::Key_A + (c - 'A'), with);
    }
    row("Left", Qt::Key_Left, all);
    row("Down", Qt::Key_Down, all);
    row("Tab", Qt::Key_Tab, "none");
    row("Return", Qt::Key_Return, "none");
    row("Enter", Qt::Key_Enter, "none");
    row("Backspace", Qt::Key_Backspace, "none");
    row("Delete", Qt::Key_Delete, "none");
    row("PageUp", Qt::Key_PageUp, "none");
    row("PageDown", Qt::Key_PageDown, "none");
    row("Space", Qt::Key_Space, "");
    row("1", Qt::Key_1, "");
}

void PolyLineSurfaceTest::keyClaims()
{
    QFETCH(int, key);
    QFETCH(QString, claimedWith);
    ViewerFixture f;
    AddShape(f, 4);
    QVERIFY(f.Show());
    KeyCatcher catcher;
    f.viewer.setParent(&catcher);
    const QStringList combos{"none", "S", "C", "A", "SC", "SA", "CA", "SCA"};
    const QStringList claiming = claimedWith.split(',', Qt::SkipEmptyParts);
    for (const QString &combo : combos) {
        Qt::KeyboardModifiers mods;
        mods.setFlag(Qt::ShiftModifier, combo.contains('S'));
        mods.setFlag(Qt::ControlModifier, combo.contains('C'));
        mods.setFlag(Qt::AltModifier, combo.contains('A'));
        catcher.passed.clear();
        QTest::keyPress(&f.viewer, Qt::Key(key), mods);
        QTest::keyRelease(&f.viewer, Qt::Key(key), mods);
        QCOMPARE(combo + (catcher.passed.count(key) ? " passed" : " claimed"),
                 combo + (claiming.contains(combo) ? " claimed" : " passed"));
    }
    f.viewer.setParent(nullptr);
}

// Each key's action on a shape whose four points are all selected (Shift+A
// first): the undo step it makes, by name, and what the user then sees.
void PolyLineSurfaceTest::keyActions_data()
{
    QTest::addColumn<int>("key");
    QTest::addColumn<int>("mods");
    QTest::addColumn<QString>("undo"); // the new step's name; empty: none
    QTest::addColumn<QString>("field");
    QTest::addColumn<QString>("value");
    const int S = Qt::ShiftModifier, C = Qt::ControlModifier, N = 0;
    auto row = [](const char *name, int key, int mods, const char *undo, const char *field, const char *value) {
        QTest::newRow(name) << key << mods << QString(undo) << QString(field) << QString(value);
    };
    row("Delete", Qt::Key_Delete, N, "Delete Points", "points", "0");
    row("Backspace", Qt::Key_Backspace, N, "Delete Points", "points", "0");
    row("Shift+S", Qt::Key_S, S, "Smooth Polyline", "points", "4");
    row("Shift+L", Qt::Key_L, S, "Linear Polyline", "points", "4");
    row("O", Qt::Key_O, N, "Close polygon", "points", "4");
    row("Ctrl+O", Qt::Key_O, C, "Close polygon", "points", "4");
    row("Shift+C", Qt::Key_C, S, "Close polygon", "points", "4");
    row("X", Qt::Key_X, N, "Flip Points", "points", "4");
    row("Y", Qt::Key_Y, N, "Flip Points", "points", "4");
    row("Shift+T", Qt::Key_T, S, "Tag Points", "points", "4");
    row("Shift+P", Qt::Key_P, S, "Publish Points", "points", "4");
    row("Right", Qt::Key_Right, N, "Shift points", "points", "4");
    row("Shift+Up", Qt::Key_Up, S, "Shift points", "points", "4");
    row("Shift+D", Qt::Key_D, S, "", "mode", "0");
    row("Shift+I", Qt::Key_I, S, "", "mode", "3");
    row("Shift+M", Qt::Key_M, S, "", "mode", "4");
    row("Return", Qt::Key_Return, N, "", "mode", "0");
    row("Enter", Qt::Key_Enter, N, "", "mode", "0");
    row("Shift+A", Qt::Key_A, S, "", "selected", "#4");
    row("Tab", Qt::Key_Tab, N, "", "selected", "#1");
    row("Shift+K", Qt::Key_K, S, "", "displayFlags", QByteArray::number(0x86).constData());
    row("Shift+H", Qt::Key_H, S, "", "displayFlags", QByteArray::number(0x85).constData());
    row("V", Qt::Key_V, N, "", "displayFlags", QByteArray::number(0x84).constData());
    row("Shift+N", Qt::Key_N, S, "", "pointNumbers", "true");
    row("Shift+B", Qt::Key_B, S, "", "shapeBox", "1");
    row("Shift+R", Qt::Key_R, S, "", "reduceDialog", "true");
    row("Ctrl+R", Qt::Key_R, C, "", "message", "The inner polyline has no points");
    row("E", Qt::Key_E, N, "", "pointEditor", "true");
    row("PageDown", Qt::Key_PageDown, N, "", "message", "Keyframes: the shape is not animated");
    row("PageUp", Qt::Key_PageUp, N, "", "message", "Keyframes: the shape is not animated");
    row("Shift+F", Qt::Key_F, S, "", "message", "-");
}

void PolyLineSurfaceTest::keyActions()
{
    QFETCH(int, key);
    QFETCH(int, mods);
    QFETCH(QString, undo);
    QFETCH(QString, field);
    QFETCH(QString, value);
    ViewerFixture f;
    Input *input = AddShape(f, 4);
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(input);
    f.Hover(f.At(kAway));
    f.Key(Qt::Key_A, Qt::ShiftModifier);
    QCOMPARE(FieldText(overlay, "selected"), QString("#4"));
    const int steps = f.UndoSteps();
    const AutoParam<PolyLine> before(input, 0.0);
    f.Key(Qt::Key(key), Qt::KeyboardModifiers(mods));
    const AutoParam<PolyLine> after(input, 0.0);
    if (field == "message" && value == "-")
        QVERIFY(!FieldText(overlay, "message").isEmpty());
    else
        QCOMPARE(FieldText(overlay, qPrintable(field)), value);
    if (undo.isEmpty()) {
        QCOMPARE(f.UndoSteps(), steps);
        return;
    }
    QVERIFY2(f.UndoSteps() == steps + 1, qPrintable(FieldText(overlay, "message")));
    QCOMPARE(f.doc.UndoNames().last(), undo);
    QVERIFY(!(*before == *after));
    QVERIFY(f.doc.Undo());
    QVERIFY(*AutoParam<PolyLine>(input, 0.0) == *before);
}

// The toolbar lists the buttons by tip and label with their pop-downs, and
// a press acts on the shape.
void PolyLineSurfaceTest::toolbar()
{
    ViewerFixture f;
    Input *input = AddShape(f, 4);
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(input);
    QStringList bar;
    QAction *prev = nullptr, *draw = nullptr, *closed = nullptr;
    for (QAction *a : f.viewer.OverlayToolBar()->actions()) {
        if (a->isSeparator()) {
            bar << "|";
            continue;
        }
        bar << a->toolTip() + "/" + a->text() + (a->menu() ? QString("[%1]").arg(a->menu()->actions().size()) : "");
        if (a->text() == "Draw")
            draw = a;
        if (a->text() == "Closed")
            closed = a;
        if (a->text() == "Multiframe")
            for (QAction *item : a->menu()->actions())
                if (item->text() == "Prev")
                    prev = item;
    }
    QCOMPARE(
        bar.join(" "),
        QString("Click Append/Click Draw Append/Draw Insert and Modify/Insert Modify Only/Modify Done/Done | "
                "Current Time Only/Current Close the Polyline/Closed Lock Points/Lock Select All points/Select All | "
                "Show Key Points/Keys Show All Handles/Handles Show Polygon curve/Polygon | Shape Box/Shape "
                "Delete Points (Del)/Delete Reduce Points/Reduce | Publish Menu/Publish[5] "
                "Make Points Follow Nearby Published Points/Follow Points | Make Double Poly/Double Poly "
                "Follow Inner Poly/Follow Inner | Multiframe Menu/Multiframe[4] | Onion Skin/Onion Skin[6] | "
                "Roto Assist/Roto Assist[10]"));
    QVERIFY(prev && draw && closed);
    prev->trigger();
    QCOMPARE(FieldText(overlay, "multiFrame"), QString("1"));
    draw->trigger();
    QCOMPARE(FieldText(overlay, "mode"), QString("2"));
    closed->trigger();
    QCOMPARE(f.doc.UndoNames().last(), QString("Close polygon"));
    QVERIFY(AutoParam<PolyLine>(input, 0.0)->IsClosed());
}

// Over a point: the tool, the shape and the point, with the time on an
// animated shape; over the skin of another keyframe: its time.
void PolyLineSurfaceTest::tips()
{
    ViewerFixture f;
    Input *input = AddShape(f, 4);
    QVERIFY(f.Show());
    QCOMPARE(f.viewer.TipAt(f.At({0.7, 0.3})), QString("Tool1:Shape - Point 2"));
    QCOMPARE(f.viewer.TipAt(f.At(kAway)), QString());
    input->SetAnimated(true);
    AutoRef<PolyLine> later = MakeShape(4);
    later->Copy(*MakeShape(4));
    AutoRef<PolyLine> moved(new PolyLine);
    for (int i = 0; i < 4; ++i) {
        PolyPoint p = *later->GetPoint(i);
        p.Offset(0.0, -0.2);
        moved->AddPoint(p);
    }
    input->SetValue(moved.get(), 10.0);
    QCOMPARE(f.viewer.TipAt(f.At({0.7, 0.3})), QString("Tool1:Shape - Point 2 (at time 0.00)"));
    QCOMPARE(f.viewer.TipAt(f.At({0.7, 0.1})), QString("Time : 10.00"));
}

// Entries with their own meaning act at once; a value a dialog would ask
// for comes from the command's tags; what cannot act says so.
void PolyLineSurfaceTest::menuCommandsAct()
{
    ViewerFixture f;
    Input *input = AddShape(f, 4);
    QVERIFY(f.Show());
    PreviewControl *overlay = f.OverlayOf(input);
    QVERIFY(Choose(f, kAway, "Draw Style>Dash"));
    QCOMPARE(FieldText(overlay, "displayFlags"), QString::number(0x97));
    QVERIFY(MenuAt(f, kAway).contains("Draw Style>Dash=20062,1,408"));
    QVERIFY(Choose(f, kAway, "Edit Multiple Polylines"));
    QVERIFY(MenuAt(f, kAway).contains("Edit Multiple Polylines=20063,0,408"));
    QVERIFY(Choose(f, kAway, "Record>Pressure"));
    QCOMPARE(FieldText(overlay, "record"), QString("2"));
    QVERIFY(Choose(f, kAway, "Create>Ellipse…"));
    QTest::mouseClick(f.viewer.findChild<QPushButton *>("numbersOk"), Qt::LeftButton);
    QCOMPARE(f.doc.UndoNames().last(), QString("Create Ellipse"));
    QVERIFY(AutoParam<PolyLine>(input, 0.0)->IsClosed());
    QVERIFY(!Choose(f, kAway, "Import>Import Nuke Shapes…"));
    QCOMPARE(FieldText(overlay, "message"),
             QString("Import: the Nuke shape format is not read yet; \"Import Shape…\" reads shape and SVG files"));
    f.viewer.SetCommandTags(TagList{{PCA_FromScript, 1}, {PCA_CommandValue, "#ff8000"}});
    QVERIFY(Choose(f, kAway, "Draw Style>Custom Spline Color…"));
    f.viewer.SetCommandTags(TagList{{PCA_FromScript, 1}, {PCA_CommandValue, "12"}});
    QVERIFY(Choose(f, kAway, "Roto Assist>Distance 5…"));
    QCOMPARE(FieldText(overlay, "rotoDistance"), QString("12"));
    f.viewer.SetCommandTags(TagList{{PCA_FromScript, 1}, {PCA_CommandValue, "many"}});
    QVERIFY(!Choose(f, kAway, "Roto Assist>Distance 12…"));
    QCOMPARE(FieldText(overlay, "rotoDistance"), QString("12"));
    f.viewer.SetCommandTags(TagList{{PCA_FromScript, 1}});
    QVERIFY(!Choose(f, kAway, "Draw Style>Custom Key Point Color…"));
    QVERIFY(FieldText(overlay, "message").contains("#rrggbb"));
    f.viewer.SetCommandTags(TagList());
}

QTEST_MAIN(PolyLineSurfaceTest)
#include "PolyLineSurfaceTest.moc"
