#include "platform/user/overlay.h"

#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/waker.h"
#include "platform/user/window.h"

#include <QGuiApplication>
#include <QPainter>
#include <QScreen>
#include <qdrawutil.h>

namespace seam {

namespace {

/// Where a dialog over this window has its middle: in the part of it on its own monitor.
QPoint middleOf(const QWindow& owner) {
    if (owner.parent() != nullptr) {
        return QGuiApplication::primaryScreen()->geometry().center();
    }
    const QRect seen = owner.geometry() & owner.screen()->geometry();
    return seen.isEmpty() ? owner.geometry().center() : seen.center();
}

/// Puts the dialog over its owner. A window that stays above all others, out of the window
/// manager's hands, would hide a dialog that isn't the same.
void placeOver(QDialog& dialog, QWindow& owner) {
    if ((owner.flags() & Qt::X11BypassWindowManagerHint) != 0) {
        // Nothing of the flags that it has: with any button of a title it wouldn't be frameless.
        dialog.setWindowFlags(Qt::Dialog | Qt::FramelessWindowHint | Qt::WindowStaysOnTopHint |
                              Qt::X11BypassWindowManagerHint);
    }
    dialog.winId(); // makes its window, for the owner to be told
    if (owner.isVisible()) {
        dialog.windowHandle()->setTransientParent(&owner);
    }
    dialog.adjustSize();
    dialog.move(middleOf(owner) - dialog.rect().center());
}

int boxes = 0; // calls of runOver on the stack

struct BoxCount {
    BoxCount() {
        ++boxes;
    }

    BoxCount(const BoxCount&) = delete;
    BoxCount& operator=(const BoxCount&) = delete;

    ~BoxCount() {
        --boxes;
    }
};

} // namespace

bool boxIsUp() {
    return boxes > 0;
}

int runOver(QDialog& dialog, HWND owner) {
    const BoxCount count;
    flushWindows();
    dialog.setWindowModality(Qt::ApplicationModal);
    const Window* over = findWindow(topLevelOf(owner));
    if (QWindow* under = over != nullptr ? toolkitWindow(*over) : nullptr) {
        placeOver(dialog, *under);
        QObject::connect(under, &QObject::destroyed, &dialog, &QDialog::reject);
    }
    dialog.winId();                       // makes its window
    bringForward(*dialog.windowHandle()); // before it is seen, to hear of that
    dialog.show();
    dialog.activateWindow();
    wakeToolkitLoop();
    const int result = dialog.exec();
    rethrowFromToolkitLoop();
    return result;
}

void paintOwnFrame(QDialog& dialog) {
    if ((dialog.windowFlags() & Qt::FramelessWindowHint) != 0) {
        QPainter painter(&dialog);
        qDrawWinPanel(&painter, dialog.rect(), dialog.palette());
    }
}

} // namespace seam
