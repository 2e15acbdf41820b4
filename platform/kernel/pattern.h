// Patterns for names of files.
#pragma once

#include <string_view>

namespace seam {

bool isPattern(std::string_view text); ///< Whether `*` or `?` stands in it.

/// Whether the name fits the pattern: `*` stands for any run of bytes, `?` for one, or for none at
/// the end of the name, "*.*" for every name; case doesn't matter.
bool matchesPattern(std::string_view name, std::string_view pattern);

} // namespace seam
