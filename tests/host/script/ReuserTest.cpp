#include "orbane/Reuser.h"

#include <gtest/gtest.h>

#include <cstring>
#include <vector>

namespace Orbane {

class ReuserTest : public testing::Test
{
protected:
    void SetUp() override { Reuser::Trim(); }
    void TearDown() override { Reuser::Trim(); }
};

TEST_F(ReuserTest, SizeClassesAreSixteenByteStepsUpToOneKiB)
{
    EXPECT_EQ(Reuser::ClassSize(0), 16u);
    EXPECT_EQ(Reuser::ClassSize(1), 16u);
    EXPECT_EQ(Reuser::ClassSize(16), 16u);
    EXPECT_EQ(Reuser::ClassSize(17), 32u);
    EXPECT_EQ(Reuser::ClassSize(1000), 1008u);
    EXPECT_EQ(Reuser::ClassSize(1024), 1024u);
    EXPECT_EQ(Reuser::ClassSize(1025), 0u) << "larger blocks go to the heap";
}

TEST_F(ReuserTest, AFreedBlockIsHandedOutAgain)
{
    void *a = Reuser::operator new(40);
    ASSERT_NE(a, nullptr);
    std::memset(a, 0xAB, 40);
    Reuser::operator delete(a, 40);
    EXPECT_EQ(Reuser::FreeBlocks(40), 1u);
    EXPECT_EQ(Reuser::FreeBlocks(48), 1u) << "40 and 48 bytes share a class";
    void *b = Reuser::operator new(48);
    EXPECT_EQ(b, a);
    EXPECT_EQ(Reuser::FreeBlocks(40), 0u);
    Reuser::operator delete(b, 48);
}

TEST_F(ReuserTest, BlocksComeBackLastFreedFirstAndClassesStayApart)
{
    void *small1 = Reuser::operator new(16);
    void *small2 = Reuser::operator new(16);
    void *big = Reuser::operator new(512);
    Reuser::operator delete(small1, 16);
    Reuser::operator delete(small2, 16);
    Reuser::operator delete(big, 512);
    EXPECT_EQ(Reuser::FreeBlocks(16), 2u);
    EXPECT_EQ(Reuser::FreeBlocks(512), 1u);
    EXPECT_EQ(Reuser::operator new(16), small2);
    EXPECT_EQ(Reuser::operator new(16), small1);
    EXPECT_EQ(Reuser::FreeBlocks(16), 0u);
    Reuser::operator delete(small1, 16);
    Reuser::operator delete(small2, 16);
}

TEST_F(ReuserTest, LargeBlocksBypassThePool)
{
    void *block = Reuser::operator new(4096);
    ASSERT_NE(block, nullptr);
    std::memset(block, 0, 4096);
    Reuser::operator delete(block, 4096);
    EXPECT_EQ(Reuser::FreeBlocks(4096), 0u);
    Reuser::operator delete(nullptr, 64);
    EXPECT_EQ(Reuser::FreeBlocks(64), 0u) << "deleting null changes nothing";
}

TEST_F(ReuserTest, TrimEmptiesEveryClass)
{
    std::vector<void *> blocks;
    for (std::size_t size = 8; size <= 1024; size += 100)
        blocks.push_back(Reuser::operator new(size));
    std::size_t size = 8;
    for (void *block : blocks) {
        Reuser::operator delete(block, size);
        size += 100;
    }
    EXPECT_EQ(Reuser::FreeBlocks(8), 1u);
    Reuser::Trim();
    for (std::size_t s = 8; s <= 1024; s += 100)
        EXPECT_EQ(Reuser::FreeBlocks(s), 0u);
}

} // namespace Orbane
