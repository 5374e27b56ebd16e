#include "RecordingWatcher.h"

#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <gtest/gtest.h>

#include <map>
#include <string>
#include <utility>
#include <vector>

namespace Orbane {
namespace {

float64 ValueOf(const Input *in)
{
    const AutoNumber n(const_cast<Input *>(in), in->CurrentTime());
    return n ? n->Value : -1.0;
}

// Two tools, "Blur1" (Size 1, Gain 0.5) and "Merge1" (Mix 0.25, Angle 0), in
// a document.
struct Scene
{
    Scene()
    {
        AddTool(doc, "Blur1", {{"Size", 1.0}, {"Gain", 0.5}});
        AddTool(doc, "Merge1", {{"Mix", 0.25}, {"Angle", 0.0}});
    }

    static AutoRef<Operator> AddTool(OrbaneDoc &to, const char *name,
                                     std::vector<std::pair<const char *, float64>> inputs)
    {
        AutoRef<Operator> tool(new Operator(name, "Tool"));
        for (const auto &[id, value] : inputs)
            tool->AddInput(id, id, CLSID_DataType_Number, {}, AutoNumber(value));
        EXPECT_TRUE(to.AddTool(tool));
        return tool;
    }

    // "Blur1.Size" -> the Input.
    Input *In(const std::string &path) const
    {
        const std::size_t dot = path.find('.');
        const Operator *tool = doc.FindTool(path.substr(0, dot).c_str());
        return tool ? tool->FindInput(OrbID(path.substr(dot + 1))) : nullptr;
    }

    bool Set(const std::string &path, const char *text, std::string *why = nullptr)
    {
        return In(path)->SetExpression(text, 0, why);
    }

    void Write(const std::string &path, float64 value) { EXPECT_TRUE(In(path)->SetValue(AutoNumber(value), 0.0)); }

    float64 Value(const std::string &path) const { return ValueOf(In(path)); }

    OrbaneDoc doc;
};

struct FollowCase
{
    const char *name;
    std::vector<std::pair<const char *, const char *>> expressions; // set in this order
    std::pair<const char *, float64> write;
    std::map<std::string, float64> expected;
};

TEST(ExpressionGraphTest, ReadersFollowTheInputsTheyNameInDependencyOrder)
{
    const FollowCase cases[] = {
        {"other tool", {{"Merge1.Mix", "Blur1.Size * 2"}}, {"Blur1.Size", 3.0}, {{"Merge1.Mix", 6.0}}},
        {"same tool by id", {{"Blur1.Gain", "Size + 1"}}, {"Blur1.Size", 3.0}, {{"Blur1.Gain", 4.0}}},
        {"chain",
         {{"Blur1.Gain", "Size + 1"}, {"Merge1.Mix", "Blur1.Gain * 10"}, {"Merge1.Angle", "Mix / 2"}},
         {"Blur1.Size", 2.0},
         {{"Blur1.Gain", 3.0}, {"Merge1.Mix", 30.0}, {"Merge1.Angle", 15.0}}},
        {"chain set readers first",
         {{"Merge1.Angle", "Mix / 2"}, {"Merge1.Mix", "Blur1.Gain * 10"}, {"Blur1.Gain", "Size + 1"}},
         {"Blur1.Size", 2.0},
         {{"Blur1.Gain", 3.0}, {"Merge1.Mix", 30.0}, {"Merge1.Angle", 15.0}}},
        {"diamond",
         {{"Blur1.Gain", "Size * 2"}, {"Merge1.Mix", "Blur1.Size + 1"}, {"Merge1.Angle", "Mix + Blur1.Gain"}},
         {"Blur1.Size", 5.0},
         {{"Merge1.Angle", 16.0}}},
        {"unrelated write", {{"Merge1.Mix", "Blur1.Size * 2"}}, {"Blur1.Gain", 9.0}, {{"Merge1.Mix", 2.0}}},
    };
    for (const FollowCase &c : cases) {
        SCOPED_TRACE(c.name);
        Scene s;
        for (const auto &[path, text] : c.expressions) {
            std::string why;
            ASSERT_TRUE(s.Set(path, text, &why)) << why;
            EXPECT_STREQ(s.In(path)->GetExpression(), text);
        }
        s.Write(c.write.first, c.write.second);
        for (const auto &[path, value] : c.expected)
            EXPECT_DOUBLE_EQ(s.Value(path), value) << path;
    }
}

TEST(ExpressionGraphTest, TimeDependentExpressionsFollowEveryTimeChange)
{
    Scene s;
    ASSERT_TRUE(s.Set("Merge1.Mix", "time * 2 + Blur1.Size"));
    ASSERT_TRUE(s.Set("Merge1.Angle", "Mix + 1"));
    std::vector<RecordingWatcher::Call> log;
    RecordingWatcher watcher("angle", log);
    s.In("Merge1.Angle")->AttachWatcher(&watcher);
    for (float64 time : {1.5, 10.0, -3.0, 24.0, 0.0}) {
        s.doc.SetCurrentTime(time);
        EXPECT_DOUBLE_EQ(s.Value("Merge1.Mix"), 2 * time + 1.0) << time;
        EXPECT_DOUBLE_EQ(s.Value("Merge1.Angle"), 2 * time + 2.0) << time;
        ASSERT_FALSE(log.empty());
        EXPECT_DOUBLE_EQ(dynamic_cast<Number *>(log.back().value.get())->Value, 2 * time + 2.0);
    }
    // Time changes are no edits.
    EXPECT_EQ(s.doc.UndoNames().size(), 2);
    s.In("Merge1.Angle")->DetachWatcher(&watcher);
}

struct RefusedCase
{
    const char *name;
    std::vector<std::pair<const char *, const char *>> kept;
    std::pair<const char *, const char *> refused;
    const char *message;
};

TEST(ExpressionGraphTest, RefusedExpressionsSayWhyAndChangeNothing)
{
    const RefusedCase cases[] = {
        {"reads itself", {}, {"Blur1.Size", "Size + 1"}, "cycle: Blur1.Size -> Blur1.Size"},
        {"two Inputs",
         {{"Blur1.Size", "Gain"}},
         {"Blur1.Gain", "Size"},
         "cycle: Blur1.Gain -> Blur1.Size -> Blur1.Gain"},
        {"through three tools' Inputs",
         {{"Blur1.Size", "Merge1.Mix"}, {"Merge1.Mix", "Angle * 2"}},
         {"Merge1.Angle", "Blur1.Size - 1"},
         "cycle: Merge1.Angle -> Blur1.Size -> Merge1.Mix -> Merge1.Angle"},
        {"missing tool", {}, {"Merge1.Mix", "Blur9.Size * 2"}, "no Input \"Blur9.Size\""},
        {"missing Input", {}, {"Merge1.Mix", "Blur1.Radius"}, "no Input \"Blur1.Radius\""},
        {"names are ids, with case", {}, {"Merge1.Mix", "mix + 1"}, "no Input \"mix\""},
        {"does not parse", {}, {"Merge1.Mix", "2 +"}, "Unexpected end of expression"},
        {"not a number", {}, {"Merge1.Mix", "sqrt(-1)"}, "not a number"},
    };
    for (const RefusedCase &c : cases) {
        SCOPED_TRACE(c.name);
        Scene s;
        for (const auto &[path, text] : c.kept)
            ASSERT_TRUE(s.Set(path, text));
        const float64 before = s.Value(c.refused.first);
        const int steps = s.doc.UndoNames().size();
        std::string why;
        EXPECT_FALSE(s.Set(c.refused.first, c.refused.second, &why));
        EXPECT_NE(why.find(c.message), std::string::npos) << why;
        EXPECT_FALSE(s.In(c.refused.first)->HasExpression());
        EXPECT_EQ(s.Value(c.refused.first), before);
        EXPECT_EQ(s.doc.UndoNames().size(), steps);
    }
}

// A cycle can only come in with a tool that brings an expression along; the
// graph marks it on both Inputs and evaluates neither, however often asked.
TEST(ExpressionGraphTest, ACycleBroughtInIsAnErrorOnItsInputsAndNeverAHang)
{
    Scene s;
    // Blur1 of another document reads Merge1.Mix there.
    OrbaneDoc other;
    AutoRef<Operator> blurElsewhere = Scene::AddTool(other, "Blur1", {{"Size", 7.0}});
    Scene::AddTool(other, "Merge1", {{"Mix", 3.0}});
    ASSERT_TRUE(blurElsewhere->FindInput("Size")->SetExpression("Merge1.Mix + 1"));
    ASSERT_TRUE(other.RemoveTool(blurElsewhere));
    // Here Merge1.Mix reads Blur1.Size; when Blur1 goes, it keeps its value
    // and says why.
    ASSERT_TRUE(s.Set("Merge1.Mix", "Blur1.Size * 2"));
    ASSERT_TRUE(s.doc.RemoveTool(s.doc.FindTool("Blur1")));
    EXPECT_STREQ(s.In("Merge1.Mix")->GetExpressionError(), "no Input \"Blur1.Size\"");
    EXPECT_EQ(s.Value("Merge1.Mix"), 2.0);

    ASSERT_TRUE(s.doc.AddTool(blurElsewhere));
    ASSERT_TRUE(s.Set("Merge1.Angle", "Mix + 1"));
    const std::string cycle = "cycle: ";
    EXPECT_EQ(std::string(s.In("Blur1.Size")->GetExpressionError()).rfind(cycle, 0), 0u);
    EXPECT_EQ(std::string(s.In("Merge1.Mix")->GetExpressionError()).rfind(cycle, 0), 0u);
    EXPECT_STREQ(s.In("Merge1.Angle")->GetExpressionError(), "reads a cycle through Merge1.Mix");
    s.doc.SetCurrentTime(5.0);
    s.Write("Merge1.Angle", 1.0);
    EXPECT_EQ(s.Value("Blur1.Size"), 4.0); // Mix there was 3
    EXPECT_EQ(s.Value("Merge1.Mix"), 2.0);

    // Breaking the cycle lets the other side evaluate at once.
    ASSERT_TRUE(s.Set("Blur1.Size", ""));
    EXPECT_STREQ(s.In("Merge1.Mix")->GetExpressionError(), "");
    EXPECT_EQ(s.Value("Merge1.Mix"), 8.0);
    ASSERT_TRUE(s.Set("Merge1.Angle", "Mix + 1"));
    s.Write("Blur1.Size", 5.0);
    EXPECT_EQ(s.Value("Merge1.Angle"), 11.0);
}

TEST(ExpressionGraphTest, UndoRestoresTheExpressionAndTheValueExactly)
{
    Scene s;
    ASSERT_TRUE(s.Set("Merge1.Mix", "Blur1.Size * 2"));
    EXPECT_EQ(s.doc.UndoNames(), QStringList{"Expression Mix"});
    EXPECT_EQ(s.Value("Merge1.Mix"), 2.0);
    s.Write("Blur1.Size", 4.0);
    EXPECT_EQ(s.Value("Merge1.Mix"), 8.0);
    // A user's write takes the Input over, in one step.
    s.Write("Merge1.Mix", 0.75);
    EXPECT_FALSE(s.In("Merge1.Mix")->HasExpression());
    EXPECT_EQ(s.doc.UndoNames().size(), 3);

    const std::vector<std::pair<const char *, float64>> back = {
        {"Blur1.Size * 2", 8.0}, // the write undone: the expression is back
        {"Blur1.Size * 2", 2.0}, // Size back to 1: Mix follows
        {"", 0.25},              // the expression undone: the value before it
    };
    for (const auto &[expression, value] : back) {
        ASSERT_TRUE(s.doc.Undo());
        EXPECT_STREQ(s.In("Merge1.Mix")->GetExpression(), expression);
        EXPECT_EQ(s.Value("Merge1.Mix"), value);
    }
    ASSERT_TRUE(s.doc.Redo());
    ASSERT_TRUE(s.doc.Redo());
    EXPECT_STREQ(s.In("Merge1.Mix")->GetExpression(), "Blur1.Size * 2");
    EXPECT_EQ(s.Value("Merge1.Mix"), 8.0);
    // Removing is an undo step too; undo brings the expression back live.
    ASSERT_TRUE(s.Set("Merge1.Mix", ""));
    s.Write("Blur1.Size", 1.5);
    EXPECT_EQ(s.Value("Merge1.Mix"), 8.0);
    ASSERT_TRUE(s.doc.Undo());
    ASSERT_TRUE(s.doc.Undo());
    EXPECT_STREQ(s.In("Merge1.Mix")->GetExpression(), "Blur1.Size * 2");
    s.Write("Blur1.Size", 1.5);
    EXPECT_EQ(s.Value("Merge1.Mix"), 3.0);
}

TEST(ExpressionGraphTest, AnimatedAndNonNumberInputsTakeNoExpression)
{
    Scene s;
    AutoRef<Operator> text(new Operator("Text1", "Tool"));
    Input *caption = text->AddInput("Caption", "Caption", CLSID_DataType_Text, {}, AutoParam<Text>("hi"));
    ASSERT_TRUE(s.doc.AddTool(text));
    std::string why;
    EXPECT_FALSE(caption->SetExpression("1", 0, &why));
    EXPECT_NE(why.find("holds no number"), std::string::npos);
    EXPECT_FALSE(s.Set("Merge1.Mix", "Text1.Caption", &why));
    EXPECT_NE(why.find("holds no number"), std::string::npos);
    s.In("Blur1.Gain")->SetAnimated(true);
    EXPECT_FALSE(s.Set("Blur1.Gain", "time", &why));
    EXPECT_NE(why.find("animated"), std::string::npos);
    // Animated after the expression was set: the keys win, and it says so.
    ASSERT_TRUE(s.Set("Merge1.Mix", "time"));
    s.In("Merge1.Mix")->SetAnimated(true);
    s.doc.SetCurrentTime(3.0);
    EXPECT_STREQ(s.In("Merge1.Mix")->GetExpressionError(), "animated: its keys set the value");
    EXPECT_EQ(s.Value("Merge1.Mix"), 0.0);
}

} // namespace
} // namespace Orbane
