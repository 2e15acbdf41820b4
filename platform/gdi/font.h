// Fonts of the program as the toolkit's.
#pragma once

#include "platform/gdi.h"

#include <QFont>
#include <QFontMetrics>

#include <memory>

namespace seam {

/// The font of dialogs and controls, `pixels` high.
QFont dialogFont(int pixels);

/// What the toolkit makes of a font. It needs the application object.
struct FontFace {
    QFont font;
    QFontMetrics metrics;
};

/// As CreateFontA describes it. The face is made when it is first asked for.
class Font {
  public:
    Font(int height, int weight, bool serif) : height_(height), weight_(weight), serif_(serif) {}

    const FontFace& face() const;

    int weight() const;

  private:
    int height_; // pixels: of the characters if negative, of the cell if positive
    int weight_;
    bool serif_;
    mutable std::unique_ptr<FontFace> face_;
};

} // namespace seam
