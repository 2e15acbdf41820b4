// Push buttons, check boxes and radio buttons.
#include "platform/user/controls/control.h"

#include "platform/gdi/encoding.h"
#include "platform/gdi/objects.h"
#include "platform/user/controls/item_painter.h"
#include "platform/user/text.h"

#include <QButtonGroup>
#include <QCheckBox>
#include <QDialog>
#include <QPainter>
#include <QPushButton>
#include <QRadioButton>
#include <QShortcutEvent>

namespace seam {

namespace {

/// A button that its underlined letter presses at once. The toolkit would show it down for a tenth
/// of a second first, and keys that come within that time would overtake it.
template <class Base>
class Prompt : public Base {
  public:
    using Base::Base;

  protected:
    bool event(QEvent* event) override {
        if (event->type() != QEvent::Shortcut ||
            static_cast<QShortcutEvent*>(event)->isAmbiguous()) {
            return Base::event(event);
        }
        if (this->isCheckable()) {
            this->setFocus(Qt::ShortcutFocusReason);
        }
        this->click();
        return true;
    }
};

/// A button of whose looks the program draws everything.
class DrawnButton : public Prompt<QPushButton> {
  public:
    DrawnButton(HWND handle, QWidget* dialog) : Prompt(dialog), handle_(handle) {}

  protected:
    void paintEvent(QPaintEvent* /*event*/) override {
        QPainter painter(this);
        const UINT state = (isDown() ? ODS_SELECTED : 0U) | (isEnabled() ? 0U : ODS_DISABLED) |
                           (hasFocus() ? ODS_FOCUS : 0U);
        paintItem(painter, rect(), palette().color(QPalette::Button),
                  {handle_, ODT_BUTTON, 0, state, 0});
    }

  private:
    HWND handle_;
};

/// The toolkit makes the one of a group that has the focus a tab stop: only the template does.
class RadioButton : public Prompt<QRadioButton> {
  public:
    using Prompt::Prompt;

  protected:
    void focusInEvent(QFocusEvent* event) override {
        const Qt::FocusPolicy policy = focusPolicy();
        QRadioButton::focusInEvent(event);
        setFocusPolicy(policy);
    }
};

QAbstractButton* makeWidget(DWORD style, HWND handle, QWidget& dialog) {
    switch (style & BS_TYPEMASK) {
    case BS_OWNERDRAW:
        return new DrawnButton(handle, &dialog);
    case BS_AUTOCHECKBOX:
        return new Prompt<QCheckBox>(&dialog);
    case BS_AUTORADIOBUTTON:
        return new RadioButton(&dialog);
    default:
        auto* button = new Prompt<QPushButton>(&dialog);
        button->setDefault((style & BS_TYPEMASK) == BS_DEFPUSHBUTTON);
        return button;
    }
}

class Button : public Control {
  public:
    Button(const ControlTemplate& made, HWND handle, QWidget& dialog)
        : button_(makeWidget(made.style, handle, dialog)) {
        Button::setText(made.text);
        button_->setCursor(Qt::ArrowCursor);
        QObject::connect(button_, &QAbstractButton::clicked, button_,
                         [handle] { notify(handle, BN_CLICKED); });
    }

    QWidget& widget() override {
        return *button_;
    }

    /// The text of a check box or a radio button is never cut: nothing stands beside it.
    int leastWidth() const override {
        return qobject_cast<QPushButton*>(button_) == nullptr ? button_->sizeHint().width() : 0;
    }

    std::string text() const override {
        return toWindows1252(button_->text());
    }

    void setText(const std::string& text) override {
        button_->setText(shownText(text));
        if (qobject_cast<QDialog*>(button_->window()) == nullptr) {
            button_->setShortcut(QKeySequence()); // only a dialog sees to the underlined letters
        }
    }

    bool checked() const override {
        return button_->isChecked();
    }

    /// Of radio buttons each is checked and unchecked for itself.
    void check(bool on) override {
        QButtonGroup* group = button_->group();
        const bool exclusive = group != nullptr && group->exclusive();
        if (exclusive) {
            group->setExclusive(false);
        }
        button_->setChecked(on);
        if (exclusive) {
            group->setExclusive(true);
        }
    }

    std::optional<LRESULT> answer(UINT message, WPARAM wParam, LPARAM /*lParam*/) override {
        const Font* font = findObjectAs<Font>(HFONT{HGDIOBJ{static_cast<DWORD>(wParam)}});
        if (message != WM_SETFONT || font == nullptr) {
            return std::nullopt;
        }
        button_->setFont(font->face().font);
        return 0;
    }

  private:
    QAbstractButton* button_;
};

} // namespace

std::unique_ptr<Control> makeButton(const ControlTemplate& made, HWND handle, QWidget& dialog) {
    return std::make_unique<Button>(made, handle, dialog);
}

} // namespace seam
