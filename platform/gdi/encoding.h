// The 8-bit text of the program as the toolkit's.
#pragma once

#include <QString>

#include <cstddef>
#include <string>

namespace seam {

/// Windows-1252; its five holes stand for U+0081, U+008D, U+008F, U+0090 and U+009D.
QString fromWindows1252(const char* text, std::size_t length);

/// The way back; a character that has no byte becomes a question mark.
std::string toWindows1252(const QString& text);

} // namespace seam
