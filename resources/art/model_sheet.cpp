#include "resources/art/model_sheet.h"

#include "resources/art/figure.h"
#include "resources/art/head.h"
#include "resources/art/poses.h"
#include "resources/art/walk.h"
#include "resources/art/wardrobe.h"

#include <algorithm>
#include <iterator>

namespace art {

namespace {

constexpr int Scale = 3;
constexpr int FaceSize = 62;
constexpr int SwatchSize = 16;

struct Face {
    Eyes eyes;
    Mouth mouth;
    Brows brows;
};

constexpr Face Faces[] = {
    {Eyes::Open, Mouth::Smile, Brows::Level},   {Eyes::Shut, Mouth::Smile, Brows::Level},
    {Eyes::Open, Mouth::Open, Brows::Level},    {Eyes::Open, Mouth::Round, Brows::Level},
    {Eyes::Open, Mouth::Grin, Brows::Raised},   {Eyes::Merry, Mouth::Laugh, Brows::Raised},
    {Eyes::Wide, Mouth::Gasp, Brows::High},     {Eyes::Aside, Mouth::Whisper, Brows::OneUp},
    {Eyes::Open, Mouth::Musing, Brows::Worried}};
constexpr double Turns[] = {0, 1, 1.5};

// Top of the cap, chin, hem of the coat, soles.
constexpr int Measures[] = {4, 46, 88, static_cast<int>(Ground)};

constexpr Ink Inks[] = {Skin,      SkinShade,     Blush,     HairShade,    Felt,
                        FeltShade, Trim,          TrimShade, Bobble,       BobbleShade,
                        Linen,     LinenShade,    CoatGlow,  Coat,         CoatShade,
                        Trousers,  TrousersShade, Leather,   LeatherShade, Line};

Figure fromTheFront() {
    Figure figure = turningRight(2);
    figure.turn = 0;
    figure.head.turn = 0;
    figure.head.mouthCell.x = figure.head.eyeCell.x;
    figure.head.capSwing = 0;
    return figure;
}

Picture drawFace(double turn, const Face& face) {
    Head head;
    head.eyeCell = {26, 20};
    head.mouthCell = {26 + 4 * std::min(turn, 1.0), 36};
    head.turn = turn;
    head.eyes = face.eyes;
    head.mouth = face.mouth;
    head.brows = face.brows;
    Picture picture(FaceSize, FaceSize);
    paintHead(picture, head);
    return picture;
}

Picture drawSwatch(Ink ink) {
    Picture picture(SwatchSize, SwatchSize, Line);
    for (int i = 0; i < (SwatchSize - 2) * (SwatchSize - 2); ++i) {
        const int x = 1 + i % (SwatchSize - 2);
        const int y = 1 + i / (SwatchSize - 2);
        picture.set(x, y, ink.at(x, y));
    }
    return picture;
}

void drawMeasures(Image& sheet) {
    for (const int measure : Measures) {
        Picture line(sheet.width / Scale, 1, LightGrey);
        place(sheet, line, 0, measure * Scale, Scale);
    }
}

} // namespace

Image drawModelSheet() {
    const Figure figures[] = {fromTheFront(), turningRight(2), turningRight(1), walkingRight(1)};
    Image sheet(Scale * 4 * FigureSize, Scale * (FigureSize + 3 * FaceSize + SwatchSize + 8));
    std::fill(sheet.pixels.begin(), sheet.pixels.end(), Rgba{240, 240, 232, 255});
    drawMeasures(sheet);
    int left = 0;
    for (const Figure& figure : figures) {
        place(sheet, drawFigure(figure), left, 0, Scale);
        left += Scale * FigureSize;
    }
    int top = Scale * FigureSize;
    for (const double turn : Turns) {
        left = 0;
        for (const Face& face : Faces) {
            place(sheet, drawFace(turn, face), left, top, Scale);
            left += sheet.width / static_cast<int>(std::size(Faces));
        }
        top += Scale * FaceSize;
    }
    left = 0;
    for (const Ink& ink : Inks) {
        place(sheet, drawSwatch(ink), left + 4 * Scale, top + 4 * Scale, Scale);
        left += sheet.width / static_cast<int>(std::size(Inks));
    }
    return sheet;
}

} // namespace art
