// The records behind the handles of menus.
#pragma once

#include "platform/menus.h"
#include "platform/user/dialog_template.h"

#include <cstddef>
#include <string>
#include <vector>

class QMenu;
class QMenuBar;

namespace seam {

struct MenuItem {
    UINT flags = 0; // MF_GRAYED, MF_SEPARATOR, MF_POPUP
    UINT_PTR id = 0;
    std::string text;
    HMENU popup; // for MF_POPUP: the menu that it opens
};

struct Menu {
    std::vector<MenuItem> items;
};

/// The record of a menu; null for any other number.
Menu* findMenu(HMENU menu);

/// A menu that opens from an item of another one, or from a menu bar.
constexpr UINT MF_POPUP = 0x0010;

/// Makes the menu bar of a dialog's template; null if there are too many menus.
HMENU makeMenuBar(const std::vector<MenuTemplate>& made);

/// Ends a menu and those that open from it.
void destroyMenuTree(HMENU menu);

/// Shows the menus of a bar in one of the toolkit's. What is chosen reaches the window as a
/// WM_COMMAND, through the loop.
void fillMenuBar(QMenuBar& shown, HMENU bar, HWND window);

/// Adds the items to one of the toolkit's; each action's data is the id.
void fillMenu(QMenu& shown, const Menu& menu);

std::size_t liveMenus();

} // namespace seam
