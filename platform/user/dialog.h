// The toolkit's window behind a dialog's handle.
#pragma once

#include "platform/dialogs.h"
#include "platform/user/dialog_template.h"

#include <QDialog>

#include <optional>

class QMenuBar;

namespace seam {

/// Its keys are the toolkit's: Tab, the underlined letters and the arrows. Enter presses the
/// default button and Escape stands for IDCANCEL; closing it is WM_CLOSE. F10 opens the first menu
/// of its bar.
class DialogWindow : public QDialog {
  public:
    DialogWindow(HWND handle, const DialogTemplate& made, DLGPROC answering);

    DLGPROC procedure() const {
        return procedure_;
    }

    /// Gives it the menu bar, above all else.
    void addMenuBar(HMENU bar);

    /// In what its controls lie: all of it but the menu bar.
    QWidget& client() {
        return *client_;
    }

    /// Gives the focus to the first tab stop.
    void focusFirst();

    /// What EndDialog has been given.
    std::optional<LRESULT> result;

    void reject() override;

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    void keyPressEvent(QKeyEvent* event) override;

  private:
    bool hasDefaultButton() const;
    void openFirstMenu();
    void command(int id);

    HWND handle_;
    DLGPROC procedure_;
    QWidget* client_ = this;
    QMenuBar* menuBar_ = nullptr;
};

} // namespace seam
