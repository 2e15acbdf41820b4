#include "resources/art/features.h"

#include "resources/art/painter.h"
#include "resources/art/wardrobe.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
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

// The rows inside of the mouth's cell. Its rim stays free, and so do the first rows, where the nose
// may reach in.
using MouthRows = std::array<const char*, 6>;

// In the order of the mouths.
constexpr MouthRows Mouths[] = {
    {"          ", " b      b ", "  bb  bb  ", "    bb    ", "          ", "          "}, // Smile
    {"          ", " bbbbbbbb ", "  brrrrb  ", "  brRRrb  ", "   bbbb   ", "          "}, // Open
    {"          ", "    bb    ", "   brrb   ", "   brrb   ", "   bRRb   ", "    bb    "}, // Round
    {"          ", " bbbbbbbb ", " bWWWWWWb ", "  bWWWWb  ", "   bbbb   ", "          "}, // Grin
    {"          ", " bbbbbbbb ", " bWWWWWWb ", " brrrrrrb ", "  brRRrb  ", "   bbbb   "}, // Laugh
    {" bbbbbbbb ", " bWWWWWWb ", " brrrrrrb ", " brrrrrrb ", " brRRRRrb ", "  bbbbbb  "}, // Roar
    {"          ", "   bbbb   ", "  brrrrb  ", "  brrrrb  ", "  brRRrb  ", "   bbbb   "}, // Gasp
    {"   bbbb   ", "  brrrrb  ", " brrrrrrb ", " brrrrrrb ", "  brRRrb  ", "   bbbb   "}, // Yell
    {"          ", "          ", "    bb    ", "   brrb   ", "   brrb   ", "    bb    "}, // Peep
    {"          ", "          ", "    bbb   ", "   brrrb  ", "    bbb   ", "          "}, // Whisper
    {"          ", "          ", "     bb   ", "    brrb  ", "    brrb  ", "     bb   "}, // Purse
    {"          ", "          ", "          ", "    bbbb  ", "     bb   ", "          "}, // Hush
    {"          ", "          ", "      bb  ", "  bbbb    ", "          ", "          "}, // Musing
    {"          ", "          ", "     bbb  ", "  bbbrrb  ", "    bbb   ", "          "}, // Mumble
    {"          ", "          ", "   bbb    ", "   brrbb  ", "    bb    ", "          "}, // Mutter
};

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
    const MouthRows& mouth = Mouths[static_cast<std::size_t>(head.mouth)];
    stampFacing(picture, head.mouthCell + Point{0, 3}, side, Rows(mouth.begin(), mouth.end()));
}

} // namespace art
