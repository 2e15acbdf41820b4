// The controls of dialogs: the toolkit's widgets behind the platform's messages.
#pragma once

#include "platform/dialogs.h"
#include "platform/user/dialog_template.h"

#include <QWidget>

#include <memory>
#include <optional>
#include <string>

namespace seam {

/// What stands behind a control's handle. The widget belongs to the one that it lies in, and goes
/// with the handle.
class Control {
  public:
    Control() = default;
    Control(const Control&) = delete;
    Control& operator=(const Control&) = delete;
    virtual ~Control() = default;

    virtual QWidget& widget() = 0;

    /// What its text needs, for a control that may be wider than its template has it.
    virtual int leastWidth() const {
        return 0;
    }

    /// How high it is where its template says that.
    virtual int height(int wanted) {
        return wanted;
    }

    virtual std::string text() const {
        return {};
    }

    virtual void setText(const std::string& /*text*/) {}

    virtual bool checked() const {
        return false;
    }

    virtual void check(bool /*on*/) {}

    /// The control's own answer to a message; nothing if it has none.
    virtual std::optional<LRESULT> answer(UINT /*message*/, WPARAM /*wParam*/, LPARAM /*lParam*/) {
        return std::nullopt;
    }
};

std::unique_ptr<Control> makeButton(const ControlTemplate& made, HWND handle, QWidget& dialog);
std::unique_ptr<Control> makeStatic(const ControlTemplate& made, HWND handle, QWidget& dialog);
std::unique_ptr<Control> makeListBox(const ControlTemplate& made, HWND handle, QWidget& dialog);
std::unique_ptr<Control> makeComboBox(const ControlTemplate& made, HWND handle, QWidget& dialog);
std::unique_ptr<Control> makeScrollBar(const ControlTemplate& made, HWND handle, QWidget& dialog);
std::unique_ptr<Control> makeEdit(const ControlTemplate& made, HWND handle, QWidget& dialog);

// Of scroll bars, behind the calls.
constexpr UINT SBM_SETPOS = 0x00E0;
constexpr UINT SBM_GETPOS = 0x00E1;
constexpr UINT SBM_SETRANGE = 0x00E2;

/// Makes the control of a template with its record, in the window `parent`, whose widget is `host`.
/// Null if there is no such kind of control, or there are too many windows.
HWND addControl(const ControlTemplate& made, HWND parent, HINSTANCE instance, QWidget& host);

/// Tells the control's parent by WM_COMMAND that the user has done something with it.
void notify(HWND control, WORD code);

} // namespace seam
