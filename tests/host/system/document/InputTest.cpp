#include "RecordingWatcher.h"

#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptError.h"
#include "orbane/Tags.h"

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
        tool = AutoRef<Operator>(new Operator("Blur1", "Blur"));
        blend = tool->AddInput("Blend", "Blend", CLSID_DataType_Number, {}, AutoNumber(1.0));
        doc.AddTool(tool);
    }

    void Key(float64 time, float64 value) { ASSERT_TRUE(blend->SetValue(AutoNumber(value), time, SETVALUE_NoUndo)); }

    OrbaneDoc doc;
    AutoRef<Operator> tool;
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
    EXPECT_EQ(AutoParameter(blend, 0.0)->DataType(), CLSID_DataType_Number);
    // A plain value is the same at every time; writing it at any time makes no key.
    ASSERT_TRUE(blend->SetValue(AutoNumber(0.3), 12.0));
    EXPECT_TRUE(blend->KeyTimes().empty());
    EXPECT_EQ(NumberAt(blend, -100.0), 0.3);
}

TEST_F(InputTest, AnimatedInputsHoldBeforeAndAfterTheirKeysAndBlendBetween)
{
    blend->SetAnimated(true);
    Key(0.0, 0.0);
    Key(10.0, 1.0);
    Key(20.0, 5.0);
    const std::pair<float64, float64> expected[] = {{-5.0, 0.0}, {5.0, 0.5}, {10.0, 1.0}, {12.5, 2.0}, {99.0, 5.0}};
    for (const auto &[time, value] : expected)
        EXPECT_DOUBLE_EQ(NumberAt(blend, time), value) << "at " << time;
}

TEST_F(InputTest, AnimationKeepsTheCurrentValueAsFirstKey)
{
    doc.SetCurrentTime(4.0);
    blend->SetAnimated(true);
    EXPECT_EQ(blend->KeyTimes(), std::vector<float64>{4.0});
    Key(8.0, 3.0);
    EXPECT_DOUBLE_EQ(NumberAt(blend, 6.0), 2.0);
    doc.SetCurrentTime(6.0);
    blend->SetAnimated(false);
    EXPECT_TRUE(blend->KeyTimes().empty());
    EXPECT_DOUBLE_EQ(NumberAt(blend, 100.0), 2.0);
}

TEST_F(InputTest, NumbersAreStoredWithinTheAllowedRangeAsKeysToo)
{
    Input *mix = tool->AddInput("Mix", "Mix", CLSID_DataType_Number, {{INPA_MinAllowed, 0.0}, {INPA_MaxAllowed, 2.0}},
                                AutoNumber(1.0));
    const std::pair<float64, float64> written[] = {{-3.0, 0.0}, {0.5, 0.5}, {2.0, 2.0}, {1e300, 2.0}};
    for (const auto &[value, stored] : written) {
        ASSERT_TRUE(mix->SetValue(AutoNumber(value), 0.0));
        EXPECT_EQ(NumberAt(mix, 0.0), stored) << "written " << value;
    }
    mix->SetAnimated(true);
    ASSERT_TRUE(mix->SetValue(AutoNumber(7.0), 5.0));
    EXPECT_EQ(NumberAt(mix, 5.0), 2.0);
    // A value that clamps to the stored one changes nothing: no undo step.
    const int steps = doc.UndoStack()->count();
    ASSERT_TRUE(mix->SetValue(AutoNumber(9.0), 5.0));
    EXPECT_EQ(doc.UndoStack()->count(), steps);
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

TEST_F(InputTest, WatchersAreToldInAttachOrderWithTheValueAndMayDetachEachOther)
{
    RecordingWatcher first("first", log), second("second", log), third("third", log);
    for (RecordingWatcher *w : {&second, &first, &third})
        blend->AttachWatcher(w);
    EXPECT_FALSE(blend->AttachWatcher(&first));
    blend->DetachWatcher(&third);

    const TagList tags{{0x10050000, 1}};
    ASSERT_TRUE(blend->SetValue(AutoNumber(0.75), 0.0, 0, &tags));
    ASSERT_EQ(log.size(), 2u);
    EXPECT_EQ(log[0].who + log[1].who, "secondfirst");
    for (const auto &call : log) {
        EXPECT_EQ(call.in, blend);
        EXPECT_EQ(call.tags, &tags);
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
    // A watcher detached by one told before it is not told.
    second.OnCall = [&](Input *in, Parameter *) { in->DetachWatcher(&first); };
    ASSERT_TRUE(blend->SetValue(AutoNumber(2.0), 0.0));
    EXPECT_EQ(log.size(), 5u);
    EXPECT_EQ(blend->Watchers(), std::vector<InputWatcher *>{&second});
    blend->DetachWatcher(&second);
}

// The times that mean "no time" set the plain value, never a key.
TEST_F(InputTest, SentinelTimesSetThePlainValueAndNeverAKey)
{
    float64 plain = 7.0;
    for (float64 time : {TIME_UNDEFINED, TIME_DISCONNECT, -1.0e12}) {
        blend->SetAnimated(false);
        EXPECT_TRUE(blend->SetValue(AutoNumber(++plain), time, SETVALUE_NoUndo)) << time;
        EXPECT_TRUE(blend->KeyTimes().empty());
        blend->SetAnimated(true);
        Key(10.0, 4.0);
        EXPECT_TRUE(blend->SetValue(AutoNumber(99.0), time, SETVALUE_NoUndo));
        EXPECT_EQ(blend->KeyTimes(), (std::vector<float64>{0.0, 10.0}));
        EXPECT_EQ(NumberAt(blend, 0.0), plain);
    }
}

} // namespace
} // namespace Orbane
