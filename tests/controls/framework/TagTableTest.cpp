// The published "Create" tag tables: their shape, the rows named by the
// controls' documentation, and the enumerations.

#include "ExpectedClasses.h"

#include "orbane/FFITagMap.h"
#include "orbane/FFIType.h"
#include "orbane/TagMapEntry.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <vector>

namespace Orbane {
namespace Test {
namespace {

const TagMapEntry *TableOf(const char *scriptType)
{
    const FFITagMap *map = FFITagMap::ForType(FFIType::FindScriptName(scriptType));
    return map ? map->Table() : nullptr;
}

const TagMapEntry *Row(const char *scriptType, const std::string &name)
{
    for (const TagMapEntry *row = TableOf(scriptType); row && row->name; ++row)
        if (name == row->name)
            return row;
    return nullptr;
}

std::vector<const char *> PublishedScriptTypes()
{
    std::vector<const char *> types;
    for (const ExpectedClass &row : ExpectedClasses())
        if (row.script && row.tagNamesKnown && row.tags > 0)
            types.push_back(row.script);
    return types;
}

class TableShape : public testing::TestWithParam<const char *>
{
};

TEST_P(TableShape, RowsAreWellFormed)
{
    const TagMapEntry *table = TableOf(GetParam());
    ASSERT_NE(table, nullptr);
    std::set<std::string> names;
    for (const TagMapEntry *row = table; row->name; ++row) {
        SCOPED_TRACE(row->name);
        EXPECT_TRUE(names.insert(row->name).second) << "named twice";
        EXPECT_LE(row->tag, 0xFFFFFFFFull);
        EXPECT_GE(row->kind, TMK_Plain);
        EXPECT_LE(row->kind, TMK_Color);
        EXPECT_EQ(row->reserved, nullptr);
        const uint32 type = TagTypeOf(Tag(row->tag));
        switch (row->kind) {
        case TMK_Boolean:
        case TMK_Color:
            EXPECT_EQ(type, TAGTYPE_Long);
            EXPECT_EQ(row->extra, nullptr);
            break;
        case TMK_Enumeration:
            EXPECT_EQ(type, TAGTYPE_Long);
            EXPECT_NE(row->extra, nullptr);
            break;
        case TMK_Object:
            EXPECT_TRUE(type == TAGTYPE_Object || type == TAGTYPE_Ptr);
            EXPECT_STREQ(static_cast<const char *>(row->extra), "Input");
            break;
        default:
            EXPECT_EQ(row->extra, nullptr);
        }
    }
}

std::string TypeName(const testing::TestParamInfo<const char *> &info)
{
    return info.param;
}

INSTANTIATE_TEST_SUITE_P(Library, TableShape, testing::ValuesIn(PublishedScriptTypes()), TypeName);

struct RowCase
{
    const char *scriptType;
    const char *name;
    uint64 tag;
    int32 kind;
};

class PublishedRows : public testing::TestWithParam<RowCase>
{
};

TEST_P(PublishedRows, RowHasItsIdAndKind)
{
    const RowCase &c = GetParam();
    const TagMapEntry *row = Row(c.scriptType, c.name);
    ASSERT_NE(row, nullptr) << c.scriptType << " " << c.name;
    EXPECT_EQ(row->tag, c.tag) << c.name;
    EXPECT_EQ(row->kind, c.kind) << c.name;
}

INSTANTIATE_TEST_SUITE_P(Library, PublishedRows,
                         testing::Values(RowCase{"CheckboxControl", "CBC_TriState", 0x10050000, TMK_Boolean},
                                         RowCase{"ButtonControl", "BTNC_Align", 0x10050000, TMK_Enumeration},
                                         RowCase{"ButtonControl", "BTNCS_Execute", 0x30050000, TMK_Plain},
                                         RowCase{"ComboControl", "CC_LabelPosition", 0x10050000, TMK_Enumeration},
                                         RowCase{"ComboControl", "CC_AlphaSort", 0x10050001, TMK_Boolean},
                                         RowCase{"ComboControl", "CCS_AddString", 0x38040000, TMK_Plain},
                                         RowCase{"ComboIDControl", "CCS_AddSeparator", 0x38040001, TMK_Plain},
                                         RowCase{"ComboIDControl", "CCID_AddID", 0x88030000, TMK_Plain},
                                         RowCase{"ScriptValListControl", "LC_Rows", 0x10050000, TMK_Plain},
                                         RowCase{"ScriptValListControl", "LC_AlphaSort", 0x10050001, TMK_Boolean},
                                         RowCase{"ScriptValListControl", "ICS_AddString", 0x38040000, TMK_Plain},
                                         RowCase{"ScriptValListControl", "INPID_AddID", 0x88030000, TMK_Plain},
                                         RowCase{"SliderControl", "IC_TickFreq", 0x10050000, TMK_Plain},
                                         RowCase{"SliderControl", "SLCS_LowName", 0x30050000, TMK_Plain},
                                         RowCase{"SliderControl", "SLCS_HighName", 0x30050002, TMK_Plain},
                                         RowCase{"PointControl", "PCID_PrevPoint", 0x80058000, TMK_Plain},
                                         RowCase{"PointControl", "PCD_SetPrevPointY", 0x20058001, TMK_Plain},
                                         RowCase{"CrosshairControl", "CHC_Style", 0x10058000, TMK_Plain},
                                         RowCase{"CrosshairControl", "CHCD_CurrentY", 0x20058005, TMK_Plain},
                                         RowCase{"RectangleControl", "RC_DoLockAspect", 0x10058001, TMK_Boolean},
                                         RowCase{"RectangleControl", "RCD_SetAxisY", 0x20058009, TMK_Plain},
                                         RowCase{"RectangleControl", "RCID_AxisY", 0x8005800a, TMK_Plain},
                                         RowCase{"RectangleControl", "RCP_FlipX", 0x60058005, TMK_Object},
                                         RowCase{"AngleControl", "ACD_CurrentAngle", 0x20058005, TMK_Plain},
                                         RowCase{"AngleControl", "ACP_CenterZ", 0x60058004, TMK_Object},
                                         RowCase{"PolylineControl", "PLC_HandleColor", 0x1005800D, TMK_Color},
                                         RowCase{"PolylineControl", "PLC_ShowKeyPoints", 0x10058009, TMK_Boolean},
                                         RowCase{"PolylineControl", "PLC_ShowTaggedPointIDs", 0x10058015, TMK_Plain},
                                         RowCase{"PolylineControl", "PLCP_InPolyLine2", 0x60058008, TMK_Object},
                                         RowCase{"PolylineControl", "PLCID_TrackerSize", 0x8005800D, TMK_Plain},
                                         RowCase{"PolylineControl", "PLCD_SetTrackerSearchSize", 0x20058007,
                                                 TMK_Plain}));

struct EnumCase
{
    const char *scriptType;
    const char *tagName;
    const char *enumName;
    std::vector<std::string> values; // value i is named values[i]
};

class PublishedEnumerations : public testing::TestWithParam<EnumCase>
{
};

TEST_P(PublishedEnumerations, TableNamesEveryValueInOrder)
{
    const EnumCase &c = GetParam();
    const TagMapEntry *row = Row(c.scriptType, c.tagName);
    ASSERT_NE(row, nullptr);
    const auto *entry = static_cast<const EnumEntry *>(row->extra);
    ASSERT_NE(entry, nullptr);
    EXPECT_EQ(entry->value, ENUM_NameRow);
    EXPECT_STREQ(entry->name, c.enumName);
    std::vector<std::string> names;
    for (++entry; entry->name; ++entry) {
        EXPECT_EQ(entry->value, int64(names.size()));
        names.push_back(entry->name);
    }
    EXPECT_EQ(names, c.values);
}

INSTANTIATE_TEST_SUITE_P(
    Library, PublishedEnumerations,
    testing::Values(
        EnumCase{"ButtonControl", "BTNC_Align", "Align", {"Left", "CenteredLeft", "Center", "CenteredRight", "Right"}},
        EnumCase{"ComboControl", "CC_LabelPosition", "LabelPosition", {"Horizontal", "Vertical"}}));

TEST(TagTables, VariantsShareTheirPrimarysTable)
{
    EXPECT_EQ(TableOf("ComboIDControl"), TableOf("ComboControl"));
    EXPECT_EQ(TableOf("ListIDControl"), TableOf("ListControl"));
    EXPECT_EQ(TableOf("ScriptValListControl"), TableOf("ListControl"));
}

} // namespace
} // namespace Test
} // namespace Orbane
