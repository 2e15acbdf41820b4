#include "saver/show_cycle.h"

#include "platform/kernel.h"
#include "stage/backdrop.h"
#include "stage/character.h"
#include "stage/face.h"
#include "stage/random_walk.h"
#include "stage/stage.h"
#include "stage/walk.h"
#include "tests/saver/saver_fixture.h"
#include "toon/settings.h"

#include <malloc.h>
#include <utility>

using testing::ElementsAre;

namespace {

class ShowStage : public SaverTest {
  protected:
    /// Backdrop, caption and figure as they belong on the stage, painted on a sheet of its own.
    std::vector<DWORD> cleanPixels() const {
        const HDC dc = GetDC(stage);
        const HDC memory = CreateCompatibleDC(dc);
        const HBITMAP sheet = CreateCompatibleBitmap(dc, LOWORD(StageSize), HIWORD(StageSize));
        const HGDIOBJ before = SelectObject(memory, sheet);
        BlitBackdrop(memory, stage, BackdropBitmap);
        DrawTitles(memory, stage);
        SpriteStampOnce(memory, CharacterSprite.frameBitmap, CharacterSprite.drawX,
                        CharacterSprite.drawY);
        std::vector<DWORD> clean = seam::bitmapPicture(sheet).pixels;
        for (DWORD& pixel : clean) {
            pixel &= 0xFFFFFF;
        }
        SelectObject(memory, before);
        DeleteObject(sheet);
        DeleteDC(memory);
        ReleaseDC(stage, dc);
        return clean;
    }

    bool isClean() const {
        return pixels() == cleanPixels();
    }
};

} // namespace

TEST_F(ShowStage, TakesWhatAShowNeedsAndGivesItBack) {
    constexpr DWORD sizeBefore = MAKELONG(11, 22);
    StageSize = sizeBefore;
    OpeningDone = TitleShown = 1;
    BackgroundIndex = 7;
    const int cursorBefore = cursorCount();
    putToon("a.zkt", "", {{300, 200, 0, 5, 0, "Hello you there, all of you", 0}});

    openStage(640, 480);
    EXPECT_EQ(StageSize, MAKELONG(640, 480));
    EXPECT_EQ(SaverActive, 1U);
    EXPECT_EQ(OpeningDone + TitleShown, 0U);
    EXPECT_EQ(BackgroundIndex, 0);
    EXPECT_STREQ(StageTitle, "Fenky Dorbo Screen Saver");
    EXPECT_EQ(cursorCount(), cursorBefore - 1);
    ASSERT_TRUE(runUntilEvent("bubble_show"));

    closeStage();
    EXPECT_EQ(StageSize, sizeBefore);
    EXPECT_EQ(SaverActive + OpeningDone + TitleShown, 0U);
    EXPECT_EQ(cursorCount(), cursorBefore);
    EXPECT_FALSE(FrameStore || ExpressionSheet || TitleFont || BylineFont);
    EXPECT_EQ(CharacterArtLoaded, 0U);
    EXPECT_GT(PacesWalked, 100U);
    EXPECT_EQ(savedSetting("Paces Walked"), std::to_string(PacesWalked));
}

TEST_F(ShowStage, ThePreviewWalksOnceAndNeverLoadsWhatItChose) {
    const struct {
        std::vector<std::string> entries;
        const char* file;
        const char* styleSaved;
    } cases[] = {{{"bad.zkt"}, "bad.zkt", "1"}, {{}, "", "0"}};

    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = DefWindowProcA;
    windowClass.lpszClassName = "SaverTestParent";
    RegisterClassA(&windowClass);
    const HWND parent = CreateWindowExA(0, windowClass.lpszClassName, "", WS_POPUP | WS_VISIBLE, 0,
                                        0, 300, 200, nullptr, nullptr, nullptr, nullptr);
    const int cursorBefore = cursorCount();
    PreviewMode = 1;
    for (const auto& one : cases) {
        setEntries(one.entries);
        WalkingStyle = 1;
        Backgrounds = 0;
        PacesWalked = 0;
        openStage(300, 200, parent);
        EXPECT_STREQ(NextToonFile, one.file);
        ASSERT_TRUE(runUntilEvent("show_done"));
        EXPECT_THAT(events({"random_walk", "show_done", "random_walk_refused", "load"}),
                    ElementsAre("random_walk target=[10,0] pose=6 wink=1 statement=0", "show_done",
                                "random_walk_refused", "show_done", "random_walk_refused"));
        EXPECT_EQ(seam::liveHandles().timers, 0U);
        closeStage();
        EXPECT_EQ(cursorCount(), cursorBefore);
        EXPECT_EQ(savedSetting("Walking Style"), one.styleSaved);
        EXPECT_EQ(savedSetting("Backgrounds"), "1");
        EXPECT_EQ(savedSetting("Paces Walked"), std::to_string(PacesWalked));
    }
    DestroyWindow(parent);
}

TEST_F(ShowStage, AStageOfAnotherSizeShowsNoTraceOfTheOldOne) {
    const SIZE sizes[] = {{1024, 768}, {1200, 900}, {1024, 500}, {800, 768}, {500, 400}};
    putToon("a.zkt", "Once round the whole garden",
            {{700, 66, 0, 1, 0, "", 0}, {100, 60, 0, 1, 0, "", 0}});
    for (const SIZE& size : sizes) {
        SCOPED_TRACE(std::to_string(size.cx) + "x" + std::to_string(size.cy));
        openStage(1024, 768);
        ASSERT_TRUE(runUntilEvent("frame index=1"));
        do { // until he walks through the caption
            ASSERT_TRUE(runUntilEvent("draw"));
        } while (CharacterSprite.drawX > 460);
        ASSERT_TRUE(isClean());
        const LONG step = WalkStepIndex;
        MoveWindow(stage, 30, 20, size.cx, size.cy, FALSE);
        EXPECT_EQ(count("rebuild_backdrop"), size.cx == 1024 && size.cy == 768 ? 0U : 1U);
        EXPECT_EQ(seam::bitmapPicture(BackdropBitmap).width, size.cx);
        EXPECT_EQ(StageSize, MAKELONG(size.cx, size.cy));
        pass(0);
        EXPECT_TRUE(isClean());
        for (int i = 0; i < 10; ++i) {
            ASSERT_TRUE(runUntilEvent("draw"));
            EXPECT_TRUE(isClean()) << "step " << i;
        }
        EXPECT_EQ(WalkStepIndex, step + 10) << "the walk goes on";
        closeStage();
    }
}

TEST_F(ShowStage, AnHourOfShowsLeavesNothingBehind) {
    constexpr std::int64_t hour = 3600000;
    constexpr std::size_t slack = 16384; // bytes, for lists that find their size
    putToon("a.zkt", "", {{300, 200, 0, 5, 2, "Hello you there, all of you", 3}});
    putToon("b.zkt", "Another", {{90, 20, 0, 2, 0, "", 0}, {400, 300, 0, 7, 2, "Well!", 2}});
    for (const LONG style : {0, 1}) {
        WalkingStyle = style;
        openStage();
        ASSERT_TRUE(runUntilEvent("choice"));
        ASSERT_TRUE(runUntilEvent("choice"));
        const std::size_t heap = mallinfo2().uordblks;
        const seam::HandleCounts handles = seam::liveHandles();
        const auto sink = std::exchange(TraceSink, nullptr); // the record itself grows
        pass(hour);
        TraceSink = sink;
        ASSERT_TRUE(runUntilEvent("choice"));
        EXPECT_LE(mallinfo2().uordblks, heap + slack) << style;
        EXPECT_EQ(seam::liveHandles(), handles) << style;
        closeStage();
    }
}

TEST_F(ShowStage, TheBubbleComesOffAStageOfAnotherSize) {
    putToon("a.zkt", "A caption that stands in the middle, and so elsewhere on another stage",
            {{512, 80, 0, 3, 0, "Up here!", 0}, {200, 400, 0, 3, 0, "", 0}});
    openStage(1024, 768);
    ASSERT_TRUE(runUntilEvent("bubble_show"));
    MoveWindow(stage, 0, 0, 1200, 900, FALSE);
    ASSERT_TRUE(runUntilEvent("bubble_hide"));
    ASSERT_TRUE(runUntilEvent("draw"));
    EXPECT_TRUE(isClean());
}
