#include "orbane/ControlCommands.h"

#include <gtest/gtest.h>

#include <set>
#include <string>
#include <utility>
#include <vector>

namespace Orbane {
namespace {

const std::vector<std::pair<const OrbID *, const char *>> &commands()
{
    static const std::vector<std::pair<const OrbID *, const char *>> all = {
        {&CCMD_GetInputAt, "CCMD_GetInputAt"},
        {&CCMD_NeedsKey, "CCMD_NeedsKey"},
        {&CCMD_KeyDown, "CCMD_KeyDown"},
        {&CCMD_KeyUp, "CCMD_KeyUp"},
        {&CCMD_KeyUpAll, "CCMD_KeyUpAll"},
        {&CCMD_HitTest, "CCMD_HitTest"},
        {&CCMD_Select, "CCMD_Select"},
        {&CCMD_Copy, "CCMD_Copy"},
        {&CCMD_Paste, "CCMD_Paste"},
        {&CCMD_Delete, "CCMD_Delete"},
        {&CCMD_FollowCursor, "CCMD_FollowCursor"},
        {&CCMD_TimeChanged, "CCMD_TimeChanged"},
        {&CCMD_ImageChanged, "CCMD_ImageChanged"},
    };
    return all;
}

TEST(ControlCommands, EachIdIsItsOwnName)
{
    for (const auto &[id, name] : commands()) {
        EXPECT_STREQ(id->c_str(), name);
        // A script or a viewer building the id from text gets the same id.
        EXPECT_EQ(*id, OrbID(name));
        EXPECT_EQ(id->Key(), OrbID(std::string(name)).Key());
    }
}

TEST(ControlCommands, IdsAreDistinct)
{
    std::set<const void *> keys;
    for (const auto &entry : commands())
        keys.insert(entry.first->Key());
    EXPECT_EQ(keys.size(), commands().size());
    EXPECT_NE(CCMD_KeyUp, CCMD_KeyUpAll);
}

TEST(ControlCommands, DragTypesHaveTheirNumbers)
{
    EXPECT_EQ(int32(DRAG_None), 0);
    EXPECT_EQ(int32(DRAG_Linked), 1);
    EXPECT_EQ(int32(DRAG_Handle), 2);
    EXPECT_EQ(sizeof(DragType), 4u);
}

} // namespace
} // namespace Orbane
