// Where lines break. The font's widths are measured, so that no number of them stands here.
#include "platform/gdi/encoding.h"
#include "platform/gdi/font.h"
#include "platform/gdi/text_layout.h"

#include <gtest/gtest.h>

using namespace seam;

namespace {

using Lines = std::vector<std::string>;

Lines pieces(const QString& text, const std::vector<TextLine>& lines) {
    Lines result;
    for (const TextLine& line : lines) {
        result.push_back(text.mid(line.start, line.end - line.start).toStdString());
    }
    return result;
}

/// Wraps a line to the width of `widest` in the system font.
Lines wrapped(const QString& text, const QString& widest) {
    const Font font(-13, 400, false);
    const TextMeasure measure(text, font.face().metrics);
    const int width = TextMeasure(widest, font.face().metrics).width({0, widest.size()});
    return pieces(text, wrapLine(text, {0, text.size()}, measure, width));
}

} // namespace

TEST(Lines, BreakAtReturnFeedAndPair) {
    const std::pair<const char*, Lines> cases[] = {
        {"a\rb\nc", {"a", "b", "c"}}, {"a\r\nb", {"a", "b"}}, {"a\n\rb", {"a", "", "b"}},
        {"a\r\rb", {"a", "", "b"}},   {"a\r", {"a"}},         {"\ra", {"", "a"}},
    };
    for (const auto& [bytes, expected] : cases) {
        const QString text = QString::fromLatin1(bytes);
        EXPECT_EQ(pieces(text, splitLines(text)), expected) << bytes;
    }
}

TEST(Lines, WrapAtBlanksWhichBelongToNoLineElseWithinAWord) {
    const std::tuple<const char*, const char*, Lines> cases[] = {
        {"one two", "one tw", {"one", "two"}},
        {"one   two", "one t", {"one", "two"}},
        {"one two six", "one two", {"one two", "six"}},
        {" one", " one", {" one"}},
        {"", "x", {""}},
        {"mmmmm", "mm", {"mm", "mm", "m"}},
        {"mmm mm", "mm", {"mm", "m", "mm"}},
        {"mm", "", {"m", "m"}}, // a character at least
    };
    for (const auto& [text, widest, expected] : cases) {
        EXPECT_EQ(wrapped(QString::fromLatin1(text), QString::fromLatin1(widest)), expected)
            << text << " within " << widest;
    }
}

TEST(Encoding, IsWindows1252WithItsHolesAsControls) {
    EXPECT_EQ(fromWindows1252("A\xE4\x80\x85\x9F\0", 6),
              QStringLiteral(u"A\u00E4\u20AC\u2026\u0178\0"));
    const char16_t holes[] = {0x81, 0x8D, 0x8F, 0x90, 0x9D};
    EXPECT_EQ(fromWindows1252("\x81\x8D\x8F\x90\x9D", 5), QString::fromUtf16(holes, 5));
}

TEST(PlainText, ReadsAmpersands) {
    const std::tuple<const char*, const char*, std::vector<qsizetype>> cases[] = {
        {"a && b", "a & b", {}}, {"end&", "end", {}}, {"&a&b", "ab", {0, 1}}};
    for (const auto& [bytes, text, underlined] : cases) {
        const std::size_t length = std::string(bytes).size();
        const PlainText plain = readText(bytes, length, true);
        EXPECT_EQ(plain.text.toStdString(), text);
        EXPECT_EQ(plain.underlined, underlined) << bytes;
        EXPECT_EQ(readText(bytes, length, false).text.toStdString(), bytes);
    }
}

TEST(TextMeasure, AgreesWithTheWidthOfTheWholeText) {
    const Font font(-20, 400, true);
    const QString text = QStringLiteral("AVATAR office fifty To. Way, (x) 1.17");
    EXPECT_EQ(TextMeasure(text, font.face().metrics).width({0, text.size()}),
              font.face().metrics.horizontalAdvance(text));
}
