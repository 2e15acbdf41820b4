// The records behind the handles of menus.
#pragma once

#include "platform/menus.h"

#include <cstddef>
#include <string>
#include <vector>

class QMenu;

namespace seam {

struct MenuItem {
    UINT flags = 0; // MF_GRAYED, MF_SEPARATOR
    UINT_PTR id = 0;
    std::string text;
};

struct Menu {
    std::vector<MenuItem> items;
};

/// The record of a menu; null for any other number.
Menu* findMenu(HMENU menu);

/// Adds the items to one of the toolkit's; each action's data is the id.
void fillMenu(QMenu& shown, const Menu& menu);

std::size_t liveMenus();

} // namespace seam
