// The values that stand in a Toon's JSON: what they say, and what is said of them that are wrong.
#pragma once

#include "cli/toon_record.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

enum class JsonType { null, boolean, number, text, object, list };

struct JsonValue {
    JsonType type;
    std::string_view text; // as it stands in the file, of a text what it says
};

/// The first forty bytes of a text in UTF-8, cut between characters, with "..." behind; the text
/// itself if it is no longer.
std::string Shortened(std::string_view text);

/// "9 is no pose: 1 to 8 would be right".
std::string Refusal(const JsonValue& value, std::string_view noun, std::string_view right);

/// Nothing if it isn't a whole number of 64 bits.
std::optional<std::int64_t> WholeNumber(const JsonValue& value);

/// The bytes in the file of Toons of a text in UTF-8 that has room in its field; else empty, with
/// what is wrong in `error`.
std::string BytesForText(const Field& field, std::string_view text, std::string& error);
