// Windows: their making and end, their picture, painting, and handles that have gone stale.
#include "tests/user/test_window.h"

namespace {

using test::handlers;
using test::seen;

class Windows : public test::WindowTest {
  protected:
    static DWORD pixel(HWND of, int x, int y) {
        const seam::Picture picture = seam::windowPicture(of);
        return picture.pixels.at(static_cast<std::size_t>(y * picture.width + x));
    }
};

TEST_F(Windows, CreationRunsInsideTheCallAndBringsSizeAndPaint) {
    HWND created;
    handlers[WM_CREATE] = [&](HWND made, WPARAM, LPARAM record) {
        created = made;
        const auto* creation = reinterpret_cast<const CREATESTRUCTA*>(record);
        EXPECT_EQ(creation->cx, 40);
        EXPECT_STREQ(creation->lpszName, "Test");
        RECT client{};
        EXPECT_TRUE(GetClientRect(made, &client));
        EXPECT_EQ(client.bottom, 30);
        return LRESULT{0};
    };
    const HWND made = test::makeWindow();
    EXPECT_EQ(created, made);
    test::handleWaiting();
    const std::vector<UINT> order{WM_CREATE, WM_SIZE, WM_SHOWWINDOW, WM_PAINT};
    EXPECT_EQ(test::seenAmong(order), order);
    EXPECT_EQ(pixel(made, 39, 29), 0xC0C0C0U) << "the class's brush";
    DestroyWindow(made);
}

TEST_F(Windows, RefusedCreationLeavesNothing) {
    const auto destroy = [](HWND made, WPARAM, LPARAM) {
        DestroyWindow(made);
        return LRESULT{0};
    };
    handlers = {{WM_CREATE, [](HWND, WPARAM, LPARAM) { return LRESULT{-1}; }}};
    EXPECT_FALSE(test::makeWindow());
    for (const UINT message : {WM_CREATE, WM_SHOWWINDOW}) {
        handlers = {{message, destroy}};
        EXPECT_FALSE(test::makeWindow());
    }
    const HWND hidden = test::makeWindow(10, 10, WS_POPUP);
    EXPECT_FALSE(ShowWindow(hidden, SW_SHOWNORMAL));
    EXPECT_FALSE(IsWindow(hidden));
    EXPECT_FALSE(test::makeWindow(9, 9, WS_CHILD, HWND{12345})) << "no such window off X11";
}

TEST_F(Windows, EachIsToldOfItsEndOnceWhateverItDoesThen) {
    const HWND child = test::makeWindow(10, 10, WS_CHILD, window);
    HWND late;
    std::vector<HWND> destroyed;
    handlers[WM_DESTROY] = [&](HWND dying, WPARAM, LPARAM) {
        destroyed.push_back(dying);
        EXPECT_TRUE(IsWindow(dying));
        if (dying == child) {
            DestroyWindow(window);
            late = test::makeWindow(5, 5, WS_CHILD, window);
        }
        return LRESULT{0};
    };
    EXPECT_EQ(GetParent(child), window);
    DestroyWindow(window);
    EXPECT_EQ(destroyed, (std::vector<HWND>{window, child, late}));
    for (const HWND gone : destroyed) {
        EXPECT_FALSE(IsWindow(gone));
    }
}

TEST_F(Windows, KeysGoToTheWindowThatHasTheFocus) {
    const HWND child = test::makeWindow(10, 10, WS_CHILD | WS_VISIBLE, window);
    test::handleWaiting();
    SetFocus(child);
    test::press(test::lastNative(), Qt::Key_A);
    MSG message{};
    ASSERT_TRUE(PeekMessageA(&message, nullptr, WM_KEYDOWN, WM_KEYDOWN, PM_REMOVE));
    EXPECT_EQ(message.hwnd, child);
    DestroyWindow(window);
    EXPECT_FALSE(SetFocus(nullptr)) << "it went with the window";
}

TEST_F(Windows, StaleHandlesAreRefused) {
    const HWND old = window;
    DestroyWindow(old);
    window = test::makeWindow();
    EXPECT_NE(old, window) << "the slot is used again, with another generation";
    PAINTSTRUCT paint{};
    EXPECT_EQ(SendMessageA(old, WM_CLOSE, 0, 0), 0);
    EXPECT_FALSE(PostMessageA(old, WM_CLOSE, 0, 0));
    EXPECT_FALSE(GetDC(old));
    EXPECT_FALSE(BeginPaint(old, &paint));
    EXPECT_FALSE(DestroyWindow(old));
    EXPECT_FALSE(SetTimer(old, 1, 10, nullptr));
}

TEST_F(Windows, DrawingShowsAtOnceAndAPaintIsClippedToItsArea) {
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
    const HDC dc = GetDC(window);
    const RECT corner{0, 0, 2, 2};
    FillRect(dc, &corner, HBRUSH{GetStockObject(BLACK_BRUSH)});
    ReleaseDC(window, dc);
    MoveWindow(window, 0, 0, 60, 20, FALSE);
    EXPECT_EQ(pixel(window, 1, 1), 0U);
    ASSERT_EQ(test::seenAmong({WM_SIZE}), std::vector<UINT>{WM_SIZE});
    EXPECT_EQ(seen.front().lParam, 60 | (20 << 16));
    test::handleWaiting();
    EXPECT_EQ(pixel(window, 59, 19), 0xC0C0C0U);
}

TEST_F(Windows, PointerHidesByCountOrByShape) {
    const auto shape = [] { return test::lastNative()->cursor().shape(); };
    EXPECT_EQ(ShowCursor(FALSE), -1);
    EXPECT_EQ(shape(), Qt::BlankCursor);
    EXPECT_EQ(ShowCursor(TRUE), 0);
    EXPECT_EQ(shape(), Qt::ArrowCursor);
    const HCURSOR wait = LoadCursorA(nullptr, IDC_WAIT);
    const HCURSOR old = SetCursor(wait);
    EXPECT_EQ(shape(), Qt::WaitCursor);
    EXPECT_EQ(SetCursor(old), wait);
}

} // namespace
