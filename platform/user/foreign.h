// Windows of other programs on the same display. On a platform of the toolkit other than X11 there
// are none.
#pragma once

#include "platform/types.h"

namespace seam {

/// Whether the number can be the id of another program's window: ours have the top bit set.
inline bool mayBeForeign(HWND window) {
    return window && (window.number & 0xE0000000U) == 0;
}

bool foreignExists(HWND window);

/// Its size in pixels of ours, the last of which may lie half outside; false if it is none.
bool foreignSize(HWND window, SIZE& size);

/// From now on the end of `parent`, or of our window `child` in it, posts WM_CLOSE to `child`, and
/// a new size of `parent` becomes that of `child`.
void followHost(HWND parent, HWND child);

/// Ends that.
void leaveHost(HWND child);

/// Whether a window manager is at work, so that a minimised window can be brought back. Said to be
/// so where the platform of the toolkit is another one than X11.
bool windowsAreManaged();

/// The root window, or the one that a window manager has put in its place; null where there is
/// none.
HWND foreignDesktop();

/// The window with the keyboard, by the X server's word.
HWND foreignFocus();

} // namespace seam
