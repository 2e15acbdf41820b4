// How large the program's pixels are on the screen: each is a square of whole pixels there, and all
// places above the toolkit count such squares. What a screen's density asks for beyond that makes
// dialogs, boxes and menus larger, and nothing else.
#pragma once

class QRect;
class QScreen;
class QWindow;

namespace seam {

/// Has the toolkit take the whole part of each screen's scale, or what the variable DORBO_SCALE
/// says in its place. Called before the application object is made.
void chooseScale();

/// How many of the X server's pixels one of the window's or the screen's has on each side.
int scaleOf(const QWindow& window);

int scaleOf(const QScreen& screen);

/// That of the primary screen.
int primaryScale();

/// What a screen covers, in the X server's pixels. The toolkit keeps its corner as it is there, but
/// rounds its size: where it ends with the display this is exact.
QRect serverPlace(const QScreen& screen);

/// Gives a window its place in the X server's pixels: ours may differ from one monitor to the
/// other. Without a server its place in ours.
void placeOnServer(QWindow& window, const QRect& place);

/// How large dialogs are, for 100 at 96 dots to the inch; never less.
int dialogPercent();

/// A length in a dialog of that size; rounded.
int dialogLength(int pixels);

} // namespace seam
