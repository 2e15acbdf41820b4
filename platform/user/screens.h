// A window that has every monitor to itself: a screen saver's.
#pragma once

#include "platform/user/window.h"

class QWindow;

namespace seam {

/// Whether the window is one that goes above all others and fills the primary monitor.
bool fillsScreen(const Window& window);

/// From now on the window follows the primary monitor's size, what lies on the other monitors is
/// covered with black, and both stay above windows that appear later. Input on the black goes to
/// the window. One window at a time can have the screens; hiding it doesn't end that.
void takeScreens(Window& window);

/// Ends that, before the window goes; does nothing for any other window.
void leaveScreens(HWND window);

/// Raises a window and gives it the keyboard; where boxes stand in front of it, they are raised
/// above it and the foremost gets the keyboard.
void raiseInFront(QWindow& window);

bool screensAreTaken();

/// How many milliseconds are left until the keyboard should be where it belongs after a window has
/// taken the screens; 0 if it has long been, or none has.
int screensSettleIn();

/// To be told whenever a window has shown what has been drawn in it. When one that has the screens
/// shows its picture, nothing of the session can be seen any more, and the machine may sleep.
void pictureShown(HWND window);

/// The black on the other monitors; null while there is none.
QWindow* screenCover();

} // namespace seam
