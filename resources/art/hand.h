#pragma once

#include "resources/art/outline.h"
#include "resources/art/picture.h"

namespace art {

// What a hand does. Open shows the palm, Flat the hand laid on something, Screen the hand held up
// like a wall.
enum class Grip { Relaxed, Open, Pointing, Fist, Flat, Screen };

// A gloved hand that starts at the wrist. The fingers point `angle` degrees clockwise from the
// right; the thumb sits clockwise of them where `thumb` is 1, on the other side where it is -1.
void paintHand(Picture& picture, Grip grip, Point wrist, double angle, int thumb);

} // namespace art
