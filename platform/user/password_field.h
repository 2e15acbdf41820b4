// A field for a password. It keeps what is typed in memory that is wiped, where a text field of the
// toolkit would leave copies, and gives it to no clipboard and no input method: what those compose
// of several keys doesn't come here.
#pragma once

#include "platform/user/secret.h"

#include <QWidget>

namespace seam {

/// Shows a bullet for each character. Backspace takes the last one back, Ctrl+U all of them. Keys
/// that it has no use for go to the dialog.
class PasswordField : public QWidget {
  public:
    explicit PasswordField(QWidget* parent);

    const Secret& secret() const {
        return secret_;
    }

    void clear();
    QSize sizeHint() const override;

  protected:
    void keyPressEvent(QKeyEvent* event) override;
    void paintEvent(QPaintEvent* event) override;

  private:
    void type(const QString& text);

    Secret secret_;
};

} // namespace seam
