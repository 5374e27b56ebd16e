#include "RecordingWatcher.h"
#include "UndoGesture.h"

#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptError.h"

#include <QUndoStack>

#include <gtest/gtest.h>

namespace Orbane {
namespace {

class UndoTest : public testing::Test
{
protected:
    void SetUp() override
    {
        AutoRef<Operator> rect(new Operator("Rectangle1", "Rectangle"));
        tool = rect;
        width = tool->AddInput("Width", "Width", CLSID_DataType_Number, {}, AutoNumber(0.5));
        height = tool->AddInput("Height", "Height", CLSID_DataType_Number, {}, AutoNumber(0.25));
        doc.AddTool(tool);
        width->AttachWatcher(&watcher);
    }

    void TearDown() override { width->DetachWatcher(&watcher); }

    void Write(Input *in, float64 value, float64 time = 0.0) { ASSERT_TRUE(in->SetValue(AutoNumber(value), time)); }

    std::size_t ChangeCount(int step) const
    {
        const auto *gesture = dynamic_cast<const UndoGesture *>(doc.UndoStack()->command(step));
        return gesture ? gesture->ChangeCount() : 0;
    }

    float64 LastSeen() const
    {
        const auto *n = log.empty() ? nullptr : dynamic_cast<Number *>(log.back().value.get());
        return n ? n->Value : -1.0;
    }

    OrbaneDoc doc;
    Operator *tool = nullptr;
    Input *width = nullptr;
    Input *height = nullptr;
    std::vector<RecordingWatcher::Call> log;
    RecordingWatcher watcher{"w", log};
};

TEST_F(UndoTest, AWriteOutsideAGestureIsAStepOfItsOwnAndUndoWaitsForAnOpenGesture)
{
    Write(width, 0.6);
    Write(width, 0.7);
    EXPECT_EQ(doc.UndoNames(), (QStringList{"Change Width", "Change Width"}));
    doc.StartUndo("Drag");
    Write(width, 0.8);
    EXPECT_FALSE(doc.Undo());
    EXPECT_EQ(NumberAt(width, 0.0), 0.8);
    doc.EndUndo();
    for (float64 back : {0.7, 0.6, 0.5}) {
        ASSERT_TRUE(doc.Undo());
        EXPECT_EQ(NumberAt(width, 0.0), back);
        EXPECT_EQ(LastSeen(), back);
    }
    EXPECT_FALSE(doc.Undo());
    ASSERT_TRUE(doc.Redo());
    EXPECT_EQ(LastSeen(), 0.6);
}

TEST_F(UndoTest, AThousandMoveDragIsOneSmallStep)
{
    doc.StartUndo("Drag");
    for (int i = 1; i <= 1000; ++i) {
        Write(width, 0.5 + i * 0.0001);
        Write(height, 0.25 + i * 0.0005);
    }
    EXPECT_FALSE(doc.CanUndo());
    ASSERT_TRUE(doc.EndUndo());
    // A second drag is a step of its own, never merged into the first.
    doc.StartUndo("Drag Again");
    Write(width, 0.3);
    doc.EndUndo();

    EXPECT_EQ(doc.UndoNames(), (QStringList{"Drag", "Drag Again"}));
    EXPECT_EQ(ChangeCount(0), 2u);
    EXPECT_EQ(doc.UndoStack()->command(0)->childCount(), 0);
    doc.Undo();
    EXPECT_DOUBLE_EQ(NumberAt(width, 0.0), 0.6);
    doc.Undo();
    EXPECT_EQ(NumberAt(width, 0.0), 0.5);
    EXPECT_EQ(NumberAt(height, 0.0), 0.25);
    EXPECT_EQ(LastSeen(), 0.5);
    doc.Redo();
    EXPECT_DOUBLE_EQ(NumberAt(height, 0.0), 0.75);
    EXPECT_DOUBLE_EQ(LastSeen(), 0.6);
}

// An inner gesture joins the outer one; an inner rollback keeps what the
// outer gesture wrote.
TEST_F(UndoTest, NestedGesturesAreOneStepNamedByTheOutermost)
{
    doc.StartUndo("Move Corner");
    Write(width, 0.6);
    doc.StartUndo("Inner");
    Write(height, 0.3);
    EXPECT_TRUE(doc.EndUndo());
    EXPECT_EQ(doc.UndoStack()->count(), 0);
    doc.StartUndo("Try");
    Write(width, 0.7);
    Write(height, 0.9);
    doc.EndUndo(false);
    EXPECT_EQ(NumberAt(width, 0.0), 0.6);
    EXPECT_EQ(NumberAt(height, 0.0), 0.3);
    EXPECT_TRUE(doc.EndUndo());
    EXPECT_FALSE(doc.EndUndo());
    EXPECT_EQ(doc.UndoNames(), QStringList{"Move Corner"});
    EXPECT_EQ(ChangeCount(0), 2u);
    doc.Undo();
    EXPECT_EQ(NumberAt(width, 0.0) + NumberAt(height, 0.0), 0.75);
}

// Empty gestures and edits that come back to where they began leave no
// step; a gesture ended without keeping rolls back, telling watchers once.
TEST_F(UndoTest, OnlyWhatAGestureChangedIsKept)
{
    Write(height, 0.3);
    doc.StartUndo("Click");
    doc.EndUndo();
    doc.StartUndo("There And Back");
    Write(width, 0.9);
    Write(width, 0.5);
    doc.EndUndo();
    doc.StartUndo("Cancelled Drag");
    Write(width, 0.8);
    Write(height, 0.35);
    Write(width, 0.9);
    log.clear();
    EXPECT_TRUE(doc.EndUndo(false));
    EXPECT_EQ(NumberAt(height, 0.0), 0.3);
    ASSERT_EQ(log.size(), 1u);
    EXPECT_EQ(LastSeen(), 0.5);
    doc.StartUndo("Adjust");
    Write(width, 0.9);
    Write(height, 0.4);
    Write(width, 0.5);
    doc.EndUndo();
    EXPECT_EQ(doc.UndoNames(), (QStringList{"Change Height", "Adjust"}));
    EXPECT_EQ(ChangeCount(1), 1u);
}

// Undo tells watchers the value at the current time, not at the key it changed.
TEST_F(UndoTest, KeyframesComeBackExactly)
{
    width->SetAnimated(true); // key at 0 holding 0.5
    Write(width, 1.0, 10.0);
    doc.StartUndo("Drag");
    Write(width, 0.75, 10.0);  // changes a key
    Write(width, 0.25, 20.0);  // adds a key
    Write(width, 0.125, 20.0); // and moves it again
    doc.EndUndo();
    EXPECT_EQ(width->KeyTimes(), (std::vector<float64>{0.0, 10.0, 20.0}));
    EXPECT_EQ(ChangeCount(1), 2u);
    doc.SetCurrentTime(5.0);
    doc.Undo();
    EXPECT_EQ(width->KeyTimes(), (std::vector<float64>{0.0, 10.0}));
    EXPECT_EQ(NumberAt(width, 10.0), 1.0);
    EXPECT_EQ(LastSeen(), 0.75);
    doc.Undo();
    EXPECT_EQ(width->KeyTimes(), std::vector<float64>{0.0});
    doc.Redo();
    doc.Redo();
    EXPECT_EQ(NumberAt(width, 10.0), 0.75);
    EXPECT_EQ(NumberAt(width, 20.0), 0.125);
}

// A control that keeps Height at twice Width, as linked controls do: its
// reply to an undo is stored, not recorded.
TEST_F(UndoTest, WatcherWritingInReplyDuringUndoIsNotRecorded)
{
    watcher.OnCall = [&](Input *, Parameter *value) {
        height->SetValue(AutoNumber(dynamic_cast<Number *>(value)->Value * 2.0), 0.0);
    };
    Write(width, 0.6);
    EXPECT_EQ(doc.UndoNames(), (QStringList{"Change Width", "Change Height"}));
    doc.Undo();
    doc.Undo();
    EXPECT_EQ(doc.RedoNames(), (QStringList{"Change Width", "Change Height"}));
    EXPECT_EQ(NumberAt(height, 0.0), 1.0);
    doc.Redo();
    doc.Redo();
    EXPECT_EQ(NumberAt(height, 0.0), 1.2);
    EXPECT_EQ(doc.UndoStack()->count(), 2);
    watcher.OnCall = nullptr;
}

TEST_F(UndoTest, StepsOutliveTheirTool)
{
    Write(width, 0.6);
    doc.StartUndo("Left Open");
    Write(width, 0.7);
    width->DetachWatcher(&watcher);
    AutoRef<Input> keep = AutoRef<Input>::Share(width);
    doc.RemoveTool(tool);
    EXPECT_EQ(keep->GetOperator(), nullptr);
    EXPECT_TRUE(doc.EndUndo());
    EXPECT_TRUE(doc.Undo());
    EXPECT_EQ(NumberAt(keep, 0.0), 0.6);
    // Alone, the Input still checks what it is given.
    EXPECT_FALSE(keep->SetValue(AutoText("x"), 0.0));
    EXPECT_EQ(TakeScriptError(), "Input \"Width\" takes Number, not Text");
    width->AttachWatcher(&watcher);
}

TEST(UndoKindTest, UndoAndRedoRestoreExactValuesOfEveryKind)
{
    ScriptVal pair = ScriptVal::NewTable();
    pair.Append(ScriptVal(1));
    const std::pair<AutoParameter, AutoParameter> cases[] = {
        {AutoParameter(AutoPoint(0.1, 0.2)), AutoParameter(AutoPoint(0.3, 0.4, 1.0))},
        {AutoParameter(AutoOrbIDParam("Linear")), AutoParameter(AutoOrbIDParam("Smooth"))},
        {AutoParameter(AutoScriptValParam(pair)), AutoParameter(AutoScriptValParam(ScriptVal::NewTable()))}};
    for (const auto &[before, after] : cases) {
        SCOPED_TRACE(before->ScriptTypeName());
        OrbaneDoc doc;
        AutoRef<Operator> tool(new Operator("Tool1", "Tool"));
        Input *in = tool->AddInput("Value", "Value", before->DataType(), {}, before);
        doc.AddTool(tool);
        ASSERT_TRUE(in->SetValue(after, 0.0));
        doc.Undo();
        EXPECT_TRUE(AutoParameter(in, 0.0)->Equals(*before));
        doc.Redo();
        EXPECT_TRUE(AutoParameter(in, 0.0)->Equals(*after));
    }
}

TEST(UndoLifetimeTest, DocumentGoesWithAnOpenGestureAndSteps)
{
    AutoRef<Operator> tool(new Operator("Tool1", "Tool"));
    Input *in = tool->AddInput("Value", "Value", CLSID_DataType_Number, {}, AutoNumber(0.0));
    {
        OrbaneDoc doc;
        doc.AddTool(tool);
        in->SetValue(AutoNumber(1.0), 0.0);
        doc.StartUndo("Open");
        in->SetValue(AutoNumber(2.0), 0.0);
    }
    EXPECT_EQ(tool->GetDoc(), nullptr);
    EXPECT_EQ(tool->RefCount(), 1);
    EXPECT_EQ(in->RefCount(), 1);
    EXPECT_EQ(AutoNumber(in, 0.0)->Value, 2.0);
}

// The history stays within its bounds by dropping its oldest steps: undo
// then reaches back as far as the newest steps that were kept, never further,
// and a single step larger than the memory bound is still kept.
struct BoundCase
{
    const char *name;
    int steps;
    std::size_t bytes;
    int textLength; // of each write
    int writes;     // texts "1", "2", ... repeated to textLength
    int kept;       // steps left to undo
};

class UndoBoundTest : public testing::TestWithParam<BoundCase>
{
};

TEST_P(UndoBoundTest, DropsTheOldestSteps)
{
    const BoundCase &c = GetParam();
    const auto text = [&c](int i) { return std::string(std::size_t(c.textLength), char('0' + i)); };
    OrbaneDoc doc;
    doc.SetUndoBounds(c.steps, c.bytes);
    AutoRef<Operator> tool(new Operator("Tool1", "Tool"));
    Input *in = tool->AddInput("Label", "Label", CLSID_DataType_Text, {}, AutoText(text(0).c_str()));
    doc.AddTool(tool);
    for (int i = 1; i <= c.writes; ++i)
        ASSERT_TRUE(in->SetValue(AutoText(text(i).c_str()), 0.0));
    EXPECT_EQ(doc.UndoNames().size(), c.kept);
    while (doc.Undo()) {
    }
    EXPECT_EQ(AutoText(in, 0.0)->Value.str(), text(c.writes - c.kept)) << "undone to the oldest kept step";
    for (int i = 0; i < c.kept; ++i)
        EXPECT_TRUE(doc.Redo());
    EXPECT_EQ(AutoText(in, 0.0)->Value.str(), text(c.writes)) << "and redone to the newest";
}

// A step holding a 1000-character text costs somewhat over 1000 bytes.
const BoundCase kBounds[] = {
    {"within_both", 100, 1 << 20, 10, 5, 5},
    {"count", 3, 1 << 20, 10, 5, 3},
    {"memory", 100, 3500, 1000, 6, 3},
    {"newest_always_kept", 100, 100, 1000, 3, 1},
};

INSTANTIATE_TEST_SUITE_P(Bounds, UndoBoundTest, testing::ValuesIn(kBounds),
                         [](const auto &info) { return std::string(info.param.name); });

} // namespace
} // namespace Orbane
