// Menus, and the keys that stand for commands. An operation with a stale or foreign handle does
// nothing and gives 0.
#pragma once

#include "platform/user.h"

// ---- Menus --------------------------------------------------------------------------------------

constexpr UINT MF_ENABLED = 0x0000;
constexpr UINT MF_STRING = 0x0000;
constexpr UINT MF_GRAYED = 0x0001;
constexpr UINT MF_SEPARATOR = 0x0800;

/// An empty menu; null if there are too many. DestroyMenu ends it, also while it is open.
HMENU CreatePopupMenu();
BOOL DestroyMenu(HMENU menu);

/// Adds an item at the end: a text, in which an ampersand stands before the letter that chooses it
/// and a tab before the name of its key, or with MF_SEPARATOR a line.
BOOL AppendMenuA(HMENU menu, UINT flags, UINT_PTR id, const char* text);

int GetMenuItemCount(HMENU menu);                        ///< lines too; -1 if there is no such menu
BOOL EnableMenuItem(HMENU menu, UINT item, UINT enable); ///< its state before; -1 if none

/// The menu bar of a window; null for a window without one.
HMENU GetMenu(HWND window);

/// Opens the menu with its top left corner at a point of the screen, or as near as it fits, and
/// gives TRUE when the user has chosen or let it go. What was chosen arrives at the window as a
/// WM_COMMAND with its id and lParam 0, through the loop. Timers and paints go on meanwhile; the
/// menu goes with the window. FALSE if there is no such menu or window, or if one is open already.
/// flags, `reserved` and `area` must be 0 and null.
BOOL TrackPopupMenu(HMENU menu, UINT flags, int x, int y, int reserved, HWND window,
                    const RECT* area);

// ---- Accelerators -------------------------------------------------------------------------------

using HACCEL = Handle<struct AcceleratorKind>;

/// A table of the resources, which lasts as long as the program; null if there is no such table or
/// it can't be read. From here on the loop that runs, or begins, at this depth of the program's
/// loops gets the table's keys as messages, wherever in the program the focus is, for as long as it
/// gives each message to TranslateAcceleratorA.
HACCEL LoadAcceleratorsA(HINSTANCE instance, const char* name);

/// Stands in a loop before all other handling. If the message is the press of a key of the table,
/// with just the Alt or Ctrl that it asks for, sends the window a WM_COMMAND with the command's id
/// and 1 in the high word, and gives 1. Else 0. Loops that run inside of this one, a dialog's or a
/// menu's, have these keys for themselves.
int TranslateAcceleratorA(HWND window, HACCEL table, const MSG* message);
