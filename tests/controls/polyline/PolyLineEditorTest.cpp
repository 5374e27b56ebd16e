// The editing operations of the polyline overlay on a real control bound
// to a real Input of a document with its real undo history.
#include "polyline/PolyLineEditor.h"
#include "polyline/PolyLineControl.h"
#include "polyline/PolyLineShapes.h"

#include "orbane/AutoParam.h"
#include "orbane/BSplinePolyLine.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/PolyLine.h"
#include "orbane/ScriptVal.h"
#include "orbane/ShapeFile.h"
#include "orbane/Tags.h"

#include <QClipboard>
#include <QGuiApplication>

#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <vector>

using namespace Orbane;

namespace {

using Indices = std::vector<int32>;
using Points = std::vector<OrbPoint>;

constexpr Tag PLCID_InPolyLine2 = 0x80058008;
const Points kCorners{{0.2, 0.2}, {0.4, 0.2}, {0.6, 0.2}, {0.8, 0.6}};

AutoRef<PolyLine> Shape(const Points &points = kCorners, bool closed = false, PolyLine *kind = nullptr)
{
    AutoRef<PolyLine> s(kind ? kind : new PolyLine);
    for (const OrbPoint &p : points)
        s->AddPoint(PolyPoint(p.x, p.y));
    if (closed)
        s->Close();
    return s;
}

bool Near(OrbPoint a, OrbPoint b, double eps = 1e-9)
{
    return std::fabs(a.x - b.x) <= eps && std::fabs(a.y - b.y) <= eps;
}

// A tool with the shape "Mask" (and an outer "Mask2"), shown by a polyline
// overlay as the viewer binds one.
struct Rig
{
    OrbaneDoc doc;
    Operator *tool = new Operator("Roto1", "Roto");
    Input *mask = nullptr, *outer = nullptr;
    PolyLineControl *overlay = new PolyLineControl(nullptr, ScriptVal(), TagList());

    explicit Rig(const PolyLine *value, const TagList &attrs = TagList())
    {
        doc.AddTool(tool);
        tool->DecRef();
        mask = tool->AddInput(OrbID("Mask"), "Mask", value->DataType(), attrs, value);
        outer = tool->AddInput(OrbID("Mask2"), "Mask2", CLSID_DataType_Polyline, TagList(), Shape({}).get());
        overlay->AddInput(mask, &attrs);
        overlay->SetAttrsTagList(mask, attrs);
        Notify();
    }
    ~Rig()
    {
        overlay->RemoveInput(mask, nullptr);
        overlay->DecRef();
    }
    void Notify()
    {
        const AutoParameter value(mask->GetValue(doc.GetCurrentTime()));
        overlay->NotifyChanged(mask, value.get(), nullptr);
    }
    PolyLineEditor &Edit() { return overlay->Editor(); }
    AutoParam<PolyLine> Now(Input *in = nullptr) const
    {
        return AutoParam<PolyLine>(in ? in : mask, doc.GetCurrentTime());
    }
    Indices Selected() const
    {
        Indices out;
        for (int32 n = 0; n < overlay->Selection().GetSetCount(); ++n)
            out.push_back(overlay->Selection().GetSetItem(n));
        return out;
    }
};

struct OpRow
{
    const char *name;
    AutoRef<PolyLine> (*shape)();
    Indices selected;
    std::function<bool(Rig &)> op;
    bool changes;
    QStringList undo;
    std::function<void(Rig &, const PolyLine &)> check; // of the shape after
    const char *message = "";
};

AutoRef<PolyLine> Corners()
{
    return Shape();
}
AutoRef<PolyLine> ClosedCorners()
{
    return Shape(kCorners, true);
}
AutoRef<PolyLine> Empty()
{
    return Shape({});
}
AutoRef<PolyLine> SmoothAtOne()
{
    AutoRef<PolyLine> s = Shape();
    PolyPoint p = *s->GetPoint(1);
    p.InX = 0.35, p.OutX = 0.45;
    s->SetPoint(1, p);
    return s;
}

void Unchanged(Rig &, const PolyLine &) {}

const std::vector<OpRow> &OpRows()
{
    static const std::vector<OpRow> rows{
        {"delete",
         Corners,
         {1},
         [](Rig &r) { return r.Edit().DeleteSelected(); },
         true,
         {"Delete Points"},
         [](Rig &r, const PolyLine &s) {
             ASSERT_EQ(s.GetCount(), 3);
             EXPECT_TRUE(Near(s.GetPoint(1)->Pos(), kCorners[2]));
             EXPECT_EQ(r.Selected(), Indices{});
         }},
        {"delete every point",
         Corners,
         {0, 1, 2, 3},
         [](Rig &r) { return r.Edit().DeleteSelected(); },
         true,
         {"Delete Points"},
         [](Rig &, const PolyLine &s) { EXPECT_EQ(s.GetCount(), 0); }},
        {"smooth",
         Corners,
         {1},
         [](Rig &r) { return r.Edit().Smooth(); },
         true,
         {"Smooth Polyline"},
         [](Rig &, const PolyLine &s) {
             EXPECT_FALSE(Near(s.GetPoint(1)->Out(), kCorners[1]));
             EXPECT_TRUE(Near(s.GetPoint(2)->Out(), kCorners[2]));
         }},
        {"linear",
         SmoothAtOne,
         {1},
         [](Rig &r) { return r.Edit().MakeLinear(); },
         true,
         {"Linear Polyline"},
         [](Rig &, const PolyLine &s) { EXPECT_TRUE(Near(s.GetPoint(1)->In(), kCorners[1])); }},
        {"close",
         Corners,
         {},
         [](Rig &r) { return r.Edit().SetClosed(true); },
         true,
         {"Close polygon"},
         [](Rig &, const PolyLine &s) { EXPECT_TRUE(s.IsClosed()); }},
        {"open",
         ClosedCorners,
         {},
         [](Rig &r) { return r.Edit().SetClosed(false); },
         true,
         {"Open polygon"},
         [](Rig &, const PolyLine &s) { EXPECT_FALSE(s.IsClosed()); }},
        {"flip across X",
         Corners,
         {0, 1},
         [](Rig &r) { return r.Edit().Flip(Qt::Horizontal); },
         true,
         {"Flip Points"},
         [](Rig &, const PolyLine &s) {
             EXPECT_TRUE(Near(s.GetPoint(0)->Pos(), {0.4, 0.2}));
             EXPECT_TRUE(Near(s.GetPoint(1)->Pos(), {0.2, 0.2}));
         }},
        {"flip across Y",
         Corners,
         {2, 3},
         [](Rig &r) { return r.Edit().Flip(Qt::Vertical); },
         true,
         {"Flip Points"},
         [](Rig &, const PolyLine &s) {
             EXPECT_TRUE(Near(s.GetPoint(2)->Pos(), {0.6, 0.6}));
             EXPECT_TRUE(Near(s.GetPoint(3)->Pos(), {0.8, 0.2}));
         }},
        {"two nudges, one step",
         Corners,
         {1},
         [](Rig &r) {
             const bool a = r.Edit().Nudge({0.01, 0.0}), b = r.Edit().Nudge({0.01, 0.005});
             r.Edit().EndNudge();
             return a && b;
         },
         true,
         {"Shift points"},
         [](Rig &, const PolyLine &s) {
             EXPECT_TRUE(Near(s.GetPoint(1)->Pos(), {0.42, 0.205}));
         }},
        {"tag",
         Corners,
         {1, 2},
         [](Rig &r) { return r.Edit().TagSelected(); },
         true,
         {"Tag Points"},
         [](Rig &, const PolyLine &s) {
             EXPECT_TRUE(s.GetPoint(1)->Flags & PPF_Tagged);
             EXPECT_EQ(s.GetPoint(2)->TagID, 3);
             EXPECT_FALSE(s.GetPoint(0)->Flags & PPF_Tagged);
         }},
        {"publish: the point Input too",
         Corners,
         {1},
         [](Rig &r) { return r.Edit().PublishSelected(); },
         true,
         {"Publish Points"},
         [](Rig &r, const PolyLine &s) {
             EXPECT_TRUE(s.GetPoint(1)->Flags & PPF_Published);
             const AutoPoint p(r.tool->FindInput(OrbID("Point1")), 0.0);
             ASSERT_TRUE(p);
             EXPECT_TRUE(Near({p->X, p->Y}, kCorners[1]));
         }},
        {"stop following",
         [] {
             AutoRef<PolyLine> s = Corners();
             PolyPoint p = *s->GetPoint(1);
             p.Flags |= PPF_Following;
             s->SetPoint(1, p);
             return s;
         },
         {1},
         [](Rig &r) { return r.Edit().StopFollowing(); },
         true,
         {"Stop Points Following"},
         [](Rig &, const PolyLine &s) { EXPECT_FALSE(s.GetPoint(1)->Flags & PPF_Following); }},
        {"stop following where none follows",
         Corners,
         {1},
         [](Rig &r) { return r.Edit().StopFollowing(); },
         false,
         {},
         Unchanged,
         "None of the selected points follows another"},
        {"a locked point stays",
         Corners,
         {1, 2},
         [](Rig &r) {
             r.Edit().Select({1}, PolyLineEditor::SH_Replace);
             const bool locked = r.Edit().LockSelected(true);
             r.Edit().Select({1, 2}, PolyLineEditor::SH_Replace);
             const bool nudged = r.Edit().Nudge({0.1, 0.0});
             r.Edit().EndNudge();
             return locked && nudged;
         },
         true,
         {"Lock Points", "Shift points"},
         [](Rig &r, const PolyLine &s) {
             EXPECT_TRUE(Near(s.GetPoint(1)->Pos(), kCorners[1]));
             EXPECT_TRUE(Near(s.GetPoint(2)->Pos(), {0.7, 0.2}));
             EXPECT_TRUE(r.Edit().IsSelectionLockedPoint());
         }},
        {"cut",
         Corners,
         {1},
         [](Rig &r) { return r.Edit().Cut(); },
         true,
         {"Cut Points"},
         [](Rig &, const PolyLine &s) {
             EXPECT_EQ(s.GetCount(), 3);
             std::string why;
             const AutoRef<PolyLine> cut(
                 ShapeFile::Parse(QGuiApplication::clipboard()->text().toStdString(), "clipboard", &why));
             ASSERT_TRUE(cut) << why;
             ASSERT_EQ(cut->GetCount(), 1);
             EXPECT_TRUE(Near(cut->GetPoint(0)->Pos(), kCorners[1]));
         }},
        {"copy and paste with offset",
         Corners,
         {0, 1},
         [](Rig &r) {
             return r.Edit().Copy() && r.Edit().PasteWithOffset({0.05, 0.1});
         },
         true,
         {"Paste Points"},
         [](Rig &r, const PolyLine &s) {
             ASSERT_EQ(s.GetCount(), 6);
             EXPECT_TRUE(Near(s.GetPoint(5)->Pos(), {0.45, 0.3}));
             EXPECT_EQ(r.Selected(), (Indices{4, 5}));
         }},
        // Refusals: nothing changes, no step, a message.
        {"delete with nothing selected",
         Corners,
         {},
         [](Rig &r) { return r.Edit().DeleteSelected(); },
         false,
         {},
         Unchanged,
         "Nothing is selected"},
        {"smooth an empty shape",
         Empty,
         {},
         [](Rig &r) { return r.Edit().Smooth(); },
         false,
         {},
         Unchanged,
         "The shape has no points"},
        {"a locked tool",
         Corners,
         {1},
         [](Rig &r) {
             r.tool->SetLocked(true);
             return r.Edit().DeleteSelected();
         },
         false,
         {},
         Unchanged,
         "The tool is locked"},
        {"paste of garbage",
         Corners,
         {},
         [](Rig &r) {
             QGuiApplication::clipboard()->setText("point x=oops\nfoo bar");
             return r.Edit().Paste();
         },
         false,
         {},
         Unchanged,
         "The clipboard holds no shape"},
        {"publish to a tracker",
         Corners,
         {1},
         [](Rig &r) { return r.Edit().PublishTo(PolyLineEditor::PT_PointTracker); },
         false,
         {},
         Unchanged,
         "No tracker overlay exists yet: the points cannot be attached to a tracker"},
        {"subdivide a Bezier shape",
         Corners,
         {},
         [](Rig &r) { return r.Edit().Subdivide(); },
         false,
         {},
         Unchanged,
         "Subdivide works on B-spline shapes only"},
        {"close a closed shape",
         ClosedCorners,
         {},
         [](Rig &r) { return r.Edit().SetClosed(true); },
         false,
         {},
         Unchanged,
         "The shape is closed already"},
    };
    return rows;
}

} // namespace

// Each operation's effect and its undo step's name; undo brings the exact
// shape back, redo the edited one.
TEST(PolyLineEditorTest, OperationsAndTheirUndoSteps)
{
    for (const OpRow &row : OpRows()) {
        SCOPED_TRACE(row.name);
        Rig r(row.shape().get(), TagList{{0x10058000, 4}});
        r.Edit().Select(row.selected, PolyLineEditor::SH_Replace);
        const AutoParam<PolyLine> before = r.Now();
        EXPECT_EQ(row.op(r), row.changes);
        EXPECT_EQ(r.doc.UndoNames(), row.undo);
        EXPECT_EQ(r.Edit().Message(), std::string(row.message));
        const AutoParam<PolyLine> after = r.Now();
        row.check(r, *after);
        if (!row.changes) {
            EXPECT_TRUE(after->Equals(*before));
            continue;
        }
        for (int i = 0; i < row.undo.size(); ++i)
            EXPECT_TRUE(r.doc.Undo());
        EXPECT_TRUE(r.Now()->Equals(*before));
        for (int i = 0; i < row.undo.size(); ++i)
            EXPECT_TRUE(r.doc.Redo());
        EXPECT_TRUE(r.Now()->Equals(*after));
    }
}

TEST(PolyLineEditorTest, ReadOnlyShapeRefusesEveryEdit)
{
    Rig r(Corners().get(), TagList{{INPA_ReadOnly, 1}});
    r.Edit().SelectAll();
    EXPECT_EQ(r.Selected(), (Indices{0, 1, 2, 3}));
    for (const auto &edit : std::vector<std::function<bool()>>{
             [&] { return r.Edit().DeleteSelected(); }, [&] { return r.Edit().Smooth(); },
             [&] { return r.Edit().Flip(Qt::Vertical); },
             [&] {
                 return r.Edit().Nudge({0.1, 0.1});
             },
             [&] { return r.Edit().Cut(); }, [&] { return r.Edit().MakeOuter(); }}) {
        EXPECT_FALSE(edit());
        EXPECT_EQ(r.Edit().Message(), "The shape is read-only");
    }
    EXPECT_TRUE(r.doc.UndoNames().isEmpty());
}

struct FrameRow
{
    const char *name;
    int32 mode;
    bool structural; // a delete rather than a nudge
    bool currentOnly;
    std::vector<bool> changed; // keys at 0, 10, 20 (10 is the current time)
};

// Keys at 0, 10 and 20 with the current time at 10.
TEST(PolyLineEditorTest, EditsReachTheChosenKeyframes)
{
    const FrameRow rows[] = {
        {"none: the current key", PolyLineEditor::MF_None, false, false, {false, true, false}},
        {"prev", PolyLineEditor::MF_Prev, false, false, {true, true, false}},
        {"next", PolyLineEditor::MF_Next, false, false, {false, true, true}},
        {"all", PolyLineEditor::MF_All, false, false, {true, true, true}},
        {"a delete reaches every key", PolyLineEditor::MF_None, true, false, {true, true, true}},
        {"unless current time only", PolyLineEditor::MF_None, true, true, {false, true, false}},
    };
    for (const FrameRow &row : rows) {
        SCOPED_TRACE(row.name);
        Rig r(Corners().get(), TagList{{0x10058000, 4}});
        r.mask->SetAnimated(true);
        for (float64 t : {0.0, 10.0, 20.0})
            r.mask->SetValue(Shape().get(), t, SETVALUE_NoUndo);
        r.doc.SetCurrentTime(10.0);
        r.Notify();
        r.Edit().SetMultiFrame(row.mode);
        r.Edit().SetCurrentTimeOnly(row.currentOnly);
        r.Edit().Select({1}, PolyLineEditor::SH_Replace);
        EXPECT_TRUE(row.structural ? r.Edit().DeleteSelected() : r.Edit().Nudge({0.1, 0.0}));
        r.Edit().EndNudge();
        EXPECT_EQ(r.doc.UndoNames().size(), 1);
        for (int k = 0; k < 3; ++k) {
            const AutoRef<Parameter> key(r.mask->GetKey(10.0 * k));
            EXPECT_EQ(!key->Equals(*Shape()), bool(row.changed[std::size_t(k)])) << "key at " << 10 * k;
        }
        EXPECT_EQ(r.Edit().KeyTimes(), (std::vector<float64>{0.0, 10.0, 20.0}));
    }
}

// The outer shape is made round the inner one; once it follows, moving the
// inner points carries the outer ones along in the same step.
TEST(PolyLineEditorTest, OuterPolylineMadeAndFollowing)
{
    Rig r(ClosedCorners().get(), TagList{{PLCID_InPolyLine2, OrbID("Mask2")}});
    EXPECT_EQ(r.overlay->Pairing(), PolyLineControl::PAIR_Free);
    ASSERT_TRUE(r.Edit().MakeOuter()) << r.Edit().Message();
    const AutoParam<PolyLine> outer = r.Now(r.outer);
    ASSERT_EQ(outer->GetCount(), 4);
    for (int32 i = 0; i < 4; ++i)
        EXPECT_NEAR((outer->GetPoint(i)->Pos() - kCorners[std::size_t(i)]).Length(), PolyLineShapes::OuterDistance,
                    1e-12);
    ASSERT_TRUE(r.Edit().FollowInner());
    EXPECT_EQ(r.overlay->Pairing(), PolyLineControl::PAIR_Follow);
    r.Edit().Select({0}, PolyLineEditor::SH_Replace);
    ASSERT_TRUE(r.Edit().Nudge({0.05, 0.0}));
    r.Edit().EndNudge();
    EXPECT_TRUE(Near(r.Now(r.outer)->GetPoint(0)->Pos(), outer->GetPoint(0)->Pos() + OrbPoint(0.05, 0.0)));
    EXPECT_TRUE(Near(r.Now(r.outer)->GetPoint(1)->Pos(), outer->GetPoint(1)->Pos()));
    EXPECT_EQ(r.doc.UndoNames(), (QStringList{"Make Outer Polyline", "Follow Inner Polyline", "Shift points"}));
    ASSERT_TRUE(r.doc.Undo());
    EXPECT_TRUE(Near(r.Now(r.outer)->GetPoint(0)->Pos(), outer->GetPoint(0)->Pos()));
    ASSERT_TRUE(r.Edit().RemoveOuter());
    EXPECT_EQ(r.overlay->Pairing(), PolyLineControl::PAIR_Off);
    EXPECT_EQ(r.Now(r.outer)->GetCount(), 0);
}

// Subdividing a B-spline doubles its segments and keeps its curve: the old
// curve at p is the new one at 2p.
TEST(PolyLineEditorTest, SubdivideKeepsTheCurve)
{
    for (const bool closed : {false, true}) {
        SCOPED_TRACE(closed ? "closed" : "open");
        AutoRef<PolyLine> spline = Shape({{0.2, 0.2}, {0.5, 0.8}, {0.8, 0.3}, {0.6, 0.1}}, closed, new BSplinePolyLine);
        PolyPoint heavy = *spline->GetPoint(1);
        // Light enough that the open end's phantom mirrors in homogeneous
        // space (its weight stays positive) before and after.
        heavy.Weight = 1.5;
        spline->SetPoint(1, heavy);
        Rig r(spline.get(), TagList{{0x10058000, 4}});
        ASSERT_TRUE(r.Edit().Subdivide()) << r.Edit().Message();
        const AutoParam<PolyLine> after = r.Now();
        EXPECT_EQ(after->GetSegmentsCount(), 2 * spline->GetSegmentsCount());
        for (float64 p = 0.0; p <= spline->GetSegmentsCount(); p += 0.125)
            EXPECT_TRUE(Near(spline->ValueAt(p), after->ValueAt(2 * p), 1e-12)) << p;
        EXPECT_EQ(r.doc.UndoNames(), QStringList{"Subdivide"});
    }
}

TEST(PolyLineEditorTest, SelectNextWalksAndWrapsOnClosedShapes)
{
    for (const bool closed : {false, true}) {
        Rig r(Shape(kCorners, closed).get(), TagList{{0x10058000, 4}});
        EXPECT_TRUE(r.Edit().SelectNext(1));
        EXPECT_EQ(r.Selected(), Indices{0});
        r.Edit().SelectNext(-1);
        EXPECT_EQ(r.Selected(), Indices{closed ? 3 : 0});
        r.Edit().Select({2, 3}, PolyLineEditor::SH_Replace);
        r.Edit().SelectNext(1);
        EXPECT_EQ(r.Selected(), Indices{closed ? 0 : 3});
    }
}

int main(int argc, char **argv)
{
    QGuiApplication app(argc, argv);
    ::testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
