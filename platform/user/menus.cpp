#include "platform/user/menus.h"

#include "platform/gdi/encoding.h"
#include "platform/gdi/font.h"
#include "platform/handle_table.h"
#include "platform/user/controls/control.h"
#include "platform/user/cursors.h"
#include "platform/user/dialog.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/scale.h"
#include "platform/user/toolkit.h"
#include "platform/user/waker.h"
#include "platform/user/window.h"

#include <QMenu>
#include <QMenuBar>

#include <algorithm>
#include <memory>

namespace seam {

namespace {

/// Never freed: windows may be destroyed when the process exits.
HandleTable<Menu>& table() {
    static auto* const menus = new HandleTable<Menu>(HandleKind::menu);
    return *menus;
}

constexpr int menuFontHeight = 11; // pixels, as in dialogs, before these are enlarged

/// The one that is open.
struct OpenMenu {
    HMENU menu;
    QMenu* shown = nullptr;
};

OpenMenu openMenu;

struct Opening {
    Opening(HMENU menu, QMenu& shown) {
        openMenu = {menu, &shown};
    }

    Opening(const Opening&) = delete;
    Opening& operator=(const Opening&) = delete;

    ~Opening() {
        openMenu = {};
    }
};

/// What the toolkit has behind a window, which goes with it.
QObject& objectOf(const Window& window) {
    return window.native ? static_cast<QObject&>(*window.native) : widgetOf(window);
}

/// Runs the menu at a point of the toolkit's; gives what was chosen, null if nothing.
QAction* runMenu(QMenu& shown, const Window& window, QPoint at) {
    const BoxPointer pointer;
    shown.winId(); // makes its window, for the other one to be told
    shown.windowHandle()->setTransientParent(toolkitWindow(window));
    QObject::connect(&objectOf(window), &QObject::destroyed, &shown, &QWidget::close);
    flushWindows();
    wakeToolkitLoop();
    const ToolkitLoop loop(shown);
    return shown.exec(at);
}

} // namespace

Menu* findMenu(HMENU menu) {
    return table().find(menu.number);
}

void fillMenu(QMenu& shown, const Menu& menu) {
    shown.setFont(dialogFont(dialogLength(menuFontHeight)));
    for (const MenuItem& item : menu.items) {
        if ((item.flags & MF_SEPARATOR) != 0) {
            shown.addSeparator();
            continue;
        }
        QAction* action = shown.addAction(fromWindows1252(item.text.data(), item.text.size()));
        action->setEnabled((item.flags & MF_GRAYED) == 0);
        action->setData(QVariant::fromValue(item.id));
    }
}

HMENU makeMenuBar(const std::vector<MenuTemplate>& made) {
    const HMENU bar = CreatePopupMenu();
    for (const MenuTemplate& menu : made) {
        const HMENU popup = CreatePopupMenu();
        for (const MenuItemTemplate& item : menu.items) {
            AppendMenuA(popup, item.text.empty() ? MF_SEPARATOR : MF_STRING,
                        static_cast<UINT_PTR>(item.id), item.text.c_str());
        }
        if (Menu* found = findMenu(bar)) {
            found->items.push_back({MF_POPUP, 0, menu.text, popup});
        }
    }
    return bar;
}

void destroyMenuTree(HMENU menu) {
    if (const Menu* found = findMenu(menu)) {
        for (const MenuItem& item : found->items) {
            destroyMenuTree(item.popup);
        }
        DestroyMenu(menu);
    }
}

void fillMenuBar(QMenuBar& shown, HMENU bar, HWND window) {
    const Menu* found = findMenu(bar);
    if (found == nullptr) {
        return;
    }
    shown.setFont(dialogFont(dialogLength(menuFontHeight)));
    for (const MenuItem& item : found->items) {
        QMenu* popup = shown.addMenu(fromWindows1252(item.text.data(), item.text.size()));
        // Filled each time that it opens: items may have been enabled or greyed meanwhile.
        QObject::connect(popup, &QMenu::aboutToShow, popup, [popup, handle = item.popup] {
            popup->clear();
            if (const Menu* menu = findMenu(handle)) {
                fillMenu(*popup, *menu);
            }
        });
        QObject::connect(popup, &QMenu::triggered, popup, [window](const QAction* chosen) {
            queueInput({window, WM_COMMAND, chosen->data().value<UINT_PTR>(), 0, 0});
        });
    }
}

std::size_t liveMenus() {
    return table().live();
}

} // namespace seam

using namespace seam;

HMENU CreatePopupMenu() {
    return HMENU{table().add(std::make_unique<Menu>())};
}

BOOL DestroyMenu(HMENU menu) {
    if (findMenu(menu) == nullptr) {
        return FALSE;
    }
    if (openMenu.menu == menu) {
        openMenu.shown->close();
    }
    table().take(menu.number);
    return TRUE;
}

BOOL AppendMenuA(HMENU menu, UINT flags, UINT_PTR id, const char* text) {
    Menu* found = findMenu(menu);
    if (found == nullptr) {
        return FALSE;
    }
    found->items.push_back({flags, id, text == nullptr ? "" : text, {}});
    return TRUE;
}

int GetMenuItemCount(HMENU menu) {
    const Menu* found = findMenu(menu);
    return found == nullptr ? -1 : static_cast<int>(found->items.size());
}

/// The item of a command, in the menu or in those that open from it; null if there is none.
static MenuItem* findItem(HMENU menu, UINT command) {
    Menu* found = findMenu(menu);
    if (found == nullptr) {
        return nullptr;
    }
    for (MenuItem& item : found->items) {
        MenuItem* const inner = findItem(item.popup, command);
        if (inner != nullptr) {
            return inner;
        }
        if ((item.flags & (MF_SEPARATOR | MF_POPUP)) == 0 && item.id == command) {
            return &item;
        }
    }
    return nullptr;
}

BOOL EnableMenuItem(HMENU menu, UINT item, UINT enable) {
    MenuItem* const entry = findItem(menu, item);
    if (entry == nullptr) {
        return -1;
    }
    const UINT before = entry->flags & MF_GRAYED;
    entry->flags = (entry->flags & ~MF_GRAYED) | (enable & MF_GRAYED);
    return static_cast<BOOL>(before);
}

HMENU GetMenu(HWND window) {
    const Window* found = findWindow(window);
    return found == nullptr ? HMENU{} : found->menu;
}

BOOL TrackPopupMenu(HMENU menu, UINT flags, int x, int y, int reserved, HWND window,
                    const RECT* area) {
    const Menu* found = findMenu(menu);
    const Window* asking = findWindow(window);
    if (found == nullptr || asking == nullptr || openMenu.shown != nullptr || flags != 0 ||
        reserved != 0 || area != nullptr || !toolkit()) {
        return FALSE;
    }
    const auto shown = std::make_unique<QMenu>();
    const Opening opening(menu, *shown);
    fillMenu(*shown, *found);
    const QAction* chosen = runMenu(*shown, *asking, QPoint(x, y) + screenOrigin());
    rethrowFromToolkitLoop();
    if (chosen != nullptr && findWindow(window) != nullptr) {
        queueInput({window, WM_COMMAND, chosen->data().value<UINT_PTR>(), 0, 0});
    }
    return TRUE;
}
