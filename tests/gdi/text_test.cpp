// Text as it stands in the pixels.
#include "tests/gdi/pictures.h"

#include <algorithm>
#include <gtest/gtest.h>

using namespace test;

namespace {

HFONT makeFont(int height, int weight = 400, int escapement = 0) {
    return CreateFontA(height, 0, escapement, 0, weight, 0, 0, 0, 0, 0, 0, 0, 0, "MS Serif");
}

HFONT bubbleFont() {
    static const HFONT font = makeFont(-14); // one for all tests
    return font;
}

SIZE sizeOf(const char* text, HFONT font) {
    const Memory memory({"W"});
    SelectObject(memory.dc, font);
    SIZE size{};
    GetTextExtentPointA(memory.dc, text, static_cast<int>(std::string(text).size()), &size);
    return size;
}

int widthOf(const char* text) {
    return sizeOf(text, bubbleFont()).cx;
}

int lineHeight() {
    return sizeOf("", bubbleFont()).cy;
}

struct Drawn {
    int height; // as DrawText tells it
    RECT cells;
    RECT ink;
};

/// Draws a text in red on blue on a green picture.
Drawn draw(const char* text, RECT area, UINT format, int length = -1, int mode = OPAQUE) {
    const Memory memory(plain(140, 100, 'G'));
    SelectObject(memory.dc, bubbleFont());
    SetTextColor(memory.dc, RGB(255, 0, 0));
    SetBkColor(memory.dc, RGB(0, 0, 255));
    SetBkMode(memory.dc, mode);
    const int height = DrawTextA(memory.dc, text, length, &area, format);
    Rows rows = memory.text();
    const RECT ink = boundsOf(rows, 'R');
    for (std::string& row : rows) {
        EXPECT_EQ(row.find('?'), std::string::npos) << "no shades between ink and ground";
        std::replace(row.begin(), row.end(), 'R', 'B');
    }
    return {height, boundsOf(rows, 'B'), ink};
}

constexpr RECT roomy{10, 20, 140, 100};

} // namespace

TEST(Text, FillsTheCellsOfItsLinesUnlessTransparent) {
    const Drawn opaque = draw("Hi", roomy, DT_LEFT);
    EXPECT_EQ(opaque.cells, (RECT{10, 20, 10 + widthOf("Hi"), 20 + lineHeight()}));
    EXPECT_NEAR(opaque.ink.bottom - opaque.ink.top, 10, 2);
    const Drawn transparent = draw("Hi", roomy, DT_LEFT, -1, TRANSPARENT);
    EXPECT_EQ(transparent.ink, opaque.ink);
    EXPECT_EQ(transparent.cells, opaque.ink);
}

TEST(Text, LinesStandWhereTheFormatSays) {
    const int high = lineHeight();
    const int wide = widthOf("HHH");
    const UINT oneLine = DT_SINGLELINE | DT_VCENTER;
    const UINT bubble = DT_CENTER | DT_WORDBREAK | DT_NOPREFIX;
    const RECT narrow{5, 3, 5 + wide, 90};
    const RECT low{9, 9, 9 + wide, 10 + 2 * high};
    const std::tuple<const char*, RECT, UINT, int, RECT> cases[] = {
        {"", roomy, DT_LEFT, 0, {0, 0, 0, 0}},
        {"HHH", {10, 20, 11 + wide, 100}, DT_CENTER, 1, {10, 20, 10 + wide, 20 + high}},
        {"HHH\rI", {10, 20, 14 + wide, 99}, DT_CENTER, 2, {12, 20, 12 + wide, 20 + 2 * high}},
        {"HHH HH", narrow, DT_WORDBREAK, 2, {5, 3, 5 + wide, 3 + 2 * high}},
        {"HHH", {10, 20, 14, 25}, DT_LEFT, 1, {10, 20, 14, 25}},
        {"HHH", {10, 20, 14, 25}, DT_NOCLIP, 1, {10, 20, 10 + wide, 20 + high}},
        {"HHH\r\rI", {0, -high, 140, 100}, DT_LEFT, 3, {0, high, widthOf("I"), 2 * high}},
        {"HHH", {10, 20, 140, 25 + high}, oneLine, 1, {10, 22, 10 + wide, 22 + high}},
        {"HHH HHH HHH", low, bubble, 3, low}, // cut at the lower edge
    };
    for (const auto& [text, area, format, lines, cells] : cases) {
        const Drawn drawn = draw(text, area, format);
        EXPECT_EQ(drawn.height, lines * high) << text;
        EXPECT_EQ(drawn.cells, cells) << text;
    }
}

TEST(Text, AnAmpersandUnderlinesUnlessNoPrefixStands) {
    const Drawn underlined = draw("&H", roomy, DT_LEFT);
    EXPECT_EQ(underlined.ink.left, 10);
    EXPECT_EQ(underlined.ink.right, 10 + widthOf("H"));
    EXPECT_LT(draw("H", roomy, DT_LEFT).ink.bottom, underlined.ink.bottom);
    EXPECT_EQ(draw("&H", roomy, DT_NOPREFIX).cells.right, 10 + widthOf("&H"));
}

TEST(Text, FontsDifferInSizeAndWeight) {
    const SIZE regular = sizeOf("Dorbo", bubbleFont());
    EXPECT_NEAR(sizeOf("Dorbo", makeFont(-28)).cx, 2 * regular.cx, 4);
    EXPECT_NEAR(sizeOf("Dorbo", makeFont(14)).cy, 13.5, 0.5) << "the height of the cells";
    EXPECT_GT(sizeOf("Dorbo", makeFont(-14, 700)).cx, regular.cx);
    EXPECT_FALSE(makeFont(-14, 400, 1));
}
