// The dialogs for choosing a file.
#pragma once

#include "platform/types.h"

/// Describes one use of a file dialog.
struct OPENFILENAME {
    DWORD lStructSize; // 76, the size of the record in a 32-bit program
    HWND hwndOwner;
    HINSTANCE hInstance;
    const char*
        lpstrFilter; // pairs of text and pattern, each with its NUL, closed by an empty text
    char* lpstrCustomFilter;
    DWORD nMaxCustFilter;
    DWORD nFilterIndex; // from 1
    char* lpstrFile;    // the path: shown at the start, and what was chosen
    DWORD nMaxFile;
    char* lpstrFileTitle;
    DWORD nMaxFileTitle;
    const char* lpstrInitialDir; // empty: the current directory
    const char* lpstrTitle;
    DWORD Flags;
    WORD nFileOffset;
    WORD nFileExtension;
    const char* lpstrDefExt;
    LPARAM lCustData;
    LRESULT (*lpfnHook)(HWND, UINT, WPARAM, LPARAM);
    const char* lpTemplateName;
};

/// Lets the user choose a file to open or to write to, over hwndOwner, and writes its path to
/// lpstrFile; FALSE if it was cancelled, and then lpstrFile stays. Any name may be typed, of a file
/// that exists or not; it is taken as typed, and nobody asks about overwriting. A path that
/// lpstrFile can't hold is refused with a message and the dialog stays; so is a name with a
/// backslash, which the platform's form can't express. Names that aren't UTF-8 aren't shown and
/// can't be chosen; where the directory to begin with has such a name, the nearest one above it
/// that has none takes its place. nFilterIndex becomes that of the filter in use. The current
/// directory stays as it is. Timers and paints go on meanwhile.
BOOL GetOpenFileNameA(OPENFILENAME* dialog);
BOOL GetSaveFileNameA(OPENFILENAME* dialog);
