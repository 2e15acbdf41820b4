// Text as it stands in the pixels.
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

using namespace test;

namespace {

constexpr RECT nothing{0, 0, 0, 0};

HFONT makeFont(int height, int weight = 400) {
    return CreateFontA(height, 0, 0, 0, weight, 0, 0, 0, 0, 0, 0, 0, 0, "MS Serif");
}

/// A green picture on which text is drawn in black with a font of 14 pixels.
class Text : public testing::Test {
  public:
    Text(const Text&) = delete;
    Text& operator=(const Text&) = delete;

  protected:
    Text() : font_(makeFont(-14)), before_(SelectObject(memory_.dc, font_)) {
        TEXTMETRICA metrics{};
        GetTextMetricsA(memory_.dc, &metrics);
        lineHeight_ = metrics.tmHeight;
    }

    ~Text() override {
        SelectObject(memory_.dc, before_);
        DeleteObject(font_);
    }

    int draw(const char* text, RECT area, UINT format) const {
        return DrawTextA(memory_.dc, text, -1, &area, format);
    }

    int widthOf(const std::string& text) const {
        SIZE size{};
        GetTextExtentPointA(memory_.dc, text.c_str(), static_cast<int>(text.size()), &size);
        return size.cx;
    }

    /// Bounds of what isn't green any more.
    RECT cells() {
        Rows rows = memory_.text();
        for (std::string& row : rows) {
            for (char& pixel : row) {
                pixel = pixel == 'G' ? 'G' : 'R';
            }
        }
        return boundsOf(rows, 'R');
    }

    RECT ink() {
        return boundsOf(memory_.text(), '.');
    }

    Memory memory_{Rows(100, std::string(140, 'G'))};
    HFONT font_;
    HGDIOBJ before_;
    int lineHeight_ = 0;
};

} // namespace

TEST_F(Text, OpaqueModeFillsTheCellsOfALine) {
    EXPECT_EQ(draw("Hi", {10, 20, 140, 100}, DT_LEFT), lineHeight_);
    EXPECT_EQ(cells(), (RECT{10, 20, 10 + widthOf("Hi"), 20 + lineHeight_}));
    const RECT letters = ink();
    EXPECT_GE(letters.bottom - letters.top, 8);
    EXPECT_LE(letters.bottom - letters.top, 12);
    for (const std::string& row : memory_.text()) {
        EXPECT_EQ(row.find('?'), std::string::npos) << "no shades between ink and ground";
    }
}

TEST_F(Text, TransparentModeLeavesTheGround) {
    SetBkMode(memory_.dc, TRANSPARENT);
    draw("Hi", {10, 20, 140, 100}, DT_LEFT);
    EXPECT_EQ(boundsOf(memory_.text(), 'W'), nothing);
    EXPECT_NE(ink(), nothing);
}

TEST_F(Text, ColoursAreTheContexts) {
    SetTextColor(memory_.dc, RGB(255, 0, 0));
    SetBkColor(memory_.dc, RGB(0, 0, 255));
    draw("Hi", {10, 20, 140, 100}, DT_LEFT);
    EXPECT_EQ(boundsOf(memory_.text(), 'B'), (RECT{10, 20, 10 + widthOf("Hi"), 20 + lineHeight_}));
    EXPECT_NE(boundsOf(memory_.text(), 'R'), nothing);
    EXPECT_EQ(ink(), nothing);
}

TEST_F(Text, EachLineIsCentred) {
    EXPECT_EQ(draw("wide line\ri", {10, 20, 131, 100}, DT_CENTER), 2 * lineHeight_);
    const Rows rows = memory_.text();
    const int wide = widthOf("wide line");
    const int narrow = widthOf("i");
    const std::ptrdiff_t top = 20 + lineHeight_;
    const Rows second(rows.begin() + top, rows.end());
    EXPECT_EQ(cells(), (RECT{10 + (121 - wide) / 2, 20, 10 + (121 - wide) / 2 + wide,
                             20 + 2 * lineHeight_}));
    EXPECT_EQ(boundsOf(second, 'W').left, 10 + (121 - narrow) / 2);
    EXPECT_EQ(boundsOf(second, 'W').right, 10 + (121 - narrow) / 2 + narrow);
}

TEST_F(Text, WordsThatDontFitGoToTheNextLine) {
    const RECT area{5, 3, 5 + widthOf("some words"), 90};
    EXPECT_EQ(draw("some words here", area, DT_WORDBREAK), 2 * lineHeight_);
    EXPECT_EQ(cells(), (RECT{5, 3, area.right, 3 + 2 * lineHeight_}));
    EXPECT_EQ(draw("some words here", area, DT_LEFT), lineHeight_);
}

TEST_F(Text, ALongTextIsCutAtTheLowerEdgeOfItsBubble) {
    const char* text = "This text has sixty-nine characters, as many as a frame takes at most";
    const RECT area{10, 10, 130, 10 + 4 * lineHeight_ + 1};
    EXPECT_EQ(draw(text, area, DT_CENTER | DT_WORDBREAK | DT_NOPREFIX), 5 * lineHeight_);
    const RECT drawn = cells();
    EXPECT_EQ(drawn.top, area.top);
    EXPECT_EQ(drawn.bottom, area.bottom);
    EXPECT_GT(drawn.left, area.left);
    EXPECT_LT(drawn.right, area.right);
}

TEST_F(Text, IsClippedToTheRectangleUnlessNoClipStands) {
    draw("Hxy", {10, 20, 14, 25}, DT_LEFT);
    EXPECT_EQ(cells(), (RECT{10, 20, 14, 25}));
    draw("Hxy", {10, 20, 14, 25}, DT_NOCLIP);
    EXPECT_EQ(cells(), (RECT{10, 20, 10 + widthOf("Hxy"), 20 + lineHeight_}));
}

TEST_F(Text, AboveTheTopEdgeOnlyWhatIsBelowItShows) {
    draw("a\rb\rc", {0, -lineHeight_, 140, 100}, DT_LEFT);
    EXPECT_EQ(cells().top, 0);
    EXPECT_EQ(cells().bottom, 2 * lineHeight_);
}

TEST_F(Text, OneLineIsCentredUpAndDown) {
    draw("H\rH", {10, 20, 140, 61}, DT_SINGLELINE | DT_VCENTER);
    EXPECT_EQ(cells().top, 20 + (41 - lineHeight_) / 2);
    EXPECT_EQ(cells().bottom - cells().top, lineHeight_);
}

TEST_F(Text, AnAmpersandUnderlinesUnlessNoPrefixStands) {
    draw("&H", {10, 20, 140, 100}, DT_LEFT);
    const RECT underlined = ink();
    EXPECT_EQ(cells().right, 10 + widthOf("H"));
    EXPECT_EQ(underlined.left, 10);
    EXPECT_EQ(underlined.right, 10 + widthOf("H"));
    const RECT all{0, 0, 140, 100};
    FillRect(memory_.dc, &all, HBRUSH{GetStockObject(WHITE_BRUSH)});
    draw("H", {10, 20, 140, 100}, DT_LEFT);
    EXPECT_LT(ink().bottom, underlined.bottom);
    FillRect(memory_.dc, &all, HBRUSH{GetStockObject(WHITE_BRUSH)});
    draw("&H", {10, 20, 140, 100}, DT_NOPREFIX);
    EXPECT_GT(ink().right, underlined.right);
}

TEST_F(Text, TakesAsManyCharactersAsAskedFor) {
    RECT area{10, 20, 140, 100};
    EXPECT_EQ(DrawTextA(memory_.dc, "HHHH", 2, &area, DT_LEFT), lineHeight_);
    EXPECT_EQ(cells().right, 10 + widthOf("HH"));
}

TEST_F(Text, NothingComesOfNothing) {
    RECT area{10, 20, 140, 100};
    EXPECT_EQ(draw("", area, DT_LEFT), 0);
    EXPECT_EQ(DrawTextA(memory_.dc, nullptr, 3, &area, DT_LEFT), 0);
    EXPECT_EQ(DrawTextA(memory_.dc, "text", -2, &area, DT_LEFT), 0);
    EXPECT_EQ(DrawTextA(memory_.dc, "text", -1, nullptr, DT_LEFT), 0);
    EXPECT_EQ(draw("text", {50, 50, 20, 20}, DT_LEFT), lineHeight_);
    EXPECT_EQ(cells(), nothing);
}

TEST_F(Text, UpperCharactersAreWindows1252) {
    EXPECT_GT(widthOf("\x85"), 2 * widthOf(".")) << "an ellipsis";
    EXPECT_GT(widthOf("\x97"), widthOf("\x96")) << "the em dash is longer than the en dash";
    EXPECT_GT(widthOf("\x80"), 0);
}

TEST_F(Text, FontsDifferInSizeAndWeight) {
    SIZE regular{};
    GetTextExtentPointA(memory_.dc, "Dorbo", 5, &regular);
    EXPECT_EQ(regular.cy, lineHeight_);
    HFONT bold = makeFont(-14, 700);
    HFONT large = makeFont(-28);
    HFONT cell = makeFont(14);
    SIZE size{};
    SelectObject(memory_.dc, bold);
    GetTextExtentPointA(memory_.dc, "Dorbo", 5, &size);
    EXPECT_GT(size.cx, regular.cx);
    SelectObject(memory_.dc, large);
    GetTextExtentPointA(memory_.dc, "Dorbo", 5, &size);
    EXPECT_NEAR(size.cx, 2 * regular.cx, 4);
    SelectObject(memory_.dc, cell);
    GetTextExtentPointA(memory_.dc, "Dorbo", 5, &size);
    EXPECT_LE(size.cy, 14);
    EXPECT_GE(size.cy, 13);
    SelectObject(memory_.dc, font_);
    for (HFONT font : {bold, large, cell}) {
        EXPECT_TRUE(DeleteObject(font));
    }
    EXPECT_FALSE(CreateFontA(-14, 0, 0, 0, 0, 1, 0, 0, 0, 0, 0, 0, 0, "MS Serif"));
}

TEST_F(Text, KeepsToTheClipOfAWindowAndTellsIt) {
    TestSurface surface(Rows(30, std::string(60, 'G')));
    HDC window = seam::makeSurfaceContext(surface, {12, 0, 60, 30});
    SelectObject(window, font_);
    RECT area{10, 5, 60, 30};
    DrawTextA(window, "HHH", -1, &area, DT_LEFT);
    const RECT drawn = boundsOf(surface.text(), 'W');
    EXPECT_EQ(drawn.left, 12);
    EXPECT_EQ(drawn.top, 5);
    EXPECT_EQ(surface.shown().front(), Rows(30, std::string(60, 'G')));
    ASSERT_FALSE(surface.touched.empty());
    EXPECT_LE(surface.touched.front().left, drawn.left);
    EXPECT_GE(surface.touched.front().right, drawn.right);
    EXPECT_GE(surface.touched.front().left, 12);
    DeleteDC(window);
}
