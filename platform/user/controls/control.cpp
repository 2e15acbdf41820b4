#include "platform/user/controls/control.h"

#include "platform/user/queue.h"
#include "platform/user/window.h"

#include <algorithm>

namespace seam {

namespace {

LRESULT controlProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    Control& control = *findWindow(window)->control;
    if (message == WM_SETTEXT) {
        const auto* text = reinterpret_cast<const char*>(lParam);
        control.setText(text == nullptr ? "" : text);
        return TRUE;
    }
    return control.answer(message, wParam, lParam).value_or(0);
}

WindowClass& controlClass() {
    static WindowClass windowClass{"control", 0, controlProcedure, {}, {}, {}, {}};
    return windowClass;
}

/// Makes the control with its widget in `dialog`; null for a kind that there isn't.
std::unique_ptr<Control> makeControl(const ControlTemplate& made, HWND handle, QWidget& dialog) {
    using Maker = std::unique_ptr<Control> (*)(const ControlTemplate&, HWND, QWidget&);

    struct Kind {
        const char* name;
        Maker make;
    };

    constexpr Kind kinds[] = {{"button", makeButton},     {"static", makeStatic},
                              {"listbox", makeListBox},   {"edit", makeEdit},
                              {"combobox", makeComboBox}, {"scrollbar", makeScrollBar}};

    for (const Kind& kind : kinds) {
        if (made.kind == kind.name) {
            auto control = kind.make(made, handle, dialog);
            QWidget& widget = control->widget();
            const Place& place = made.place;
            widget.setGeometry(place.left, place.top, std::max(place.width, control->leastWidth()),
                               control->height(place.height));
            widget.setAccessibleName(QString::fromStdString(made.spokenName));
            if ((made.style & WS_TABSTOP) == 0 && widget.focusPolicy() != Qt::NoFocus) {
                widget.setFocusPolicy(Qt::ClickFocus);
            }
            return control;
        }
    }
    return nullptr;
}

} // namespace

HWND addControl(const ControlTemplate& made, HWND parent, HINSTANCE instance, QWidget& host) {
    auto record = std::make_unique<Window>();
    Window& window = *record;
    window.windowClass = &controlClass();
    window.instance = instance;
    window.parent = parent;
    window.style = made.style;
    window.id = made.id;
    window.visible = true;
    const HWND handle = addWindow(std::move(record));
    if (!handle) {
        return {};
    }
    window.control = makeControl(made, handle, host);
    if (!window.control) {
        DestroyWindow(handle);
        return {};
    }
    const QRect place = window.control->widget().geometry();
    window.place = {place.left(), place.top(), place.right() + 1, place.bottom() + 1};
    return handle;
}

void notify(HWND control, WORD code) {
    if (const Window* window = findWindow(control)) {
        const auto wParam = static_cast<WPARAM>(MAKELONG(window->id, code));
        queueInput({window->parent, WM_COMMAND, wParam, LPARAM{control.number}, 0});
    }
}

} // namespace seam
