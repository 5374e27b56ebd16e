#include "orbane/SelMask.h"

#include <gtest/gtest.h>

#include <ostream>
#include <string>
#include <vector>

namespace Orbane {
namespace {

// Parameter rows print as their names in test output.
template <typename Row> auto operator<<(std::ostream &os, const Row &row) -> decltype(row.name, os)
{
    return os << row.name;
}

// Builds a mask from a picture: '1' selected, '.' not, any digit a state.
SelMask maskOf(const std::string &picture)
{
    SelMask m(int32(picture.size()));
    for (int32 i = 0; i < int32(picture.size()); ++i) {
        if (picture[i] != '.')
            m.SetState(i, uint8(picture[i] - '0'));
    }
    return m;
}

std::string pictureOf(const SelMask &m)
{
    std::string s;
    for (int32 i = 0; i < m.GetCount(); ++i)
        s += m[i] ? char('0' + m[i]) : '.';
    return s;
}

TEST(SelMask, CreateGivesAnEmptySelection)
{
    SelMask m;
    EXPECT_EQ(m.GetCount(), 0);
    ASSERT_TRUE(m.Create(5));
    EXPECT_EQ(pictureOf(m), ".....");
    EXPECT_EQ(m.GetSetCount(), 0);
    EXPECT_FALSE(m.Create(-1));
    EXPECT_EQ(m.GetCount(), 5) << "a bad count changes nothing";
    m.Set(2, true);
    ASSERT_TRUE(m.Create(3));
    EXPECT_EQ(pictureOf(m), "...") << "re-creating clears";
}

TEST(SelMask, SetReportsRealChangesOnly)
{
    SelMask m(4);
    EXPECT_TRUE(m.Set(1, true));
    EXPECT_FALSE(m.Set(1, true));
    EXPECT_FALSE(m.Set(7, true));
    EXPECT_FALSE(m.Set(-1, true));
    EXPECT_EQ(m[1], SelMask::Selected);
    EXPECT_EQ(m[7], SelMask::Clear);
    EXPECT_TRUE(m.Set(1, false));
    EXPECT_FALSE(m.Set(1, false));
    EXPECT_EQ(m.GetSetCount(), 0);
}

TEST(SelMask, ResetClearsAndKeepsTheCount)
{
    SelMask m = maskOf("1.2.1");
    EXPECT_TRUE(m.Reset());
    EXPECT_EQ(pictureOf(m), ".....");
    EXPECT_FALSE(m.Reset()) << "already empty";
}

struct DoSetCase
{
    const char *name;
    const char *before;
    int32 index;
    SelMask::SelOp op;
    const char *after;
    bool changed;
};

class SelMaskDoSet : public testing::TestWithParam<DoSetCase>
{
};

TEST_P(SelMaskDoSet, ChangesOneItemAsAsked)
{
    const DoSetCase &c = GetParam();
    SelMask m = maskOf(c.before);
    EXPECT_EQ(m.DoSet(c.index, c.op), c.changed);
    EXPECT_EQ(pictureOf(m), c.after);
}

const DoSetCase DoSetCases[] = {
    {"SetAdds", "2...", 2, SelMask::SEL_Set, "2.2.", true},
    {"SetKeepsAnExistingState", "1...", 0, SelMask::SEL_Set, "1...", false},
    {"ClearRemoves", "2.2.", 0, SelMask::SEL_Clear, "..2.", true},
    {"ToggleOn", "2...", 3, SelMask::SEL_Toggle, "2..2", true},
    {"ToggleOff", "2..4", 3, SelMask::SEL_Toggle, "2...", true},
    {"OnlyReplacesTheSelection", "22.2", 2, SelMask::SEL_Only, "..2.", true},
    {"OnlyKeepsTheItemsState", "4.1.", 2, SelMask::SEL_Only, "..1.", true},
    {"OnlyOnTheOnlyItemIsNoChange", "..2.", 2, SelMask::SEL_Only, "..2.", false},
    {"OutOfRange", "2...", 9, SelMask::SEL_Only, "2...", false},
};

INSTANTIATE_TEST_SUITE_P(Ops, SelMaskDoSet, testing::ValuesIn(DoSetCases),
                         [](const testing::TestParamInfo<DoSetCase> &info) { return std::string(info.param.name); });

struct QueryCase
{
    const char *name;
    const char *picture;
    int32 setCount;
    std::vector<int32> setItems; // GetSetItem(0), GetSetItem(1), ...
    int32 single;
    bool all;
    bool multi;
};

class SelMaskQueries : public testing::TestWithParam<QueryCase>
{
};

TEST_P(SelMaskQueries, AnswerFromTheSelection)
{
    const QueryCase &c = GetParam();
    SelMask m = maskOf(c.picture);
    EXPECT_EQ(m.GetSetCount(), c.setCount);
    for (int32 n = 0; n < int32(c.setItems.size()); ++n)
        EXPECT_EQ(m.GetSetItem(n), c.setItems[n]) << "item " << n;
    EXPECT_EQ(m.GetSetItem(int32(c.setItems.size())), -1) << "one past the last";
    EXPECT_EQ(m.GetSetItem(-2), -1);
    EXPECT_EQ(m.GetSingleSetItem(), c.single);
    EXPECT_EQ(m.GetSetItem(-1), c.single);
    EXPECT_EQ(m.IsAllSet(), c.all);
    EXPECT_EQ(m.IsMultiSet(), c.multi);
}

const QueryCase QueryCases[] = {
    {"Empty", "", 0, {}, -1, false, false},
    {"NoneSelected", "....", 0, {}, -1, false, false},
    {"OneSelected", "..2.", 1, {2}, 2, false, false},
    {"OneOfOne", "2", 1, {0}, 0, true, false},
    {"TwoSelected", "2..1", 2, {0, 3}, -1, false, true},
    {"AllSelectedInMixedStates", "2142", 4, {0, 1, 2, 3}, -1, true, true},
};

INSTANTIATE_TEST_SUITE_P(Selections, SelMaskQueries, testing::ValuesIn(QueryCases),
                         [](const testing::TestParamInfo<QueryCase> &info) { return std::string(info.param.name); });

struct ShiftCase
{
    const char *name;
    const char *before;
    int32 offset;
    bool wrap;
    const char *after;
    bool changed;
};

class SelMaskShift : public testing::TestWithParam<ShiftCase>
{
};

TEST_P(SelMaskShift, MovesTheStates)
{
    const ShiftCase &c = GetParam();
    SelMask m = maskOf(c.before);
    EXPECT_EQ(m.ShiftSet(c.offset, c.wrap), c.changed);
    EXPECT_EQ(pictureOf(m), c.after);
    EXPECT_EQ(m.GetSetCount(), maskOf(c.after).GetSetCount());
}

const ShiftCase ShiftCases[] = {
    {"UpOne", "21...", 1, false, ".21..", true},
    {"DownOne", "..12.", -1, false, ".12..", true},
    {"PastTheEndIsDropped", "...12", 1, false, "....1", true},
    {"WrapsRound", "...12", 1, true, "2...1", true},
    {"WrapsBackwards", "1...2", -2, true, "..21.", true},
    {"FullTurnIsNoChange", ".1.2.", 5, true, ".1.2.", false},
    {"NothingSelected", ".....", 2, true, ".....", false},
    {"AllSelectedAndWrapping", "22222", 3, true, "22222", false},
    {"FarPastTheEnd", "21...", 40, false, ".....", true},
};

INSTANTIATE_TEST_SUITE_P(Shifts, SelMaskShift, testing::ValuesIn(ShiftCases),
                         [](const testing::TestParamInfo<ShiftCase> &info) { return std::string(info.param.name); });

TEST(SelMask, RestoreBringsBackTheBackedUpSelection)
{
    SelMask m = maskOf(".2.1.");
    EXPECT_FALSE(m.RestoreMask()) << "nothing backed up yet";
    m.BackupMask();
    m.DoSet(4, SelMask::SEL_Only);
    m.Create(8);
    ASSERT_TRUE(m.RestoreMask());
    EXPECT_EQ(pictureOf(m), ".2.1.");
    EXPECT_EQ(m.GetSetCount(), 2);
    m.Reset();
    EXPECT_TRUE(m.RestoreMask()) << "the backup stays for another restore";
    EXPECT_EQ(pictureOf(m), ".2.1.");
}

struct AbsoluteCase
{
    int32 count;
    int32 index;
    int32 expected;
};

void PrintTo(const AbsoluteCase &row, std::ostream *os)
{
    *os << "index " << row.index << " of " << row.count;
}

class SelMaskAbsolute : public testing::TestWithParam<AbsoluteCase>
{
};

TEST_P(SelMaskAbsolute, WrapsIndicesIntoRange)
{
    SelMask m(GetParam().count);
    EXPECT_EQ(m.GetAbsolute(GetParam().index), GetParam().expected);
}

INSTANTIATE_TEST_SUITE_P(Indices, SelMaskAbsolute,
                         testing::Values(AbsoluteCase{5, 2, 2}, AbsoluteCase{5, 5, 0}, AbsoluteCase{5, -1, 4},
                                         AbsoluteCase{5, -11, 4}, AbsoluteCase{5, 17, 2}, AbsoluteCase{0, 3, -1}));

struct SegmentCase
{
    const char *name;
    const char *picture;
    bool closed;
    std::vector<int32> segments;
    int32 single;
};

class SelMaskSegments : public testing::TestWithParam<SegmentCase>
{
};

TEST_P(SelMaskSegments, FindSegmentsWithBothEndsSelected)
{
    const SegmentCase &c = GetParam();
    SelMask m = maskOf(c.picture);
    for (int32 n = 0; n < int32(c.segments.size()); ++n)
        EXPECT_EQ(m.GetSegment(n, c.closed), c.segments[n]) << "segment " << n;
    EXPECT_EQ(m.GetSegment(int32(c.segments.size()), c.closed), -1);
    EXPECT_EQ(m.GetSingleSetSegment(c.closed), c.single);
}

const SegmentCase SegmentCases[] = {
    {"Neighbours", ".22..", false, {1}, 1},
    {"NotNeighbours", "2.2..", false, {}, -1},
    {"LastAndFirstOpen", "2...2", false, {}, -1},
    {"LastAndFirstClosed", "2...2", true, {4}, 4},
    {"RunOfThree", ".222.", false, {1, 2}, -1},
    {"AllClosed", "222", true, {0, 1, 2}, -1},
    {"TwoItemsClosedHaveOneSegment", "22", true, {0}, 0},
};

INSTANTIATE_TEST_SUITE_P(Shapes, SelMaskSegments, testing::ValuesIn(SegmentCases),
                         [](const testing::TestParamInfo<SegmentCase> &info) { return std::string(info.param.name); });

} // namespace
} // namespace Orbane
