// Where the files of this program's user lie.
#pragma once

#include <string>

namespace seam {

/// $XDG_CONFIG_HOME/dorbo, or ~/.config/dorbo where that isn't set to an absolute path. A path of
/// the file system; the directory need not be there.
std::string configDirectory();

/// Makes the directory, and those above it that are missing, for the user alone (mode 0700). False
/// if there is none afterwards.
bool makeConfigDirectory();

} // namespace seam
