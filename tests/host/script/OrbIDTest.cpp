#include "orbane/OrbID.h"
#include "orbane/ClassIDs.h"
#include "orbane/OrbColor.h"
#include "orbane/OrbString.h"

#include <gtest/gtest.h>

#include <string>

namespace Orbane {

TEST(OrbID, EqualTextsShareOneInternedPointer)
{
    const std::string built = std::string("Check") + "boxControl";
    const OrbID a("CheckboxControl");
    const OrbID b(built);
    EXPECT_EQ(a.Key(), b.Key());
    EXPECT_EQ(a, b);
    EXPECT_EQ(a, CLSID_InputControl_Checkbox);
    EXPECT_NE(OrbID("CheckBoxControl"), CLSID_InputControl_Checkbox);
    EXPECT_NE(a.c_str(), built.c_str());
}

TEST(OrbID, EmptyIdentifiersAreAllEqual)
{
    EXPECT_TRUE(OrbID().IsEmpty());
    EXPECT_TRUE(OrbID("").IsEmpty());
    EXPECT_TRUE(OrbID(static_cast<const char *>(nullptr)).IsEmpty());
    EXPECT_EQ(OrbID(""), OrbID());
    EXPECT_STREQ(OrbID().c_str(), "");
    EXPECT_FALSE(OrbID("x").IsEmpty());
}

TEST(OrbID, ComparesWithTextAndSortsByText)
{
    EXPECT_TRUE(OrbID("Slider") == "Slider");
    EXPECT_TRUE(OrbID("Slider") != "slider");
    EXPECT_TRUE(OrbID() == "");
    EXPECT_TRUE(OrbID() == nullptr);
    EXPECT_LT(OrbID("Apple"), OrbID("Banana"));
    EXPECT_FALSE(OrbID("Banana") < OrbID("Apple"));
    EXPECT_EQ(std::hash<OrbID>()(OrbID("Same")), std::hash<OrbID>()(OrbID(std::string("Same"))));
}

TEST(ClassIDs, HaveTheTextsToolsAskFor)
{
    const std::pair<OrbID, const char *> ids[] = {
        {CLSID_InputControl_Checkbox, "CheckboxControl"},
        {CLSID_InputControl_Combo, "ComboControl"},
        {CLSID_InputControl_ComboID, "ComboIDControl"},
        {CLSID_InputControl_Label, "LabelControl"},
        {CLSID_InputControl_Nest, "NestControl"},
        {CLSID_InputControl_Separator, "SeparatorControl"},
        {CLSID_InputControl_Spacer, "SpacerControl"},
        {CLSID_InputControl_List, "ListControl"},
        {CLSID_InputControl_ListID, "ListIDControl"},
        {CLSID_InputControl_MultiButton, "MultiButtonControl"},
        {CLSID_InputControl_MultiButtonID, "MultiButtonIDControl"},
        {CLSID_InputControl_Slider, "SliderControl"},
        {CLSID_PreviewControl_Crop, "CropControl"},
        {CLSID_DataType_Number, "Number"},
        {CLSID_DataType_Point, "Point"},
        {CLSID_DataType_Text, "Text"},
        {CLSID_DataType_ID, "ID"},
        {CLSID_DataType_PolyLine, "PolyLine"},
        {CLSID_DataType_ScriptVal, "ScriptVal"},
    };
    for (const auto &[id, text] : ids) {
        SCOPED_TRACE(text);
        EXPECT_EQ(id, OrbID(text));
    }
}

TEST(OrbColor, PacksChannelsAsABGR)
{
    const OrbColor c(0x11, 0x22, 0x33, 0x44);
    EXPECT_EQ(c.Packed(), 0x44332211u);
    EXPECT_EQ(c.R(), 0x11);
    EXPECT_EQ(c.G(), 0x22);
    EXPECT_EQ(c.B(), 0x33);
    EXPECT_EQ(c.A(), 0x44);
    EXPECT_EQ(OrbColor(1, 2, 3).A(), 255);
    EXPECT_TRUE(OrbColor().IsNone());
    EXPECT_FALSE(OrbColor(255, 255, 255, 254).IsNone());
    EXPECT_TRUE(OrbColor(255, 255, 255, 255).IsNone());
}

TEST(OrbString, IsAnOwnedTextValue)
{
    std::string source = "label";
    const OrbString s(source.c_str());
    source[0] = 'L';
    EXPECT_STREQ(s.c_str(), "label");
    EXPECT_EQ(s.Length(), 5u);
    EXPECT_TRUE(OrbString(static_cast<const char *>(nullptr)).IsEmpty());
    EXPECT_LT(OrbString("a"), OrbString("b"));
}

} // namespace Orbane
