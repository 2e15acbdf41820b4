#include "platform/gdi/encoding.h"

#include "platform/codepage.h"

#include <QStringDecoder>

#include <algorithm>
#include <array>

namespace seam {

namespace {

/// What the bytes 0x80 to 0x9F stand for; every other byte is its own code point.
constexpr std::array<char16_t, 32> upperControls{
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178};

/// The byte that stands for a character; nothing if none does.
std::optional<char> byteOf(QChar character) {
    const char16_t code = character.unicode();
    const auto* upper = std::find(upperControls.begin(), upperControls.end(), code);
    if (upper != upperControls.end()) {
        return static_cast<char>(0x80 + (upper - upperControls.begin()));
    }
    const bool same = code < 0x80 || (code >= 0xA0 && code < 0x100);
    return same ? std::optional(static_cast<char>(code)) : std::nullopt;
}

} // namespace

QString fromWindows1252(const char* text, std::size_t length) {
    QString result = QString::fromLatin1(text, static_cast<qsizetype>(length));
    for (QChar& character : result) {
        const char16_t code = character.unicode();
        if (code >= 0x80 && code < 0xA0) {
            character = QChar(upperControls[code - 0x80U]);
        }
    }
    return result;
}

std::string toWindows1252(const QString& text) {
    std::string result;
    bool high = false; // the first half of a pair has gone in, which is one character
    for (const QChar character : text) {
        if (!high || !character.isLowSurrogate()) {
            result += byteOf(character).value_or('?');
        }
        high = character.isHighSurrogate();
    }
    return result;
}

std::string utf8FromWindows1252(std::string_view text) {
    return fromWindows1252(text.data(), text.size()).toStdString();
}

std::optional<std::string> windows1252FromUtf8(std::string_view text) {
    QStringDecoder decode(QStringDecoder::Utf8, QStringConverter::Flag::Stateless);
    const QString characters =
        decode(QByteArrayView(text.data(), static_cast<qsizetype>(text.size())));
    if (decode.hasError()) {
        return std::nullopt;
    }
    std::string result;
    for (const QChar character : characters) {
        const std::optional<char> byte = byteOf(character);
        if (!byte) {
            return std::nullopt;
        }
        result += *byte;
    }
    return result;
}

} // namespace seam
