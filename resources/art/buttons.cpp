#include "resources/art/buttons.h"

#include <cstddef>
#include <string>
#include <vector>

namespace art {

namespace {

// A pressed button shows its picture without the last row and column of the eleven, so these are
// free.
void engrave(Picture& picture, int left, int top, const std::vector<std::string>& rows,
             Colour colour) {
    for (std::size_t y = 0; y < rows.size(); ++y) {
        for (std::size_t x = 0; x < rows[y].size(); ++x) {
            if (rows[y][x] == '#') {
                picture.set(left + static_cast<int>(x), top + static_cast<int>(y), colour);
            }
        }
    }
}

} // namespace

Picture drawSysButtons() {
    Picture picture(44, 11, LightGrey);
    engrave(picture, 2, 7, {"#######", "#######"}, Black);
    engrave(picture, 13, 2,
            {"##...##", ".##.##.", "..###..", "...#...", "..###..", ".##.##.", "##...##"}, Black);
    engrave(picture, 28, 0,
            {".....###....", ".....###....", "....##......", "..######....", ".##.##.##...",
             ".#..##..##..", "....###.....", "...##.##....", ".###...##...", ".#......##.."},
            DarkBlue);
    return picture;
}

} // namespace art
