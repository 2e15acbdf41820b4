#include "resources/art/bubbles.h"

#include "resources/art/painter.h"

namespace art {

Picture drawBubble() {
    constexpr int Width = 160;
    constexpr int Height = 95;
    // The text takes the columns 30 to 150 and the rows from 26 on down to the last: there the
    // balloon is white, and its corners are round outside of that.
    const Outline body = {{26, 1.0},    {152, 1.0},    {155.5, 2.0},  {157.5, 4.0},
                          {158.8, 8.0}, {158.8, 87.0}, {157.5, 91.0}, {155.5, 93.0},
                          {152, 94.0},  {26, 94.0},    {22.5, 93.0},  {20.5, 91.0},
                          {19.2, 87.0}, {19.2, 8.0},   {20.5, 4.0},   {22.5, 2.0}};
    const Outline tail = {{22, 40}, {17, 42}, {9, 47}, {-1, 50.5}, {9, 52.5}, {17, 55}, {22, 59}};
    Picture picture(Width, Height);
    paintOutlined(picture, {{body, tail}, White, White, 0}, DarkBlue);
    return picture;
}

} // namespace art
