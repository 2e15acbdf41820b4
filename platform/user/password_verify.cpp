// The module that asks for the password before the saver lets go.
#include "platform/kernel/modules.h"
#include "platform/user/password_dialog.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QEvent>

#include <memory>

namespace seam {

namespace {

class VerifyDialog : public PasswordDialog {
  public:
    VerifyDialog(HWND owner, const StoredPassword& stored)
        : PasswordDialog(owner, QStringLiteral("Screen Saver Password")) {
        if (stored.state == PasswordState::broken) {
            refuse("Nobody can be let in", stored);
        } else {
            explain(QStringLiteral("Enter your password to end the screen saver."));
            field_ = addField(QStringLiteral("&Password:"));
            field_->setFocus();
        }
        untilGone_.setSingleShot(true);
        untilGone_.setTimerType(Qt::PreciseTimer);
        QObject::connect(&untilGone_, &QTimer::timeout, this, &QDialog::reject);
        untilGone_.start(passwordPatience().untilGone);
    }

  protected:
    void submit() override {
        // A password has characters: no more than a key that was pressed too early.
        if (!field_->secret().bytes().empty() && check(*field_)) {
            accept();
        }
    }

    void keyPressed() override {
        untilGone_.start();
    }

  private:
    PasswordField* field_ = nullptr;
    QTimer untilGone_;
};

/// Asks for the password over the window; TRUE if the user may pass, at once if there is none.
BOOL VerifyScreenSavePwd(HWND window) {
    const StoredPassword stored = readPassword();
    if (stored.state == PasswordState::none) {
        return TRUE;
    }
    if (!toolkit()) {
        return FALSE;
    }
    // On the heap and without a parent: the window may be destroyed while the dialog is up.
    const auto dialog = std::make_unique<VerifyDialog>(topLevelOf(window), stored);
    return runOver(*dialog, window) == QDialog::Accepted ? TRUE : FALSE;
}

const ModuleRegistration
    module("PASSWORD.CPL", {"VerifyScreenSavePwd", reinterpret_cast<FARPROC>(VerifyScreenSavePwd)},
           ModuleRegistration::Kind::loadable);

} // namespace

} // namespace seam
