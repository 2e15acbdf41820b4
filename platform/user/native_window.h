// A window on the screen with its picture in memory, which is the toolkit's own backing store:
// nothing is copied between drawing and showing.
#pragma once

#include "platform/user/window_picture.h"

#include <QBackingStore>
#include <QImage>
#include <QWindow>

#include <cstdint>
#include <optional>

namespace seam {

class NativeWindow : public QWindow, public WindowPicture {
  public:
    /// A top-level window at a place of the screen, or a child of another window.
    NativeWindow(HWND owner, const QRect& place, Qt::WindowFlags flags, QWindow* parent);

    PixelView pixels() override;
    void touch(const RECT& area) override;
    void flush() override;
    void resizePicture(QSize size) override;

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
    bool hasOurForm(const QImage& image) const;
    QImage* storeImage();
    bool awaitsFirstPaint() const;
    void followScale();
    void awaitFetch(const QRect& area);
    void showShadow(const QRect& area);
    void enlargeInto(QImage& target, const QRect& area) const;

    std::optional<QBackingStore> store_;
    QImage shadow_;            // the picture where the display's pixels aren't ours: larger, or of
                               // another form
    int scale_ = 1;            // of the screen that the picture has been made for
    bool lent_ = false;        // a menu has the keyboard and will give it back
    std::int64_t flushed_ = 0; // when the server was last told to fetch pixels
};

} // namespace seam
