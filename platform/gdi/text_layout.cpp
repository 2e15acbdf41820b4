#include "platform/gdi/text_layout.h"

#include "platform/gdi/encoding.h"

namespace seam {

namespace {

constexpr QChar blank = u' ';

bool breaksLine(QChar character) {
    return character == u'\r' || character == u'\n';
}

/// The end of the longest part from `start` on that fits, one character at least.
qsizetype fittingEnd(const TextLine& rest, const TextMeasure& measure, int width) {
    qsizetype end = rest.start + 1;
    while (end < rest.end && measure.width({rest.start, end + 1}) <= width) {
        ++end;
    }
    return end;
}

} // namespace

PlainText readText(const char* bytes, std::size_t length, bool prefixes) {
    const QString decoded = fromWindows1252(bytes, length);
    if (!prefixes) {
        return {decoded, {}};
    }
    PlainText plain;
    for (qsizetype i = 0; i < decoded.size(); ++i) {
        if (decoded[i] == u'&') {
            ++i;
            if (i == decoded.size()) {
                break;
            }
            if (decoded[i] != u'&') {
                plain.underlined.push_back(plain.text.size());
            }
        }
        plain.text += decoded[i];
    }
    return plain;
}

TextMeasure::TextMeasure(const QString& text, const QFontMetrics& metrics) {
    int place = 0;
    places_.reserve(static_cast<std::size_t>(text.size()) + 1);
    places_.push_back(place);
    for (const QChar character : text) {
        place += metrics.horizontalAdvance(character);
        places_.push_back(place);
    }
}

int TextMeasure::width(const TextLine& line) const {
    return places_.at(static_cast<std::size_t>(line.end)) -
           places_.at(static_cast<std::size_t>(line.start));
}

std::vector<TextLine> splitLines(const QString& text) {
    std::vector<TextLine> lines;
    qsizetype start = 0;
    while (start < text.size()) {
        qsizetype end = start;
        while (end < text.size() && !breaksLine(text[end])) {
            ++end;
        }
        lines.push_back({start, end});
        const bool pair = end + 1 < text.size() && text[end] == u'\r' && text[end + 1] == u'\n';
        start = end + (pair ? 2 : 1);
    }
    return lines;
}

std::vector<TextLine> wrapLine(const QString& text, const TextLine& line,
                               const TextMeasure& measure, int width) {
    std::vector<TextLine> parts;
    TextLine rest = line;
    while (rest.start < rest.end && measure.width(rest) > width) {
        const qsizetype fits = fittingEnd(rest, measure, width);
        qsizetype space = fits; // the blank that may break the line: the last that is reached
        while (space > rest.start && (space == rest.end || text[space] != blank)) {
            --space;
        }
        const bool atBlank = space > rest.start;
        qsizetype end = atBlank ? space : fits;
        qsizetype next = end;
        while (atBlank && end > rest.start && text[end - 1] == blank) {
            --end;
        }
        while (atBlank && next < rest.end && text[next] == blank) {
            ++next;
        }
        parts.push_back({rest.start, end});
        rest.start = next;
    }
    if (rest.start < rest.end || parts.empty()) {
        parts.push_back(rest);
    }
    return parts;
}

} // namespace seam
