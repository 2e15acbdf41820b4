#include "platform/harness.h"
#include "platform/kernel.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>

namespace {

std::size_t liveBlocks() {
    seam::HandleCounts counts;
    seam::countKernelHandles(counts);
    return counts.memoryBlocks;
}

bool allZero(const void* bytes, std::size_t from, std::size_t to) {
    const char* first = static_cast<const char*>(bytes);
    return std::all_of(first + from, first + to, [](char byte) { return byte == 0; });
}

TEST(MemoryBlock, GrowsWithItsContentsAndClearsWhatIsNew) {
    const std::size_t before = liveBlocks();
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE | GMEM_ZEROINIT, 92);
    void* bytes = GlobalLock(block);
    EXPECT_TRUE(allZero(bytes, 0, 92));
    std::memset(bytes, 7, 92);
    EXPECT_FALSE(GlobalUnlock(block));
    EXPECT_EQ(GlobalReAlloc(block, 40, GMEM_ZEROINIT), block);
    EXPECT_EQ(GlobalReAlloc(block, 92000, GMEM_ZEROINIT), block);
    bytes = GlobalLock(block);
    EXPECT_EQ(static_cast<char*>(bytes)[39], 7);
    EXPECT_TRUE(allZero(bytes, 40, 92000));
    GlobalUnlock(block);
    EXPECT_EQ(liveBlocks(), before + 1);
    EXPECT_FALSE(GlobalFree(block));
    EXPECT_EQ(liveBlocks(), before);
}

TEST(MemoryBlock, StaysAsItWasWhenItCannotGrow) {
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE, 4);
    std::memcpy(GlobalLock(block), "abc", 4);
    EXPECT_FALSE(GlobalReAlloc(block, 8, 0)); // locked, so that it must not move
    GlobalUnlock(block);
    EXPECT_FALSE(GlobalReAlloc(block, 0x80000000, 0));
    EXPECT_STREQ(static_cast<char*>(GlobalLock(block)), "abc");
    GlobalFree(block);
    EXPECT_FALSE(GlobalAlloc(GMEM_MOVEABLE, static_cast<std::size_t>(-92)));
}

TEST(MemoryBlock, CountsItsLocks) {
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE, 4);
    EXPECT_EQ(GlobalLock(block), GlobalLock(block));
    EXPECT_TRUE(GlobalUnlock(block));
    EXPECT_FALSE(GlobalUnlock(block));
    EXPECT_FALSE(GlobalUnlock(block));
    EXPECT_EQ(GlobalReAlloc(block, 8, 0), block);
    GlobalFree(block);
}

TEST(MemoryBlock, OfNoBytesIsGivenAndCannotBeLocked) {
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE | GMEM_ZEROINIT, 0);
    EXPECT_TRUE(block);
    EXPECT_EQ(GlobalLock(block), nullptr);
    EXPECT_EQ(GlobalReAlloc(block, 3, GMEM_ZEROINIT), block);
    EXPECT_NE(GlobalLock(block), nullptr);
    EXPECT_FALSE(GlobalFree(block));
}

TEST(MemoryBlock, ThatIsFreedIsRefusedFromThenOn) {
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE, 4);
    GlobalFree(block);
    const HGLOBAL next = GlobalAlloc(GMEM_MOVEABLE, 4); // takes the same place in the table
    EXPECT_EQ(GlobalLock(block), nullptr);
    EXPECT_FALSE(GlobalReAlloc(block, 8, 0));
    EXPECT_EQ(GlobalFree(block), block);
    EXPECT_FALSE(GlobalFree(next));
    EXPECT_FALSE(GlobalFree(nullptr));
}

} // namespace
