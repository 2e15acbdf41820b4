#include "stage/window_loop.h"

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
