#include "stage/window_loop.h"

WORD RegisterGreyClass(const char* name, WNDPROC procedure, HINSTANCE instance, HICON icon) {
    WNDCLASSA windowClass{};
    windowClass.style = CS_VREDRAW | CS_HREDRAW;
    windowClass.lpfnWndProc = procedure;
    windowClass.hInstance = instance;
    windowClass.hIcon = icon;
    windowClass.hCursor = LoadCursorA(nullptr, IDC_ARROW);
    windowClass.hbrBackground = HBRUSH{GetStockObject(LTGRAY_BRUSH)};
    windowClass.lpszClassName = name;
    return RegisterClassA(&windowClass);
}

int RunWindowLoop(HWND window, MessageTranslator translate) {
    MSG message{};
    while (IsWindow(window)) {
        if (!GetMessageA(&message, nullptr, 0, 0)) {
            continue;
        }
        if (translate == nullptr || translate(&message) == 0) {
            TranslateMessage(&message);
            DispatchMessageA(&message);
        }
    }
    // The quit that its end has posted doesn't outlive the loop.
    PeekMessageA(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE);
    return message.message == WM_QUIT ? static_cast<int>(message.wParam) : 0;
}
