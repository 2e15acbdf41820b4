// The queue, nested loops, the quit message and timers.
#include "tests/user/test_window.h"

namespace {

using test::handlers;

class Loop : public test::WindowTest {
  protected:
    static std::vector<UINT> takeAll() {
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
};

constexpr UINT ownMessage = 0x8001;

TEST_F(Loop, GivesPostedThenQuitThenInputThenPaintThenTimers) {
    SetTimer(window, 5, 10, nullptr);
    InvalidateRect(window, nullptr, FALSE);
    test::press(test::lastNative(), Qt::Key_A);
    PostQuitMessage(3);
    PostMessageA(window, ownMessage, 0, 0);
    Sleep(10);
    EXPECT_EQ(takeAll(), (std::vector<UINT>{ownMessage, WM_QUIT, WM_KEYDOWN, WM_PAINT, WM_TIMER}));
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
    using Ticks = std::vector<std::pair<UINT_PTR, std::int64_t>>;
    Ticks ticks;
    handlers[WM_TIMER] = [&](HWND, WPARAM timer, LPARAM) {
        ticks.emplace_back(timer, seam::clockNow());
        return LRESULT{0};
    };
    SetTimer(window, 3, 100, nullptr);
    SetTimer(window, 1, 50, nullptr);
    SetTimer(window, 2, 50, nullptr);
    SetTimer(window, 1, 50, nullptr); // set anew: now behind 2
    EXPECT_TRUE(seam::runUntil(100));
    EXPECT_EQ(ticks, (Ticks{{2, 50}, {1, 50}, {3, 100}, {2, 100}, {1, 100}}));
}

TEST_F(Loop, LateTimerTicksOnceAndAKilledOneNotAtAll) {
    SetTimer(window, 1, 10, nullptr);
    SetTimer(window, 2, 10, nullptr);
    Sleep(95);
    EXPECT_TRUE(KillTimer(window, 2));
    EXPECT_FALSE(KillTimer(window, 2));
    EXPECT_EQ(takeAll(), std::vector<UINT>{WM_TIMER});
    for (const std::int64_t until : {104, 105}) {
        EXPECT_TRUE(seam::runUntil(until));
        EXPECT_EQ(test::seenAmong({WM_TIMER}).size(), until == 105 ? 1U : 0U);
    }
}

TEST_F(Loop, KeysCarryThePlatformsCodes) {
    const std::tuple<Qt::Key, Qt::KeyboardModifiers, UINT, WPARAM> cases[] = {
        {Qt::Key_A, Qt::NoModifier, WM_KEYDOWN, 'A'},
        {Qt::Key_Escape, Qt::NoModifier, WM_KEYDOWN, 0x1B},
        {Qt::Key_F1, Qt::NoModifier, WM_KEYDOWN, 0x70},
        {Qt::Key_F10, Qt::NoModifier, WM_SYSKEYDOWN, 0x79},
        {Qt::Key_X, Qt::AltModifier, WM_SYSKEYDOWN, 'X'},
        {Qt::Key_Shift, Qt::ShiftModifier, WM_KEYDOWN, 0x10}};
    for (const auto& [key, held, kind, code] : cases) {
        test::press(test::lastNative(), key, held);
        MSG message{};
        ASSERT_TRUE(PeekMessageA(&message, window, 0, 0, PM_REMOVE));
        EXPECT_EQ(message.message, kind) << key;
        EXPECT_EQ(message.wParam, code) << key;
    }
}

} // namespace
