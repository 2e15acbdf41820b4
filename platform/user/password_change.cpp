// The module that changes the saver's password.
#include "platform/kernel/modules.h"
#include "platform/kernel/text.h"
#include "platform/user/foreign.h"
#include "platform/user/password_dialog.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QWindow>

#include <memory>

namespace seam {

namespace {

constexpr DWORD changed = 0;
constexpr DWORD invalidData = 13;
constexpr DWORD notReady = 21;
constexpr DWORD badProvider = 1204;
constexpr DWORD cancelled = 1223;

class ChangeDialog : public PasswordDialog {
  public:
    ChangeDialog(HWND owner, const StoredPassword& stored)
        : PasswordDialog(owner, QStringLiteral("Change Password")) {
        if (stored.state == PasswordState::broken) {
            refuse("The password can't be changed", stored);
            return;
        }
        if (stored.state == PasswordState::set) {
            explain(QStringLiteral("An empty new password removes the old one."));
            old_ = addField(QStringLiteral("&Old password:"));
        } else {
            explain(QStringLiteral("The screen saver will ask for this password."));
        }
        new_ = addField(QStringLiteral("&New password:"));
        again_ = addField(QStringLiteral("&Confirm new password:"));
        (old_ != nullptr ? old_ : new_)->setFocus();
    }

  protected:
    void submit() override {
        if (new_->secret().bytes() != again_->secret().bytes()) {
            say(QStringLiteral("The two new passwords differ."));
            new_->clear();
            again_->clear();
            new_->setFocus();
        } else if (old_ == nullptr || check(*old_)) {
            change();
        }
    }

  private:
    void change() {
        if (changePassword(new_->secret().bytes())) {
            accept();
        } else {
            say(QStringLiteral("The password can't be written. It stays as it was."));
        }
    }

    PasswordField* old_ = nullptr; // none if there is no password yet
    PasswordField* new_ = nullptr;
    PasswordField* again_ = nullptr;
};

/// Asks for a new password, and the old one if there is one, and keeps it. `provider` must be
/// "SCRSAVE"; the window may be null or another program's. 0 if it has been changed, else an error
/// number of the platform.
DWORD PwdChangePasswordA(const char* provider, HWND window, DWORD /*reserved*/,
                         void* /*reserved*/) {
    if (provider == nullptr || !sameButForCase(provider, "SCRSAVE")) {
        return badProvider;
    }
    if (!toolkit()) {
        return notReady;
    }
    const StoredPassword stored = readPassword();
    const std::unique_ptr<QWindow> host(foreignExists(window) ? QWindow::fromWinId(window.number)
                                                              : nullptr);
    const auto dialog = std::make_unique<ChangeDialog>(topLevelOf(window), stored);
    if (host != nullptr) {
        dialog->winId(); // makes its window, for the other program's to be told as its owner
        dialog->windowHandle()->setTransientParent(host.get());
    }
    if (runOver(*dialog, window) == QDialog::Accepted) {
        return changed;
    }
    return stored.state == PasswordState::broken ? invalidData : cancelled;
}

const ModuleRegistration
    module("MPR.DLL", {"PwdChangePasswordA", reinterpret_cast<FARPROC>(PwdChangePasswordA)},
           ModuleRegistration::Kind::loadable);

} // namespace

} // namespace seam
