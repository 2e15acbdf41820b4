// The pointer's shape over the windows of this program.
#pragma once

#include "platform/types.h"

namespace seam {

class NativeWindow;

/// Gives a window the shape in force.
void applyCursor(NativeWindow& window);

} // namespace seam
