// A window that can hold controls: a widget with the program's picture in it and a black line round
// that. The toolkit gives it no frame; whoever wants to drag it says where by WM_NCHITTEST.
#pragma once

#include "platform/user/window_picture.h"

#include <QImage>
#include <QWidget>

#include <optional>

namespace seam {

class FrameWindow : public QWidget, public WindowPicture {
  public:
    /// How wide the line is.
    static constexpr int border = 1;

    /// At a place of the screen, which includes the line.
    FrameWindow(HWND owner, const QRect& place);

    PixelView pixels() override;
    void flush() override;
    void resizePicture(QSize size) override;

    /// Gives it a place; nobody else can change its size.
    void moveTo(const QRect& place);

    /// Lets the user drag it, while the left button is down, with or without a window manager.
    void drag();

  protected:
    bool event(QEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;
    bool focusNextPrevChild(bool next) override;
    void paintEvent(QPaintEvent* event) override;
    void moveEvent(QMoveEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;
    void keyReleaseEvent(QKeyEvent* event) override;
    void mouseMoveEvent(QMouseEvent* event) override;
    void mousePressEvent(QMouseEvent* event) override;
    void mouseReleaseEvent(QMouseEvent* event) override;
    void wheelEvent(QWheelEvent* event) override;

  private:
    void queueActivation(bool active);
    void keepSize();

    QImage image_;
    int scale_ = 1;              // of the screen that it has its size on
    std::optional<QPoint> grip_; // while it is dragged without a window manager: where, in it
};

} // namespace seam
