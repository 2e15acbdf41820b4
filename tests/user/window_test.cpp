// Windows: their making and end, their picture, painting, and handles that have gone stale.
#include "tests/user/test_window.h"

#include <QGuiApplication>
#include <QKeyEvent>
#include <QWindow>

#include <gtest/gtest.h>

namespace {

using test::handlers;
using test::seen;

class Windows : public testing::Test {
  protected:
    void SetUp() override {
        seam::useManualClock(0);
        handlers.clear();
        seen.clear();
        before = seam::liveHandles();
    }

    void TearDown() override {
        EXPECT_EQ(seam::liveHandles(), before) << "something was left behind";
        MSG message{};
        while (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE)) {
        }
        seam::useSystemClock();
    }

    static DWORD pixel(HWND window, int x, int y) {
        const seam::Picture picture = seam::windowPicture(window);
        return picture.pixels.at(static_cast<std::size_t>(y * picture.width + x));
    }

    seam::HandleCounts before;
};

TEST_F(Windows, CreationRunsInsideTheCallAndBringsSizeAndPaint) {
    HWND created;
    handlers[WM_CREATE] = [&](HWND window, WPARAM, LPARAM record) {
        created = window;
        const auto* creation = reinterpret_cast<const CREATESTRUCTA*>(record);
        EXPECT_EQ(creation->cx, 40);
        EXPECT_STREQ(creation->lpszName, "Test");
        RECT client{};
        EXPECT_TRUE(GetClientRect(window, &client));
        EXPECT_EQ(client.bottom, 30);
        return LRESULT{0};
    };
    const HWND window = test::makeWindow();
    EXPECT_EQ(created, window);
    test::handleWaiting();
    EXPECT_EQ(test::seenAmong({WM_CREATE, WM_SIZE, WM_SHOWWINDOW, WM_PAINT}),
              (std::vector<UINT>{WM_CREATE, WM_SIZE, WM_SHOWWINDOW, WM_PAINT}));
    EXPECT_EQ(pixel(window, 39, 29), 0xC0C0C0U) << "the class's brush";
    DestroyWindow(window);
}

TEST_F(Windows, RefusedCreationLeavesNothing) {
    handlers[WM_CREATE] = [](HWND, WPARAM, LPARAM) { return LRESULT{-1}; };
    EXPECT_FALSE(test::makeWindow());
    handlers[WM_CREATE] = [](HWND window, WPARAM, LPARAM) {
        DestroyWindow(window);
        return LRESULT{0};
    };
    EXPECT_FALSE(test::makeWindow());
    EXPECT_FALSE(CreateWindowExA(0, "NoSuchClass", "", WS_POPUP, 0, 0, 9, 9, nullptr, nullptr,
                                 nullptr, nullptr));
    EXPECT_FALSE(test::makeWindow(9, 9, WS_CHILD, HWND{12345})) << "no such window off X11";
}

TEST_F(Windows, AWindowMayGoWhileItIsShown) {
    handlers[WM_SHOWWINDOW] = [](HWND window, WPARAM, LPARAM) {
        DestroyWindow(window);
        return LRESULT{0};
    };
    EXPECT_FALSE(test::makeWindow());
    const HWND hidden = test::makeWindow(10, 10, WS_POPUP);
    EXPECT_FALSE(ShowWindow(hidden, SW_SHOWNORMAL));
    EXPECT_FALSE(IsWindow(hidden));
}

TEST_F(Windows, EachIsToldOfItsEndOnceWhateverItDoesThen) {
    const HWND parent = test::makeWindow();
    const HWND child = test::makeWindow(10, 10, WS_CHILD, parent);
    HWND late;
    std::vector<HWND> destroyed;
    handlers[WM_DESTROY] = [&](HWND window, WPARAM, LPARAM) {
        destroyed.push_back(window);
        if (window == child) {
            DestroyWindow(parent);
            late = test::makeWindow(5, 5, WS_CHILD, parent);
        }
        return LRESULT{0};
    };
    DestroyWindow(parent);
    EXPECT_EQ(destroyed, (std::vector<HWND>{parent, child, late}));
    EXPECT_FALSE(IsWindow(late));
}

TEST_F(Windows, KeysGoToTheWindowThatHasTheFocus) {
    const HWND parent = test::makeWindow();
    const HWND child = test::makeWindow(10, 10, WS_CHILD | WS_VISIBLE, parent);
    test::handleWaiting();
    SetFocus(child);
    QKeyEvent event(QEvent::KeyPress, Qt::Key_A, Qt::NoModifier);
    QCoreApplication::sendEvent(QGuiApplication::topLevelWindows().constLast(), &event);
    MSG message{};
    ASSERT_TRUE(PeekMessageA(&message, nullptr, WM_KEYDOWN, WM_KEYDOWN, PM_REMOVE));
    EXPECT_EQ(message.hwnd, child);
    DestroyWindow(parent);
    EXPECT_FALSE(SetFocus(nullptr)) << "it went with the window";
}

TEST_F(Windows, DestroyingTakesTheChildrenAlong) {
    const HWND parent = test::makeWindow();
    const HWND child = test::makeWindow(10, 10, WS_CHILD | WS_VISIBLE, parent);
    std::vector<HWND> destroyed;
    handlers[WM_DESTROY] = [&](HWND window, WPARAM, LPARAM) {
        destroyed.push_back(window);
        EXPECT_TRUE(IsWindow(window));
        return LRESULT{0};
    };
    EXPECT_EQ(GetParent(child), parent);
    DestroyWindow(parent);
    EXPECT_EQ(destroyed, (std::vector<HWND>{parent, child}));
    EXPECT_FALSE(IsWindow(parent));
    EXPECT_FALSE(IsWindow(child));
}

TEST_F(Windows, StaleHandlesAreRefused) {
    const HWND old = test::makeWindow();
    DestroyWindow(old);
    const HWND now = test::makeWindow();
    EXPECT_NE(old, now) << "the slot is used again, with another generation";
    RECT client{};
    PAINTSTRUCT paint{};
    EXPECT_EQ(SendMessageA(old, WM_CLOSE, 0, 0), 0);
    EXPECT_FALSE(PostMessageA(old, WM_CLOSE, 0, 0));
    EXPECT_FALSE(GetClientRect(old, &client));
    EXPECT_FALSE(GetDC(old));
    EXPECT_FALSE(BeginPaint(old, &paint));
    EXPECT_FALSE(InvalidateRect(old, nullptr, FALSE));
    EXPECT_FALSE(DestroyWindow(old));
    EXPECT_TRUE(IsWindow(now));
    DestroyWindow(now);
}

TEST_F(Windows, DrawingShowsAtOnceAndAPaintIsClippedToItsArea) {
    const HWND window = test::makeWindow();
    test::handleWaiting();
    const HBRUSH red = CreateSolidBrush(RGB(255, 0, 0));
    const RECT all{0, 0, 40, 30};
    handlers[WM_PAINT] = [&](HWND, WPARAM, LPARAM) {
        PAINTSTRUCT paint{};
        FillRect(BeginPaint(window, &paint), &all, red);
        EXPECT_EQ(paint.rcPaint.left, 5);
        EXPECT_EQ(paint.rcPaint.bottom, 20);
        EndPaint(window, &paint);
        return LRESULT{0};
    };
    const RECT first{5, 5, 10, 10};
    const RECT second{8, 12, 30, 20};
    InvalidateRect(window, &first, FALSE);
    InvalidateRect(window, &second, FALSE);
    UpdateWindow(window);
    EXPECT_EQ(pixel(window, 29, 19), 0xFF0000U);
    EXPECT_EQ(pixel(window, 30, 19), 0xC0C0C0U);
    EXPECT_EQ(pixel(window, 4, 10), 0xC0C0C0U);

    const HDC dc = GetDC(window);
    FillRect(dc, &all, red);
    EXPECT_EQ(pixel(window, 0, 0), 0xFF0000U) << "outside any paint, at once";
    DestroyWindow(window);
    FillRect(dc, &all, red); // the window's picture has gone: nothing is drawn, nothing breaks
    EXPECT_TRUE(ReleaseDC(window, dc)) << "also once the window has gone";
    DeleteObject(red);
}

TEST_F(Windows, ResizingKeepsThePictureAndPaintsAnew) {
    const HWND window = test::makeWindow();
    test::handleWaiting();
    const HDC dc = GetDC(window);
    const RECT corner{0, 0, 2, 2};
    FillRect(dc, &corner, HBRUSH{GetStockObject(BLACK_BRUSH)});
    ReleaseDC(window, dc);
    seen.clear();
    MoveWindow(window, 0, 0, 60, 20, FALSE);
    EXPECT_EQ(pixel(window, 1, 1), 0U);
    ASSERT_EQ(test::seenAmong({WM_SIZE}).size(), 1U);
    EXPECT_EQ(seen.front().lParam, 60 | (20 << 16));
    test::handleWaiting();
    EXPECT_EQ(test::seenAmong({WM_PAINT}).size(), 1U);
    EXPECT_EQ(pixel(window, 59, 19), 0xC0C0C0U);
    DestroyWindow(window);
}

TEST_F(Windows, AreFoundByClassAndTitleAndCloseByDefault) {
    const HWND window = test::makeWindow(10, 10, WS_POPUP, nullptr, "One of a kind");
    EXPECT_EQ(FindWindowA("TestClass", "One of a kind"), window);
    EXPECT_FALSE(FindWindowA("TestClass", "Another"));
    EXPECT_FALSE(FindWindowA("OtherClass", "One of a kind"));
    EXPECT_EQ(GetWindowLongA(window, GWL_HINSTANCE),
              static_cast<LONG>(GetModuleHandleA(nullptr).number));
    SendMessageA(window, WM_CLOSE, 0, 0);
    EXPECT_FALSE(IsWindow(window));
}

TEST_F(Windows, PointerHidesByCountOrByShape) {
    const HWND window = test::makeWindow();
    const auto shape = [] {
        return QGuiApplication::topLevelWindows().constLast()->cursor().shape();
    };
    EXPECT_EQ(ShowCursor(FALSE), -1);
    EXPECT_EQ(shape(), Qt::BlankCursor);
    EXPECT_EQ(ShowCursor(TRUE), 0);
    EXPECT_EQ(shape(), Qt::ArrowCursor);
    const HCURSOR wait = LoadCursorA(nullptr, IDC_WAIT);
    const HCURSOR old = SetCursor(wait);
    EXPECT_EQ(shape(), Qt::WaitCursor);
    SetCursor(nullptr);
    EXPECT_EQ(shape(), Qt::BlankCursor);
    SetCursor(wait);
    EXPECT_EQ(SetCursor(old), wait);
    DestroyWindow(window);
}

} // namespace
