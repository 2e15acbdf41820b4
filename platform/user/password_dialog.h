// What the two dialogs that take a password have in common.
#pragma once

#include "platform/user/overlay.h"
#include "platform/user/password_field.h"
#include "platform/user/password_store.h"

#include <QTimer>

#include <chrono>
#include <set>
#include <string>
#include <utility>

class QDialogButtonBox;
class QFormLayout;
class QLabel;
class QPushButton;

namespace seam {

/// How long the dialogs wait. Tests are in more of a hurry.
struct PasswordPatience {
    std::chrono::milliseconds untilGone{30000};    // without a key, where a dialog doesn't stay
    std::chrono::milliseconds firstDelay{1000};    // after the first wrong password; then doubled
    std::chrono::milliseconds longestDelay{16000}; // comes to its end before a dialog goes
};

PasswordPatience& passwordPatience();

/// Somebody knew the password: the next wrong one counts as the first.
void forgetWrongPasswords();

/// A dialog with fields for passwords, a line for what is wrong, and OK and Cancel. After a wrong
/// password there is no OK for a while that grows with each, also from one dialog to the next.
/// While it lives the process leaves no dumps.
class PasswordDialog : public Overlay<QDialog> {
  protected:
    PasswordDialog(HWND owner, const QString& title);

    /// OK has been asked for, and isn't held back.
    virtual void submit() = 0;

    void explain(const QString& text); ///< above the fields
    void say(const QString& message);  ///< below them

    PasswordField* addField(const QString& label);

    /// Nothing can be done, as the password that is kept is broken: tells why and what to do, and
    /// leaves Cancel alone. `what` is a sentence without its stop.
    void refuse(const std::string& what, const StoredPassword& broken);

    /// Whether it is the password that is kept now, or there is none any more. If not says so,
    /// empties the field and holds OK back.
    bool check(PasswordField& field);

    virtual void keyPressed() {} ///< a key has gone down, and isn't one that is still held

    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    bool isRepetition(const QKeyEvent& key);
    void holdBack();

    NoDumps noDumps_;
    QLabel* text_;
    QFormLayout* form_;
    QLabel* message_;
    QDialogButtonBox* buttons_;
    QPushButton* ok_;
    QTimer delay_;
    std::pair<quint32, quint64> released_{}; // which key went up last, and when
    std::set<quint32> pressedHere_;          // keys that have gone down in this dialog
};

} // namespace seam
