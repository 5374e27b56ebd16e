#include "RecordingWatcher.h"

#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"

#include <QSignalSpy>

#include <gtest/gtest.h>

namespace Orbane {
namespace {

AutoRef<Operator> MakeTool(const char *name)
{
    AutoRef<Operator> tool(new Operator(name, "Blur"));
    tool->AddInput("Blend", "Blend", CLSID_DataType_Number, {}, AutoNumber(0.0));
    return tool;
}

TEST(OrbaneDocTest, AddsFindsAndRemovesTools)
{
    OrbaneDoc doc;
    QSignalSpy added(&doc, SIGNAL(toolAdded(Orbane::Operator *)));
    AutoRef<Operator> a = MakeTool("Blur1"), b = MakeTool("Blur2"), clash = MakeTool("Blur1");

    EXPECT_TRUE(doc.AddTool(a));
    EXPECT_TRUE(doc.AddTool(b));
    EXPECT_FALSE(doc.AddTool(a));
    EXPECT_FALSE(doc.AddTool(clash));
    EXPECT_FALSE(doc.AddTool(nullptr));
    EXPECT_EQ(added.count(), 2);
    EXPECT_EQ(a->RefCount(), 2);
    EXPECT_EQ(doc.Tools(), (std::vector<Operator *>{a, b}));
    EXPECT_EQ(doc.FindTool("Blur2"), b.get());

    // While its removal is signalled, the tool is still there.
    std::vector<Operator *> removing;
    QObject::connect(&doc, &OrbaneDoc::toolRemoving,
                     [&](Operator *t) { removing.push_back(doc.FindTool(t->GetName())); });
    EXPECT_TRUE(doc.RemoveTool(a));
    EXPECT_FALSE(doc.RemoveTool(a));
    EXPECT_EQ(removing, std::vector<Operator *>{a});
    EXPECT_EQ(a->GetDoc(), nullptr);
    EXPECT_EQ(a->RefCount(), 1);
    EXPECT_EQ(doc.Tools(), std::vector<Operator *>{b});
}

TEST(OrbaneDocTest, TimeChangeRetellsEveryInput)
{
    OrbaneDoc doc;
    AutoRef<Operator> a = MakeTool("Blur1"), b = MakeTool("Blur2");
    doc.AddTool(a);
    doc.AddTool(b);
    Input *animated = a->FindInput("Blend");
    animated->SetAnimated(true);
    ASSERT_TRUE(animated->SetValue(AutoNumber(10.0), 10.0, SETVALUE_NoUndo));

    std::vector<RecordingWatcher::Call> log;
    RecordingWatcher wa("a", log), wb("b", log);
    animated->AttachWatcher(&wa);
    b->FindInput("Blend")->AttachWatcher(&wb);
    QSignalSpy changed(&doc, SIGNAL(currentTimeChanged(float64)));

    doc.SetCurrentTime(2.5);
    ASSERT_EQ(changed.count(), 1);
    EXPECT_EQ(changed.at(0).at(0).toDouble(), 2.5);
    ASSERT_EQ(log.size(), 2u);
    EXPECT_EQ(log[0].who, "a");
    EXPECT_DOUBLE_EQ(dynamic_cast<Number *>(log[0].value.get())->Value, 2.5);
    EXPECT_EQ(log[1].who, "b");

    doc.SetCurrentTime(2.5);
    EXPECT_EQ(changed.count(), 1);
    EXPECT_EQ(log.size(), 2u);
    animated->DetachWatcher(&wa);
    b->FindInput("Blend")->DetachWatcher(&wb);
}

TEST(OrbaneDocTest, PreferencesHaveDefaultsAndSignalChanges)
{
    OrbaneDoc doc;
    EXPECT_FALSE(doc.GetPrefs().GetBool(PREF_SelectPointsFromMultiPolies, true));
    QSignalSpy changed(&doc, SIGNAL(prefChanged(uint32)));
    doc.SetPref(PREF_SelectPointsFromMultiPolies, true);
    EXPECT_TRUE(doc.GetPrefs().GetBool(PREF_SelectPointsFromMultiPolies));
    ASSERT_EQ(changed.count(), 1);
    EXPECT_EQ(changed.at(0).at(0).toUInt(), uint32(PREF_SelectPointsFromMultiPolies));
}

struct PathCase
{
    const char *name;
    const char *path;
    const char *mapped;
};

class MapPathTest : public testing::TestWithParam<PathCase>
{
};

TEST_P(MapPathTest, MapsKnownPrefixes)
{
    OrbaneDoc doc;
    doc.SetPathMap("Scripts", "/opt/orbane/scripts");
    doc.SetPathMap("Looks", "/opt/orbane/looks/");
    EXPECT_EQ(doc.MapPath(GetParam().path).str(), GetParam().mapped);
}

INSTANTIATE_TEST_SUITE_P(Paths, MapPathTest,
                         testing::Values(PathCase{"Prefix", "Scripts:Tool/blur.lua",
                                                  "/opt/orbane/scripts/Tool/blur.lua"},
                                         PathCase{"PrefixInOtherCase", "scripts:x.lua", "/opt/orbane/scripts/x.lua"},
                                         PathCase{"FolderWithSlash", "Looks:default", "/opt/orbane/looks/default"},
                                         PathCase{"UnknownPrefix", "Comps:a.comp", "Comps:a.comp"}),
                         [](const auto &info) { return std::string(info.param.name); });

} // namespace
} // namespace Orbane
