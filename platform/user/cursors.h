// The pointer's shape over the windows of this program.
#pragma once

class QWindow;

namespace seam {

/// Gives a window the shape in force.
void applyCursor(QWindow& window);

/// While one of these lives a box is up, and the pointer shows over all windows.
class BoxPointer {
  public:
    BoxPointer();
    BoxPointer(const BoxPointer&) = delete;
    BoxPointer& operator=(const BoxPointer&) = delete;
    ~BoxPointer();
};

} // namespace seam
