// Text of the program as the toolkit wants it.
#pragma once

#include <QString>

#include <string>

namespace seam {

/// For titles, boxes and lists, which show names of files: UTF-8 where the bytes are valid as that,
/// else Windows-1252, with its five holes as U+0081 and so on.
QString shownText(const std::string& bytes);

} // namespace seam
