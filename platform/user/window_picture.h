// The picture of a window of a class of the program's own, and what of it the screen hasn't got
// yet.
#pragma once

#include "platform/gdi/surface.h"
#include "platform/user.h"

#include <QImage>
#include <QRect>

namespace seam {

class WindowPicture : public Surface {
  public:
    explicit WindowPicture(HWND owner) : owner_(owner) {}

    WindowPicture(const WindowPicture&) = delete;
    WindowPicture& operator=(const WindowPicture&) = delete;
    ~WindowPicture() override;

    void touch(const RECT& area) override;

    /// Brings what has been touched to the screen.
    virtual void flush() = 0;

    /// Gives the picture another size and keeps what fits of it.
    virtual void resizePicture(QSize size) = 0;

    /// Tells the watcher of pictures what has been drawn.
    void tellWatcher();

  protected:
    /// A copy of the picture as it is now; null if there is none.
    QImage copyPicture();

    /// Puts a copy's top left part back.
    void pastePicture(const QImage& kept);

    HWND owner_;
    QRect dirty_; // one rectangle: what a step touches overlaps, and each piece costs a request

  private:
    QRect untold_; // what the watcher of pictures hasn't been told of
};

} // namespace seam
