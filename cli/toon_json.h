// A Toon as JSON, for people to write and to compare: docs/toon-format.md tells it.
#pragma once

#include "cli/toon_record.h"

#include <string>
#include <string_view>
#include <vector>

/// The Toon as UTF-8, with a line end behind the last line. JsonToToon makes the same Toon of it,
/// but for the bytes behind a text's NUL and the reserved ones, which become zero.
std::string ToonToJson(const Toon& toon);

struct ToonFromJson {
    Toon toon;                         // if error is empty
    std::string error;                 // "12: frame 3, pose: ...", a line and what is wrong in it
    std::vector<std::string> warnings; // in the same form, of what the editor would not have made
};

ToonFromJson JsonToToon(std::string_view text);
