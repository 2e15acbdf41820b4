#pragma once

#include "resources/art/outline.h"
#include "resources/art/painter.h"
#include "resources/art/picture.h"

namespace art {

enum class Eyes { Open, Shut, Wide, Merry, Aside };
enum class Mouth {
    Smile,
    Open,
    Round,
    Grin,
    Laugh,
    Roar,
    Gasp,
    Yell,
    Peep,
    Whisper,
    Purse,
    Hush,
    Musing,
    Mumble,
    Mutter
};
enum class Brows { Level, Raised, High, OneUp, Worried };

constexpr int CellSize = 10;

// His head. Everything else about it follows from where eyes and mouth are: the face is as long as
// the way between them.
struct Head {
    // Top left corners of the fields of ten by ten pixels in which both eyes and the mouth lie.
    Point eyeCell;
    Point mouthCell;
    // 0 looks at us, 1 half to the right, -1 half to the left, 1.5 to the side.
    double turn = 0;
    Eyes eyes = Eyes::Open;
    Mouth mouth = Mouth::Smile;
    Brows brows = Brows::Level;
    // How far the tip of the cap swings, in degrees; 0 hangs down on the side away from the nose.
    double capSwing = 0;
};

Head mirrored(const Head& head, int pictureWidth);

// Where the neck joins.
Point chin(const Head& head);

void paintHead(Picture& picture, const Head& head);

} // namespace art
