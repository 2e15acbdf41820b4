// Where the lines of a text break.
#pragma once

#include "platform/types.h"

#include <QFontMetrics>
#include <QString>

#include <cstddef>
#include <vector>

namespace seam {

/// A text as it is drawn, with the characters that have a line under them.
struct PlainText {
    QString text;
    std::vector<qsizetype> underlined;
};

/// Decodes bytes. With `prefixes` an ampersand underlines the next character, and two print one.
PlainText readText(const char* bytes, std::size_t length, bool prefixes);

/// Characters `start` up to `end` of a text.
struct TextLine {
    qsizetype start;
    qsizetype end;
};

/// A text's places in a font: every character stands on whole pixels.
class TextMeasure {
  public:
    TextMeasure(const QString& text, const QFontMetrics& metrics);

    int width(const TextLine& line) const;

  private:
    std::vector<int> places_; // the left edge of each character, and the right one of the last
};

/// Breaks at a carriage return, a line feed, or both in this order. One at the end opens no further
/// line; an empty text has none.
std::vector<TextLine> splitLines(const QString& text);

/// Breaks a line further, so that each part fits the width: at blanks, which then belong to no
/// part, or within a word that is wider. A part has at least one character.
std::vector<TextLine> wrapLine(const QString& text, const TextLine& line,
                               const TextMeasure& measure, int width);

} // namespace seam
