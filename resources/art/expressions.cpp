#include "resources/art/expressions.h"

#include "resources/art/poses.h"

namespace art {

namespace {

constexpr int Columns = 5;
constexpr int Pitch = CellSize + 1;

// Columns from the left: eyes shut, eyes as in the pose, two shapes of the mouth, mouth as in the
// pose.
Picture drawCell(int column, int number) {
    Figure figure = pose(number);
    figure.head.eyes = column == 0 ? Eyes::Shut : Eyes::Open;
    figure.head.mouth = column == 2 ? Mouth::Open : column == 3 ? Mouth::Round : Mouth::Smile;
    const auto index = static_cast<std::size_t>(number);
    const Point corner = column < 2 ? EyeCells[index] : MouthCells[index];
    return cut(drawFigure(figure), static_cast<int>(corner.x), static_cast<int>(corner.y), CellSize,
               CellSize);
}

} // namespace

Picture drawExpressions() {
    Picture sheet(Columns * Pitch - 1, PoseCount * Pitch - 1, White);
    for (int number = 0; number < PoseCount; ++number) {
        for (int column = 0; column < Columns; ++column) {
            const Picture cell = drawCell(column, number);
            for (int y = 0; y < CellSize; ++y) {
                for (int x = 0; x < CellSize; ++x) {
                    sheet.set(column * Pitch + x, number * Pitch + y, cell.at(x, y));
                }
            }
        }
    }
    return sheet;
}

} // namespace art
