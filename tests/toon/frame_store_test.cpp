// The frames of the open Toon, and the scaling of positions.
#include "tests/toon/toon_fixture.h"

#include <gmock/gmock.h>

#include <cstring>

namespace {

using Positions = std::vector<LONG>;

class FrameStoreTest : public test::ToonTest {};

// Taken before anything else runs.
const std::tuple atStart{FrameCount, CurrentFrameIndex, ToonSpeed, BackgroundIndex, ToonDirty};

TEST_F(FrameStoreTest, AProcessBeginsWithOneFrameAtMiddleSpeed) {
    EXPECT_EQ(atStart, std::tuple(1, 0, 3, 0, 0U));
}

TEST_F(FrameStoreTest, IndicesAreHeldToTheStore) {
    const std::tuple<LONG, LONG, int, int> cases[] = {
        {3, -1, 0, 0}, {3, 0, 1, 1},         {3, 1, 1, 1},         {3, 2, 0, 1},
        {3, 3, 0, 0},  {3, INT32_MAX, 0, 0}, {3, INT32_MIN, 0, 0}, {0, 0, 0, 0}};
    for (const auto& [frames, index, get, put] : cases) {
        makeToon(frames);
        FrameCount = 2; // fewer than the store has
        ToonFrame frame{7, 7, 7, 7, 7, "as it was", 7};
        EXPECT_EQ(FrameGet(index, &frame), get) << index;
        EXPECT_EQ(frame.x == 7, get == 0) << index;
        EXPECT_EQ(FramePut(index, &frame), put) << index;
    }
    FrameStoreFree();
    EXPECT_EQ(FrameStoreGrow() + FrameStoreDelete(0) + FrameStoreInsert(0), 0);
    EXPECT_EQ(FrameCount, 0) << "no more than the store has";
}

TEST_F(FrameStoreTest, SizesThatCannotBeHadAreRefused) {
    for (const LONG count : {-1, INT32_MIN, INT32_MAX, INT32_MAX / 92 + 1, 46684428}) {
        makeToon(1);
        EXPECT_EQ(FrameStoreAlloc(count), 0) << count;
        EXPECT_FALSE(FrameStore) << count;
    }
    makeToon(2);
    FrameCount = INT32_MAX;
    EXPECT_EQ(FrameStoreGrow(), 0);
    EXPECT_EQ(positions(), (Positions{0, 1}));
}

TEST_F(FrameStoreTest, InsertOpensAGapAndDeleteClosesIt) {
    const std::tuple<int (*)(LONG), LONG, LONG, int, Positions> cases[] = {
        {FrameStoreInsert, 3, 0, 1, {0, 0, 1, 2}},
        {FrameStoreInsert, 3, 2, 1, {0, 1, 0, 2}},
        {FrameStoreInsert, 3, 3, 1, {0, 1, 2, 0}},
        {FrameStoreInsert, 3, 4, 0, {0, 1, 2}},
        {FrameStoreInsert, 3, -1, 0, {0, 1, 2}},
        {FrameStoreDelete, 3, 0, 1, {1, 2}},
        {FrameStoreDelete, 3, 2, 1, {0, 1}},
        {FrameStoreDelete, 3, 3, 0, {0, 1, 2}},
        {FrameStoreDelete, 3, -1, 0, {0, 1, 2}},
        {FrameStoreDelete, 1, 0, 1, {0}}, // the only one is cleared
    };
    for (const auto& [change, frames, index, result, after] : cases) {
        makeToon(frames);
        EXPECT_EQ(change(index), result) << index;
        EXPECT_EQ(positions(), after) << index;
        ToonFrame frame{};
        if (result == 1 && (change == FrameStoreInsert || frames == 1)) {
            FrameGet(index, &frame);
            EXPECT_EQ(frame.pause, 0) << index;
            EXPECT_STREQ(frame.text, "") << index;
        }
    }
    makeToon(250);
    EXPECT_EQ(FrameStoreInsert(5), 1);
    EXPECT_EQ(FrameStoreInsert(5), 0);
    EXPECT_EQ(FrameCount, 251);
}

TEST_F(FrameStoreTest, ACopyTakesTheTextUpToItsNulAndNoMore) {
    makeToon(1); // "Hello" stands there
    ToonFrame in{1, 2, 3, 4, 5, "Ho", 0x1234};
    in.text[50] = 'x';
    ASSERT_EQ(FramePut(0, &in), 1);
    const ToonFrame stored = *static_cast<const ToonFrame*>(GlobalLock(FrameStore));
    GlobalUnlock(FrameStore);
    ToonFrame out{9, 9, 9, 9, 9, "#####", 9};
    ASSERT_EQ(FrameGet(0, &out), 1);
    const LONG numbers[] = {1, 2, 3, 4, 5};
    EXPECT_EQ(std::memcmp(&out, numbers, sizeof numbers), 0);
    EXPECT_EQ(std::memcmp(out.text, "Ho\0##\0", 6), 0);
    EXPECT_EQ(std::memcmp(stored.text, "Ho\0lo\0", 6), 0);
    EXPECT_EQ(stored.text[50], '\0');
    EXPECT_EQ(stored.reserved, 0);

    std::memset(in.text, 'T', sizeof in.text + sizeof in.reserved);
    FramePut(0, &in);
    FrameGet(0, &out);
    EXPECT_EQ(std::string(out.text), std::string(69, 'T'))
        << "without a NUL it ends with its field";
}

TEST_F(FrameStoreTest, ScalingGoesTowardZeroAndWraps) {
    WNDCLASSA stageClass{};
    stageClass.lpfnWndProc = DefWindowProcA;
    stageClass.lpszClassName = "ScalingClass";
    RegisterClassA(&stageClass);
    const DWORD classic = MAKELONG(1024, 768);
    const std::tuple<const char*, int, int, DWORD, POINT, POINT> cases[] = {
        {"same size", 1024, 768, classic, {-77, 765}, {-77, 765}},
        {"toward zero below 0", 640, 480, classic, {-3, -1}, {-1, 0}},
        {"no recorded size", 640, 480, 0, {-3, 9}, {-3, 9}},
        {"no recorded width", 640, 480, MAKELONG(0, 768), {33, 16}, {33, 10}},
        {"halves are unsigned", 640, 480, 0xFFFFFFFF, {65535, -65535}, {640, -480}},
        {"past 31 bits", 1024, 1024, 0x20002, {2097152, 4194303}, {INT32_MIN / 2, -512}},
        {"lowest, highest", 3, 3, 0x10001, {INT32_MIN, INT32_MAX}, {INT32_MIN, INT32_MAX - 2}},
    };
    for (const auto& [why, width, height, recorded, from, expected] : cases) {
        const HWND stage = CreateWindowExA(0, "ScalingClass", "", WS_POPUP, 0, 0, width, height,
                                           nullptr, nullptr, nullptr, nullptr);
        ToonDocHeader.windowSize = recorded;
        POINT point = from;
        EXPECT_EQ(ScaleToStage(stage, &point), recorded != 0 ? 1 : 0);
        EXPECT_EQ(point.x, expected.x) << why;
        EXPECT_EQ(point.y, expected.y) << why;
        DestroyWindow(stage);
    }
}

} // namespace
