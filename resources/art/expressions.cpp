#include "resources/art/expressions.h"

#include "resources/art/poses.h"

#include <array>

namespace art {

namespace {

constexpr int Columns = 5;
constexpr int Pitch = CellSize + 1;

// The two shapes of the mouth in which he talks in each pose, so that his mood lasts.
constexpr std::array<std::array<Mouth, 2>, PoseCount> TalkingMouths = {
    {{Mouth::Open, Mouth::Round},
     {Mouth::Yell, Mouth::Peep},
     {Mouth::Open, Mouth::Round},
     {Mouth::Open, Mouth::Round},
     {Mouth::Laugh, Mouth::Open},
     {Mouth::Mumble, Mouth::Mutter},
     {Mouth::Roar, Mouth::Grin},
     {Mouth::Purse, Mouth::Hush}}};

void copyCell(Picture& sheet, int column, int number, const Picture& figure, Point corner) {
    for (int y = 0; y < CellSize; ++y) {
        for (int x = 0; x < CellSize; ++x) {
            const auto colour =
                figure.at(static_cast<int>(corner.x) + x, static_cast<int>(corner.y) + y);
            sheet.set(column * Pitch + x, number * Pitch + y, colour);
        }
    }
}

Picture drawFace(int number, Eyes eyes, Mouth mouth) {
    Figure figure = pose(number);
    figure.head.eyes = eyes;
    figure.head.mouth = mouth;
    return drawFigure(figure);
}

// Columns from the left: eyes shut, eyes as in the pose, two shapes of the mouth, mouth as in the
// pose.
void drawRow(Picture& sheet, int number) {
    const Point eyes = EyeCells[static_cast<std::size_t>(number)];
    const Point mouth = MouthCells[static_cast<std::size_t>(number)];
    const Figure figure = pose(number);
    const Picture plain = drawFigure(figure);
    const auto& mouths = TalkingMouths[static_cast<std::size_t>(number)];
    const Picture talking = drawFace(number, Eyes::Shut, mouths[0]);
    const Picture other = drawFace(number, figure.head.eyes, mouths[1]);
    copyCell(sheet, 0, number, talking, eyes);
    copyCell(sheet, 1, number, plain, eyes);
    copyCell(sheet, 2, number, talking, mouth);
    copyCell(sheet, 3, number, other, mouth);
    copyCell(sheet, 4, number, plain, mouth);
}

} // namespace

Picture drawExpressions() {
    Picture sheet(Columns * Pitch - 1, PoseCount * Pitch - 1, White);
    for (int number = 0; number < PoseCount; ++number) {
        drawRow(sheet, number);
    }
    return sheet;
}

} // namespace art
