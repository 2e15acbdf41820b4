// Small helpers for 8-bit texts: comparing whatever the case, trimming, copying into a buffer.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace seam {

/// The text with A to Z as a to z. Other bytes stay, so that the parts of a UTF-8 letter do too.
std::string lowered(std::string_view text);

/// Whether the texts are the same but for the case of A to Z.
bool sameButForCase(std::string_view one, std::string_view other);

/// The text without the blanks, tabs and line ends at its two ends.
std::string_view trimmed(std::string_view text);

/// Copies the text and a NUL into a buffer of `size` bytes, cut to size - 1 of them, and gives the
/// number copied. A buffer of no bytes is left alone.
std::size_t copyCut(std::string_view text, char* buffer, std::size_t size);

} // namespace seam
