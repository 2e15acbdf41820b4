#include "platform/harness.h"
#include "platform/kernel.h"

#include <gtest/gtest.h>

#include <cstring>

namespace {

TEST(MemoryBlock, GrowsWithItsContentsAndClearsWhatIsNew) {
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE | GMEM_ZEROINIT, 92);
    void* bytes = GlobalLock(block);
    EXPECT_EQ(std::string(static_cast<char*>(bytes), 92), std::string(92, '\0'));
    std::memset(bytes, 'x', 92);
    EXPECT_EQ(GlobalLock(block), bytes);
    EXPECT_FALSE(GlobalReAlloc(block, 100, 0)); // locked, so that it must not move
    EXPECT_TRUE(GlobalUnlock(block));
    EXPECT_FALSE(GlobalUnlock(block));
    EXPECT_FALSE(GlobalUnlock(block));
    EXPECT_EQ(GlobalReAlloc(block, 40, GMEM_ZEROINIT), block);
    EXPECT_EQ(GlobalReAlloc(block, 9000, GMEM_ZEROINIT), block);
    EXPECT_FALSE(GlobalReAlloc(block, 0x80000000, 0));
    EXPECT_EQ(std::string(static_cast<char*>(GlobalLock(block)), 9000),
              std::string(40, 'x') + std::string(8960, '\0'));
    EXPECT_FALSE(GlobalFree(block));
    EXPECT_FALSE(GlobalAlloc(GMEM_MOVEABLE, static_cast<std::size_t>(-92)));
}

TEST(MemoryBlock, ThatIsFreedIsRefusedFromThenOnAlsoOneOfNoBytes) {
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE, 0);
    EXPECT_EQ(GlobalLock(block), nullptr);
    EXPECT_EQ(GlobalReAlloc(block, 3, 0), block);
    EXPECT_NE(GlobalLock(block), nullptr);
    EXPECT_FALSE(GlobalFree(block));
    const HGLOBAL next = GlobalAlloc(GMEM_MOVEABLE, 4); // takes the same place in the table
    EXPECT_EQ(GlobalLock(block), nullptr);
    EXPECT_FALSE(GlobalReAlloc(block, 8, 0));
    EXPECT_EQ(GlobalFree(block), block);
    EXPECT_FALSE(GlobalFree(next));
    seam::HandleCounts counts;
    seam::countKernelHandles(counts);
    EXPECT_EQ(counts.memoryBlocks, 0U);
}

} // namespace
