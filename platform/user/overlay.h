// Boxes and dialogs over a window of ours, also over one that stays above all others.
#pragma once

#include "platform/user.h"
#include "platform/user/cursors.h"
#include "platform/user/grabs.h"

#include <QDialog>

namespace seam {

/// Shows the dialog over its owner and runs it; gives the value that it ends with. It is rejected
/// if the owner goes.
int runOver(QDialog& dialog, HWND owner);

/// The same over a window of the toolkit's, for a box that comes out of one of its handlers: what a
/// handler of ours has thrown meanwhile is left to the runOver round it.
int execOver(QDialog& dialog, QWindow* under);

/// Whether runOver is at work, also when its dialog has just been hidden.
bool boxIsUp();

/// Draws a frame on a dialog that no window manager draws one round.
void paintOwnFrame(QDialog& dialog);

/// A dialog that gives the keyboard back to its owner before it goes: were it the other way round,
/// the window manager would give it to somebody else.
template <class Dialog>
class Overlay : public Dialog {
  public:
    explicit Overlay(HWND owner) : owner_(owner) {}

    void setVisible(bool visible) override {
        if (!visible && this->isVisible()) {
            giveBack(*this->windowHandle());
            SetForegroundWindow(owner_); // or what stands in front of it
        }
        Dialog::setVisible(visible);
    }

  protected:
    void paintEvent(QPaintEvent* event) override {
        Dialog::paintEvent(event);
        paintOwnFrame(*this);
    }

  private:
    HWND owner_;
    BoxPointer pointer_;
};

} // namespace seam
