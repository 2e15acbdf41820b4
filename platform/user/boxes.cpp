// Message boxes, dialogs, menus and the guard against exceptions.
#include "platform/harness.h"
#include "platform/kernel.h"
#include "platform/trace.h"
#include "platform/user/cursors.h"
#include "platform/user/grabs.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/text.h"
#include "platform/user/toolkit.h"
#include "platform/user/waker.h"
#include "platform/user/window.h"

#include <QApplication>
#include <QMessageBox>
#include <QPainter>
#include <QScreen>
#include <qdrawutil.h>

#include <cstdio>
#include <exception>
#include <memory>

namespace seam {

namespace {

BoxAnswer answerInstead;

QMessageBox::Icon iconOf(UINT type) {
    switch (type & 0xF0U) {
    case MB_ICONHAND:
        return QMessageBox::Critical;
    case MB_ICONEXCLAMATION:
        return QMessageBox::Warning;
    default:
        return QMessageBox::NoIcon;
    }
}

/// A box that was closed without a button counts as cancelled where it asks.
int answerOf(int button, bool asks) {
    switch (button) {
    case QMessageBox::Yes:
        return IDYES;
    case QMessageBox::No:
        return IDNO;
    default:
        return asks ? IDCANCEL : IDOK;
    }
}

/// A box that gives the keyboard back to its owner before it goes: were it the other way round, the
/// window manager would give it to somebody else.
class Box : public QMessageBox {
  public:
    explicit Box(HWND owner) : owner_(owner) {}

    void setVisible(bool visible) override {
        if (!visible && isVisible()) {
            giveBack(*windowHandle());
            SetForegroundWindow(owner_);
        }
        QMessageBox::setVisible(visible);
    }

  protected:
    /// Where no window manager draws a frame round it, the box draws its own.
    void paintEvent(QPaintEvent* event) override {
        QMessageBox::paintEvent(event);
        if ((windowFlags() & Qt::FramelessWindowHint) != 0) {
            QPainter painter(this);
            qDrawWinPanel(&painter, rect(), palette());
        }
    }

  private:
    HWND owner_;
    BoxPointer pointer_;
};

/// Puts the box over its owner. A window that stays above all others, out of the window manager's
/// hands, would hide a box that isn't the same.
void placeOver(QMessageBox& box, QWindow* owner) {
    if (owner == nullptr) {
        return;
    }
    const bool above = (owner->flags() & Qt::X11BypassWindowManagerHint) != 0;
    if (above) {
        box.setWindowFlags(box.windowFlags() | Qt::FramelessWindowHint | Qt::WindowStaysOnTopHint |
                           Qt::X11BypassWindowManagerHint);
    }
    box.winId(); // makes its window, for the owner to be told
    if (owner->isVisible()) {
        box.windowHandle()->setTransientParent(owner);
    }
    box.adjustSize();
    const QRect area = owner->parent() == nullptr ? owner->geometry()
                                                  : QGuiApplication::primaryScreen()->geometry();
    box.move(area.center() - box.rect().center());
}

} // namespace

void answerBoxes(BoxAnswer answer) {
    answerInstead = std::move(answer);
}

} // namespace seam

using namespace seam;

int MessageBoxA(HWND owner, const char* text, const char* caption, UINT type) {
    const std::string title = caption == nullptr ? "Error" : caption;
    Trace("message text=%s", text);
    if (answerInstead) {
        return answerInstead(text, title, type);
    }
    if (!toolkit()) {
        return 0;
    }
    flushWindows();
    // On the heap and without a parent: the owner may be destroyed while the box is up.
    const auto box = std::make_unique<Box>(topLevelOf(owner));
    box->setWindowTitle(shownText(title));
    box->setText(shownText(text));
    box->setTextFormat(Qt::PlainText);
    box->setIcon(iconOf(type));
    const bool asks = (type & 0xFU) == MB_YESNOCANCEL;
    box->setStandardButtons(asks ? QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel
                                 : QMessageBox::StandardButtons(QMessageBox::Ok));
    box->setWindowModality(Qt::ApplicationModal);
    const Window* over = findWindow(topLevelOf(owner));
    placeOver(*box, over == nullptr ? nullptr : over->native.get());
    box->winId(); // makes its window
    bringForward(*box->windowHandle());
    box->show();
    box->activateWindow();
    wakeToolkitLoop();
    const int answer = answerOf(box->exec(), asks);
    rethrowFromToolkitLoop();
    return answer;
}

BOOL MessageBeep(UINT /*type*/) {
    if (toolkit()) {
        QApplication::beep();
    }
    return TRUE;
}

LRESULT DialogBoxParamA(HINSTANCE /*instance*/, ResourceName /*name*/, HWND /*owner*/,
                        DLGPROC /*procedure*/, LPARAM /*parameter*/) {
    // The resources hold no dialog yet.
    return -1;
}

HMENU GetMenu(HWND /*window*/) {
    return {}; // no class of the program has a menu bar
}

BOOL EnableMenuItem(HMENU /*menu*/, UINT /*item*/, UINT /*enable*/) {
    return -1;
}

int RunGuarded(int (*body)(), int (*handler)()) {
    try {
        return body();
    } catch (const std::exception& error) {
        std::fprintf(stderr, "dorbo: %s\n", error.what());
    } catch (...) {
        std::fputs("dorbo: an unknown exception\n", stderr);
    }
    return handler();
}
