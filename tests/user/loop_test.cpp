// The queue, nested loops, the quit message and timers.
#include "tests/user/test_window.h"

#include <QCoreApplication>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QWindow>

#include <gtest/gtest.h>

namespace {

using test::handlers;
using test::seen;

class Loop : public testing::Test {
  protected:
    void SetUp() override {
        seam::useManualClock(0);
        handlers.clear();
        window = test::makeWindow();
        test::handleWaiting();
        seen.clear();
    }

    void TearDown() override {
        DestroyWindow(window);
        MSG message{};
        while (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE)) {
        }
        seam::useSystemClock();
    }

    static void press(Qt::Key key) {
        QKeyEvent event(QEvent::KeyPress, key, Qt::NoModifier);
        QCoreApplication::sendEvent(QGuiApplication::topLevelWindows().constLast(), &event);
    }

    std::vector<UINT> takeAll() {
        std::vector<UINT> taken;
        MSG message{};
        while (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE)) {
            taken.push_back(message.message);
            if (message.message == WM_PAINT) {
                DispatchMessageA(&message); // which validates
            }
        }
        return taken;
    }

    HWND window;
};

constexpr UINT ownMessage = 0x8001;

TEST_F(Loop, GivesPostedThenQuitThenInputThenPaintThenTimers) {
    SetTimer(window, 5, 10, nullptr);
    InvalidateRect(window, nullptr, FALSE);
    press(Qt::Key_A);
    PostQuitMessage(3);
    PostMessageA(window, ownMessage, 0, 0);
    Sleep(10);
    EXPECT_EQ(takeAll(), (std::vector<UINT>{ownMessage, WM_QUIT, WM_KEYDOWN, WM_PAINT, WM_TIMER}));
}

TEST_F(Loop, InnermostLoopTakesTheQuitMessage) {
    int innerResult = -1;
    handlers[ownMessage] = [&](HWND, WPARAM, LPARAM) {
        PostQuitMessage(7);
        MSG inner{};
        while (GetMessageA(&inner, nullptr, 0, 0)) {
            DispatchMessageA(&inner);
        }
        innerResult = static_cast<int>(inner.wParam);
        PostQuitMessage(8);
        return LRESULT{0};
    };
    PostMessageA(window, ownMessage, 0, 0);
    MSG message{};
    while (GetMessageA(&message, nullptr, 0, 0)) {
        DispatchMessageA(&message);
    }
    EXPECT_EQ(innerResult, 7);
    EXPECT_EQ(message.wParam, 8U);
}

TEST_F(Loop, PeekTakesOnlyWhatItsFilterLetsThrough) {
    const HWND other = test::makeWindow(10, 10, WS_POPUP);
    PostMessageA(other, ownMessage, 1, 0);
    PostMessageA(window, ownMessage + 1, 2, 0);
    PostMessageA(window, ownMessage, 3, 0);
    PostQuitMessage(0);
    MSG message{};
    ASSERT_TRUE(PeekMessageA(&message, window, ownMessage, ownMessage, PM_REMOVE));
    EXPECT_EQ(message.wParam, 3U);
    EXPECT_FALSE(PeekMessageA(&message, window, WM_TIMER, WM_TIMER, PM_REMOVE))
        << "a filter for timers must not swallow the quit message";
    ASSERT_TRUE(PeekMessageA(&message, window, 0, 0, PM_NOREMOVE));
    ASSERT_TRUE(PeekMessageA(&message, window, 0, 0, PM_REMOVE));
    EXPECT_EQ(message.wParam, 2U);
    DestroyWindow(other);
    ASSERT_TRUE(PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE));
    EXPECT_EQ(message.message, WM_QUIT) << "what was queued for a window goes with it";
}

TEST_F(Loop, TimersComeByDueTimeThenInTheOrderTheyWereSet) {
    std::vector<std::pair<UINT_PTR, std::int64_t>> ticks;
    handlers[WM_TIMER] = [&](HWND, WPARAM timer, LPARAM) {
        ticks.emplace_back(timer, seam::clockNow());
        return LRESULT{0};
    };
    SetTimer(window, 3, 100, nullptr);
    SetTimer(window, 1, 50, nullptr);
    SetTimer(window, 2, 50, nullptr);
    SetTimer(window, 1, 50, nullptr); // set anew: now behind 2
    EXPECT_TRUE(seam::runUntil(100));
    EXPECT_EQ(ticks, (std::vector<std::pair<UINT_PTR, std::int64_t>>{
                         {2, 50}, {1, 50}, {3, 100}, {2, 100}, {1, 100}}));
}

TEST_F(Loop, LateTimerTicksOnceAndAKilledOneNotAtAll) {
    SetTimer(window, 1, 10, nullptr);
    SetTimer(window, 2, 10, nullptr);
    Sleep(95);
    EXPECT_TRUE(KillTimer(window, 2));
    EXPECT_FALSE(KillTimer(window, 2));
    EXPECT_EQ(takeAll(), std::vector<UINT>{WM_TIMER});
    EXPECT_TRUE(seam::runUntil(104));
    EXPECT_EQ(test::seenAmong({WM_TIMER}).size(), 0U);
    EXPECT_TRUE(seam::runUntil(105));
    EXPECT_EQ(test::seenAmong({WM_TIMER}).size(), 1U);
}

TEST_F(Loop, TimersEndWithTheirWindow) {
    const HWND other = test::makeWindow(10, 10, WS_POPUP);
    SetTimer(other, 1, 10, nullptr);
    const std::size_t running = seam::liveHandles().timers;
    DestroyWindow(other);
    EXPECT_EQ(seam::liveHandles().timers, running - 1);
    EXPECT_EQ(SetTimer(other, 1, 10, nullptr), 0U);
}

TEST_F(Loop, KeysCarryThePlatformsCodes) {
    struct Case {
        Qt::Key key;
        Qt::KeyboardModifiers held;
        UINT message;
        WPARAM code;
    };

    const Case cases[] = {{Qt::Key_A, Qt::NoModifier, WM_KEYDOWN, 'A'},
                          {Qt::Key_7, Qt::NoModifier, WM_KEYDOWN, '7'},
                          {Qt::Key_Escape, Qt::NoModifier, WM_KEYDOWN, 0x1B},
                          {Qt::Key_F1, Qt::NoModifier, WM_KEYDOWN, 0x70},
                          {Qt::Key_F10, Qt::NoModifier, WM_SYSKEYDOWN, 0x79},
                          {Qt::Key_X, Qt::AltModifier, WM_SYSKEYDOWN, 'X'},
                          {Qt::Key_Shift, Qt::ShiftModifier, WM_KEYDOWN, 0x10}};
    for (const Case& c : cases) {
        QKeyEvent event(QEvent::KeyPress, c.key, c.held);
        QCoreApplication::sendEvent(QGuiApplication::topLevelWindows().constLast(), &event);
        MSG message{};
        ASSERT_TRUE(PeekMessageA(&message, window, 0, 0, PM_REMOVE));
        EXPECT_EQ(message.message, c.message) << c.key;
        EXPECT_EQ(message.wParam, c.code) << c.key;
    }
}

} // namespace
