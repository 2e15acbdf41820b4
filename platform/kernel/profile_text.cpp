#include "platform/kernel/profile_text.h"

#include "platform/kernel/text.h"

#include <algorithm>

namespace seam {

namespace {

constexpr std::string_view byteOrderMark = "\xEF\xBB\xBF"; // some editors put one in front

/// Where a key stands in a text, or would stand.
struct Place {
    bool inSection = false;                  // the section is there
    std::size_t begin = 0;                   // the key's line with its end, or an empty range
    std::size_t end = 0;                     // where its line belongs
    std::optional<std::string_view> value{}; // as it stands behind the "=", without blanks
};

/// The name in a line of the form "[name]".
std::optional<std::string_view> sectionName(std::string_view line) {
    const std::size_t end = line.find(']');
    if (!line.starts_with('[') || end == std::string_view::npos) {
        return std::nullopt;
    }
    return trimmed(line.substr(1, end - 1));
}

Place placeOf(std::string_view text, std::string_view section, std::string_view key) {
    Place place{.begin = text.size(), .end = text.size()};
    std::size_t next = 0;
    for (std::size_t at = text.starts_with(byteOrderMark) ? byteOrderMark.size() : 0;
         at < text.size(); at = next) {
        next = std::min(text.find('\n', at), text.size() - 1) + 1;
        const std::string_view line = trimmed(text.substr(at, next - at));
        if (const std::optional<std::string_view> name = sectionName(line)) {
            if (place.inSection) {
                break;
            }
            place.inSection = sameButForCase(*name, section);
        }
        if (!place.inSection) {
            continue;
        }
        const std::size_t equals = line.find('=');
        if (equals != std::string_view::npos &&
            sameButForCase(trimmed(line.substr(0, equals)), key)) {
            return {true, at, next, trimmed(line.substr(equals + 1))};
        }
        if (!line.empty()) {
            place.begin = place.end = next;
        }
    }
    return place;
}

/// Takes one pair of quotes off.
std::string_view withoutQuotes(std::string_view value) {
    const bool quoted = value.size() >= 2 && value.front() == value.back() &&
                        (value.front() == '"' || value.front() == '\'');
    return quoted ? value.substr(1, value.size() - 2) : value;
}

} // namespace

std::optional<std::string> profileValue(std::string_view text, std::string_view section,
                                        std::string_view key) {
    const Place place = placeOf(text, section, key);
    if (!place.value) {
        return std::nullopt;
    }
    const std::string_view value = withoutQuotes(*place.value);
    return std::string(value.substr(0, value.find('\0')));
}

bool profileHasSection(std::string_view text, std::string_view section) {
    return placeOf(text, section, "").inSection;
}

std::string profileWithValue(std::string_view text, std::string_view section, std::string_view key,
                             std::string_view value) {
    const Place place = placeOf(text, section, key);
    std::string result(text.substr(0, place.begin));
    if (!result.empty() && result.back() != '\n') {
        result += "\r\n";
    }
    if (!place.inSection) {
        result.append("[").append(section).append("]\r\n");
    }
    const std::string_view quote = withoutQuotes(trimmed(value)) == value ? "" : "\"";
    result.append(key).append("=").append(quote).append(value).append(quote).append("\r\n");
    return result.append(text.substr(place.end));
}

bool canStandInProfile(std::string_view section, std::string_view key, std::string_view value) {
    constexpr std::string_view lineEnds = "\r\n";
    return section.find_first_of("]\r\n") == std::string_view::npos &&
           trimmed(section) == section && key.find_first_of("=\r\n") == std::string_view::npos &&
           trimmed(key) == key && !key.empty() && key.front() != '[' &&
           value.find_first_of(lineEnds) == std::string_view::npos;
}

} // namespace seam
