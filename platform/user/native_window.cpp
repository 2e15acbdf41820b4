#include "platform/user/native_window.h"

#include "platform/gdi/rows.h"
#include "platform/harness.h"
#include "platform/user/clock.h"
#include "platform/user/input_contexts.h"
#include "platform/user/keys.h"
#include "platform/user/queue.h"
#include "platform/user/scale.h"
#include "platform/user/screens.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QExposeEvent>
#include <QGuiApplication>
#include <QImage>
#include <QInputMethodQueryEvent>
#include <QKeyEvent>
#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>

namespace seam {

namespace {

/// The X server fetches pixels from memory that it shares with us, some time after it is told to.
/// Drawing sooner than this after a flush first waits until it has. A server that is held up for
/// longer can show a step half drawn; asking it at each step would cost twice the wake-ups.
constexpr std::int64_t fetchTime = 50;

/// Without a window manager nobody else gives a window the keyboard that is clicked in.
void activateHost(const QWindow& child) {
    QWindow* host = child.parent();
    while (host->parent() != nullptr) {
        host = host->parent();
    }
    if (QGuiApplication::focusWindow() != host) {
        host->requestActivate();
    }
}

QRect toQt(const RECT& area) {
    return {area.left, area.top, area.right - area.left, area.bottom - area.top};
}

} // namespace

NativeWindow::NativeWindow(HWND owner, const QRect& place, Qt::WindowFlags flags, QWindow* parent)
    : QWindow(parent), WindowPicture(owner) {
    setSurfaceType(QSurface::RasterSurface);
    setFlags(flags);
    setGeometry(place);
    create();
    resizePicture(place.size());
    connect(this, &QWindow::screenChanged, this, [this] { followScale(); });
}

/// The store of a window without alpha has either form, and clears neither.
bool NativeWindow::hasOurForm(const QImage& image) const {
    return image.format() == QImage::Format_RGB32 ||
           (image.format() == QImage::Format_ARGB32_Premultiplied && !requestedFormat().hasAlpha());
}

QImage* NativeWindow::storeImage() {
    return store_ ? static_cast<QImage*>(store_->paintDevice()) : nullptr;
}

PixelView NativeWindow::pixels() {
    const QImage* image = shadow_.isNull() ? storeImage() : &shadow_;
    if (image == nullptr || image->isNull()) {
        return {};
    }
    // Not bits(): the image is never shared, and a detached copy would never be shown.
    auto* bits = reinterpret_cast<DWORD*>(const_cast<uchar*>(image->constBits()));
    return {bits, image->width(), image->height(), static_cast<int>(image->bytesPerLine() / 4)};
}

/// Before the pixels of the backing store change.
void NativeWindow::awaitFetch(const QRect& area) {
    if (!clockIsManual() && clockNow() - flushed_ < fetchTime) {
        store_->beginPaint(area);
        store_->endPaint();
    }
}

void NativeWindow::touch(const RECT& area) {
    if (shadow_.isNull()) {
        awaitFetch(toQt(area));
    }
    WindowPicture::touch(area);
}

void NativeWindow::showShadow(const QRect& area) {
    awaitFetch(area); // which may make another image of the same pixels
    QImage* image = storeImage();
    if (image != nullptr && hasOurForm(*image)) {
        enlargeInto(*image, area & shadow_.rect());
        return;
    }
    store_->beginPaint(area);
    QPainter(storeImage()).drawImage(area, shadow_, area);
    store_->endPaint();
}

/// Each pixel becomes a square of whole ones.
void NativeWindow::enlargeInto(QImage& target, const QRect& area) const {
    const int scale = scale_;
    const auto count = static_cast<std::size_t>(area.width());
    const qsizetype stride = target.bytesPerLine() / 4;
    // Not bits(): see pixels().
    auto* bits = reinterpret_cast<DWORD*>(const_cast<uchar*>(target.constBits()));
    for (int y = area.top(); y <= area.bottom(); ++y) {
        DWORD* const row = bits + y * scale * stride + area.left() * scale;
        const auto* source = reinterpret_cast<const DWORD*>(shadow_.constScanLine(y));
        widenRow(row, source + area.left(), count, static_cast<std::size_t>(scale));
        for (int again = 1; again < scale; ++again) {
            copyRow(row + again * stride, row, count * static_cast<std::size_t>(scale));
        }
    }
}

/// A new window shows nothing before its procedure has painted it: to bring the blank one to the
/// screen, and to wait until it is there, would hold up the first picture by some 10 ms.
bool NativeWindow::awaitsFirstPaint() const {
    const seam::Window* window = findWindow(owner_);
    return window != nullptr && window->paintNeeded && !window->painted;
}

void NativeWindow::flush() {
    if (dirty_.isEmpty() || !isExposed() || awaitsFirstPaint()) {
        return; // the expose event that makes it visible, or its painting, shows all of it
    }
    const QRect area = std::exchange(dirty_, QRect());
    if (!shadow_.isNull()) {
        showShadow(area);
    }
    store_->flush(area);
    flushed_ = clockNow();
    pictureShown(owner_);
}

void NativeWindow::resizePicture(QSize size) {
    const QImage kept = copyPicture();
    scale_ = scaleOf(*this);
    shadow_ = QImage();
    store_.emplace(this); // a new one: of an old one the toolkit may keep an image of freed pixels
    store_->resize(size);
    store_->beginPaint(QRect(QPoint(), size)); // which has its image ready where it is a larger one
    store_->endPaint();
    const QImage* image = storeImage();
    if (image != nullptr && (scale_ != 1 || !hasOurForm(*image))) {
        shadow_ = QImage(size, QImage::Format_RGB32);
        shadow_.fill(Qt::black);
    }
    pastePicture(kept);
}

bool NativeWindow::event(QEvent* event) {
    if (inputIsBarred(owner_, *event)) {
        return true;
    }
    if (event->type() == QEvent::Close) {
        // The window goes when its procedure says so.
        queuePosted({owner_, WM_CLOSE, 0, 0, 0});
        event->ignore();
        return true;
    }
    if (event->type() == QEvent::InputMethodQuery) {
        answerInputMethod(owner_, static_cast<QInputMethodQueryEvent&>(*event));
        return true;
    }
    return QWindow::event(event);
}

void NativeWindow::exposeEvent(QExposeEvent* /*event*/) {
    // A paint event follows, which says what has come to light.
}

void NativeWindow::paintEvent(QPaintEvent* event) {
    dirty_ |= event->region().boundingRect();
    flush();
}

void NativeWindow::resizeEvent(QResizeEvent* event) {
    seam::Window* window = findWindow(owner_);
    if (window == nullptr || window->native == nullptr ||
        (window->width() == event->size().width() && window->height() == event->size().height())) {
        return;
    }
    resizePicture(event->size());
    windowResized(*window, event->size().width(), event->size().height());
}

/// On a screen of another scale. Where it lies in a window of ours, that one keeps its size in our
/// pixels, and so does this; the toolkit would keep its size on the server.
void NativeWindow::followScale() {
    const seam::Window* window = findWindow(owner_);
    if (window == nullptr || scaleOf(*this) == scale_) {
        return;
    }
    const QSize size(window->width(), window->height());
    resizePicture(size);
    if (parent() != nullptr) {
        const QPoint corner = QPoint(window->place.left, window->place.top) + originOf(*window);
        placeOnServer(*this, {corner * scale_, size * scale_});
    }
    dirty_ = QRect(QPoint(), size);
}

void NativeWindow::keyPressEvent(QKeyEvent* event) {
    queueKey(keyTarget(owner_), *event, true);
}

void NativeWindow::keyReleaseEvent(QKeyEvent* event) {
    queueKey(keyTarget(owner_), *event, false);
}

void NativeWindow::mouseMoveEvent(QMouseEvent* event) {
    queueMouse(owner_, WM_MOUSEMOVE, *event);
}

void NativeWindow::mousePressEvent(QMouseEvent* event) {
    if ((flags() & Qt::WindowDoesNotAcceptFocus) != 0) {
        activateHost(*this);
    }
    queueMouse(owner_, buttonMessage(event->button(), true), *event);
}

void NativeWindow::mouseReleaseEvent(QMouseEvent* event) {
    queueMouse(owner_, buttonMessage(event->button(), false), *event);
}

void NativeWindow::wheelEvent(QWheelEvent* event) {
    queueWheel(owner_, *event);
}

void NativeWindow::focusInEvent(QFocusEvent* /*event*/) {
    if (std::exchange(lent_, false)) {
        return;
    }
    queueInput({owner_, WM_ACTIVATE, 1, 0, 0});
    queueInput({owner_, WM_SETFOCUS, 0, 0, 0});
}

void NativeWindow::focusOutEvent(QFocusEvent* event) {
    lent_ = event->reason() == Qt::PopupFocusReason;
    if (lent_) {
        return;
    }
    queueInput({owner_, WM_KILLFOCUS, 0, 0, 0});
    queueInput({owner_, WM_ACTIVATE, 0, 0, 0});
}

} // namespace seam
