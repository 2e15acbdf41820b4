#include "saver/setup_dialog.h"

#include "editor/editor_shell.h"
#include "platform/kernel.h"
#include "saver/show_cycle.h"
#include "saver/toon_player.h"
#include "stage/stage.h"
#include "toon/settings.h"
#include "toon/toon_document.h"

#include <cstring>
#include <initializer_list>
#include <strings.h>

constexpr int WALK_RADIO = 1037;
constexpr int TOONS_RADIO = 1038;
constexpr int STATEMENTS_CHECK = 1040;
constexpr int BACKGROUNDS_CHECK = 1041;
constexpr int TOON_LIST = 1043;
constexpr int EDIT_BUTTON = 1044;
constexpr int COUNT_LABEL = 1045;
constexpr int FOUND_LABEL = 1046;

constexpr LONG CHOICE_WALK = 0;
constexpr LONG CHOICE_TOONS = 1;
constexpr LPARAM SETUP_DONE = 1; // OK and Cancel end alike

constexpr std::size_t ENTRY_SIZE = 128; // bytes, NUL included
constexpr const char* TOON_EXTENSION = ".zkt";

// ---- The controls ------------------------------------------------------------------------------

void SetupFillControls(HWND dialog) {
    CheckDlgButton(dialog, WALK_RADIO, WalkingStyleChoice == CHOICE_WALK ? 1 : 0);
    CheckDlgButton(dialog, TOONS_RADIO, WalkingStyleChoice == CHOICE_WALK ? 0 : 1);
    CheckDlgButton(dialog, STATEMENTS_CHECK, static_cast<UINT>(Statements));
    CheckDlgButton(dialog, BACKGROUNDS_CHECK, static_cast<UINT>(Backgrounds));
    SetupRefreshList(dialog);
    SetupEnableControls(dialog);
}

void SetupEnableControls(HWND dialog) {
    const BOOL walks = WalkingStyleChoice == CHOICE_WALK ? TRUE : FALSE;
    for (const int id : {STATEMENTS_CHECK, BACKGROUNDS_CHECK}) {
        EnableWindow(GetDlgItem(dialog, id), walks);
    }
    for (const int id : {TOON_LIST, EDIT_BUTTON, COUNT_LABEL, FOUND_LABEL}) {
        EnableWindow(GetDlgItem(dialog, id), walks ? FALSE : TRUE);
    }
}

void SetupCommit(HWND dialog) {
    WalkingStyle = WalkingStyleChoice;
    Statements = static_cast<LONG>(IsDlgButtonChecked(dialog, STATEMENTS_CHECK));
    Backgrounds = static_cast<LONG>(IsDlgButtonChecked(dialog, BACKGROUNDS_CHECK));
}

static void ListEntries(HWND dialog, WPARAM kinds, const char* pattern) {
    SendDlgItemMessageA(dialog, TOON_LIST, LB_DIR, DDL_EXCLUSIVE | kinds,
                        reinterpret_cast<LPARAM>(pattern));
}

void SetupRefreshList(HWND dialog) {
    // Meant: a directory that can't be entered stays the chosen one, and may be saved so.
    if (!SetCurrentDirectoryA(Directory)) {
        return;
    }
    char count[16];
    wsprintfA(count, "%d", CountToonFiles());
    SendDlgItemMessageA(dialog, COUNT_LABEL, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(count));
    SendDlgItemMessageA(dialog, TOON_LIST, LB_RESETCONTENT, 0, 0);
    ListEntries(dialog, DDL_ARCHIVE, "*.zkt");
    ListEntries(dialog, DDL_DRIVES | DDL_DIRECTORY, "*.*");
}

// ---- The list ----------------------------------------------------------------------------------

/// Writes directory + name + backslash, in lower case; FALSE if that doesn't fit.
static BOOL MakeDirectory(char* result, const char* directory, std::size_t length, const char* name,
                          std::size_t nameLength) {
    if (length + nameLength + 1 >= DIRECTORY_SIZE) {
        return FALSE;
    }
    char made[DIRECTORY_SIZE];
    std::memcpy(made, directory, length);
    std::memcpy(made + length, name, nameLength);
    std::memcpy(made + length + nameLength, "\\", 2);
    for (char* at = made; *at != '\0'; ++at) {
        *at = *at >= 'A' && *at <= 'Z' ? static_cast<char>(*at - 'A' + 'a') : *at;
    }
    CopyText(result, made, DIRECTORY_SIZE);
    return TRUE;
}

/// Takes the last element off a directory, which ends in a backslash; FALSE if it has none.
static BOOL MakeParent(char* directory) {
    std::size_t length = std::strlen(directory);
    for (length -= length > 0 ? 1 : 0; length > 0; --length) {
        if (directory[length - 1] == '\\') {
            return MakeDirectory(directory, directory, length - 1, "", 0);
        }
    }
    return FALSE;
}

EntryStep StepDirectory(char* directory, const char* entry) {
    const std::size_t length = std::strlen(directory);
    BOOL fits = FALSE;
    if (std::strncmp(entry, "[..]", 4) == 0) {
        fits = MakeParent(directory);
    } else if (std::strncmp(entry, "[-", 2) == 0 && entry[2] != '\0') {
        const char drive[] = {entry[2], ':'};
        fits = MakeDirectory(directory, "", 0, drive, sizeof drive);
    } else {
        const char* end = entry[0] == '[' ? std::strrchr(entry + 1, ']') : nullptr;
        if (end == nullptr) {
            return EntryStep::file;
        }
        const auto nameLength = static_cast<std::size_t>(end - entry - 1);
        fits = nameLength > 0 && MakeDirectory(directory, directory, length, entry + 1, nameLength);
    }
    return fits ? EntryStep::moved : EntryStep::refused;
}

/// Reads the selected entry; FALSE if there is none, or one that is too long for the buffer.
static BOOL SelectedEntry(HWND dialog, char* entry) {
    const LRESULT row = SendDlgItemMessageA(dialog, TOON_LIST, LB_GETCURSEL, 0, 0);
    const auto which = static_cast<WPARAM>(row);
    const LRESULT length = SendDlgItemMessageA(dialog, TOON_LIST, LB_GETTEXTLEN, which, 0);
    if (row == LB_ERR || length == LB_ERR || length >= static_cast<LRESULT>(ENTRY_SIZE)) {
        return FALSE;
    }
    SendDlgItemMessageA(dialog, TOON_LIST, LB_GETTEXT, which, reinterpret_cast<LPARAM>(entry));
    return TRUE;
}

void SetupOpenEntry(HWND dialog, HINSTANCE instance) {
    char entry[ENTRY_SIZE];
    if (!SelectedEntry(dialog, entry)) {
        MessageBeep(0);
        return;
    }
    switch (StepDirectory(Directory, entry)) {
    case EntryStep::moved:
        SetupRefreshList(dialog);
        break;
    case EntryStep::refused:
        MessageBeep(0);
        break;
    case EntryStep::file:
        OpenToonTarget(instance, dialog, entry, SW_SHOWNORMAL);
        break;
    }
}

// ---- What it opens -----------------------------------------------------------------------------

void CloseEditorIfOpen() {
    if (EditorMainWindow) {
        SendMessageA(EditorMainWindow, WM_CLOSE, 0, 0);
    }
}

static BOOL NamesToon(const char* name) {
    const std::size_t length = std::strlen(name);
    const std::size_t extension = std::strlen(TOON_EXTENSION);
    return length >= extension && strcasecmp(name + length - extension, TOON_EXTENSION) == 0
               ? TRUE
               : FALSE;
}

int OpenToonTarget(HINSTANCE instance, HWND parent, const char* name, int showCommand) {
    if (name[0] == '\0') {
        return RunEditor(instance, parent, showCommand);
    }
    // The player and the editor share the stage's state: only one of them can run.
    CloseEditorIfOpen();
    return RunPlayer(instance, nullptr, NamesToon(name) ? name : "");
}

// ---- The dialog --------------------------------------------------------------------------------

static LRESULT SaveAndEnd(HWND dialog) {
    // Meant: Cancel comes here too. It has committed nothing, but the file is written.
    CloseEditorIfOpen();
    SettingsSave();
    EndDialog(dialog, SETUP_DONE);
    return 1;
}

static void Choose(HWND dialog, LONG choice) {
    WalkingStyleChoice = choice;
    SetupEnableControls(dialog);
}

static void OpenEditor(HWND dialog, HINSTANCE instance) {
    CloseEditorIfOpen();
    SetupCommit(dialog);
    SettingsSave();
    OpenToonTarget(instance, dialog, "", SW_SHOWNORMAL);
}

static LRESULT SetupCommand(HWND dialog, HINSTANCE instance, DWORD command) {
    switch (LOWORD(command)) {
    case IDOK:
        SetupCommit(dialog);
        return SaveAndEnd(dialog);
    case IDCANCEL:
        return SaveAndEnd(dialog);
    case WALK_RADIO:
        Choose(dialog, CHOICE_WALK);
        return 0;
    case TOONS_RADIO:
        Choose(dialog, CHOICE_TOONS);
        return 0;
    case TOON_LIST:
        if (HIWORD(command) == LBN_DBLCLK) {
            SetupOpenEntry(dialog, instance);
        }
        return 0;
    case EDIT_BUTTON:
        OpenEditor(dialog, instance);
        return 0;
    default:
        return 0;
    }
}

LRESULT SetupDialogProc(HWND dialog, UINT message, WPARAM wParam, LPARAM /*lParam*/) {
    switch (message) {
    case WM_INITDIALOG:
        CentreDialog(dialog);
        SettingsLoad();
        SetupFillControls(dialog);
        return 1;
    case WM_COMMAND:
        return SetupCommand(dialog, WindowInstance(dialog), static_cast<DWORD>(wParam));
    default:
        return 0;
    }
}
