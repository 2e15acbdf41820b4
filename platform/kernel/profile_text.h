// The text of a profile file: finding a value and setting one.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace seam {

/// The value of a key; none if it is missing. Of two sections or keys of the same name the first
/// holds. A value ends at a NUL.
std::optional<std::string> profileValue(std::string_view text, std::string_view section,
                                        std::string_view key);

/// Whether there is a section of this name.
bool profileHasSection(std::string_view text, std::string_view section);

/// The text with the key's value set: in the place of its line, else as the last line of its
/// section, else in a new section at the end. All other bytes stay. A value that would lose blanks
/// or quotes at its ends when read gets quotes round it.
std::string profileWithValue(std::string_view text, std::string_view section, std::string_view key,
                             std::string_view value);

/// Whether such a section, key and value would be found again.
bool canStandInProfile(std::string_view section, std::string_view key, std::string_view value);

} // namespace seam
