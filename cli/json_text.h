// Texts as JSON writes them.
#pragma once

#include <string>
#include <string_view>

bool IsUtf8(std::string_view text);

/// A text in UTF-8 as JSON writes it, in quotes. Characters that nobody sees are written by number;
/// where the bytes are no UTF-8 they are taken for Windows-1252.
std::string JsonText(std::string_view text);

/// A line break of a Toon is a carriage return, that of JSON a line feed; each stands for the
/// other, so that none is lost.
std::string WithBreaksSwapped(std::string_view text);
