// A window whose procedure keeps a list of what reaches it, and the fixture round it.
#pragma once

#include "platform/harness.h"
#include "platform/kernel.h"
#include "platform/user.h"

#include <QApplication>
#include <QKeyEvent>
#include <QTimer>
#include <QWindow>

#include <gtest/gtest.h>

#include <algorithm>
#include <functional>
#include <map>
#include <string>
#include <vector>

namespace test {

struct Seen {
    UINT message;
    WPARAM wParam;
    LPARAM lParam;
};

inline std::vector<Seen> seen;
inline std::map<UINT, std::function<LRESULT(HWND, WPARAM, LPARAM)>> handlers;

inline LRESULT recordingProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    seen.push_back({message, wParam, lParam});
    const auto handler = handlers.find(message);
    return handler != handlers.end() ? handler->second(window, wParam, lParam)
                                     : DefWindowProcA(window, message, wParam, lParam);
}

/// The messages of the list among those asked for, in their order.
inline std::vector<UINT> seenAmong(const std::vector<UINT>& wanted) {
    std::vector<UINT> found;
    for (const Seen& entry : seen) {
        if (std::find(wanted.begin(), wanted.end(), entry.message) != wanted.end()) {
            found.push_back(entry.message);
        }
    }
    return found;
}

inline HWND makeWindow(int width = 40, int height = 30, DWORD style = WS_POPUP | WS_VISIBLE,
                       HWND parent = nullptr, const char* title = "Test") {
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = recordingProc;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.hbrBackground = HBRUSH{GetStockObject(LTGRAY_BRUSH)};
    windowClass.lpszClassName = "TestClass";
    RegisterClassA(&windowClass);
    return CreateWindowExA(0, "TestClass", title, style, 0, 0, width, height, parent, nullptr,
                           windowClass.hInstance, nullptr);
}

/// Takes and dispatches what waits now, timers left out.
inline void handleWaiting() {
    MSG message{};
    while (PeekMessageA(&message, nullptr, 0, WM_TIMER - 1, PM_REMOVE) ||
           PeekMessageA(&message, nullptr, WM_TIMER + 1, 0xFFFF, PM_REMOVE)) {
        DispatchMessageA(&message);
    }
}

/// Dispatches until a quit message comes; gives its code.
inline WPARAM runLoop() {
    MSG message{};
    while (GetMessageA(&message, nullptr, 0, 0)) {
        DispatchMessageA(&message);
    }
    return message.wParam;
}

/// The toolkit's window that was made last.
inline QWindow* lastNative() {
    return QGuiApplication::topLevelWindows().constLast();
}

inline void press(QObject* target, Qt::Key key, Qt::KeyboardModifiers held = Qt::NoModifier) {
    QKeyEvent event(QEvent::KeyPress, key, held);
    QCoreApplication::sendEvent(target, &event);
}

/// Does something with the innermost box, dialog or menu of the toolkit's once it is up.
template <class Widget>
void whenUp(const std::function<void(Widget&)>& action) {
    QTimer::singleShot(0, [action] {
        QWidget* popup = QApplication::activePopupWidget();
        QWidget* inner = popup != nullptr ? popup : QApplication::activeModalWidget();
        auto* up = qobject_cast<Widget*>(inner);
        if (up == nullptr || !up->isActiveWindow()) {
            whenUp<Widget>(action);
        } else {
            action(*up);
        }
    });
}

/// Lets the window's timer do something, once.
inline void onTimer(HWND window, const std::function<void()>& action) {
    handlers[WM_TIMER] = [=](HWND, WPARAM timer, LPARAM) {
        KillTimer(window, timer);
        action();
        return LRESULT{0};
    };
    SetTimer(window, 1, 1, nullptr);
}

/// One window that has been painted, and a clock moved by hand. At the end nothing may be left.
class WindowTest : public testing::Test {
  protected:
    void SetUp() override {
        seam::useManualClock(0);
        handlers.clear();
        before_ = seam::liveHandles();
        window = makeWindow();
        handleWaiting();
        seen.clear();
    }

    void TearDown() override {
        DestroyWindow(window);
        EXPECT_EQ(seam::liveHandles(), before_) << "something was left behind";
        MSG message{};
        while (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE)) {
        }
        seam::useSystemClock();
    }

    HWND window;

  private:
    seam::HandleCounts before_;
};

} // namespace test
