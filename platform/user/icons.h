// Icons of the program file. A handle is the number of its resource.
#pragma once

#include "platform/user.h"

#include <QIcon>

namespace seam {

/// The icon in all sizes that there are of it; empty for a null handle. Only once the toolkit
/// is up.
QIcon iconOf(HICON icon);

/// The one that stands for the program.
QIcon programIcon();

} // namespace seam
