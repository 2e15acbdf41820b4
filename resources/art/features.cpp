#include "resources/art/features.h"

#include "resources/art/painter.h"
#include "resources/art/wardrobe.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <utility>
#include <vector>

namespace art {

namespace {

using Rows = std::vector<std::string>;

// All features are drawn for a head that looks right; the others are the same the other way round.

constexpr double Profile = 1.2;
// Less turned than this, he looks at us.
constexpr double Facing = 0.2;

// Seen from the side the nose hides a part of the far eye.
Rows profileRows(Eyes eyes) {
    if (eyes == Eyes::Shut) {
        return {"sssssss   ", "sYYYsYYs  ", "YYYYYYYY  ", "YYYYYYYY  ",
                "bYYYbYYb  ", " bbb bb   ", " sss ss   "};
    }
    return {" bbb bb   ", "bWWWbWWb  ", "bWWWbWWb  ", "bWbbbWbb  ",
            "bWbbbWbb  ", "bWWWbWWb  ", " bbb bb   "};
}

// Seen from the front he looks straight at us.
Rows facingRows() {
    return {" bbb bbb  ", "bWWWbWWWb ", "bWbWbWbWb ", "bWbWbWbWb ",
            "bWbWbWbWb ", "bWWWbWWWb ", " bbb bbb  "};
}

Rows eyeRows(Eyes eyes) {
    switch (eyes) {
    case Eyes::Open:
        return {" bbb bbb  ", "bWWWbWWWb ", "bWWWbWWWb ", "bWbbbWbbb ",
                "bWbbbWbbb ", "bWWWbWWWb ", " bbb bbb  "};
    case Eyes::Shut:
        return {"ssssssss  ", "sYYYsYYYs ", "YYYYsYYYY ", "bYYbsbYYb ",
                "sbbsssbbs ", "sssssss   ", " sss sss  "};
    case Eyes::Wide:
        return {"bWWWbWWWb ", "bWWWbWWWb ", "bWbWbWbWb ", "bWbWbWbWb ",
                "bWWWbWWWb ", "bWWWbWWWb ", " bbb bbb  "};
    case Eyes::Merry:
        return {"ssssssss  ", "sbbsssbbs ", "bssbsbssb ", "bssbsbssb ",
                "sssssssss ", "sssssss   ", " sss sss  "};
    case Eyes::Aside:
        return {"ssssssss  ", "bbbbbbbbb ", "bWWWbWWWb ", "bWWbbWWbb ",
                "bWWbbWWbb ", "bWWWbWWWb ", " bbb bbb  "};
    }
    return {};
}

Rows browRows(Brows brows) {
    switch (brows) {
    case Brows::Level:
        return {"          ", " bb   bb  "};
    case Brows::Raised:
        return {" bbb bbb  "};
    case Brows::High:
        return {" bb   bb  ", "          ", " bbb bbb  "};
    case Brows::OneUp:
        return {"     bbb  ", "bbb       "};
    case Brows::Worried:
        return {"  bb bb   ", "bb     bb "};
    }
    return {};
}

Rows mouthRows(Mouth mouth) {
    switch (mouth) {
    case Mouth::Smile:
        return {" b      b ", "  bb  bb  ", "    bb    "};
    case Mouth::Open:
        return {" bbbbbbbb ", "  brrrrb  ", "  brRRrb  ", "   bbbb   "};
    case Mouth::Round:
        return {"    bb    ", "   brrb   ", "   brrb   ", "   bRRb   ", "    bb    "};
    case Mouth::Grin:
        return {" bbbbbbbb ", " bWWWWWWb ", "  bWWWWb  ", "   bbbb   "};
    case Mouth::Laugh:
        return {" bbbbbbbb ", " bWWWWWWb ", " brrrrrrb ", "  brRRrb  ", "   bbbb   "};
    case Mouth::Gasp:
        return {"   bbbb   ", "  brrrrb  ", "  brrrrb  ", "  brRRrb  ", "   bbbb   "};
    case Mouth::Whisper:
        return {"          ", "    bbb   ", "   brrrb  ", "    bbb   "};
    case Mouth::Musing:
        return {"          ", "      bb  ", "  bbbb    "};
    }
    return {};
}

void stampFacing(Picture& picture, Point corner, double side, Rows rows) {
    for (std::string& row : rows) {
        if (side < 0) {
            std::reverse(row.begin(), row.end());
        }
    }
    stamp(picture, static_cast<int>(corner.x), static_cast<int>(corner.y), rows, Skin);
}

} // namespace

void paintFeatures(Picture& picture, const Head& head) {
    const double turn = std::fabs(head.turn);
    const double side = head.turn < 0 ? -1 : 1;
    Rows eyes = turn > Profile ? profileRows(head.eyes) : eyeRows(head.eyes);
    if (turn < Facing && head.eyes == Eyes::Open) {
        eyes = facingRows();
    }
    stampFacing(picture, head.eyeCell + Point{0, 3}, side, std::move(eyes));
    stampFacing(picture, head.eyeCell, side, browRows(head.brows));
    stampFacing(picture, head.mouthCell + Point{0, 4}, side, mouthRows(head.mouth));
}

} // namespace art
