// The texts of the program by their numbers.
#pragma once

#include "platform/types.h"

#include <string>
#include <string_view>
#include <unordered_map>

namespace seam {

using StringTable = std::unordered_map<UINT, std::string>;

/// Reads lines of the form "number TAB text", where \r stands for a carriage return and \\ for a
/// backslash. Other lines are passed over; of two with the same number the first holds.
StringTable parseStringTable(std::string_view lines);

} // namespace seam
