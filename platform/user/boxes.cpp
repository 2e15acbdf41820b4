// Message boxes and the guard against exceptions.
#include "platform/harness.h"
#include "platform/kernel.h"
#include "platform/trace.h"
#include "platform/user/foreign.h"
#include "platform/user/overlay.h"
#include "platform/user/text.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QAbstractButton>
#include <QApplication>
#include <QKeyEvent>
#include <QMessageBox>

#include <cerrno>
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

/// A key presses its buttons at once. The toolkit would show them down for a tenth of a second
/// first, and the keys that come within that time would be the box's, too.
class Box : public Overlay<QMessageBox> {
  public:
    using Overlay::Overlay;

    bool eventFilter(QObject* watched, QEvent* event) override {
        auto* const button = qobject_cast<QAbstractButton*>(watched);
        if (button == nullptr || event->type() != QEvent::Shortcut) {
            return Overlay::eventFilter(watched, event);
        }
        button->click();
        return true;
    }

  protected:
    void showEvent(QShowEvent* event) override {
        Overlay::showEvent(event);
        for (QAbstractButton* button : buttons()) {
            button->installEventFilter(this);
        }
    }

    void keyPressEvent(QKeyEvent* event) override {
        Overlay::keyPressEvent(event);
        for (QAbstractButton* button : buttons()) {
            if (button->isDown() && event->key() != Qt::Key_Space) {
                button->click();
            }
        }
    }
};

/// Whether the window, or one that it lies in, is a child in another program's window.
bool liesInHost(HWND window) {
    const Window* outermost = findWindow(topLevelOf(window));
    return outermost != nullptr && mayBeForeign(outermost->parent);
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
    const bool asks = (type & 0xFU) == MB_YESNOCANCEL;
    if (liesInHost(owner)) {
        std::fprintf(stderr, "%s: %s\n", program_invocation_short_name, text);
        return asks ? IDCANCEL : IDOK;
    }
    // On the heap and without a parent: the owner may be destroyed while the box is up.
    const auto box = std::make_unique<Box>(topLevelOf(owner));
    box->setWindowTitle(shownText(title));
    box->setText(shownText(text));
    box->setTextFormat(Qt::PlainText);
    box->setIcon(iconOf(type));
    box->setStandardButtons(asks ? QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel
                                 : QMessageBox::StandardButtons(QMessageBox::Ok));
    return answerOf(runOver(*box, owner), asks);
}

BOOL MessageBeep(UINT /*type*/) {
    if (toolkit()) {
        QApplication::beep();
    }
    return TRUE;
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
