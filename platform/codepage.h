// Text of the program, Windows-1252, as the UTF-8 of files that people write.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace seam {

/// The five holes of Windows-1252 become U+0081, U+008D, U+008F, U+0090 and U+009D.
std::string utf8FromWindows1252(std::string_view text);

/// The way back; nothing if the bytes are no UTF-8, or hold a character that Windows-1252 lacks.
std::optional<std::string> windows1252FromUtf8(std::string_view text);

/// Whether a byte of UTF-8 goes on with a character that an earlier one began.
inline bool continuesUtf8(char byte) {
    return (static_cast<unsigned char>(byte) & 0xC0U) == 0x80U;
}

} // namespace seam
