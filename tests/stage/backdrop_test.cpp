#include "tests/stage/stage_fixture.h"

#include <set>
#include <sstream>

namespace {

class Backdrop : public StageTest {
  protected:
    std::vector<DWORD> build(LONG index) const {
        BackgroundIndex = index;
        RebuildBackdrop(stage, GetModuleHandleA(nullptr));
        return seam::bitmapPicture(BackdropBitmap).pixels;
    }

    /// The pixels of some rows of the stage.
    std::vector<DWORD> rows(LONG top, LONG bottom) const {
        const std::vector<DWORD> all = pixels();
        return {all.begin() + top * 1024, all.begin() + bottom * 1024};
    }

    /// What a repaint has drawn beyond a picture: "left,top-right,bottom", then the colours.
    std::string drawnBeyond(const std::vector<DWORD>& before) const {
        const std::vector<DWORD> now = pixels();
        std::set<std::size_t> columns, lines;
        std::set<DWORD> colours;
        for (std::size_t pixel = 0; pixel < now.size(); ++pixel) {
            if (now[pixel] != before[pixel]) {
                columns.insert(pixel % 1024);
                lines.insert(pixel / 1024);
                colours.insert(now[pixel]);
            }
        }
        std::ostringstream told;
        if (!colours.empty()) {
            told << *columns.begin() << ',' << *lines.begin() << '-' << *columns.rbegin() << ','
                 << *lines.rbegin() << std::hex;
        }
        for (const DWORD colour : colours) {
            told << ' ' << colour;
        }
        return told.str();
    }
};

} // namespace

TEST_F(Backdrop, TilesCoverTheStageFromTheTopLeftInTheirOwnColours) {
    const auto expectTiles = [this](LONG index, int width, int height) {
        char name[TILE_NAME_SIZE];
        TileName(name, index >= 1 && index <= 10 ? index : 1); // that of a missing number too
        const HBITMAP plain = LoadBitmapA(GetModuleHandleA(nullptr), name);
        const seam::Picture tile = seam::bitmapPicture(plain);
        DeleteObject(plain);
        std::vector<DWORD> expected;
        for (int y = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x) {
                const int place = y % tile.height * tile.width + x % tile.width;
                expected.push_back(tile.pixels.at(static_cast<std::size_t>(place)));
            }
        }
        EXPECT_TRUE(build(index) == expected) << index;
        repaint();
        EXPECT_TRUE(pixels() == expected) << index;
    };
    for (const LONG index : {0, 1, 2, 9, 10, 11, -4, 2147483647}) {
        expectTiles(index, 1024, 768);
    }
    openStage(801, 641); // one more than whole tiles of 80
    expectTiles(10, 801, 641);
}

TEST_F(Backdrop, AColourTableIsAsLongAsTheFileSaysOrItsBitsNeed) {
    for (const char* name : {"eight_bits", "four_bits", "no_table"}) { // green above blue
        const HDC dc = GetDC(stage);
        const HBITMAP bitmap = LoadPaletteBitmap(GetModuleHandleA(nullptr), dc, name);
        EXPECT_EQ(seam::bitmapPicture(bitmap).pixels, (std::vector<DWORD>{0x00FF00, 0x0000FF}))
            << name;
        DeleteObject(bitmap);
        ReleaseDC(stage, dc);
    }
}

TEST_F(Backdrop, BlanksTheStageOnlyInASaverOnceTheTitleIsPainted) {
    const std::tuple<DWORD, LONG, DWORD, LONG, bool> cases[] = {
        {1, 1, 1, 2, true},  {0, 1, 1, 2, false}, {1, 0, 1, 2, false},
        {1, 1, 0, 2, false}, {1, 7, 1, 2, true},  {1, 1, 1, 1, true},
        {1, 1, 1, -1, true}, {1, 1, 1, 99, true}, {1, 1, 1, 0, false}, // loaded without its palette
    };
    for (const auto& [saver, backgrounds, title, index, isBlank] : cases) {
        repaint();
        SaverActive = saver;
        Backgrounds = backgrounds;
        TitleShown = title;
        build(index);
        const std::vector<DWORD> shown = pixels();
        const bool blank = shown[0] == 0 && shown[1024] == 0 && shown[1024 + 1] == 0xC0C0C0;
        EXPECT_EQ(blank, isBlank) << saver << backgrounds << title << ' ' << index;
        SaverActive = TitleShown = 1;
    }
}

TEST_F(Backdrop, ShowsTheBigTitleOnceAndThenTheCaptionInTheSaverOnly) {
    const std::vector<DWORD> bare = pixels();
    const std::vector<DWORD> captionLine = rows(0, 24);
    const std::vector<DWORD> titleLine = rows(214, 260);  // 170 above the middle
    const std::vector<DWORD> bylineLine = rows(304, 330); // 80 above it
    const std::vector<DWORD> topLine = rows(0, 20);
    TitleShown = 0;
    CopyText(StageTitle, "Fenky Dorbo Screen Saver", sizeof StageTitle);
    repaint();
    EXPECT_EQ(TitleShown, 1U);
    EXPECT_NE(rows(214, 260), titleLine);
    EXPECT_NE(rows(304, 330), bylineLine);
    repaint();
    EXPECT_EQ(pixels(), bare) << "an empty caption draws nothing";
    CopyText(CaptionText, "A caption", sizeof CaptionText);
    repaint();
    EXPECT_NE(rows(0, 24), captionLine);
    SaverActive = 0;
    repaint();
    EXPECT_EQ(pixels(), bare) << "the editor's stage has no caption";
    PreviewMode = PREVIEW_WALK;
    TitleShown = 0;
    repaint();
    EXPECT_NE(pixels(), bare);
    EXPECT_EQ(rows(0, 20), topLine);
    EXPECT_EQ(TitleShown, 0U);
    PreviewMode = 0;
}

TEST_F(Backdrop, TitlesHaveTheirPlacesColoursAndShadows) {
    // The big title's lines begin 170 and 80 above the middle, at 384, the preview's at 20; their
    // letters a little below that.
    const std::vector<DWORD> bare = pixels();
    CopyText(CaptionText, "A caption", sizeof CaptionText);
    repaint();
    EXPECT_EQ(drawnBeyond(bare), "474,5-550,22 808080 c0c0c0");
    CaptionText[0] = '\0';
    TitleShown = 0;
    CopyText(StageTitle, "Dorbo", sizeof StageTitle);
    repaint();
    EXPECT_EQ(drawnBeyond(bare), "437,221-585,326 ff 808080 ffffff");
    PreviewMode = PREVIEW_WALK;
    repaint();
    EXPECT_EQ(drawnBeyond(bare), "454,24-568,60 ff 808080 ffffff");
    PreviewMode = 0;
}

TEST_F(Backdrop, SavesWhatLiesUnderHimOnlyWhenAsked) {
    const std::vector<DWORD> bare = pixels();
    stand(300, 300);
    StageRepaintFlag = 1;
    repaint();
    EXPECT_EQ(StageRepaintFlag, 0U);
    const std::vector<DWORD> standing = pixels();
    EXPECT_NE(standing, bare);
    repaint();
    EXPECT_EQ(pixels(), standing);
    const HDC dc = GetDC(stage);
    SpriteRestoreUnder(dc, &CharacterSprite);
    ReleaseDC(stage, dc);
    EXPECT_EQ(pixels(), bare);
}

TEST_F(Backdrop, TheEditorsStageKeepsItsPlaceAndSize) {
    MoveWindow(stage, 3, 4, 50, 60, FALSE);
    EXPECT_EQ(ResizeStage(stage), 0);
    RECT place = {};
    GetWindowRect(stage, &place);
    EXPECT_EQ(place.left, 10);
    EXPECT_EQ(place.top, 25);
    EXPECT_EQ(pixels().size(), 1024U * 768U);
}

TEST_F(Backdrop, TheEditorsStageMakesHisImageAnewInItsSize) {
    stand(300, 300);
    repaint();
    const std::vector<DWORD> before = pixels();
    CharacterSprite.frameBitmap = CharacterArt[CHARACTER_PICTURES - 1];
    repaint();
    EXPECT_EQ(pixels(), before) << "he is drawn from the image";
    ResizeStage(stage);
    repaint();
    EXPECT_NE(pixels(), before);
}
