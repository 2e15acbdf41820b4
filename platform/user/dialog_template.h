// Templates of dialogs, as the resources hold them: text, one control on each line.
#pragma once

#include "platform/types.h"

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace seam {

/// A place in pixels, made from dialog units.
struct Place {
    int left = 0;
    int top = 0;
    int width = 0;
    int height = 0;
};

struct ControlTemplate {
    int id = -1;
    std::string kind; // "button", "static", "listbox", "edit", "combobox" or "scrollbar"
    std::string text;
    Place place;
    DWORD style = 0;
    std::string spokenName; // for who can't see what stands beside it
};

struct MenuItemTemplate {
    int id = 0;
    std::string text; // empty: a line
};

struct MenuTemplate {
    std::string text;
    std::vector<MenuItemTemplate> items;
};

struct DialogTemplate {
    std::string title;
    Place place;
    DWORD style = 0;
    int fontHeight = 0;              // in pixels
    std::vector<MenuTemplate> menus; // of its menu bar
    std::vector<ControlTemplate> controls;
};

/// Reads a template:
///
///     # a remark
///     dialog "title" LEFT TOP WIDTH HEIGHT STYLE..
///     font POINTS "face"
///     menu "text of the bar"
///     item ID "text"
///     separator
///     ID KIND "text" LEFT TOP WIDTH HEIGHT STYLE.. named "spoken name"
///
/// Places are in dialog units. In a text \r stands for a carriage return, \t for a tab, \" and
/// \\ for themselves. Items and separators belong to the menu before them. A label whose text, but
/// for the ampersand and a colon, is the spoken name of a control stands for that control. Styles
/// are the platform's in lower case without what stands before the underscore. Nothing if a line
/// can't be read.
///
/// Places and fonts are enlarged to `percent`.
std::optional<DialogTemplate> parseDialogTemplate(std::string_view text, int percent = 100);

} // namespace seam
