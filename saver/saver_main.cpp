#include "saver/saver_main.h"

#include "platform/kernel.h"
#include "saver/saver_guard.h"
#include "saver/setup_dialog.h"
#include "stage/stage.h"
#include "stage/window_loop.h"

HINSTANCE SaverInstance;
HWND SaverWindow;

constexpr int EXIT_REFUSED = -1;
constexpr int SAVER_ICON = 100;

static const char* CommandText; // what RunCommand works on, inside the guard
static HWND HostWindow;         // and RunInHost

const char* SkipProgramName(const char* line) {
    if (*line == '"') {
        ++line;
        while (*line != '\0' && *line != '"') {
            ++line;
        }
        if (*line == '"') {
            ++line;
        }
    } else {
        while (static_cast<unsigned char>(*line) > ' ') {
            ++line;
        }
    }
    while (*line != '\0' && static_cast<unsigned char>(*line) <= ' ') {
        ++line;
    }
    return line;
}

int ProcessStart() {
    return SaverMain(GetModuleHandleA(nullptr), SkipProgramName(GetCommandLineA()));
}

static const char* SkipBlanks(const char* text) {
    while (*text == ' ') {
        ++text;
    }
    return text;
}

static int RunCommand() {
    const char* text = CommandText;
    while (*text == ' ' || *text == '-' || *text == '/') {
        ++text;
    }
    switch (*text) {
    case '\0':
        return RunSetup(nullptr);
    case 'C':
    case 'c':
        return RunSetup(GetForegroundWindow());
    case 'S':
    case 's':
        return RunSaver(nullptr);
    case 'P':
    case 'p':
    case 'L':
    case 'l':
        return RunPreview(SkipBlanks(text + 1));
    case 'A':
    case 'a':
        return RunPasswordChange(SkipBlanks(text + 1));
    default:
        return EXIT_REFUSED;
    }
}

static int AfterException() {
    RebootDeviceCall(REBOOT_PASSWORD_DROPPED);
    return EXIT_REFUSED;
}

int SaverMain(HINSTANCE instance, const char* commandText) {
    SaverInstance = instance;
    CommandText = commandText;
    return RunGuarded(RunCommand, AfterException);
}

HWND ParseWindowHandle(const char* text) {
    DWORD value = 0;
    for (; *text >= '0' && *text <= '9'; ++text) {
        value = value * 10 + static_cast<DWORD>(*text - '0');
    }
    return HWND{value};
}

int RunPreview(const char* text) {
    const HWND parent = ParseWindowHandle(text);
    if (!parent || !IsWindow(parent)) {
        return EXIT_REFUSED;
    }
    return RunSaver(parent);
}

int RunSetup(HWND parent) {
    return static_cast<int>(
        DialogBoxParamA(SaverInstance, SETUP_DIALOG, parent, SetupDialogProc, 0));
}

int RunPasswordChange(const char* text) {
    HWND parent = ParseWindowHandle(text);
    if (!parent || !IsWindow(parent)) {
        parent = GetForegroundWindow();
    }
    ChangePassword(parent);
    return 0;
}

void ChangePassword(HWND parent) {
    using ChangeEntry = DWORD (*)(const char* provider, HWND window, DWORD, void*);

    const HMODULE module = LoadLibraryA("MPR.DLL");
    if (!module) {
        return;
    }
    const auto change = reinterpret_cast<ChangeEntry>(GetProcAddress(module, "PwdChangePasswordA"));
    if (change != nullptr) {
        change("SCRSAVE", parent, 0, nullptr);
    }
    FreeLibrary(module);
}

static BOOL RegisterSaverClass() {
    WNDCLASSA windowClass{};
    windowClass.style = CS_VREDRAW | CS_HREDRAW | CS_DBLCLKS | CS_OWNDC;
    windowClass.lpfnWndProc = SaverGuardProc;
    windowClass.hInstance = SaverInstance;
    windowClass.hIcon = LoadIconA(SaverInstance, SAVER_ICON);
    windowClass.hbrBackground = HBRUSH{GetStockObject(BLACK_BRUSH)};
    windowClass.lpszClassName = SAVER_CLASS;
    return RegisterClassA(&windowClass);
}

static HWND CreateSaverWindow(HWND parent) {
    constexpr DWORD fullScreenStyle = WS_POPUP | WS_VISIBLE | WS_CLIPSIBLINGS | WS_CLIPCHILDREN;
    constexpr DWORD previewStyle = WS_CHILD | WS_VISIBLE | WS_CLIPCHILDREN;
    constexpr DWORD hostedStyle = previewStyle | WS_DISABLED; // input is the host's affair

    if (PreviewMode == PREVIEW_NONE) {
        return CreateWindowExA(WS_EX_TOPMOST, SAVER_CLASS, SAVER_TITLE, fullScreenStyle, 0, 0,
                               GetSystemMetrics(SM_CXSCREEN), GetSystemMetrics(SM_CYSCREEN),
                               nullptr, nullptr, SaverInstance, nullptr);
    }
    RECT area{};
    GetClientRect(parent, &area);
    const bool whole = PreviewMode == PREVIEW_WHOLE;
    return CreateWindowExA(0, SAVER_CLASS, whole ? SAVER_TITLE : "Preview",
                           whole ? hostedStyle : previewStyle, 0, 0, area.right, area.bottom,
                           parent, nullptr, SaverInstance, nullptr);
}

/// Makes the saver window, a child where PreviewMode says so, and runs until it has gone.
static int RunSaverWindow(HWND parent) {
    int result = EXIT_REFUSED;
    SaverWindow = nullptr;
    if (RegisterSaverClass()) {
        SaverWindow = CreateSaverWindow(parent);
    }
    if (SaverWindow) {
        if (PreviewMode == PREVIEW_NONE) {
            SetForegroundWindow(SaverWindow);
        }
        result = RunWindowLoop(SaverWindow, nullptr);
    }
    return result;
}

int RunSaver(HWND parent) {
    if (parent) {
        PreviewMode = PREVIEW_WALK;
        return RunSaverWindow(parent);
    }
    const HWND running = FindWindowA(SAVER_CLASS, SAVER_TITLE);
    if (running && IsWindow(running)) {
        SetForegroundWindow(running);
        return 0;
    }
    LoadPasswordModule();
    const int result = RunSaverWindow(nullptr);
    UnloadPasswordModule();
    return result;
}

static int RunInHost() {
    PreviewMode = PREVIEW_WHOLE;
    return RunSaverWindow(HostWindow);
}

int RunHostedShow(HWND host) {
    SaverInstance = GetModuleHandleA(nullptr);
    HostWindow = host;
    return RunGuarded(RunInHost, AfterException);
}
