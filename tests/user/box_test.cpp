// Message boxes: what they show and answer, and what goes on behind them.
#include "tests/user/test_window.h"

#include <QApplication>
#include <QKeyEvent>
#include <QMessageBox>
#include <QTimer>

#include <gtest/gtest.h>

namespace {

using test::handlers;

class Boxes : public testing::Test {
  protected:
    void SetUp() override {
        handlers.clear();
        window = test::makeWindow();
        test::handleWaiting();
    }

    void TearDown() override {
        DestroyWindow(window);
        MSG message{};
        while (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE)) {
        }
    }

    /// Does something with the box once it is up.
    static void whenUp(const std::function<void(QMessageBox&)>& action) {
        QTimer::singleShot(0, [action] {
            auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
            if (box == nullptr) {
                whenUp(action);
            } else {
                action(*box);
            }
        });
    }

    static void press(QWidget& widget, Qt::Key key) {
        QKeyEvent event(QEvent::KeyPress, key, Qt::NoModifier);
        QCoreApplication::sendEvent(&widget, &event);
    }

    HWND window;
};

TEST_F(Boxes, ShowTheirTextAndGiveTheAnswer) {
    struct Case {
        UINT type;
        Qt::Key key;
        int answer;
    };

    const Case cases[] = {{MB_OK | MB_ICONHAND, Qt::Key_Escape, IDOK},
                          {MB_OK | MB_ICONEXCLAMATION, Qt::Key_Return, IDOK},
                          {MB_YESNOCANCEL, Qt::Key_Escape, IDCANCEL},
                          {MB_YESNOCANCEL, Qt::Key_Return, IDYES}};
    for (const Case& c : cases) {
        QString text;
        QString title;
        whenUp([&](QMessageBox& box) {
            text = box.text();
            title = box.windowTitle();
            press(box, c.key);
        });
        // Valid UTF-8 is shown as that, anything else as Windows-1252.
        EXPECT_EQ(MessageBoxA(window, "Error reading \xC3\xA9.", "\x80 caf\xE9", c.type), c.answer);
        EXPECT_EQ(text, QStringLiteral("Error reading \u00E9."));
        EXPECT_EQ(title, QStringLiteral("\u20AC caf\u00E9"));
    }
}

TEST_F(Boxes, TimersAndPaintsGoOnBehindThem) {
    int ticks = 0;
    int paints = 0;
    handlers[WM_PAINT] = [&](HWND painted, WPARAM, LPARAM) {
        ++paints;
        return DefWindowProcA(painted, WM_PAINT, 0, 0);
    };
    handlers[WM_TIMER] = [&](HWND, WPARAM, LPARAM) {
        InvalidateRect(window, nullptr, FALSE);
        if (++ticks == 4) {
            whenUp([](QMessageBox& box) { press(box, Qt::Key_Return); });
        }
        return LRESULT{0};
    };
    SetTimer(window, 1, 5, nullptr);
    EXPECT_EQ(MessageBoxA(window, "Wait", nullptr, MB_OK), IDOK);
    EXPECT_GE(ticks, 4);
    EXPECT_GE(paints, 3);
}

TEST_F(Boxes, RunTheirOwnLoopWithinAHandlerAndGoOnAfterIt) {
    // A loop of the program's within the box's own, ended by a timer; then the box goes on.
    constexpr UINT innerMessage = 0x8001;
    int after = 0;
    handlers[WM_TIMER] = [&](HWND, WPARAM timer, LPARAM) {
        KillTimer(window, 1);
        if (timer == 1) {
            PostMessageA(window, innerMessage, 0, 0);
        } else if (timer == 3) {
            KillTimer(window, 3);
            PostQuitMessage(0);
        } else if (++after == 3) {
            whenUp([](QMessageBox& box) { press(box, Qt::Key_Return); });
        }
        return LRESULT{0};
    };
    handlers[innerMessage] = [&](HWND, WPARAM, LPARAM) {
        SetTimer(window, 3, 1, nullptr);
        MSG inner{};
        while (GetMessageA(&inner, nullptr, 0, 0)) {
            DispatchMessageA(&inner);
        }
        SetTimer(window, 2, 1, nullptr);
        return LRESULT{0};
    };
    SetTimer(window, 1, 1, nullptr);
    EXPECT_EQ(MessageBoxA(window, "Outer", nullptr, MB_OK), IDOK);
    EXPECT_GE(after, 3) << "the box's own loop goes on dispatching";
}

TEST_F(Boxes, AQuitEndsTheBoxAndReachesTheLoopBehindIt) {
    handlers[WM_TIMER] = [](HWND, WPARAM, LPARAM) {
        PostQuitMessage(5);
        return LRESULT{0};
    };
    SetTimer(window, 1, 1, nullptr);
    EXPECT_EQ(MessageBoxA(window, "Wait", nullptr, MB_YESNOCANCEL), IDCANCEL);
    MSG message{};
    while (GetMessageA(&message, nullptr, 0, 0)) {
    }
    EXPECT_EQ(message.wParam, 5U);
}

} // namespace
