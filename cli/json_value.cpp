#include "cli/json_value.h"

#include "cli/json_text.h"
#include "platform/codepage.h"

#include <algorithm>
#include <charconv>
#include <cstdio>

std::string Shortened(std::string_view text) {
    constexpr std::size_t longest = 40;
    if (text.size() <= longest) {
        return std::string(text);
    }
    std::size_t end = longest;
    while (end > 0 && seam::continuesUtf8(text[end])) {
        --end; // not within a character
    }
    return std::string(text.substr(0, end)) + "...";
}

static std::string Described(const JsonValue& value) {
    return value.type == JsonType::text ? JsonText(Shortened(value.text)) : Shortened(value.text);
}

std::string Refusal(const JsonValue& value, std::string_view noun, std::string_view right) {
    return Advice(Described(value).append(" is no ").append(noun), right);
}

std::optional<std::int64_t> WholeNumber(const JsonValue& value) {
    std::int64_t number = 0;
    const char* end = value.text.data() + value.text.size();
    const auto [stopped, error] = std::from_chars(value.text.data(), end, number);
    const bool whole = value.type == JsonType::number && error == std::errc() && stopped == end;
    return whole ? std::optional(number) : std::nullopt;
}

/// The end of the UTF-8 character that begins at `begin`.
static std::size_t CharacterEnd(std::string_view text, std::size_t begin) {
    std::size_t end = begin + 1;
    while (end < text.size() && seam::continuesUtf8(text[end])) {
        ++end;
    }
    return end;
}

/// "U+263A" of a character in UTF-8, also of half a pair, which isn't valid alone.
static std::string CodePoint(std::string_view character) {
    unsigned code = static_cast<unsigned char>(character.front());
    constexpr unsigned leading[] = {0x7F, 0x7F, 0x1F, 0x0F, 0x07};
    code &= leading[std::min<std::size_t>(character.size(), 4)];
    for (const char byte : character.substr(1)) {
        code = code << 6U | (static_cast<unsigned char>(byte) & 0x3FU);
    }
    char digits[16];
    std::snprintf(digits, sizeof digits, "U+%04X", code);
    return digits;
}

std::string BytesForText(const Field& field, std::string_view text, std::string& error) {
    const auto continuing = std::count_if(text.begin(), text.end(), seam::continuesUtf8);
    const auto characters = static_cast<std::ptrdiff_t>(text.size()) - continuing;
    if (characters > field.most) {
        error = Advice(std::to_string(characters) + " characters are too many", field.right);
        return "";
    }
    std::string bytes;
    for (std::size_t begin = 0, end = 0; begin < text.size(); begin = end) {
        end = CharacterEnd(text, begin);
        const std::string_view character = text.substr(begin, end - begin);
        const std::optional<std::string> byte = seam::windows1252FromUtf8(character);
        if (character.front() == '\0') {
            error = Advice("a \\u0000 would end the text", "any other character");
            return "";
        }
        if (!byte || byte->size() != 1) {
            const std::string seen = IsUtf8(character) ? JsonText(character) + ", " : "";
            error = Advice(seen + CodePoint(character) + (seen.empty() ? "" : ",") +
                               " is not in Windows-1252",
                           "a character of that set");
            return "";
        }
        bytes += *byte;
    }
    return WithBreaksSwapped(bytes);
}
