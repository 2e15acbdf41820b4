// The frames of the open Toon, its header and the scaling of positions.
#include "tests/toon/toon_fixture.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cstring>

namespace {

using testing::ElementsAre;

class FrameStoreTest : public test::ToonTest {};

TEST_F(FrameStoreTest, NothingCanBeDoneWithoutAStore) {
    ToonFrame frame{7, 7, 7, 7, 7, "as it was", 7};
    const ToonFrame before = frame;
    EXPECT_EQ(FrameGet(0, &frame), 0);
    EXPECT_EQ(std::memcmp(&frame, &before, sizeof frame), 0);
    EXPECT_EQ(FramePut(0, &frame), 0);
    EXPECT_EQ(FrameStoreGrow(), 0);
    EXPECT_EQ(FrameStoreDelete(0), 0);
    EXPECT_EQ(FrameStoreInsert(0), 0);
    EXPECT_EQ(FrameCount, 0); // no more than the store has
}

TEST_F(FrameStoreTest, IndicesAreHeldToTheStore) {
    makeToon(3);
    FrameCount = 2;

    struct Case {
        LONG index;
        int get;
        int put;
    };

    const Case cases[] = {{-1, 0, 0}, {0, 1, 1},         {1, 1, 1},        {2, 0, 1},
                          {3, 0, 0},  {INT32_MAX, 0, 0}, {INT32_MIN, 0, 0}};
    for (const Case& c : cases) {
        ToonFrame frame{};
        EXPECT_EQ(FrameGet(c.index, &frame), c.get) << c.index;
        EXPECT_EQ(FramePut(c.index, &frame), c.put) << c.index;
    }
}

TEST_F(FrameStoreTest, SizesThatCannotBeHadAreRefused) {
    for (const LONG count : {-1, INT32_MIN, INT32_MAX, INT32_MAX / 92 + 1, 46684428}) {
        makeToon(1);
        EXPECT_EQ(FrameStoreAlloc(count), 0) << count;
        EXPECT_FALSE(FrameStore) << count;
    }
    EXPECT_EQ(FrameStoreAlloc(0), 1);
    EXPECT_EQ(storeSize(), 0);
}

TEST_F(FrameStoreTest, GrowsByZeroedFramesAndKeepsTheOthers) {
    makeToon(2);
    ++FrameCount;
    ASSERT_EQ(FrameStoreGrow(), 1);
    EXPECT_THAT(positions(), ElementsAre(0, 1, 0));
    ToonFrame frame{9, 9, 9, 9, 9, "nine", 9};
    ASSERT_EQ(FrameGet(2, &frame), 1);
    EXPECT_EQ(frame.pause, 0);
    EXPECT_STREQ(frame.text, "");
}

TEST_F(FrameStoreTest, AFailedGrowthLeavesAllAsItWas) {
    makeToon(2);
    FrameCount = INT32_MAX;
    EXPECT_EQ(FrameStoreGrow(), 0);
    EXPECT_EQ(FrameCount, 2);
    EXPECT_THAT(positions(), ElementsAre(0, 1));
}

TEST_F(FrameStoreTest, InsertOpensAGap) {
    struct Case {
        LONG index;
        int result;
        std::vector<LONG> after;
    };

    const Case cases[] = {{0, 1, {0, 0, 1, 2}}, {1, 1, {0, 0, 1, 2}}, {2, 1, {0, 1, 0, 2}},
                          {3, 1, {0, 1, 2, 0}}, {4, 0, {0, 1, 2}},    {-1, 0, {0, 1, 2}}};
    for (const Case& c : cases) {
        makeToon(3);
        EXPECT_EQ(FrameStoreInsert(c.index), c.result) << c.index;
        EXPECT_EQ(positions(), c.after) << c.index;
        ToonFrame frame{};
        if (c.result == 1 && FrameGet(c.index, &frame)) {
            EXPECT_EQ(frame.pause, 0) << c.index;
            EXPECT_STREQ(frame.text, "") << c.index;
        }
    }
}

TEST_F(FrameStoreTest, InsertStopsAtTheLimit) {
    makeToon(250);
    EXPECT_EQ(FrameStoreInsert(5), 1);
    EXPECT_EQ(FrameStoreInsert(5), 0);
    EXPECT_EQ(FrameCount, 251);
    makeToon(300);
    EXPECT_EQ(FrameStoreInsert(0), 0);
    EXPECT_EQ(FrameCount, 300);
}

TEST_F(FrameStoreTest, DeleteClosesTheGap) {
    struct Case {
        LONG index;
        int result;
        std::vector<LONG> after;
    };

    const Case cases[] = {
        {0, 1, {1, 2}}, {1, 1, {0, 2}}, {2, 1, {0, 1}}, {3, 0, {0, 1, 2}}, {-1, 0, {0, 1, 2}}};
    for (const Case& c : cases) {
        makeToon(3);
        EXPECT_EQ(FrameStoreDelete(c.index), c.result) << c.index;
        EXPECT_EQ(positions(), c.after) << c.index;
    }
}

TEST_F(FrameStoreTest, TheOnlyFrameIsClearedAndNotTakenOut) {
    makeToon(1);
    EXPECT_EQ(FrameStoreDelete(0), 1);
    EXPECT_EQ(FrameCount, 1);
    ToonFrame frame{9, 9, 9, 9, 9, "nine", 9};
    ASSERT_EQ(FrameGet(0, &frame), 1);
    EXPECT_EQ(frame.pause, 0);
    EXPECT_STREQ(frame.text, "");
}

TEST_F(FrameStoreTest, ACopyTakesTheTextUpToItsNulAndNoMore) {
    makeToon(1);
    ToonFrame in{1, 2, 3, 4, 5, "Ho", 0x1234};
    in.text[50] = 'x';
    ASSERT_EQ(FramePut(0, &in), 1);
    ToonFrame out{};
    std::memset(&out, '#', sizeof out);
    ASSERT_EQ(FrameGet(0, &out), 1);
    EXPECT_EQ(out.x, 1);
    EXPECT_EQ(out.y, 2);
    EXPECT_EQ(out.pose, 3);
    EXPECT_EQ(out.pause, 4);
    EXPECT_EQ(out.wink, 5);
    EXPECT_EQ(std::memcmp(out.text, "Ho\0##", 5), 0);
    EXPECT_EQ(out.text[50], '#');
    EXPECT_EQ(out.reserved, 0x2323);

    const auto* stored = static_cast<const ToonFrame*>(GlobalLock(FrameStore));
    EXPECT_EQ(std::memcmp(stored->text, "Ho\0lo", 6), 0); // "Hello" stood there
    EXPECT_EQ(stored->text[50], '\0');
    EXPECT_EQ(stored->reserved, 0);
    GlobalUnlock(FrameStore);
}

TEST_F(FrameStoreTest, ATextWithoutItsNulEndsWithItsField) {
    makeToon(1);
    ToonFrame in{};
    std::ranges::fill(in.text, 'T');
    in.reserved = 0x5555;
    ASSERT_EQ(FramePut(0, &in), 1);
    ToonFrame out{};
    ASSERT_EQ(FrameGet(0, &out), 1);
    EXPECT_EQ(std::string(out.text), std::string(69, 'T'));
}

TEST_F(FrameStoreTest, ANewToonTakesStageAndCaptionInForce) {
    std::ranges::fill(ToonDocHeader.magic, '+');
    std::strcpy(CaptionText, "Before");
    StageSize = MAKELONG(1024, 768);
    ToonSpeed = 5;
    ToonNewDefaults();
    EXPECT_EQ(std::string(ToonDocHeader.magic, 32),
              std::string("Dorbo Toon Frame File\0++++++++++", 32));
    EXPECT_EQ(ToonDocHeader.version, 0x20001U);
    EXPECT_STREQ(ToonDocHeader.caption, "Before");
    EXPECT_EQ(ToonDocHeader.windowSize, 0x03000400U);
    EXPECT_EQ(ToonDocHeader.frameCount, 1);
    EXPECT_EQ(ToonDocHeader.speed, 3);
    EXPECT_EQ(ToonDocHeader.background, 1);
    EXPECT_EQ(ToonSpeed, 5);
}

TEST_F(FrameStoreTest, TheFileDialogsShareOneRecord) {
    ToonDirty = 1;
    ToonFileDialog.Flags = 77;
    EXPECT_EQ(ToonFileSetup(nullptr), 1);
    EXPECT_EQ(ToonDirty, 0U);
    EXPECT_EQ(ToonFileDialog.lStructSize, 76U);
    const std::string filter("Dorbo Toon Files (*.zkt)\0*.zkt\0", 32);
    EXPECT_EQ(std::string(ToonFileDialog.lpstrFilter, 32), filter);
    EXPECT_EQ(ToonFileDialog.nMaxCustFilter, 40U);
    EXPECT_NE(ToonFileDialog.lpstrCustomFilter, nullptr);
    EXPECT_EQ(ToonFileDialog.nFilterIndex, 1U);
    EXPECT_EQ(ToonFileDialog.lpstrFile, ToonFileName);
    EXPECT_EQ(ToonFileDialog.nMaxFile, 256U);
    EXPECT_STREQ(ToonFileDialog.lpstrInitialDir, "");
    EXPECT_EQ(ToonFileDialog.Flags, 0U);
    EXPECT_EQ(ToonFileDialog.lpstrDefExt, nullptr);
}

// ---- Scaling
// -------------------------------------------------------------------------------------

class Scaling : public test::ToonTest {
  protected:
    Scaling() {
        WNDCLASSA stageClass{};
        stageClass.lpfnWndProc = DefWindowProcA;
        stageClass.hInstance = GetModuleHandleA(nullptr);
        stageClass.lpszClassName = "ScalingClass";
        RegisterClassA(&stageClass);
    }

    static POINT scaled(int width, int height, DWORD recorded, POINT point, int expected) {
        const HWND stage = CreateWindowExA(0, "ScalingClass", "", WS_POPUP, 0, 0, width, height,
                                           nullptr, nullptr, GetModuleHandleA(nullptr), nullptr);
        ToonDocHeader.windowSize = recorded;
        EXPECT_TRUE(stage);
        EXPECT_EQ(ScaleToStage(stage, &point), expected);
        DestroyWindow(stage);
        return point;
    }
};

TEST_F(Scaling, GoesTowardZeroAndWraps) {
    struct Case {
        const char* why;
        int width;
        int height;
        DWORD recorded;
        POINT point;
        int result;
        POINT expected;
    };

    const DWORD classic = MAKELONG(1024, 768);
    const Case cases[] = {
        {"same size", 1024, 768, classic, {-77, 765}, 1, {-77, 765}},
        {"smaller", 640, 480, classic, {512, 384}, 1, {320, 240}},
        {"toward zero below 0", 640, 480, classic, {-3, -1}, 1, {-1, 0}},
        {"toward zero above 0", 640, 480, classic, {3, 1}, 1, {1, 0}},
        {"larger", 2048, 1536, classic, {-150, 101}, 1, {-300, 202}},
        {"no recorded size", 640, 480, 0, {-3, 9}, 0, {-3, 9}},
        {"no recorded width", 640, 480, MAKELONG(0, 768), {33, 16}, 1, {33, 10}},
        {"no recorded height", 640, 480, MAKELONG(1024, 0), {16, 33}, 1, {10, 33}},
        {"halves are unsigned", 640, 480, 0xFFFFFFFF, {65535, -65535}, 1, {640, -480}},
        {"product past 31 bits",
         1024,
         1024,
         MAKELONG(1, 1),
         {2097152, 4194303},
         1,
         {INT32_MIN, -1024}},
        {"lowest and highest",
         3,
         3,
         MAKELONG(1, 1),
         {INT32_MIN, INT32_MAX},
         1,
         {INT32_MIN, INT32_MAX - 2}},
    };
    for (const Case& c : cases) {
        const POINT point = scaled(c.width, c.height, c.recorded, c.point, c.result);
        EXPECT_EQ(point.x, c.expected.x) << c.why;
        EXPECT_EQ(point.y, c.expected.y) << c.why;
    }
}

} // namespace
