// Message boxes: what they show and answer, and what goes on behind them.
#include "tests/user/test_window.h"

#include <QApplication>
#include <QMessageBox>
#include <QTimer>

#include <stdexcept>

namespace {

using test::handlers;

class Boxes : public test::WindowTest {
  protected:
    void SetUp() override {
        WindowTest::SetUp();
        seam::useSystemClock(); // the toolkit's own loop runs behind a box
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

    static void answerWhenUp() {
        whenUp([](QMessageBox& box) { test::press(&box, Qt::Key_Return); });
    }
};

TEST_F(Boxes, ShowTheirTextAndGiveTheAnswer) {
    const struct {
        UINT type;
        Qt::Key key;
        int answer;
    } cases[] = {{MB_OK | MB_ICONHAND, Qt::Key_Escape, IDOK},
                 {MB_OK | MB_ICONEXCLAMATION, Qt::Key_Return, IDOK},
                 {MB_YESNOCANCEL, Qt::Key_Escape, IDCANCEL},
                 {MB_YESNOCANCEL, Qt::Key_Return, IDYES}};

    for (const auto& one : cases) {
        QString text;
        QString title;
        whenUp([&](QMessageBox& box) {
            text = box.text();
            title = box.windowTitle();
            test::press(&box, one.key);
        });
        // Valid UTF-8 is shown as that, anything else as Windows-1252.
        EXPECT_EQ(MessageBoxA(window, "Error reading \xC3\xA9.", "\x80 caf\xE9", one.type),
                  one.answer);
        EXPECT_EQ(text, QStringLiteral("Error reading \u00E9."));
        EXPECT_EQ(title, QStringLiteral("\u20AC caf\u00E9"));
    }
}

TEST_F(Boxes, ARequestToCloseWaitsForTheAnswer) {
    for (const bool atTheLastMoment : {false, true}) {
        test::seen.clear();
        whenUp([&](QMessageBox& box) {
            PostMessageA(window, WM_CLOSE, 0, 0);
            PostMessageA(window, WM_CLOSE, 0, 0);
            if (!atTheLastMoment) {
                QCoreApplication::processEvents();
            }
            test::press(&box, Qt::Key_Return);
        });
        handlers[WM_CLOSE] = [](HWND, WPARAM, LPARAM) { return 0; };
        MessageBoxA(window, "", "", MB_OK);
        EXPECT_TRUE(test::seenAmong({WM_CLOSE}).empty());
        test::handleWaiting();
        EXPECT_EQ(test::seenAmong({WM_CLOSE}).size(), 1U) << "and there is one of them";
    }
}

TEST_F(Boxes, ThePointerShowsWhileTheyAreUp) {
    QWindow* const below = test::lastNative();
    const HCURSOR before = SetCursor(nullptr);
    EXPECT_EQ(below->cursor().shape(), Qt::BlankCursor);
    whenUp([&](QMessageBox& box) {
        EXPECT_EQ(below->cursor().shape(), Qt::ArrowCursor);
        test::press(&box, Qt::Key_Return);
    });
    MessageBoxA(window, "", "", MB_OK);
    EXPECT_EQ(below->cursor().shape(), Qt::BlankCursor);
    SetCursor(before);
}

TEST_F(Boxes, AnExceptionBehindThemComesOutOfThem) {
    handlers[WM_TIMER] = [](HWND, WPARAM, LPARAM) -> LRESULT { throw std::runtime_error("fault"); };
    SetTimer(window, 1, 1, nullptr);
    EXPECT_THROW(MessageBoxA(window, "", "", MB_OK), std::runtime_error);
    EXPECT_EQ(QApplication::activeModalWidget(), nullptr);
    KillTimer(window, 1);
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
            answerWhenUp();
        }
        return LRESULT{0};
    };
    SetTimer(window, 1, 5, nullptr);
    EXPECT_EQ(MessageBoxA(window, "Wait", nullptr, MB_OK), IDOK);
    EXPECT_GE(ticks, 4);
    EXPECT_GE(paints, 3);
}

TEST_F(Boxes, ALoopWithinTheirOwnEndsAndTheyGoOn) {
    int after = 0;
    handlers[WM_TIMER] = [&](HWND, WPARAM timer, LPARAM) {
        if (timer == 1) { // the inner loop, which timer 2 ends
            KillTimer(window, 1);
            SetTimer(window, 2, 1, nullptr);
            test::runLoop();
            SetTimer(window, 3, 1, nullptr);
        } else if (timer == 2) {
            KillTimer(window, 2);
            PostQuitMessage(0);
        } else if (++after == 3) {
            answerWhenUp();
        }
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
    EXPECT_EQ(test::runLoop(), 5U);
}

} // namespace
