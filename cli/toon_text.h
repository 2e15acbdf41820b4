// The text form of a Toon file, for people to write and to compare: docs/toon-format.md tells it.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

/// The text of a Toon file's bytes; none if they don't begin with a header of our version.
/// TextToToon makes the same bytes of it again, whatever they hold.
std::optional<std::string> ToonToText(std::string_view bytes);

struct ToonFromText {
    std::string bytes;                 // the file, if error is empty
    std::string error;                 // "line 3: ..."
    std::vector<std::string> warnings; // of what the editor would not have made
};

/// The bytes of the Toon file that a text in UTF-8 tells.
ToonFromText TextToToon(std::string_view text);
