#include "orbane/SelMask.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <ostream>
#include <string>

namespace Orbane {
namespace {

// A mask as a picture: '.' not selected, a digit the item's state.
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

// One call on a mask: what it answers (a change flag as 0 or 1) and the
// mask it leaves (null: the same as before).
struct OpCase
{
    const char *name;
    const char *before;
    std::function<int32(SelMask &)> op;
    const char *after;
    int32 result;
};

std::ostream &operator<<(std::ostream &os, const OpCase &c)
{
    return os << c.name;
}

using SelMaskOps = testing::TestWithParam<OpCase>;

TEST_P(SelMaskOps, AnswerAndLeaveTheMask)
{
    const OpCase &c = GetParam();
    SelMask m = maskOf(c.before);
    EXPECT_EQ(c.op(m), c.result);
    const std::string after = c.after ? c.after : c.before;
    EXPECT_EQ(pictureOf(m), after);
    EXPECT_EQ(m.GetSetCount(), int32(after.size() - std::count(after.begin(), after.end(), '.'))) << "the kept count";
}

std::function<int32(SelMask &)> doSet(int32 i, SelMask::SelOp op)
{
    return [=](SelMask &m) { return m.DoSet(i, op); };
}

std::function<int32(SelMask &)> shift(int32 offset, bool wrap)
{
    return [=](SelMask &m) { return m.ShiftSet(offset, wrap); };
}

std::function<int32(SelMask &)> segment(int32 n, bool closed)
{
    return [=](SelMask &m) { return m.GetSegment(n, closed); };
}

// clang-format off
const OpCase OpCases[] = {
    // Changes
    {"CreateClears", "1.2", [](SelMask &m) { return m.Create(5); }, ".....", 1},
    {"InsertKeepsStatesOnTheirItems", "1.2", [](SelMask &m) { return m.InsertItem(1, 4); }, "14.2", 1},
    {"InsertAppends", "1.", [](SelMask &m) { return m.InsertItem(2); }, "1..", 1},
    {"InsertOutOfRange", "1.", [](SelMask &m) { return m.InsertItem(3); }, nullptr, 0},
    {"RemoveSetItemsLeavesTheOthers", "1.2..", [](SelMask &m) { return m.RemoveSetItems(); }, "...", 1},
    {"RemoveWithNothingSet", "...", [](SelMask &m) { return m.RemoveSetItems(); }, nullptr, 0},
    {"CreateRefusesANegativeCount", "1.2", [](SelMask &m) { return m.Create(-1); }, nullptr, 0},
    {"SetSelects", "....", [](SelMask &m) { return m.Set(1, true); }, ".2..", 1},
    {"DoSetAdds", "2...", doSet(2, SelMask::SEL_Set), "2.2.", 1},
    {"DoSetKeepsAnExistingState", "1...", doSet(0, SelMask::SEL_Set), nullptr, 0},
    {"DoSetOutOfRange", "2...", doSet(9, SelMask::SEL_Only), nullptr, 0},
    {"DoClearRemoves", "2.2.", doSet(0, SelMask::SEL_Clear), "..2.", 1},
    {"ToggleOn", "2...", doSet(3, SelMask::SEL_Toggle), "2..2", 1},
    {"ToggleOff", "2..4", doSet(3, SelMask::SEL_Toggle), "2...", 1},
    {"OnlyReplacesTheSelection", "22.2", doSet(2, SelMask::SEL_Only), "..2.", 1},
    {"OnlyKeepsTheItemsState", "4.1.", doSet(2, SelMask::SEL_Only), "..1.", 1},
    {"OnlyOnTheOnlyItemIsNoChange", "..2.", doSet(2, SelMask::SEL_Only), nullptr, 0},
    {"ShiftedPastTheEndIsDropped", "...12", shift(1, false), "....1", 1},
    {"ShiftWrapsBackwards", "1...2", shift(-2, true), "..21.", 1},
    {"ShiftAFullTurnIsNoChange", ".1.2.", shift(5, true), nullptr, 0},
    {"RestoreWithoutBackup", ".2.1.", [](SelMask &m) { return m.RestoreMask(); }, nullptr, 0},
    {"RestoreBringsBackTheBackupAndKeepsIt", ".2.1.", [](SelMask &m) {
         m.BackupMask();
         m.DoSet(4, SelMask::SEL_Only);
         m.Create(8);
         return m.RestoreMask() && m.Reset() && m.RestoreMask();
     }, nullptr, 1},
    // Queries: every non-zero state counts as selected
    {"SetItemsInIndexOrder", "2..1", [](SelMask &m) { return m.GetSetItem(1); }, nullptr, 3},
    {"SetItemMinusOneIsTheSingleItem", "..2.", [](SelMask &m) { return m.GetSetItem(-1); }, nullptr, 2},
    {"AllSetInMixedStates", "2142", [](SelMask &m) { return m.IsAllSet(); }, nullptr, 1},
    {"EmptyIsNotAllSet", "", [](SelMask &m) { return m.IsAllSet(); }, nullptr, 0},
    {"TwoAreMultiSet", "2..1", [](SelMask &m) { return m.IsMultiSet(); }, nullptr, 1},
    {"AbsoluteWrapsBackwards", ".....", [](SelMask &m) { return m.GetAbsolute(-11); }, nullptr, 4},
    // Segments join neighbours, and the last item to the first in a closed shape
    {"NoSegmentOfNonNeighbours", "2.2..", segment(0, false), nullptr, -1},
    {"NoSegmentFromLastToFirstOpen", "2...2", segment(0, false), nullptr, -1},
    {"SegmentFromLastToFirstClosed", "2...2", segment(0, true), nullptr, 4},
    {"SecondSegmentOfARun", ".222.", segment(1, false), nullptr, 2},
    {"TwoItemsClosedHaveOneSegment", "22", segment(1, true), nullptr, -1},
    {"SingleSegment", "2...2", [](SelMask &m) { return m.GetSingleSetSegment(true); }, nullptr, 4},
    {"NoSingleSegmentOfThree", ".222.", [](SelMask &m) { return m.GetSingleSetSegment(false); }, nullptr, -1},
};
// clang-format on

INSTANTIATE_TEST_SUITE_P(Masks, SelMaskOps, testing::ValuesIn(OpCases), testing::PrintToStringParamName());

} // namespace
} // namespace Orbane
