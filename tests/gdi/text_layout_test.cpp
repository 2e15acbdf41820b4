// Where lines break. The font's widths are measured, so that no number of them stands here.
#include "platform/gdi/encoding.h"
#include "platform/gdi/font.h"
#include "platform/gdi/text_layout.h"

#include <gtest/gtest.h>

using namespace seam;

namespace {

std::vector<std::string> pieces(const QString& text, const std::vector<TextLine>& lines) {
    std::vector<std::string> result;
    result.reserve(lines.size());
    for (const TextLine& line : lines) {
        result.push_back(text.mid(line.start, line.end - line.start).toStdString());
    }
    return result;
}

/// Wraps a line to the width of `widest` in the system font.
std::vector<std::string> wrapped(const char* text, const char* widest) {
    const Font font(-13, 400, false);
    const QString decoded = QString::fromLatin1(text);
    const QString measured = QString::fromLatin1(widest);
    const TextMeasure measure(decoded, font.face().metrics);
    const int width = TextMeasure(measured, font.face().metrics).width({0, measured.size()});
    return pieces(decoded, wrapLine(decoded, {0, decoded.size()}, measure, width));
}

using Lines = std::vector<std::string>;

} // namespace

TEST(Lines, BreakAtReturnFeedAndPair) {
    const struct {
        const char* text;
        Lines expected;
    } cases[] = {
        {"", {}},
        {"a", {"a"}},
        {"a\rb", {"a", "b"}},
        {"a\nb", {"a", "b"}},
        {"a\r\nb", {"a", "b"}},
        {"a\n\rb", {"a", "", "b"}},
        {"a\r\rb", {"a", "", "b"}},
        {"a\r", {"a"}},
        {"\ra", {"", "a"}},
    };

    for (const auto& c : cases) {
        const QString text = QString::fromLatin1(c.text);
        EXPECT_EQ(pieces(text, splitLines(text)), c.expected) << c.text;
    }
}

TEST(Lines, WrapAtBlanksWhichBelongToNoLine) {
    EXPECT_EQ(wrapped("one two", "one two"), (Lines{"one two"}));
    EXPECT_EQ(wrapped("one two", "one tw"), (Lines{"one", "two"}));
    EXPECT_EQ(wrapped("one two", "one"), (Lines{"one", "two"}));
    EXPECT_EQ(wrapped("one   two", "one t"), (Lines{"one", "two"}));
    EXPECT_EQ(wrapped("one two ", "one two"), (Lines{"one two"}));
    EXPECT_EQ(wrapped("one two six", "one two"), (Lines{"one two", "six"}));
    EXPECT_EQ(wrapped(" one", " one"), (Lines{" one"}));
    EXPECT_EQ(wrapped("", "x"), Lines{""});
}

TEST(Lines, BreakWithinAWordThatIsTooWide) {
    EXPECT_EQ(wrapped("mmmmm", "mm"), (Lines{"mm", "mm", "m"}));
    EXPECT_EQ(wrapped("a mmmm", "mmm"), (Lines{"a", "mmm", "m"}));
    EXPECT_EQ(wrapped("mmm mm", "mm"), (Lines{"mm", "m", "mm"}));
    EXPECT_EQ(wrapped("mm", ""), (Lines{"m", "m"})) << "a character at least";
}

TEST(Encoding, IsWindows1252WithItsHolesAsControls) {
    EXPECT_EQ(fromWindows1252("A\xE4\x80\x85\x9F", 5),
              QStringLiteral(u"A\u00E4\u20AC\u2026\u0178"));
    const QString holes = fromWindows1252("\x81\x8D\x8F\x90\x9D", 5);
    const char16_t expected[] = {0x81, 0x8D, 0x8F, 0x90, 0x9D};
    EXPECT_EQ(holes, QString::fromUtf16(expected, 5));
    EXPECT_EQ(fromWindows1252("a\0b", 3).size(), 3);
}

TEST(PlainText, ReadsAmpersands) {
    const struct {
        const char* bytes;
        const char* text;
        std::vector<qsizetype> underlined;
    } cases[] = {
        {"&File", "File", {0}}, {"S&top", "Stop", {1}}, {"a && b", "a & b", {}},
        {"end&", "end", {}},    {"&a&b", "ab", {0, 1}},
    };

    for (const auto& c : cases) {
        const PlainText plain = readText(c.bytes, std::string(c.bytes).size(), true);
        EXPECT_EQ(plain.text.toStdString(), c.text);
        EXPECT_EQ(plain.underlined, c.underlined) << c.bytes;
        EXPECT_EQ(readText(c.bytes, std::string(c.bytes).size(), false).text.toStdString(),
                  c.bytes);
    }
}

TEST(TextMeasure, AgreesWithTheWidthOfTheWholeText) {
    for (const int pixels : {13, 14, 16, 20, 32}) {
        for (const bool serif : {false, true}) {
            const Font font(-pixels, 400, serif);
            const QString text = QStringLiteral("AVATAR office fifty To. Way, (x) 1.17");
            EXPECT_EQ(TextMeasure(text, font.face().metrics).width({0, text.size()}),
                      font.face().metrics.horizontalAdvance(text))
                << pixels << (serif ? " serif" : " sans");
        }
    }
}
