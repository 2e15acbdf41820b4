#include "resources/art/features.h"

#include "resources/art/painter.h"
#include "resources/art/wardrobe.h"

#include <algorithm>
#include <cmath>
#include <string>
#include <vector>

namespace art {

namespace {

using Rows = std::vector<std::string>;

// All features are drawn for a head that looks right; the others are the same the other way round.

constexpr double Profile = 1.2;

// Seen from the side the nose hides a part of the far eye.
Rows profileRows(Eyes eyes) {
    if (eyes == Eyes::Shut) {
        return {"sssssss   ", "sYYYsYYs  ", "YYYYYYYY  ", "YYYYYYYY  ",
                "bYYYbYYb  ", " bbb bb   ", " sss ss   "};
    }
    return {" bbb bb   ", "bWWWbWWb  ", "bWWWbWWb  ", "bWbbbWbb  ",
            "bWbbbWbb  ", "bWWWbWWb  ", " bbb bb   "};
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
        return {"ssssssss  ", "sbbbsbbbs ", "bWWWbWWWb ", "bWbbbWbbb ",
                "bWbbbWbbb ", "bYYYYYYYb ", "          "};
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
        return {" bbbbbbbb ", " bWWWWWWb ", " brrrrrrb ", "  bRRRRb  ", "   bbbb   "};
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
    const double side = head.turn < 0 ? -1 : 1;
    const bool fromTheSide = std::fabs(head.turn) > Profile;
    stampFacing(picture, head.eyeCell + Point{0, 3}, side,
                fromTheSide ? profileRows(head.eyes) : eyeRows(head.eyes));
    stampFacing(picture, head.eyeCell, side, browRows(head.brows));
    stampFacing(picture, head.mouthCell + Point{0, 4}, side, mouthRows(head.mouth));
}

} // namespace art
