// A window on the screen with its picture in memory, which is the toolkit's own backing store:
// nothing is copied between drawing and showing.
#pragma once

#include "platform/gdi/surface.h"
#include "platform/user.h"

#include <QBackingStore>
#include <QImage>
#include <QRect>
#include <QWindow>

#include <cstdint>

namespace seam {

class NativeWindow : public QWindow, public Surface {
  public:
    /// A top-level window at a place of the screen, or a child of another window.
    NativeWindow(HWND owner, const QRect& place, bool topmost, QWindow* parent);
    ~NativeWindow() override;

    PixelView pixels() override;
    void touch(const RECT& area) override;

    /// Brings what has been touched to the screen.
    void flush();

    /// Tells the watcher of pictures what has been drawn.
    void tellWatcher();

    /// Gives the picture the window's present size and keeps what fits of it.
    void resizePicture(QSize size);

  protected:
    bool event(QEvent* event) override;
    void exposeEvent(QExposeEvent* event) override;
    void paintEvent(QPaintEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;
    void focusInEvent(QFocusEvent* event) override;
    void focusOutEvent(QFocusEvent* event) override;

  private:
    QImage* storeImage();
    void queueMouse(UINT message, const QMouseEvent& event, WPARAM wParam);

    HWND owner_;
    QBackingStore store_;
    QImage shadow_; // the picture where the display's pixels have another form than ours
    QRect dirty_;   // one rectangle: what a step touches overlaps, and each piece costs a request
    QRect untold_;  // what the watcher of pictures hasn't been told of
    std::int64_t flushed_ = 0; // when the server was last told to fetch pixels
};

} // namespace seam
