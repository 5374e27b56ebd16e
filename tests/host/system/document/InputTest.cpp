#include "RecordingWatcher.h"

#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/ScriptError.h"

#include <QUndoStack>

#include <gtest/gtest.h>

namespace Orbane {
namespace {

class InputTest : public testing::Test
{
protected:
    void SetUp() override
    {
        TakeScriptError();
        AutoRef<Operator> blur(new Operator("Blur1", "Blur"));
        tool = blur;
        blend = tool->AddInput("Blend", "Blend", CLSID_DataType_Number, {{INPA_Name, "Blend"}}, AutoNumber(1.0));
        center = tool->AddInput("Center", "Center", CLSID_DataType_Point, {}, AutoPoint(0.5, 0.5));
        label = tool->AddInput("Label", "Label", CLSID_DataType_Text, {}, AutoText("Soft"));
        doc.AddTool(tool);
    }

    void Key(Input *in, float64 time, float64 value)
    {
        ASSERT_TRUE(in->SetValue(AutoNumber(value), time, SETVALUE_NoUndo));
    }

    OrbaneDoc doc;
    Operator *tool = nullptr;
    Input *blend = nullptr;
    Input *center = nullptr;
    Input *label = nullptr;
    std::vector<RecordingWatcher::Call> log;
};

TEST_F(InputTest, DeclarationIsKept)
{
    EXPECT_EQ(blend->GetID(), OrbID("Blend"));
    EXPECT_STREQ(blend->GetName(), "Blend");
    EXPECT_EQ(blend->GetDataType(), CLSID_DataType_Number);
    EXPECT_STREQ(blend->GetAttrs().GetString(INPA_Name), "Blend");
    EXPECT_EQ(blend->GetOperator(), tool);
    EXPECT_EQ(blend->GetDoc(), &doc);
    EXPECT_STREQ(blend->ScriptTypeName(), "Input");
    EXPECT_EQ(NumberAt(blend, 0.0), 1.0);
    EXPECT_TRUE(AutoNumber(1.0)->Equals(*blend->GetDefault()));
}

TEST_F(InputTest, PlainValueIsTheSameAtEveryTime)
{
    ASSERT_TRUE(blend->SetValue(AutoNumber(0.3), 12.0));
    EXPECT_FALSE(blend->IsAnimated());
    EXPECT_TRUE(blend->KeyTimes().empty());
    EXPECT_EQ(NumberAt(blend, -100.0), 0.3);
    EXPECT_EQ(NumberAt(blend, 500.0), 0.3);
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
                         testing::Values(AnimatedCase{"BeforeFirstKey", -5.0, 0.0},
                                         AnimatedCase{"OnFirstKey", 0.0, 0.0}, AnimatedCase{"HalfwayUp", 5.0, 0.5},
                                         AnimatedCase{"OnMiddleKey", 10.0, 1.0},
                                         AnimatedCase{"QuarterIntoSecondSpan", 12.5, 2.0},
                                         AnimatedCase{"OnLastKey", 20.0, 5.0}, AnimatedCase{"AfterLastKey", 99.0, 5.0}),
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

TEST_F(InputTest, AnimatedPointBlendsAndTextSteps)
{
    center->SetAnimated(true);
    label->SetAnimated(true);
    ASSERT_TRUE(center->SetValue(AutoPoint(0.0, 0.0), 0.0, SETVALUE_NoUndo));
    ASSERT_TRUE(center->SetValue(AutoPoint(1.0, 0.5), 10.0, SETVALUE_NoUndo));
    ASSERT_TRUE(label->SetValue(AutoText("A"), 0.0, SETVALUE_NoUndo));
    ASSERT_TRUE(label->SetValue(AutoText("B"), 10.0, SETVALUE_NoUndo));

    AutoPoint p(center, 2.0);
    ASSERT_TRUE(p.IsValid());
    EXPECT_DOUBLE_EQ(p->X, 0.2);
    EXPECT_DOUBLE_EQ(p->Y, 0.1);
    EXPECT_EQ(AutoText(label, 9.0)->Value, OrbString("A"));
    EXPECT_EQ(AutoText(label, 10.0)->Value, OrbString("B"));
}

TEST_F(InputTest, WrongTypeIsRefusedWithAMessage)
{
    RecordingWatcher w("w", log);
    blend->AttachWatcher(&w);
    EXPECT_FALSE(blend->SetValue(AutoText("0.5"), 0.0));
    EXPECT_EQ(TakeScriptError(), "Input \"Blend\" of tool \"Blur1\" takes Number, not Text");
    EXPECT_FALSE(blend->SetValue(nullptr, 0.0));
    EXPECT_EQ(TakeScriptError(), "Input \"Blend\" of tool \"Blur1\" takes Number, not nil");
    EXPECT_EQ(NumberAt(blend, 0.0), 1.0);
    EXPECT_TRUE(log.empty());
    EXPECT_EQ(doc.UndoStack()->count(), 0);
    blend->DetachWatcher(&w);
}

TEST_F(InputTest, EqualValueChangesNothing)
{
    RecordingWatcher w("w", log);
    blend->AttachWatcher(&w);
    EXPECT_TRUE(blend->SetValue(AutoNumber(1.0), 0.0));
    EXPECT_TRUE(log.empty());
    EXPECT_EQ(doc.UndoStack()->count(), 0);
    blend->DetachWatcher(&w);
}

TEST_F(InputTest, WatchersAreToldInAttachOrderWithTheValue)
{
    RecordingWatcher first("first", log), second("second", log), third("third", log);
    EXPECT_TRUE(blend->AttachWatcher(&second));
    EXPECT_TRUE(blend->AttachWatcher(&first));
    EXPECT_TRUE(blend->AttachWatcher(&third));
    EXPECT_FALSE(blend->AttachWatcher(&first));
    EXPECT_FALSE(blend->AttachWatcher(nullptr));
    EXPECT_TRUE(blend->DetachWatcher(&third));
    EXPECT_FALSE(blend->DetachWatcher(&third));

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
    blend->DetachWatcher(&first);
    blend->DetachWatcher(&second);
}

TEST_F(InputTest, WatchersSeeTheValueAtTheCurrentTime)
{
    RecordingWatcher w("w", log);
    blend->AttachWatcher(&w);
    blend->SetAnimated(true); // key at time 0 holding 1.0
    log.clear();
    ASSERT_TRUE(blend->SetValue(AutoNumber(3.0), 10.0));
    ASSERT_EQ(log.size(), 1u);
    EXPECT_EQ(dynamic_cast<Number *>(log[0].value.get())->Value, 1.0);

    doc.SetCurrentTime(5.0);
    ASSERT_EQ(log.size(), 2u);
    EXPECT_DOUBLE_EQ(dynamic_cast<Number *>(log[1].value.get())->Value, 2.0);
    blend->DetachWatcher(&w);
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

TEST_F(InputTest, WatchersListCanBeWalkedUnderTheReadLock)
{
    RecordingWatcher a("a", log), b("b", log);
    blend->AttachWatcher(&a);
    blend->AttachWatcher(&b);
    std::vector<InputWatcher *> seen;
    {
        LockableObject::ReadGuard guard(*blend);
        for (InputWatcher *w : blend->Watchers())
            seen.push_back(w);
        // Telling the watchers reads the list again under the same lock.
        blend->Notify();
    }
    EXPECT_EQ(seen, (std::vector<InputWatcher *>{&a, &b}));
    EXPECT_EQ(log.size(), 2u);
    blend->DetachWatcher(&a);
    blend->DetachWatcher(&b);
}

class SentinelTimeTest : public InputTest, public testing::WithParamInterface<float64>
{
};

TEST_P(SentinelTimeTest, NeverBecomesAKey)
{
    blend->SetAnimated(true);
    Key(blend, 10.0, 4.0);
    const std::vector<float64> keys = blend->KeyTimes();
    EXPECT_TRUE(blend->SetValue(AutoNumber(7.0), GetParam(), SETVALUE_NoUndo));
    EXPECT_EQ(blend->KeyTimes(), keys);
    EXPECT_EQ(NumberAt(blend, 0.0), 1.0);
    EXPECT_EQ(NumberAt(blend, 10.0), 4.0);
}

TEST_P(SentinelTimeTest, SetsThePlainValue)
{
    EXPECT_TRUE(blend->SetValue(AutoNumber(7.0), GetParam(), SETVALUE_NoUndo));
    EXPECT_EQ(NumberAt(blend, 0.0), 7.0);
    EXPECT_TRUE(blend->KeyTimes().empty());
    EXPECT_EQ(doc.UndoStack()->count(), 0);
}

INSTANTIATE_TEST_SUITE_P(Times, SentinelTimeTest, testing::Values(TIME_UNDEFINED, TIME_DISCONNECT, -1.0e12));

TEST_F(InputTest, JustAboveTheSentinelIsAKey)
{
    blend->SetAnimated(true);
    Key(blend, TIME_UNDEFINED + 1.0, 2.0);
    EXPECT_EQ(blend->KeyTimes().size(), 2u);
}

TEST_F(InputTest, InputOutsideADocumentStoresWithoutUndo)
{
    AutoRef<Operator> loose(new Operator("Loose1", "Loose"));
    Input *in = loose->AddInput("Size", "Size", CLSID_DataType_Number, {}, nullptr);
    EXPECT_EQ(in->GetDoc(), nullptr);
    EXPECT_EQ(AutoParameter(in, 0.0).get(), nullptr);
    RecordingWatcher w("w", log);
    in->AttachWatcher(&w);
    ASSERT_TRUE(in->SetValue(AutoNumber(3.0), 0.0));
    EXPECT_EQ(NumberAt(in, 0.0), 3.0);
    EXPECT_EQ(log.size(), 1u);
    in->DetachWatcher(&w);
}

} // namespace
} // namespace Orbane
