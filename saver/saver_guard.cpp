#include "saver/saver_guard.h"

#include "platform/kernel.h"
#include "platform/registry.h"
#include "saver/show_cycle.h"
#include "stage/stage.h"

#include <cstdlib>

DWORD SaverVerifying;
DWORD SaverClosing;
POINT MouseStartPos;
VerifyEntry VerifyPassword;

using AssociateEntry = HIMC (*)(HWND window, HIMC context);

static HMODULE PasswordModule; // null when none is loaded

static HMODULE ImeModule;           // null when the process has none
static AssociateEntry ImeAssociate; // null when the module lacks it
static HIMC ImeSavedContext;        // detached from the saver window

constexpr LONG END_TRAVEL = 4;    // pixels, sideways and up or down together
constexpr int DROPPED_TIMERS = 2; // timer messages thrown away before the password is asked for

enum class GuardState { NORMAL, PREVIEW, VERIFYING, CLOSING };

static GuardState StateOfGuard() {
    if (PreviewMode != PREVIEW_NONE) {
        return GuardState::PREVIEW;
    }
    if (SaverClosing != 0) {
        return GuardState::CLOSING;
    }
    return SaverVerifying != 0 ? GuardState::VERIFYING : GuardState::NORMAL;
}

// ---- First in the chain ------------------------------------------------------------------------

/// Takes the input method off the window: a key has to end the saver, not to begin a word.
static void DetachInputMethod(HWND window) {
    ImeModule = GetModuleHandleA("IMM32.DLL");
    ImeAssociate = nullptr;
    ImeSavedContext = nullptr;
    if (ImeModule) {
        ImeAssociate =
            reinterpret_cast<AssociateEntry>(GetProcAddress(ImeModule, "ImmAssociateContext"));
    }
    if (ImeAssociate != nullptr) {
        ImeSavedContext = ImeAssociate(window, nullptr);
    }
}

static void OnCreate(HWND window) {
    DetachInputMethod(window);
    GetCursorPos(&MouseStartPos);
    if (PreviewMode == PREVIEW_NONE) {
        SetCursor(nullptr);
    }
}

static void OnDestroy(HWND window) {
    if (ImeModule && ImeAssociate != nullptr && ImeSavedContext) {
        ImeAssociate(window, ImeSavedContext);
    }
    PostQuitMessage(0);
}

/// Help on a preview is for the program that shows it.
static void PassToParent(HWND window, UINT message, LPARAM lParam) {
    const HWND parent = GetParent(window);
    if (IsWindow(parent)) {
        PostMessageA(parent, message, parent.number, lParam);
    }
}

static bool LeavesTheSaver(WPARAM command) {
    return command == SC_NEXTWINDOW || command == SC_PREVWINDOW || command == SC_SCREENSAVE;
}

/// Once the saver may go its window is no longer painted, and input is nothing to it.
static bool IsOver(UINT message) {
    switch (message) {
    case WM_PAINT:
    case WM_KEYDOWN:
    case WM_SYSKEYDOWN:
    case WM_MOUSEMOVE:
    case WM_LBUTTONDOWN:
    case WM_RBUTTONDOWN:
    case WM_MBUTTONDOWN:
        return StateOfGuard() == GuardState::CLOSING;
    default:
        return false;
    }
}

LRESULT SaverGuardProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (IsOver(message)) {
        return DefWindowProcA(window, message, wParam, lParam);
    }
    switch (message) {
    case WM_CREATE:
        OnCreate(window);
        break;
    case WM_DESTROY:
        OnDestroy(window);
        break;
    case WM_SETTEXT:
        return 0; // the title stays: another saver finds this one by it
    case WM_PAINT:
        if (PreviewMode == PREVIEW_NONE) {
            SetCursor(nullptr);
        }
        break;
    case WM_HELP:
    case WM_CONTEXTMENU:
        if (PreviewMode != PREVIEW_NONE) {
            PassToParent(window, message, lParam);
            return 1;
        }
        break;
    case WM_SYSCOMMAND:
        if (PreviewMode == PREVIEW_NONE && LeavesTheSaver(wParam)) {
            return 0;
        }
        break;
    case WM_TIMER:
        if (StateOfGuard() == GuardState::CLOSING) {
            return 0; // nothing on the stage moves any more
        }
        Sleep(0);
        break;
    default:
        break;
    }
    return ShowProc(window, message, wParam, lParam);
}

// ---- Last in the chain -------------------------------------------------------------------------

/// Posted, not sent: the saver ends by way of the next WM_CLOSE that the loop hands over. The
/// platform queues no second one behind one that waits.
static void RequestClose(HWND window) {
    PostMessageA(window, WM_CLOSE, 0, 0);
}

/// Where the mouse is counts, not what a message says of it: an event without travel ends nothing.
/// The start doesn't follow the mouse, so that small moves add up.
static void TestMouse(HWND window) {
    POINT at{};
    GetCursorPos(&at);
    if (std::abs(at.x - MouseStartPos.x) + std::abs(at.y - MouseStartPos.y) >= END_TRAVEL) {
        RequestClose(window);
    }
}

static LRESULT OnClose(HWND window) {
    if (VerifyBeforeClose(window) != 0) {
        return DefWindowProcA(window, WM_CLOSE, 0, 0);
    }
    GetCursorPos(&MouseStartPos);
    return 0;
}

LRESULT SaverDefaultProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message == TM_VERIFYPASSWORD) {
        return VerifyPassword != nullptr ? VerifyPassword(window) : 1;
    }
    if (StateOfGuard() != GuardState::NORMAL) {
        return DefWindowProcA(window, message, wParam, lParam);
    }
    switch (message) {
    case WM_CLOSE:
        return OnClose(window);
    case WM_SHOWWINDOW:
        if (wParam != 0) {
            SetCursor(nullptr);
        }
        break;
    case WM_ACTIVATEAPP:
        if (wParam == 0) {
            RequestClose(window);
        }
        break;
    case WM_SETCURSOR:
        SetCursor(nullptr);
        return 1;
    case WM_KEYDOWN:
    case WM_SYSKEYDOWN:
    case WM_LBUTTONDOWN:
    case WM_RBUTTONDOWN:
    case WM_MBUTTONDOWN:
        RequestClose(window);
        break;
    case WM_MOUSEMOVE:
        TestMouse(window);
        break;
    default:
        break;
    }
    return DefWindowProcA(window, message, wParam, lParam);
}

// ---- The password ------------------------------------------------------------------------------

static void DropWaitingTimers(HWND window) {
    MSG message{};
    for (int i = 0; i < DROPPED_TIMERS; ++i) {
        PeekMessageA(&message, window, WM_TIMER, WM_TIMER, PM_REMOVE | PM_NOYIELD);
    }
}

/// Hands over what has piled up behind the password's dialog, while the state still keeps it from
/// having any effect. A request to close is left out: in this state it would end the saver.
static void DrainMessages(HWND window) {
    MSG message{};
    while (PeekMessageA(&message, window, 0, 0, PM_REMOVE | PM_NOYIELD)) {
        if (message.message == WM_QUIT) {
            PostQuitMessage(static_cast<int>(message.wParam));
            return;
        }
        if (message.message != WM_CLOSE) {
            TranslateMessage(&message);
            DispatchMessageA(&message);
        }
    }
}

DWORD VerifyBeforeClose(HWND window) {
    if (VerifyPassword == nullptr) {
        SaverClosing = 1;
        return 1;
    }
    SaverVerifying = 1;
    DropWaitingTimers(window);
    SaverClosing = static_cast<DWORD>(SendMessageA(window, TM_VERIFYPASSWORD, 0, 0));
    DrainMessages(window);
    SaverVerifying = 0; // not before the drain: it is what keeps that without effect
    if (SaverClosing == 0) {
        SetCursor(nullptr);
    }
    return SaverClosing;
}

/// Whether the user's settings want the password asked for.
static bool PasswordIsWanted(HKEY desktop) {
    DWORD value = 0;
    DWORD size = sizeof value;
    return RegQueryValueExA(desktop, "ScreenSaveUsePassword", nullptr, nullptr,
                            reinterpret_cast<BYTE*>(&value), &size) == ERROR_SUCCESS &&
           value != 0;
}

void LoadPasswordModule() {
    HKEY desktop{};
    if (RegOpenKeyA(HKEY_CURRENT_USER, "Control Panel\\Desktop", &desktop) != ERROR_SUCCESS) {
        return;
    }
    if (PasswordIsWanted(desktop)) {
        PasswordModule = LoadLibraryA("PASSWORD.CPL");
        if (PasswordModule) {
            VerifyPassword = reinterpret_cast<VerifyEntry>(
                GetProcAddress(PasswordModule, "VerifyScreenSavePwd"));
            if (VerifyPassword != nullptr) {
                RebootDeviceCall(REBOOT_PASSWORD_SET);
            } else {
                UnloadPasswordModule();
            }
        }
    }
    RegCloseKey(desktop);
}

void UnloadPasswordModule() {
    if (!PasswordModule) {
        return;
    }
    FreeLibrary(PasswordModule);
    PasswordModule = nullptr;
    if (VerifyPassword != nullptr) {
        VerifyPassword = nullptr;
        RebootDeviceCall(REBOOT_PASSWORD_DROPPED);
    }
}

void RebootDeviceCall(DWORD code) {
    const HANDLE device =
        CreateFileA("\\\\.\\REBOOT", GENERIC_READ | GENERIC_WRITE,
                    FILE_SHARE_READ | FILE_SHARE_WRITE, nullptr, OPEN_EXISTING, 0, nullptr);
    if (device == INVALID_HANDLE_VALUE) {
        return;
    }
    DWORD transferred = 0;
    DeviceIoControl(device, code, nullptr, 0, nullptr, 0, &transferred, nullptr);
    CloseHandle(device);
}
