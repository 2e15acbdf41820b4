// Dialogs and the controls in them.
//
// A dialog is made from a template of the resources, whose places are in dialog units: here always
// a quarter of 6 pixels across and an eighth of 13 down. Its controls are the toolkit's own
// widgets. What the user does with them arrives at the dialog as WM_COMMAND through the loop; what
// the program does with them arrives nowhere. Unless it says otherwise, an operation with a stale
// or foreign handle, or on a control that isn't there, does nothing and gives 0.
#pragma once

#include "platform/user.h"

#include <cstdint>

// ---- Dialogs -----------------------------------------------------------------------------------

/// Before the dialog shows; lParam is the parameter of its making. A result other than 0 gives the
/// focus to the first tab stop.
constexpr UINT WM_INITDIALOG = 0x0110;

/// Gets each message first. A result other than 0 answers it, except WM_INITDIALOG; 0 leaves it to
/// the dialog, in which WM_CLOSE presses the control IDCANCEL.
using DLGPROC = LRESULT (*)(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);

/// Runs a modal dialog and gives the value that it ends with; -1 if there is no such dialog, or if
/// it is destroyed before it ends. The owner, if it is this program's, takes no input meanwhile;
/// the dialog stays in front of it. A quit message stays where it is.
LRESULT DialogBoxParamA(HINSTANCE instance, ResourceName name, HWND owner, DLGPROC procedure,
                        LPARAM parameter);

/// Makes a dialog that is served by the loops of the program and ended by DestroyWindow; it goes
/// with its owner. Null if there is no such dialog.
HWND CreateDialogParamA(HINSTANCE instance, ResourceName name, HWND owner, DLGPROC procedure,
                        LPARAM parameter);

/// Ends a modal dialog once its procedure has returned to the dialog's own loop.
BOOL EndDialog(HWND dialog, LPARAM result);

/// Stands in loops that serve a modeless dialog; gives FALSE: the keys of dialogs are seen to by
/// the toolkit.
BOOL IsDialogMessageA(HWND dialog, const MSG* message);

// ---- The controls of a dialog, by their ids ----------------------------------------------------
//
// Of several with one id it may be any. Nothing happens where there is none.

HWND GetDlgItem(HWND dialog, int id);
LRESULT SendDlgItemMessageA(HWND dialog, int id, UINT message, WPARAM wParam, LPARAM lParam);
BOOL SetDlgItemTextA(HWND dialog, int id, const char* text);
/// Copies the text, cut to size - 1 bytes, with one carriage return for each line break; gives
/// its length.
UINT GetDlgItemTextA(HWND dialog, int id, char* buffer, int size);
BOOL SetDlgItemInt(HWND dialog, int id, UINT value, BOOL isSigned);
/// The number at the start of the text, behind blanks and one sign; 0, and FALSE in `read` (which
/// may be null), if there is none or it doesn't fit 32 bits. Without isSigned a minus is no number.
UINT GetDlgItemInt(HWND dialog, int id, BOOL* read, BOOL isSigned);
BOOL CheckDlgButton(HWND dialog, int id, UINT check); ///< 0: unchecked
UINT IsDlgButtonChecked(HWND dialog, int id);         ///< 1 or 0

/// A disabled control, or window, takes no input.
BOOL EnableWindow(HWND window, BOOL enable); ///< whether it was disabled before
BOOL IsWindowEnabled(HWND window);

// ---- Styles of controls ------------------------------------------------------------------------

constexpr DWORD WS_CAPTION = 0x00C00000;
constexpr DWORD WS_SYSMENU = 0x00080000;
constexpr DWORD WS_VSCROLL = 0x00200000;
constexpr DWORD WS_GROUP = 0x00020000; // radio buttons belong together from one to the next
constexpr DWORD WS_TABSTOP = 0x00010000;

constexpr DWORD BS_PUSHBUTTON = 0;
constexpr DWORD BS_DEFPUSHBUTTON = 1;
constexpr DWORD BS_AUTOCHECKBOX = 3;
constexpr DWORD BS_AUTORADIOBUTTON = 9;
constexpr DWORD BS_OWNERDRAW = 11;
constexpr DWORD BS_TYPEMASK = 0x0F;

constexpr DWORD SS_LEFT = 0;
constexpr DWORD SS_CENTER = 1;
constexpr DWORD SS_RIGHT = 2;
constexpr DWORD SS_ICON = 3;
constexpr DWORD SS_BLACKFRAME = 7;
constexpr DWORD SS_GRAYFRAME = 8;
constexpr DWORD SS_TYPEMASK = 0x1F;

constexpr DWORD ES_CENTER = 0x0001;
constexpr DWORD ES_MULTILINE = 0x0004;
constexpr DWORD ES_WANTRETURN = 0x1000;

constexpr DWORD CBS_DROPDOWNLIST = 0x0003;
constexpr DWORD CBS_OWNERDRAWVARIABLE = 0x0020;

constexpr DWORD LBS_NOTIFY = 0x0001;
constexpr DWORD LBS_SORT = 0x0002;
constexpr DWORD LBS_NOINTEGRALHEIGHT = 0x0100;

// ---- Messages of controls ----------------------------------------------------------------------

// In the high word of a WM_COMMAND's wParam; the low word is the id, lParam the control.
constexpr WORD BN_CLICKED = 0;
constexpr WORD LBN_SELCHANGE = 1;
constexpr WORD LBN_DBLCLK = 2; // or the space bar

constexpr WORD CBN_SELCHANGE = 1;
constexpr WORD CBN_SETFOCUS = 3;
constexpr WORD CBN_KILLFOCUS = 4;
constexpr WORD CBN_DROPDOWN = 7;
constexpr WORD CBN_CLOSEUP = 8;

constexpr UINT WM_SETFONT = 0x0030; // wParam: the font of its text

constexpr UINT EM_LIMITTEXT = 0x00C5; // the most bytes that can be typed

constexpr UINT LB_ADDSTRING = 0x0180;    // its place; LB_ERR
constexpr UINT LB_RESETCONTENT = 0x0184; // empties the list
constexpr UINT LB_SETCURSEL = 0x0186;    // -1: none
constexpr UINT LB_GETCURSEL = 0x0188;    // LB_ERR if none is selected
constexpr UINT LB_GETTEXT = 0x0189;      // into lParam, which must hold it; its length
constexpr UINT LB_GETTEXTLEN = 0x018A;   // without the NUL
constexpr UINT LB_GETCOUNT = 0x018B;
constexpr LRESULT LB_ERR = -1;

/// Adds names of the current directory that match the pattern of lParam: a file by its name, and
/// as wParam says a directory as "[name]", the parent as "[..]" except at the root of a drive, and
/// the drives as "[-c-]". Hidden ones and those that FindFirstFileA passes over are left out.
constexpr UINT LB_DIR = 0x018D;
constexpr WPARAM DDL_DIRECTORY = 0x0010;
constexpr WPARAM DDL_ARCHIVE = 0x0020;
constexpr WPARAM DDL_DRIVES = 0x4000;
constexpr WPARAM DDL_EXCLUSIVE = 0x8000; // only what is named; else files come too

constexpr UINT CB_GETCOUNT = 0x0146;
constexpr UINT CB_ADDSTRING = 0x0143;    // a text, or the data of an item that the program draws
constexpr UINT CB_GETCURSEL = 0x0147;    // CB_ERR if none is selected
constexpr UINT CB_INSERTSTRING = 0x014A; // at the place wParam; -1: at the end
constexpr UINT CB_RESETCONTENT = 0x014B;
constexpr UINT CB_SETCURSEL = 0x014E; // none if there is no such item
constexpr UINT CB_GETITEMDATA = 0x0150;
constexpr UINT CB_SETEXTENDEDUI = 0x0155; // does nothing
constexpr LRESULT CB_ERR = -1;

/// To the parent: a scroll bar's user wants to go there. Low word of wParam: one of the codes;
/// lParam: the bar. The thumb stands where SetScrollPos puts it.
constexpr UINT WM_HSCROLL = 0x0114;
constexpr WORD SB_LINEUP = 0;
constexpr WORD SB_LINEDOWN = 1;
constexpr WORD SB_PAGEUP = 2;
constexpr WORD SB_PAGEDOWN = 3;
constexpr WORD SB_THUMBTRACK = 5;
constexpr int SB_CTL = 2;
BOOL SetScrollRange(HWND bar, int kind, int lowest, int highest, BOOL redraw);
int SetScrollPos(HWND bar, int kind, int position, BOOL redraw); ///< held to the range; the old one
int GetScrollPos(HWND bar, int kind);

// ---- What the program draws itself -------------------------------------------------------------

constexpr UINT ODT_COMBOBOX = 3;
constexpr UINT ODT_BUTTON = 4;
constexpr UINT ODA_DRAWENTIRE = 1;
constexpr UINT ODS_SELECTED = 0x0001; // of a button: it is pressed
constexpr UINT ODS_DISABLED = 0x0004;
constexpr UINT ODS_FOCUS = 0x0010;

struct MEASUREITEMSTRUCT {
    UINT CtlType;
    UINT CtlID;
    UINT itemID; // -1: the field of the closed list
    UINT itemWidth;
    UINT itemHeight; // in pixels; a line of text to begin with
    std::uintptr_t itemData;
};

struct DRAWITEMSTRUCT {
    UINT CtlType;
    UINT CtlID;
    UINT itemID;
    UINT itemAction;
    UINT itemState;
    HWND hwndItem;
    HDC hDC; // on white ground, or a button's
    RECT rcItem;
    std::uintptr_t itemData;
};

/// To the parent, lParam a MEASUREITEMSTRUCT: how high is an item?
constexpr UINT WM_MEASUREITEM = 0x002C;
/// To the parent, lParam a DRAWITEMSTRUCT: draw it.
constexpr UINT WM_DRAWITEM = 0x002B;
