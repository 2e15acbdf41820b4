// Where the parts of the main window lie, what drags it, and what is drawn.
#include "tests/editor/editor_fixture.h"

#include "stage/player.h"

namespace {

class Chrome : public EditorTest {
  protected:
    void SetUp() override {
        EditorTest::SetUp();
        openAtRest();
    }

    /// The size that its client area has on a screen of 1024x768.
    static void sizeAsOnLargerScreen() {
        MoveWindow(EditorMainWindow, 14, 16, 996, 735, TRUE);
        pass(0);
    }

    static std::vector<LONG> inMain(HWND window) {
        RECT main{};
        RECT place{};
        GetWindowRect(EditorMainWindow, &main);
        GetWindowRect(window, &place);
        const LONG x = main.left + 1; // behind its border
        const LONG y = main.top + 1;
        return {place.left - x, place.top - y, place.right - x, place.bottom - y};
    }

    static std::vector<LONG> edges(const RECT& place) {
        return {place.left, place.top, place.right, place.bottom};
    }

    static LRESULT hit(LONG x, LONG y) {
        RECT main{};
        GetWindowRect(EditorMainWindow, &main);
        return SendMessageA(EditorMainWindow, WM_NCHITTEST, 0,
                            static_cast<LPARAM>(MAKELONG(main.left + 1 + x, main.top + 1 + y)));
    }

    static DWORD pixel(LONG x, LONG y) {
        const seam::Picture picture = seam::windowPicture(EditorMainWindow);
        return picture.pixels[static_cast<std::size_t>(y * picture.width + x)];
    }
};

using Edges = std::vector<LONG>;

TEST_F(Chrome, FollowsTheScreenAndTheWindow) {
    RECT main{};
    GetWindowRect(EditorMainWindow, &main);
    EXPECT_EQ(edges(main), (Edges{14, 16, 786, 783}));
    EXPECT_EQ(StageSize, DWORD(MAKELONG(750, 700)));
    EXPECT_EQ(inMain(EditorStage), (Edges{10, 25, 760, 725}));
    sizeAsOnLargerScreen();
    const std::tuple<const char*, Edges, Edges> cases[] = {
        {"File", inMain(FileButton), {10, 701, 85, 724}},
        {"Play", inMain(PlayButton), {909, 701, 984, 724}},
        {"walk", inMain(WalkButton), {10, 4, 42, 19}},
        {"minimise", inMain(MinimizeButton), {954, 4, 969, 19}},
        {"close", inMain(CloseButton), {969, 4, 984, 19}},
        {"frame", edges(FrameRect), {8, 23, 986, 695}},
        {"left cap", edges(CaptionLeftCap), {8, 3, 43, 20}},
        {"right cap", edges(CaptionRightCap), {952, 3, 986, 20}},
    };
    for (const auto& [name, is, shouldBe] : cases) {
        EXPECT_EQ(is, shouldBe) << name;
    }
}

TEST_F(Chrome, TheCaptionStandsInTheMiddleWhateverItsLength) {
    const std::string captions[] = {"", "Dorbo", std::string(24, 'i'), std::string(48, 'W')};
    LONG narrower = -1;
    for (const std::string& caption : captions) {
        CopyText(CaptionText, caption.c_str(), TOON_CAPTION_SIZE);
        LayoutChrome(EditorMainWindow);
        const LONG width = CaptionTextRect.right - CaptionTextRect.left;
        const LONG c = 8 + (762 - width - 8 - 10) / 2;
        EXPECT_GT(width, narrower);
        EXPECT_EQ(edges(CaptionLeftBar), (Edges{44, 3, c, 20})) << caption;
        EXPECT_EQ(edges(CaptionTextRect), (Edges{c + 5, 2, c + 5 + width, 22})) << caption;
        EXPECT_EQ(edges(CaptionRightBar), (Edges{c + 10 + width, 3, 727, 20})) << caption;
        InvalidateRect(EditorMainWindow, nullptr, TRUE);
        pass(0);
        narrower = width;
    }
}

TEST_F(Chrome, BarsAndCaptionDragTheWindowAndNothingElseDoes) {
    const LONG text = CaptionTextRect.left;
    const LONG end = CaptionTextRect.right;
    const std::tuple<LONG, LONG, LRESULT> cases[] = {
        {43, 10, HTNOWHERE},       {44, 10, HTCAPTION},       {100, 2, HTNOWHERE},
        {100, 3, HTCAPTION},       {100, 19, HTCAPTION},      {100, 20, HTNOWHERE},
        {text - 6, 10, HTCAPTION}, {text - 5, 10, HTNOWHERE}, {text, 1, HTNOWHERE},
        {text, 2, HTCAPTION},      {end - 1, 21, HTCAPTION},  {end, 10, HTNOWHERE},
        {end + 5, 10, HTCAPTION},  {726, 10, HTCAPTION},      {727, 10, HTNOWHERE},
        {9, 10, HTNOWHERE},        {8, 300, HTNOWHERE},       {300, 740, HTNOWHERE},
    };
    for (const auto& [x, y, what] : cases) {
        EXPECT_EQ(hit(x, y), what) << x << ' ' << y;
    }
    EXPECT_EQ(SendMessageA(EditorStage, WM_NCHITTEST, 0, 0), HTCLIENT);
}

TEST_F(Chrome, TheBarOfProgressShowsHowFarTheShowHasCome) {
    constexpr DWORD done = 0x000080;
    constexpr DWORD toCome = 0xC0C0C0;
    sizeAsOnLargerScreen();
    FrameCount = 4;
    const std::tuple<LONG, LONG, DWORD> cases[] = {
        // NextFrameIndex, x, colour
        {0, 100, toCome}, {1, 100, done},   {1, 290, done}, {1, 298, toCome},
        {3, 690, done},   {3, 710, toCome}, {4, 890, done},
    };
    for (const auto& [next, x, colour] : cases) {
        NextFrameIndex = next;
        DrawProgress(EditorMainWindow);
        EXPECT_EQ(pixel(x, 710), colour) << next << ' ' << x;
    }
    NextFrameIndex = 0;
    FrameCount = 1;
}

TEST_F(Chrome, CaptionBarsTellOfActivationUntilTheNextPaint) {
    constexpr DWORD active = 0x000080;
    constexpr DWORD inactive = 0xC0C0C0;
    SendMessageA(EditorMainWindow, WM_ACTIVATE, WA_INACTIVE, 0);
    EXPECT_EQ(pixel(60, 10), inactive);
    InvalidateRect(EditorMainWindow, nullptr, TRUE);
    pass(0);
    EXPECT_EQ(pixel(60, 10), active);
}

} // namespace
