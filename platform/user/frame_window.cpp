#include "platform/user/frame_window.h"

#include "platform/user/keys.h"
#include "platform/user/queue.h"
#include "platform/user/scale.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QAccessible>
#include <QAccessibleWidget>
#include <QCloseEvent>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPainter>
#include <QScreen>
#include <QWheelEvent>
#include <QWindow>

#include <algorithm>
#include <utility>

namespace seam {

namespace {

constexpr QPoint clientCorner(FrameWindow::border, FrameWindow::border);

/// Says of a framed window that it is a window; else it would be told of as a mere part of one.
QAccessibleInterface* accessibleWindow(const QString& /*className*/, QObject* object) {
    auto* window = dynamic_cast<FrameWindow*>(object);
    return window == nullptr ? nullptr : new QAccessibleWidget(window, QAccessible::Window);
}

} // namespace

FrameWindow::FrameWindow(HWND owner, const QRect& place) : WindowPicture(owner) {
    setWindowFlags(Qt::Window | Qt::FramelessWindowHint);
    setAttribute(Qt::WA_OpaquePaintEvent);
    setAttribute(Qt::WA_NoSystemBackground);
    setMouseTracking(true);
    QAccessible::installFactory(accessibleWindow); // once, however often it is asked for
    moveTo(place);
    winId(); // makes its window
    windowHandle()->installEventFilter(this);
    scale_ = scaleOf(*windowHandle());
}

PixelView FrameWindow::pixels() {
    if (image_.isNull()) {
        return {};
    }
    // Not bits(): the image is never shared.
    auto* bits = reinterpret_cast<DWORD*>(const_cast<uchar*>(image_.constBits()));
    return {bits, image_.width(), image_.height(), static_cast<int>(image_.bytesPerLine() / 4)};
}

void FrameWindow::flush() {
    if (!dirty_.isEmpty() && isVisible()) {
        const QRect area = dirty_;
        dirty_ = QRect();
        repaint(area.translated(clientCorner));
    }
}

void FrameWindow::resizePicture(QSize size) {
    const QImage kept = copyPicture();
    image_ = QImage(size, QImage::Format_RGB32);
    image_.fill(Qt::black);
    pastePicture(kept);
}

void FrameWindow::moveTo(const QRect& place) {
    setFixedSize(place.size());
    move(place.topLeft());
    const QSize client = place.size() - QSize(2 * border, 2 * border);
    if (image_.size() != client) {
        resizePicture(client.expandedTo({1, 1}));
    }
}

void FrameWindow::drag() {
    const bool held = (QGuiApplication::mouseButtons() & Qt::LeftButton) != 0;
    if (held && !windowHandle()->startSystemMove()) {
        grip_ = QCursor::pos() - pos();
    }
}

void FrameWindow::queueActivation(bool active) {
    const LONG minimised = isMinimized() ? 1 : 0;
    const MSG activation{owner_, WM_ACTIVATE,
                         static_cast<WPARAM>(MAKELONG(active ? WA_ACTIVE : WA_INACTIVE, minimised)),
                         0, 0};
    queueInput({owner_, static_cast<UINT>(active ? WM_SETFOCUS : WM_KILLFOCUS), 0, 0, 0});
    queuePosted(activation); // no input: it doesn't wait until a box that takes it away is answered
}

bool FrameWindow::event(QEvent* event) {
    switch (event->type()) {
    case QEvent::Close:
        queuePosted({owner_, WM_CLOSE, 0, 0, 0}); // it goes when its procedure says so
        event->ignore();
        return true;
    case QEvent::WindowActivate:
    case QEvent::WindowDeactivate:
        queueActivation(event->type() == QEvent::WindowActivate);
        break;
    default:
        break;
    }
    return QWidget::event(event);
}

bool FrameWindow::eventFilter(QObject* /*watched*/, QEvent* event) {
    return inputIsBarred(owner_, *event);
}

/// It is no dialog: neither Tab nor a button that is disabled passes the focus on.
bool FrameWindow::focusNextPrevChild(bool /*next*/) {
    return false;
}

void FrameWindow::paintEvent(QPaintEvent* event) {
    QPainter painter(this);
    for (const QRect& area : event->region()) {
        const QRect inner = area & image_.rect().translated(clientCorner);
        painter.drawImage(inner, image_, inner.translated(-clientCorner));
    }
    painter.setClipRegion(QRegion(rect()) - image_.rect().translated(clientCorner));
    painter.fillRect(rect(), Qt::black);
}

void FrameWindow::moveEvent(QMoveEvent* /*event*/) {
    Window* window = findWindow(owner_);
    const QPoint corner = pos() - screenOrigin();
    if (window == nullptr ||
        (window->place.left == corner.x() && window->place.top == corner.y())) {
        return;
    }
    RECT& place = window->place;
    place = {corner.x(), corner.y(), corner.x() + place.right - place.left,
             corner.y() + place.bottom - place.top};
    queuePosted({owner_, WM_MOVE, 0, static_cast<LPARAM>(MAKELONG(corner.x(), corner.y())), 0});
}

/// The toolkit keeps the size that it has on the server when it comes to a screen of another scale.
/// About its middle: else it might go back to the screen that it comes from.
void FrameWindow::keepSize() {
    const QRect screen = windowHandle()->screen()->geometry();
    QRect place(QPoint(), image_.size() + QSize(2 * border, 2 * border));
    place.moveCenter(geometry().center());
    place.moveRight(std::min(place.right(), screen.right()));
    place.moveBottom(std::min(place.bottom(), screen.bottom()));
    place.moveLeft(std::max(place.left(), screen.left()));
    place.moveTop(std::max(place.top(), screen.top())); // what it is dragged by stays in reach
    setMinimumSize(0, 0); // what the window manager knows of its size counts the server's pixels
    setMaximumSize(QWIDGETSIZE_MAX, QWIDGETSIZE_MAX);
    setFixedSize(place.size());
    move(place.topLeft());
    update();
}

/// A window manager that has its own idea of windows has given it another size, or it lies on
/// another screen now.
void FrameWindow::resizeEvent(QResizeEvent* event) {
    if (std::exchange(scale_, scaleOf(*windowHandle())) != scaleOf(*windowHandle())) {
        QMetaObject::invokeMethod(
            this, [this] { keepSize(); }, Qt::QueuedConnection);
        return;
    }
    Window* window = findWindow(owner_);
    const QSize client = event->size() - QSize(2 * border, 2 * border);
    if (window != nullptr && image_.size() != client && !client.isEmpty()) {
        resizePicture(client);
        windowResized(*window, client.width(), client.height());
    }
}

void FrameWindow::keyPressEvent(QKeyEvent* event) {
    queueKey(keyTarget(owner_), *event, true);
}

void FrameWindow::keyReleaseEvent(QKeyEvent* event) {
    queueKey(keyTarget(owner_), *event, false);
}

void FrameWindow::mouseMoveEvent(QMouseEvent* event) {
    if (grip_) {
        move(event->globalPosition().toPoint() - *grip_);
        return;
    }
    queueMouse(owner_, WM_MOUSEMOVE, *event, clientCorner);
}

void FrameWindow::mousePressEvent(QMouseEvent* event) {
    queueMouse(owner_, buttonMessage(event->button(), true), *event, clientCorner);
}

void FrameWindow::mouseReleaseEvent(QMouseEvent* event) {
    if (grip_ && event->button() == Qt::LeftButton) {
        grip_.reset();
        return;
    }
    queueMouse(owner_, buttonMessage(event->button(), false), *event, clientCorner);
}

void FrameWindow::wheelEvent(QWheelEvent* event) {
    queueWheel(owner_, *event);
}

} // namespace seam
