#include "stage/backdrop.h"

#include "platform/kernel.h"
#include "stage/character.h"
#include "tests/stage/stage_fixture.h"
#include "toon/settings.h"

#include <cstdlib>

using testing::ElementsAre;

namespace {

class Backdrop : public StageTest {
  protected:
    std::vector<DWORD> build(LONG index) const {
        BackgroundIndex = index;
        RebuildBackdrop(stage, GetModuleHandleA(nullptr));
        return seam::bitmapPicture(BackdropBitmap).pixels;
    }

    void repaint() const {
        InvalidateRect(stage, nullptr, FALSE);
        UpdateWindow(stage);
    }
};

const RECT wholeStage = {0, 0, 1024, 768};
const RECT captionLine = {0, 0, 1024, 24};

/// A memory context with a bitmap of its own, both gone at the end.
struct Canvas {
    Canvas(HWND window, int width, int height) {
        const HDC screen = GetDC(window);
        dc = CreateCompatibleDC(screen);
        bitmap = CreateCompatibleBitmap(screen, width, height);
        ReleaseDC(window, screen);
        before = SelectObject(dc, bitmap);
    }

    Canvas(const Canvas&) = delete;
    Canvas& operator=(const Canvas&) = delete;

    ~Canvas() {
        SelectObject(dc, before);
        DeleteDC(dc);
        DeleteObject(bitmap);
    }

    HDC dc;
    HBITMAP bitmap;
    HGDIOBJ before;
};

} // namespace

TEST_F(Backdrop, TilesFromTheTopLeftAndCutsAtRightAndBottom) {
    const Canvas tile(stage, 3, 2);
    const HGDIOBJ brushBefore = SelectObject(tile.dc, GetStockObject(WHITE_BRUSH));
    Rectangle(tile.dc, 0, 0, 2, 1);
    const HBRUSH white{GetStockObject(WHITE_BRUSH)};
    const RECT corner = {0, 0, 1, 1};
    FillRect(tile.dc, &corner, white); // one white pixel at the corner
    SelectObject(tile.dc, brushBefore);
    SelectObject(tile.dc, tile.before);
    const Canvas target(stage, 7, 5);
    TileBitmap(target.dc, 0, 0, 7, 5, tile.bitmap);
    std::string picture;
    const seam::Picture drawn = seam::bitmapPicture(target.bitmap);
    for (std::size_t pixel = 0; pixel < drawn.pixels.size(); ++pixel) {
        picture += (drawn.pixels[pixel] & 0xFFFFFF) == 0xFFFFFF ? '#' : '.';
        picture += pixel % 7 == 6 ? "\n" : "";
    }
    EXPECT_EQ(picture, "#..#..#\n"
                       ".......\n"
                       "#..#..#\n"
                       ".......\n"
                       "#..#..#\n");
    TileBitmap(target.dc, 0, 0, 7, 5, nullptr);
}

TEST_F(Backdrop, ZeroAndOneShowTheSameTileAndAMissingNumberToo) {
    const std::vector<DWORD> plain = build(0);
    EXPECT_EQ(plain.size(), 1024U * 768U);
    for (const LONG index : {1, 11, 99, -4, 2147483647}) {
        EXPECT_EQ(build(index), plain) << index;
    }
    EXPECT_NE(build(10), plain);
    EXPECT_THAT(
        events({"rebuild_backdrop"}),
        ElementsAre("rebuild_backdrop index=0 tile=bg01", "rebuild_backdrop index=1 tile=bg01",
                    "rebuild_backdrop index=11 tile=bg01", "rebuild_backdrop index=99 tile=bg01",
                    "rebuild_backdrop index=-4 tile=bg01",
                    "rebuild_backdrop index=2147483647 tile=bg01",
                    "rebuild_backdrop index=10 tile=bg10"));
}

TEST_F(Backdrop, EveryNumberedTileHasTheColoursOfItsPlainLoad) {
    const HINSTANCE instance = GetModuleHandleA(nullptr);
    for (const char* name :
         {"bg01", "bg02", "bg03", "bg04", "bg05", "bg06", "bg07", "bg08", "bg09", "bg10"}) {
        const HDC dc = GetDC(stage);
        const HBITMAP byPalette = LoadPaletteBitmap(instance, dc, name);
        ReleaseDC(stage, dc);
        const HBITMAP plain = LoadBitmapA(instance, name);
        EXPECT_EQ(seam::bitmapPicture(byPalette).pixels, seam::bitmapPicture(plain).pixels) << name;
        EXPECT_FALSE(seam::bitmapPicture(plain).pixels.empty()) << name;
        DeleteObject(byPalette);
        DeleteObject(plain);
    }
}

TEST_F(Backdrop, BlanksTheStageOnlyInASaverOnceTheTitleIsPainted) {
    const struct {
        DWORD saver;
        LONG backgrounds;
        DWORD title;
        bool blank;
    } cases[] = {
        {1, 1, 1, true}, {0, 1, 1, false}, {1, 0, 1, false}, {1, 1, 0, false}, {1, 7, 1, true}};

    for (const auto& one : cases) {
        repaint();
        SaverActive = one.saver;
        Backgrounds = one.backgrounds;
        TitleShown = one.title;
        build(2);
        const std::vector<DWORD> shown = pixels({0, 0, 2, 2});
        const bool blank = shown == std::vector<DWORD>{0, 0, 0, 0xC0C0C0};
        EXPECT_EQ(blank, one.blank) << one.saver << one.backgrounds << one.title;
        SaverActive = 1;
        TitleShown = 1;
    }
}

TEST_F(Backdrop, ShowsTheBigTitleOnceAndThenTheCaptionInTheSaverOnly) {
    repaint();
    const std::vector<DWORD> bare = pixels(wholeStage);
    TitleShown = 0;
    std::snprintf(StageTitle, sizeof(StageTitle), "Fenky Dorbo Screen Saver");
    repaint();
    EXPECT_EQ(TitleShown, 1U);
    EXPECT_NE(pixels({0, 214, 1024, 260}), pixels({0, 160, 1024, 206}))
        << "title 170 above the middle";
    const std::vector<DWORD> titled = pixels(wholeStage);
    EXPECT_NE(titled, bare);
    repaint();
    EXPECT_EQ(pixels(wholeStage), bare) << "an empty caption draws nothing";
    CopyText(CaptionText, "A caption", sizeof(CaptionText));
    const std::vector<DWORD> bareLine = pixels(captionLine);
    repaint();
    EXPECT_NE(pixels(captionLine), bareLine);
    SaverActive = 0;
    repaint();
    EXPECT_EQ(pixels(wholeStage), bare) << "the editor's stage has no caption";
    PreviewMode = 1;
    TitleShown = 0;
    repaint();
    EXPECT_NE(pixels(wholeStage), bare);
    EXPECT_EQ(TitleShown, 0U);
}

TEST_F(Backdrop, SavesWhatLiesUnderHimOnlyWhenAsked) {
    CharacterSprite.x = CharacterSprite.drawX = 300;
    CharacterSprite.y = CharacterSprite.drawY = 300;
    RepaintFlag = 1;
    repaint();
    EXPECT_EQ(RepaintFlag, 0U);
    const HBITMAP saved = CharacterSprite.savedUnder;
    EXPECT_TRUE(saved);
    const RECT him = {300, 300, 430, 430};
    const std::vector<DWORD> standing = pixels(him);
    repaint();
    EXPECT_EQ(CharacterSprite.savedUnder, saved);
    EXPECT_EQ(pixels(him), standing);
    const HDC dc = GetDC(stage);
    SpriteRestoreUnder(dc, &CharacterSprite);
    ReleaseDC(stage, dc);
    EXPECT_NE(pixels(him), standing);
}

TEST_F(Backdrop, TheEditorsStageKeepsItsPlaceAndSize) {
    MoveWindow(stage, 3, 4, 50, 60, FALSE);
    EXPECT_EQ(ResizeStage(stage), 0);
    RECT client = {};
    GetClientRect(stage, &client);
    EXPECT_EQ(client.right, 1024);
    EXPECT_EQ(client.bottom, 768);
}
