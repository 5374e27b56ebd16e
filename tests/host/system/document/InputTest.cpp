#include "RecordingWatcher.h"

#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptError.h"

#include <QUndoStack>

#include <gtest/gtest.h>

#include <type_traits>

namespace Orbane {
namespace {

// A holder never makes a value out of a pointer to hold, nor out of a value
// of another kind.
static_assert(!std::is_constructible_v<AutoNumber, Text *>);
static_assert(!std::is_constructible_v<AutoNumber, const char *>);
static_assert(!std::is_constructible_v<AutoParameter, float64>);

class InputTest : public testing::Test
{
protected:
    void SetUp() override
    {
        TakeScriptError();
        AutoRef<Operator> blur(new Operator("Blur1", "Blur"));
        tool = blur;
        blend = tool->AddInput("Blend", "Blend", CLSID_DataType_Number, {}, AutoNumber(1.0));
        doc.AddTool(tool);
    }

    void Key(Input *in, float64 time, float64 value)
    {
        ASSERT_TRUE(in->SetValue(AutoNumber(value), time, SETVALUE_NoUndo));
    }

    OrbaneDoc doc;
    Operator *tool = nullptr;
    Input *blend = nullptr;
    std::vector<RecordingWatcher::Call> log;
};

TEST_F(InputTest, ValueHoldersReadACopyOfTheirKindOnly)
{
    AutoNumber n(blend, 0.0);
    ASSERT_TRUE(n.IsValid());
    n->Value = 9.0;
    EXPECT_EQ(NumberAt(blend, 0.0), 1.0);
    EXPECT_FALSE(AutoText(blend, 0.0).IsValid());
    EXPECT_FALSE(AutoNumber(nullptr, 0.0).IsValid());
    EXPECT_EQ(AutoParameter(blend, 0.0)->DataType(), CLSID_DataType_Number);
    // A plain value is the same at every time; writing it at any time makes no key.
    ASSERT_TRUE(blend->SetValue(AutoNumber(0.3), 12.0));
    EXPECT_TRUE(blend->KeyTimes().empty());
    EXPECT_EQ(NumberAt(blend, -100.0), 0.3);
}

struct AnimatedCase
{
    const char *name;
    float64 time;
    float64 expected;
};

class AnimatedInputTest : public InputTest, public testing::WithParamInterface<AnimatedCase>
{
};

TEST_P(AnimatedInputTest, ReadsKeysAndBlendsBetweenThem)
{
    blend->SetAnimated(true);
    Key(blend, 0.0, 0.0);
    Key(blend, 10.0, 1.0);
    Key(blend, 20.0, 5.0);
    EXPECT_DOUBLE_EQ(NumberAt(blend, GetParam().time), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Times, AnimatedInputTest,
                         testing::Values(AnimatedCase{"BeforeFirstKey", -5.0, 0.0}, AnimatedCase{"HalfwayUp", 5.0, 0.5},
                                         AnimatedCase{"OnMiddleKey", 10.0, 1.0},
                                         AnimatedCase{"QuarterIntoSecondSpan", 12.5, 2.0},
                                         AnimatedCase{"AfterLastKey", 99.0, 5.0}),
                         [](const auto &info) { return std::string(info.param.name); });

TEST_F(InputTest, AnimationKeepsTheCurrentValueAsFirstKey)
{
    doc.SetCurrentTime(4.0);
    blend->SetAnimated(true);
    EXPECT_EQ(blend->KeyTimes(), std::vector<float64>{4.0});
    Key(blend, 8.0, 3.0);
    EXPECT_EQ(blend->KeyTimes(), (std::vector<float64>{4.0, 8.0}));
    EXPECT_DOUBLE_EQ(NumberAt(blend, 6.0), 2.0);

    doc.SetCurrentTime(6.0);
    blend->SetAnimated(false);
    EXPECT_TRUE(blend->KeyTimes().empty());
    EXPECT_DOUBLE_EQ(NumberAt(blend, 100.0), 2.0);
}

TEST_F(InputTest, WrongTypeIsRefusedAndAnEqualValueWritesNothing)
{
    RecordingWatcher w("w", log);
    blend->AttachWatcher(&w);
    EXPECT_FALSE(blend->SetValue(AutoText("0.5"), 0.0));
    EXPECT_EQ(TakeScriptError(), "Input \"Blend\" of tool \"Blur1\" takes Number, not Text");
    EXPECT_FALSE(blend->SetValue(nullptr, 0.0));
    EXPECT_EQ(TakeScriptError(), "Input \"Blend\" of tool \"Blur1\" takes Number, not nil");
    EXPECT_TRUE(blend->SetValue(AutoNumber(1.0), 0.0));
    EXPECT_EQ(NumberAt(blend, 0.0), 1.0);
    EXPECT_TRUE(log.empty());
    EXPECT_EQ(doc.UndoStack()->count(), 0);
    blend->DetachWatcher(&w);
}

TEST_F(InputTest, WatchersAreToldInAttachOrderWithTheValue)
{
    RecordingWatcher first("first", log), second("second", log), third("third", log);
    blend->AttachWatcher(&second);
    blend->AttachWatcher(&first);
    blend->AttachWatcher(&third);
    EXPECT_FALSE(blend->AttachWatcher(&first));
    blend->DetachWatcher(&third);

    const TagList tags{{0x10050000, 1}};
    ASSERT_TRUE(blend->SetValue(AutoNumber(0.75), 0.0, 0, &tags));
    ASSERT_EQ(log.size(), 2u);
    EXPECT_EQ(log[0].who, "second");
    EXPECT_EQ(log[1].who, "first");
    for (const auto &call : log) {
        EXPECT_EQ(call.in, blend);
        EXPECT_EQ(call.tags, &tags);
        ASSERT_TRUE(call.value.IsValid());
        EXPECT_TRUE(AutoNumber(0.75)->Equals(*call.value));
    }
    EXPECT_EQ(log[0].value.get(), log[1].value.get());
    {
        // The list can be walked under the read lock, and telling the
        // watchers reads it again under the same lock.
        LockableObject::ReadGuard guard(*blend);
        EXPECT_EQ(blend->Watchers(), (std::vector<InputWatcher *>{&second, &first}));
        blend->Notify();
    }
    EXPECT_EQ(log.size(), 4u);
    blend->DetachWatcher(&first);
    blend->DetachWatcher(&second);
}

TEST_F(InputTest, AWatcherDetachedDuringNotificationIsNotTold)
{
    RecordingWatcher first("first", log), second("second", log);
    first.OnCall = [&](Input *in, Parameter *) { in->DetachWatcher(&second); };
    blend->AttachWatcher(&first);
    blend->AttachWatcher(&second);
    ASSERT_TRUE(blend->SetValue(AutoNumber(2.0), 0.0));
    ASSERT_EQ(log.size(), 1u);
    EXPECT_EQ(log[0].who, "first");
    EXPECT_EQ(blend->Watchers().size(), 1u);
    blend->DetachWatcher(&first);
}

class SentinelTimeTest : public InputTest, public testing::WithParamInterface<float64>
{
};

TEST_P(SentinelTimeTest, SetsThePlainValueAndNeverAKey)
{
    EXPECT_TRUE(blend->SetValue(AutoNumber(7.0), GetParam(), SETVALUE_NoUndo));
    EXPECT_EQ(NumberAt(blend, 0.0), 7.0);
    EXPECT_TRUE(blend->KeyTimes().empty());
    EXPECT_EQ(doc.UndoStack()->count(), 0);

    blend->SetAnimated(true);
    Key(blend, 10.0, 4.0);
    EXPECT_TRUE(blend->SetValue(AutoNumber(9.0), GetParam(), SETVALUE_NoUndo));
    EXPECT_EQ(blend->KeyTimes(), (std::vector<float64>{0.0, 10.0}));
    EXPECT_EQ(NumberAt(blend, 0.0), 7.0);
    EXPECT_EQ(NumberAt(blend, 10.0), 4.0);
}

INSTANTIATE_TEST_SUITE_P(Times, SentinelTimeTest, testing::Values(TIME_UNDEFINED, TIME_DISCONNECT, -1.0e12));

} // namespace
} // namespace Orbane
