#include "platform/user/controls/control.h"

#include "platform/user/queue.h"
#include "platform/user/window.h"

#include <algorithm>

namespace seam {

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

void notify(HWND control, WORD code) {
    if (const Window* window = findWindow(control)) {
        const auto wParam = static_cast<WPARAM>(MAKELONG(window->id, code));
        queueInput({window->parent, WM_COMMAND, wParam, LPARAM{control.number}, 0});
    }
}

} // namespace seam
