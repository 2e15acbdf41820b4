#include "platform/user/menus.h"

#include "platform/gdi/encoding.h"
#include "platform/gdi/font.h"
#include "platform/handle_table.h"
#include "platform/user/controls/control.h"
#include "platform/user/cursors.h"
#include "platform/user/dialog.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/toolkit.h"
#include "platform/user/waker.h"
#include "platform/user/window.h"

#include <QMenu>

#include <algorithm>
#include <memory>

namespace seam {

namespace {

/// Never freed: windows may be destroyed when the process exits.
HandleTable<Menu>& table() {
    static auto* const menus = new HandleTable<Menu>(HandleKind::menu);
    return *menus;
}

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
    return shown.exec(at);
}

} // namespace

Menu* findMenu(HMENU menu) {
    return table().find(menu.number);
}

void fillMenu(QMenu& shown, const Menu& menu) {
    constexpr int fontHeight = 11; // as in dialogs
    shown.setFont(dialogFont(fontHeight));
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
    found->items.push_back({flags, id, text == nullptr ? "" : text});
    return TRUE;
}

int GetMenuItemCount(HMENU menu) {
    const Menu* found = findMenu(menu);
    return found == nullptr ? -1 : static_cast<int>(found->items.size());
}

BOOL EnableMenuItem(HMENU menu, UINT item, UINT enable) {
    Menu* found = findMenu(menu);
    if (found == nullptr) {
        return -1;
    }
    const auto entry =
        std::find_if(found->items.begin(), found->items.end(), [item](const MenuItem& one) {
            return (one.flags & MF_SEPARATOR) == 0 && one.id == item;
        });
    if (entry == found->items.end()) {
        return -1;
    }
    const UINT before = entry->flags & MF_GRAYED;
    entry->flags = (entry->flags & ~MF_GRAYED) | (enable & MF_GRAYED);
    return static_cast<BOOL>(before);
}

HMENU GetMenu(HWND /*window*/) {
    return {}; // no window of the program has a menu bar
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
