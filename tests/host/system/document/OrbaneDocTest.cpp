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

TEST(OrbaneDocTest, TimeChangeRetellsEveryInputAndPrefsSignalTheirChange)
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
    doc.SetCurrentTime(2.5);
    ASSERT_EQ(changed.count(), 1);
    EXPECT_EQ(changed.at(0).at(0).toDouble(), 2.5);
    ASSERT_EQ(log.size(), 2u);
    EXPECT_EQ(log[0].who + log[1].who, "ab");
    EXPECT_DOUBLE_EQ(dynamic_cast<Number *>(log[0].value.get())->Value, 2.5);
    animated->DetachWatcher(&wa);
    b->FindInput("Blend")->DetachWatcher(&wb);

    EXPECT_FALSE(doc.GetPrefs().GetBool(PREF_SelectPointsFromMultiPolies, true));
    QSignalSpy pref(&doc, SIGNAL(prefChanged(uint32)));
    doc.SetPref(PREF_SelectPointsFromMultiPolies, true);
    EXPECT_TRUE(doc.GetPrefs().GetBool(PREF_SelectPointsFromMultiPolies));
    ASSERT_EQ(pref.count(), 1);
    EXPECT_EQ(pref.at(0).at(0).toUInt(), uint32(PREF_SelectPointsFromMultiPolies));
}

TEST(OrbaneDocTest, MapPathReplacesKnownPrefixesInAnyCase)
{
    OrbaneDoc doc;
    doc.SetPathMap("Scripts", "/opt/orbane/scripts");
    doc.SetPathMap("Looks", "/opt/orbane/looks/");
    const std::pair<const char *, const char *> cases[] = {
        {"Scripts:Tool/blur.lua", "/opt/orbane/scripts/Tool/blur.lua"},
        {"scripts:x.lua", "/opt/orbane/scripts/x.lua"},
        {"Looks:default", "/opt/orbane/looks/default"},
        {"Comps:a.comp", "Comps:a.comp"},
    };
    for (const auto &[path, mapped] : cases)
        EXPECT_EQ(doc.MapPath(path).str(), mapped);
}

} // namespace
} // namespace Orbane
