#pragma once

#include "resources/art/painter.h"

namespace art {

// What he is painted in. Black would be a hole, so his lines are dark blue.
constexpr Colour Line = DarkBlue;

constexpr Ink Skin = {White, Yellow};
constexpr Ink SkinShade = Yellow;
constexpr Ink Blush = {Red, Yellow};

constexpr Ink Coat = DarkMagenta;
constexpr Ink CoatShade = {DarkMagenta, DarkBlue};
constexpr Ink CoatGlow = {Magenta, DarkMagenta};

constexpr Ink Trousers = DarkCyan;
constexpr Ink TrousersShade = {DarkCyan, DarkBlue};

constexpr Ink TrousersGlow = {Cyan, DarkCyan};

constexpr Ink Linen = White;
constexpr Ink LinenShade = LightGrey;

constexpr Ink Brass = Yellow;
constexpr Ink BrassShade = DarkYellow;

constexpr Ink Leather = Red;
constexpr Ink LeatherShade = DarkRed;

constexpr Ink Hair = Blush;
constexpr Ink HairShade = Red;

constexpr Ink Felt = DarkCyan;
constexpr Ink FeltShade = {DarkCyan, DarkBlue};

constexpr Ink FeltGlow = {Cyan, DarkCyan};

constexpr Ink Trim = Yellow;
constexpr Ink TrimShade = DarkYellow;

constexpr Ink Bobble = Red;
constexpr Ink BobbleShade = DarkRed;

} // namespace art
