#include "broker/HandleSpace.h"

#include <gtest/gtest.h>

namespace cimhost {

namespace {

TEST(HandleSpaceTest, FindsHandlesByTheirAddressOnly)
{
    HandleSpace& space = HandleSpace::instance();
    Handle* const block = space.takeBlock();
    EXPECT_EQ(space.find(block), block);
    EXPECT_EQ(space.find(block + HandleSpace::blockSize - 1), block + HandleSpace::blockSize - 1);
    EXPECT_EQ(space.find(reinterpret_cast<const char*>(block) + 1), nullptr);
    int elsewhere = 0;
    EXPECT_EQ(space.find(&elsewhere), nullptr);
    EXPECT_EQ(space.find(nullptr), nullptr);
    space.giveBack(block);
    EXPECT_EQ(space.find(block), block); // it may be asked for its state at any time
}

TEST(HandleSpaceTest, QuarantinesABlockGivenBack)
{
    HandleSpace& space = HandleSpace::instance();
    Handle* const block = space.takeBlock();
    space.giveBack(block);
    for (std::size_t i = 0; i < HandleSpace::quarantinedBlocks; ++i) {
        Handle* const other = space.takeBlock();
        ASSERT_NE(other, block) << "after " << i;
        space.giveBack(other);
    }
    bool reused = false;
    for (std::size_t i = 0; i < HandleSpace::quarantinedBlocks + 1 && !reused; ++i) {
        Handle* const other = space.takeBlock();
        reused = other == block;
        space.giveBack(other);
    }
    EXPECT_TRUE(reused);
}

} // namespace

} // namespace cimhost
