#include "cli/json_text.h"

#include "platform/codepage.h"

#include <rapidjson/encodings.h>
#include <rapidjson/memorystream.h>

bool IsUtf8(std::string_view text) {
    struct Nowhere {
        static void Put(char) {}
    } nowhere;

    rapidjson::MemoryStream stream(text.data(), text.size());
    while (stream.Tell() < text.size()) {
        if (!rapidjson::UTF8<>::Validate(stream, nowhere)) {
            return false;
        }
    }
    return true;
}

std::string WithBreaksSwapped(std::string_view text) {
    std::string result(text);
    for (char& character : result) {
        if (character == '\r' || character == '\n') {
            character = character == '\r' ? '\n' : '\r';
        }
    }
    return result;
}

/// The escape of a control character.
static std::string Escaped(unsigned character) {
    constexpr std::string_view digits = "0123456789ABCDEF";
    switch (character) {
    case '\n':
        return "\\n";
    case '\r':
        return "\\r";
    case '\t':
        return "\\t";
    default:
        return std::string("\\u00") + digits[character / 16] + digits[character % 16];
    }
}

std::string JsonText(std::string_view text) {
    if (!IsUtf8(text)) {
        return JsonText(seam::utf8FromWindows1252(text));
    }
    constexpr char upperControls = '\xC2'; // begins U+0080 to U+00BF
    std::string result = "\"";
    for (std::size_t i = 0; i < text.size(); ++i) {
        const auto byte = static_cast<unsigned char>(text[i]);
        const auto next = static_cast<unsigned char>(i + 1 < text.size() ? text[i + 1] : 0);
        if (text[i] == '"' || text[i] == '\\') {
            result += {'\\', text[i]};
        } else if (byte < 0x20 || byte == 0x7F) {
            result += Escaped(byte);
        } else if (text[i] == upperControls && next < 0xA0) {
            result += Escaped(next);
            ++i;
        } else {
            result += text[i];
        }
    }
    return result + '"';
}
