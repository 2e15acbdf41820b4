#include "platform/user/dialog.h"

#include "platform/gdi/font.h"
#include "platform/kernel.h"
#include "platform/user/controls/control.h"
#include "platform/user/ending.h"
#include "platform/user/foreign.h"
#include "platform/user/icons.h"
#include "platform/user/menus.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/scale.h"
#include "platform/user/text.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QButtonGroup>
#include <QCloseEvent>
#include <QKeyEvent>
#include <QLabel>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <QWindow>

#include <algorithm>

namespace seam {

namespace {

LRESULT dialogProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

WindowClass& dialogClass() {
    static WindowClass windowClass{"dialog", 0, dialogProcedure, {}, {}, {}, {}};
    return windowClass;
}

/// What a dialog does with a message that its procedure leaves to it.
LRESULT dialogsOwnAnswer(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_CLOSE:
        return SendMessageA(dialog, WM_COMMAND, IDCANCEL, 0);
    case WM_ENDSESSION:
        return EndDialog(dialog, -1);
    default:
        return DefWindowProcA(dialog, message, wParam, lParam);
    }
}

LRESULT dialogProcedure(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    const Window* dialog = findWindow(window);
    const LRESULT result = dialog->dialog->procedure()(window, message, wParam, lParam);
    return result != 0 || message == WM_INITDIALOG
               ? result
               : dialogsOwnAnswer(window, message, wParam, lParam);
}

std::optional<DialogTemplate> loadTemplate(HINSTANCE instance, ResourceName name) {
    const HRSRC found = FindResourceA(instance, name, RT_DIALOG);
    const HGLOBAL block = found ? LoadResource(instance, found) : HGLOBAL{};
    const auto* text = static_cast<const char*>(LockResource(block));
    if (text == nullptr) {
        return std::nullopt;
    }
    auto made = parseDialogTemplate({text, SizeofResource(instance, found)}, dialogPercent());
    FreeResource(block);
    return made;
}

/// Radio buttons go together from one WS_GROUP to the next.
void groupButtons(DialogWindow& dialog, const DialogTemplate& made,
                  const std::vector<QWidget*>& widgets) {
    QButtonGroup* group = nullptr;
    for (std::size_t i = 0; i < widgets.size(); ++i) {
        if (group == nullptr || (made.controls[i].style & WS_GROUP) != 0) {
            group = new QButtonGroup(&dialog);
        }
        if (auto* radio = qobject_cast<QRadioButton*>(widgets[i])) {
            group->addButton(radio);
        }
    }
}

/// A label that stands for a control shows its underlined letter, and screen readers tell of it.
void tieLabels(const std::vector<QWidget*>& widgets) {
    for (QWidget* widget : widgets) {
        auto* label = qobject_cast<QLabel*>(widget);
        if (label == nullptr) {
            continue;
        }
        const QString name = label->text().remove(QLatin1Char('&')).remove(QLatin1Char(':'));
        for (QWidget* control : widgets) {
            if (!name.isEmpty() && control->accessibleName() == name) {
                label->setBuddy(control);
            }
        }
    }
}

/// The first control of the template is the first to have the focus.
void orderTabs(const std::vector<QWidget*>& widgets) {
    for (std::size_t i = 1; i < widgets.size(); ++i) {
        QWidget::setTabOrder(widgets[i - 1], widgets[i]);
    }
}

/// Without a button that the template says is the default one, the toolkit would choose one.
void chooseNoDefault(const std::vector<QWidget*>& widgets) {
    const auto buttonOf = [](QWidget* widget) { return qobject_cast<QPushButton*>(widget); };
    const bool chosen = std::ranges::any_of(widgets, [&](QWidget* widget) {
        return buttonOf(widget) != nullptr && buttonOf(widget)->isDefault();
    });
    for (QWidget* widget : widgets) {
        if (!chosen && buttonOf(widget) != nullptr) {
            buttonOf(widget)->setAutoDefault(false);
        }
    }
}

/// Makes the controls; false if one of them can't be made.
bool addControls(const Window& owner, const DialogTemplate& made) {
    DialogWindow& dialog = *owner.dialog;
    std::vector<QWidget*> widgets;
    for (const ControlTemplate& control : made.controls) {
        const HWND handle = addControl(control, owner.handle, owner.instance, dialog.client());
        if (!handle) {
            return false;
        }
        widgets.push_back(&widgetOf(*findWindow(handle)));
    }
    groupButtons(dialog, made, widgets);
    orderTabs(widgets);
    tieLabels(widgets);
    chooseNoDefault(widgets);
    return true;
}

/// In front of its owner, also where that is another program's.
void tieToOwner(QWindow& dialog, HWND owner) {
    const Window* ours = findWindow(topLevelOf(owner));
    QWindow* over = ours != nullptr ? toolkitWindow(*ours) : nullptr;
    if (over == nullptr && mayBeForeign(owner) && foreignExists(owner)) {
        over = QWindow::fromWinId(owner.number);
        QObject::connect(&dialog, &QObject::destroyed, over, &QObject::deleteLater);
    }
    dialog.setTransientParent(over);
}

/// Makes a dialog that isn't shown yet, with all that is in it.
HWND makeDialog(HINSTANCE instance, ResourceName name, HWND owner, DLGPROC procedure,
                LPARAM parameter) {
    const auto made = toolkit() ? loadTemplate(instance, name) : std::nullopt;
    if (!made) {
        return {};
    }
    auto record = std::make_unique<Window>();
    Window& window = *record;
    window.windowClass = &dialogClass();
    window.instance = instance;
    window.owner = findWindow(owner) != nullptr ? topLevelOf(owner) : HWND{};
    window.style = made->style;
    window.title = made->title;
    const Place& place = made->place;
    window.place = {place.left, place.top, place.left + place.width, place.top + place.height};
    const HWND handle = addWindow(std::move(record));
    if (!handle) {
        return {};
    }
    window.dialog = std::make_unique<DialogWindow>(handle, *made, procedure);
    if (!made->menus.empty()) {
        window.menu = makeMenuBar(made->menus);
        window.dialog->addMenuBar(window.menu);
        window.place.bottom = window.place.top + window.dialog->height();
    }
    tieToOwner(*window.dialog->windowHandle(), owner);
    if (!addControls(window, *made)) {
        DestroyWindow(handle);
        return {};
    }
    const bool focus = SendMessageA(handle, WM_INITDIALOG, 0, parameter) != 0;
    const Window* still = findWindow(handle);
    if (still != nullptr && focus) {
        still->dialog->focusFirst();
    }
    return still != nullptr ? handle : HWND{};
}

/// Runs a dialog's loop until it has been ended or destroyed.
LRESULT runDialog(HWND dialog) {
    for (;;) {
        const Window* window = findWindow(dialog);
        if (window == nullptr) {
            return -1;
        }
        if (window->dialog->result) {
            return *window->dialog->result;
        }
        MSG message{};
        waitForMessage(message);
        DispatchMessageA(&message);
    }
}

} // namespace

DialogWindow::DialogWindow(HWND handle, const DialogTemplate& made, DLGPROC answering)
    : handle_(handle), procedure_(answering) {
    setWindowFlags(Qt::Dialog | Qt::CustomizeWindowHint | Qt::WindowTitleHint |
                   Qt::WindowSystemMenuHint | Qt::WindowCloseButtonHint);
    setWindowTitle(shownText(made.title));
    setWindowIcon(programIcon());
    setFont(dialogFont(made.fontHeight));
    setFixedSize(made.place.width, made.place.height);
    winId(); // makes its window
    windowHandle()->installEventFilter(this);
}

void DialogWindow::addMenuBar(HMENU bar) {
    menuBar_ = new QMenuBar(this);
    fillMenuBar(*menuBar_, bar, handle_);
    const int height = menuBar_->sizeHint().height();
    menuBar_->setGeometry(0, 0, width(), height);
    client_ = new QWidget(this);
    client_->setGeometry(0, height, width(), this->height());
    setFixedSize(width(), client_->height() + height);
}

void DialogWindow::focusFirst() {
    QWidget* next = nextInFocusChain();
    while (next != this && ((next->focusPolicy() & Qt::TabFocus) == 0 || !next->isEnabled())) {
        next = next->nextInFocusChain();
    }
    next->setFocus();
}

void DialogWindow::command(int id) {
    const HWND button = GetDlgItem(handle_, id);
    if (!button || IsWindowEnabled(button) != FALSE) {
        queueInput({handle_, WM_COMMAND, static_cast<WPARAM>(id), LPARAM{button.number}, 0});
    }
}

void DialogWindow::reject() {
    command(IDCANCEL);
}

bool DialogWindow::eventFilter(QObject* /*watched*/, QEvent* event) {
    return inputIsBarred(handle_, *event);
}

void DialogWindow::closeEvent(QCloseEvent* event) {
    event->ignore(); // it goes when the program says so
    queuePosted({handle_, WM_CLOSE, 0, 0, 0});
}

bool DialogWindow::hasDefaultButton() const {
    const auto buttons = findChildren<QPushButton*>();
    return std::any_of(buttons.begin(), buttons.end(),
                       [](const QPushButton* button) { return button->isDefault(); });
}

/// As the underlined letter does: with its first item marked.
void DialogWindow::openFirstMenu() {
    QAction* const first = menuBar_->actions().value(0);
    menuBar_->setActiveAction(first);
    first->menu()->setActiveAction(first->menu()->actions().value(0));
}

void DialogWindow::keyPressEvent(QKeyEvent* event) {
    const bool enter = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    if (enter && !hasDefaultButton()) {
        auto* const button = qobject_cast<QPushButton*>(focusWidget());
        button != nullptr ? button->click() : command(IDOK);
        return;
    }
    if (event->key() == Qt::Key_F10 && event->modifiers() == Qt::NoModifier &&
        menuBar_ != nullptr) {
        openFirstMenu();
        return;
    }
    QDialog::keyPressEvent(event);
}

} // namespace seam

using namespace seam;

HWND CreateDialogParamA(HINSTANCE instance, ResourceName name, HWND owner, DLGPROC procedure,
                        LPARAM parameter) {
    const HWND dialog = makeDialog(instance, name, owner, procedure, parameter);
    const Window* window = findWindow(dialog);
    if (window != nullptr && (window->style & WS_VISIBLE) != 0) {
        showWindow(dialog);
    }
    return dialog;
}

LRESULT DialogBoxParamA(HINSTANCE instance, ResourceName name, HWND owner, DLGPROC procedure,
                        LPARAM parameter) {
    const HWND over = findWindow(owner) != nullptr ? topLevelOf(owner) : HWND{};
    const HWND dialog = makeDialog(instance, name, owner, procedure, parameter);
    const Window* window = findWindow(dialog);
    if (window == nullptr) {
        return -1;
    }
    endWindowsAtExit();
    const bool enabled = EnableWindow(over, FALSE) == FALSE;
    if (!window->dialog->result) {
        showWindow(dialog);
    }
    const LRESULT result = runDialog(dialog);
    if (enabled) {
        EnableWindow(over, TRUE); // before the dialog goes, for it to get the keyboard
    }
    DestroyWindow(dialog);
    return result;
}

BOOL EndDialog(HWND dialog, LPARAM result) {
    const Window* window = findWindow(dialog);
    if (window == nullptr || !window->dialog) {
        return FALSE;
    }
    window->dialog->result = result;
    queuePosted({}); // its loop may be waiting, where this comes from one of the toolkit's events
    return TRUE;
}

BOOL IsDialogMessageA(HWND /*dialog*/, const MSG* /*message*/) {
    return FALSE;
}
