#include "platform/user/overlay.h"

#include "platform/user/activation.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/waker.h"
#include "platform/user/window.h"

#include <QGuiApplication>
#include <QPainter>
#include <QScreen>
#include <qdrawutil.h>

#include <algorithm>

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

/// Where a window has to stand to lie on the screen, at least with its upper left corner.
QPoint keptOn(const QRect& screen, const QRect& place) {
    const auto inside = [](int start, int size, int from, int room) {
        return std::max(from, std::min(start, from + room - size));
    };
    return {inside(place.x(), place.width(), screen.x(), screen.width()),
            inside(place.y(), place.height(), screen.y(), screen.height())};
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
    dialog.move(keptOn(owner.screen()->geometry(),
                       dialog.rect().translated(middleOf(owner) - dialog.rect().center())));
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

int execOver(QDialog& dialog, QWindow* under) {
    const BoxCount count;
    flushWindows();
    dialog.setWindowModality(Qt::ApplicationModal);
    if (under != nullptr) {
        placeOver(dialog, *under);
        QObject::connect(under, &QObject::destroyed, &dialog, &QDialog::reject);
    }
    dialog.winId();                       // makes its window
    bringForward(*dialog.windowHandle()); // before it is seen, to hear of that
    dialog.show();
    activate(*dialog.windowHandle());
    wakeToolkitLoop();
    const ToolkitLoop loop(dialog);
    return dialog.exec();
}

int runOver(QDialog& dialog, HWND owner) {
    const Window* over = findWindow(topLevelOf(owner));
    const int result = execOver(dialog, over != nullptr ? toolkitWindow(*over) : nullptr);
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
