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

#include <algorithm>
#include <numeric>

using testing::ElementsAre;
using testing::IsEmpty;
using testing::StartsWith;

namespace {

class ShowStage : public SaverTest {
  protected:
    /// Backdrop, caption and figure as they belong on the stage, painted on a sheet of its own.
    seam::Picture cleanPicture() const {
        const HDC dc = GetDC(stage);
        const HDC memory = CreateCompatibleDC(dc);
        const HBITMAP sheet = CreateCompatibleBitmap(dc, LOWORD(StageSize), HIWORD(StageSize));
        const HGDIOBJ before = SelectObject(memory, sheet);
        BlitBackdrop(memory, stage, BackdropBitmap);
        DrawTitles(memory, stage);
        SpriteStampOnce(memory, CharacterSprite.frameBitmap, CharacterSprite.drawX,
                        CharacterSprite.drawY);
        seam::Picture picture = seam::bitmapPicture(sheet);
        SelectObject(memory, before);
        DeleteObject(sheet);
        DeleteDC(memory);
        ReleaseDC(stage, dc);
        return picture;
    }

    /// How many pixels of the stage aren't as they belong.
    int remnants() const {
        const seam::Picture shown = seam::windowPicture(stage);
        const seam::Picture clean = cleanPicture();
        if (shown.pixels.size() != clean.pixels.size() || shown.width != clean.width) {
            return -1;
        }
        return std::transform_reduce(
            shown.pixels.begin(), shown.pixels.end(), clean.pixels.begin(), 0, std::plus<>(),
            [](DWORD a, DWORD b) { return ((a ^ b) & 0xFFFFFF) != 0 ? 1 : 0; });
    }

    /// Brings a Toon to the moment when he walks through the caption.
    void walkThroughCaption() {
        putToon("a.zkt", "Once round the whole garden",
                {{700, 66, 0, 1, 0, "", 0}, {100, 60, 0, 1, 0, "", 0}});
        openStage(1024, 768);
        ASSERT_TRUE(runUntilEvent("frame index=1"));
        do {
            ASSERT_TRUE(runUntilEvent("draw"));
        } while (CharacterSprite.drawX > 460);
        ASSERT_EQ(remnants(), 0);
    }
};

HWND makeParent() {
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = DefWindowProcA;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.lpszClassName = "SaverTestParent";
    RegisterClassA(&windowClass);
    return CreateWindowExA(0, windowClass.lpszClassName, "", WS_POPUP | WS_VISIBLE, 0, 0, 300, 200,
                           nullptr, nullptr, windowClass.hInstance, nullptr);
}

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
    EXPECT_THAT(events({"rebuild_backdrop", "timer_set", "walk", "load"}),
                ElementsAre("rebuild_backdrop index=0 tile=bg01",
                            "timer_set timer=SHOWSTART id=11 ms=2000"));
    ASSERT_TRUE(runUntilEvent("bubble_show"));
    ASSERT_TRUE(FrameStore);

    closeStage();
    EXPECT_EQ(StageSize, sizeBefore);
    EXPECT_EQ(SaverActive + OpeningDone + TitleShown, 0U);
    EXPECT_EQ(cursorCount(), cursorBefore);
    EXPECT_FALSE(FrameStore || ExpressionSheet || TitleFont || BylineFont);
    EXPECT_EQ(CharacterArtLoaded, 0U);
    EXPECT_GT(PacesWalked, 100U);
    EXPECT_EQ(savedSetting("Paces Walked"), std::to_string(PacesWalked));
}

TEST_F(ShowStage, StartsTheShowTwoSecondsAfterTheWindow) {
    putToon("a.zkt", "", {{300, 200, 0, 5, 0, "", 0}});
    openStage();
    pass(1999);
    EXPECT_THAT(events({"load"}), IsEmpty());
    pass(1);
    EXPECT_THAT(events({"load", "frame", "timer_kill", "rebuild_backdrop"}),
                testing::Contains("timer_kill timer=SHOWSTART id=11 was_set=1"));
    EXPECT_THAT(events({"load", "frame", "rebuild_backdrop", "invalidate"}),
                ElementsAre("rebuild_backdrop index=0 tile=bg01", "load file=a.zkt count=1",
                            StartsWith("frame index=0"), "rebuild_backdrop index=3 tile=bg03",
                            "invalidate"));
}

TEST_F(ShowStage, TheDoubledEndOfTheFirstWalkAboutStartsOneWalk) {
    const std::vector<std::string> names = {"show_done", "choice", "random_walk",
                                            "random_walk_refused", "walk"};
    WalkingStyle = 0;
    openStage();
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_THAT(events(names),
                ElementsAre("show_done", "choice file=", StartsWith("random_walk target"),
                            "random_walk_refused", "show_done", "choice file=",
                            StartsWith("random_walk target"), StartsWith("walk from")));
    EXPECT_EQ(seam::liveHandles().timers, 1U);
    ASSERT_TRUE(runUntilEvent("show_done"));
    EXPECT_THAT(events(names),
                ElementsAre("show_done", "choice file=", StartsWith("random_walk target"),
                            StartsWith("walk from")));
}

TEST_F(ShowStage, ThePreviewChoosesAndNeverLoads) {
    const struct {
        std::vector<std::string> entries;
        const char* file;
        const char* styleSaved;
    } cases[] = {{{"bad.zkt"}, "bad.zkt", "1"}, {{}, "", "0"}};

    const HWND parent = makeParent();
    const int cursorBefore = cursorCount();
    PreviewMode = 1;
    ToonFileName[0] = '\0';
    for (const auto& one : cases) {
        setEntries(one.entries);
        WalkingStyle = 1;
        Backgrounds = 0;
        PacesWalked = 0;
        openStage(300, 200, parent);
        EXPECT_STREQ(NextToonFile, one.file);
        EXPECT_EQ(cursorCount(), cursorBefore);
        ASSERT_TRUE(runUntilEvent("show_done"));
        EXPECT_THAT(events({"show_done", "random_walk", "walk"}),
                    ElementsAre("show_done", "show_done")); // one walk, and no other after it
        EXPECT_EQ(seam::liveHandles().timers, 0U);
        EXPECT_STREQ(ToonFileName, "");
        closeStage();
        EXPECT_EQ(cursorCount(), cursorBefore);
        EXPECT_EQ(savedSetting("Walking Style"), one.styleSaved);
        EXPECT_EQ(savedSetting("Backgrounds"), "1");
        EXPECT_GT(PacesWalked, 0U);
        EXPECT_EQ(savedSetting("Paces Walked"), std::to_string(PacesWalked));
    }
    DestroyWindow(parent);
}

TEST_F(ShowStage, AStageOfAnotherSizeShowsNoTraceOfTheOldOne) {
    const SIZE sizes[] = {{1200, 900}, {1024, 500}, {800, 768}, {500, 400}};
    for (const SIZE& size : sizes) {
        const std::string name = std::to_string(size.cx) + "x" + std::to_string(size.cy);
        walkThroughCaption();
        const LONG step = WalkStepIndex;
        MoveWindow(stage, 0, 0, size.cx, size.cy, FALSE);
        EXPECT_EQ(StageSize, MAKELONG(size.cx, size.cy));
        EXPECT_THAT(events({"rebuild_backdrop"}),
                    ElementsAre("rebuild_backdrop index=3 tile=bg03"));
        const seam::Picture backdrop = seam::bitmapPicture(BackdropBitmap);
        EXPECT_EQ(backdrop.width, size.cx);
        EXPECT_EQ(backdrop.height, size.cy);
        EXPECT_EQ(StageRepaintFlag, 1U);
        pass(0);
        EXPECT_EQ(remnants(), 0) << name;
        EXPECT_EQ(StageRepaintFlag, 0U);
        for (int i = 0; i < 10; ++i) {
            ASSERT_TRUE(runUntilEvent("draw"));
            EXPECT_EQ(remnants(), 0) << name << ", step " << i;
        }
        EXPECT_EQ(WalkStepIndex, step + 10) << "the walk goes on";
        closeStage();
    }
}

TEST_F(ShowStage, TheBubbleComesOffAStageOfAnotherSize) {
    putToon("a.zkt", "A caption that stands in the middle, and so elsewhere on another stage",
            {{512, 110, 0, 3, 0, "Up here!", 0}, {200, 400, 0, 3, 0, "", 0}});
    openStage(1024, 768);
    ASSERT_TRUE(runUntilEvent("bubble_show"));
    MoveWindow(stage, 0, 0, 1200, 900, FALSE);
    ASSERT_TRUE(runUntilEvent("bubble_hide"));
    ASSERT_TRUE(runUntilEvent("draw"));
    EXPECT_EQ(remnants(), 0);
}

TEST_F(ShowStage, AStageThatOnlyMovesStaysAsItIs) {
    walkThroughCaption();
    MoveWindow(stage, 30, 20, 1024, 768, FALSE);
    EXPECT_THAT(events({"rebuild_backdrop"}), IsEmpty());
    EXPECT_EQ(StageRepaintFlag, 0U);
    EXPECT_EQ(remnants(), 0);
}
