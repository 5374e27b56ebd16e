#include "orbane/Reuser.h"

#include <gtest/gtest.h>

#include <cstdint>

namespace Orbane {

TEST(ReuserTest, FreedBlocksComeBackLastFreedFirstWithinTheirClass)
{
    Reuser::Trim();
    void *a = Reuser::operator new(40);
    void *b = Reuser::operator new(48);
    void *big = Reuser::operator new(512);
    ASSERT_NE(a, nullptr);
    // Kept as numbers: once freed, the blocks are compared, never used.
    const auto freedA = reinterpret_cast<std::uintptr_t>(a), freedB = reinterpret_cast<std::uintptr_t>(b);
    Reuser::operator delete(a, 40);
    Reuser::operator delete(b, 48);
    Reuser::operator delete(big, 512);
    EXPECT_EQ(Reuser::FreeBlocks(40), 2u) << "40 and 48 bytes share a class";
    EXPECT_EQ(Reuser::FreeBlocks(512), 1u);
    void *again48 = Reuser::operator new(48);
    void *again40 = Reuser::operator new(40);
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(again48), freedB);
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(again40), freedA);
    EXPECT_EQ(Reuser::FreeBlocks(40), 0u);
    Reuser::operator delete(again40, 40);
    Reuser::operator delete(again48, 48);
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
