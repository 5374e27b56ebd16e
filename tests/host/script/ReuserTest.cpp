#include "orbane/Reuser.h"

#include <gtest/gtest.h>

namespace Orbane {

TEST(ReuserTest, FreedBlocksComeBackLastFreedFirstWithinTheirClass)
{
    Reuser::Trim();
    void *a = Reuser::operator new(40);
    void *b = Reuser::operator new(48);
    void *big = Reuser::operator new(512);
    ASSERT_NE(a, nullptr);
    Reuser::operator delete(a, 40);
    Reuser::operator delete(b, 48);
    Reuser::operator delete(big, 512);
    EXPECT_EQ(Reuser::FreeBlocks(40), 2u) << "40 and 48 bytes share a class";
    EXPECT_EQ(Reuser::FreeBlocks(512), 1u);
    EXPECT_EQ(Reuser::operator new(48), b);
    EXPECT_EQ(Reuser::operator new(40), a);
    EXPECT_EQ(Reuser::FreeBlocks(40), 0u);
    Reuser::operator delete(a, 40);
    Reuser::operator delete(b, 48);
}

TEST(ReuserTest, LargeBlocksAndNullBypassThePoolAndTrimEmptiesIt)
{
    Reuser::Trim();
    EXPECT_EQ(Reuser::ClassSize(1025), 0u);
    Reuser::operator delete(Reuser::operator new(4096), 4096);
    EXPECT_EQ(Reuser::FreeBlocks(4096), 0u);
    Reuser::operator delete(nullptr, 64);
    EXPECT_EQ(Reuser::FreeBlocks(64), 0u);
    Reuser::operator delete(Reuser::operator new(1000), 1000);
    EXPECT_EQ(Reuser::FreeBlocks(1000), 1u);
    Reuser::Trim();
    EXPECT_EQ(Reuser::FreeBlocks(1000), 0u);
}

} // namespace Orbane
