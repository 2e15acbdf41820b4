// Message boxes: what they show and answer, and what goes on behind them.
#include "tests/user/test_window.h"

#include <QMessageBox>

#include <stdexcept>

namespace {

using test::handlers;

class Boxes : public test::WindowTest {
  protected:
    void SetUp() override {
        WindowTest::SetUp();
        seam::useSystemClock(); // the toolkit's own loop runs behind a box
    }
};

using test::whenUp;

void answer(QMessageBox& box) {
    test::press(&box, Qt::Key_Return);
}

TEST_F(Boxes, ShowTheirTextAndGiveTheAnswer) {
    const struct {
        UINT type;
        Qt::Key key;
        int answer;
    } cases[] = {{MB_OK | MB_ICONHAND, Qt::Key_Escape, IDOK},
                 {MB_YESNOCANCEL, Qt::Key_Escape, IDCANCEL},
                 {MB_YESNOCANCEL, Qt::Key_Return, IDYES}};

    for (const auto& one : cases) {
        QString text;
        QString title;
        whenUp<QMessageBox>([&](QMessageBox& box) {
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
        whenUp<QMessageBox>([&](QMessageBox& box) {
            PostMessageA(window, WM_CLOSE, 0, 0);
            PostMessageA(window, WM_CLOSE, 0, 0);
            if (!atTheLastMoment) {
                QCoreApplication::processEvents();
            }
            answer(box);
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
    whenUp<QMessageBox>([&](QMessageBox& box) {
        EXPECT_EQ(below->cursor().shape(), Qt::ArrowCursor);
        answer(box);
    });
    MessageBoxA(window, "", "", MB_OK);
    EXPECT_EQ(below->cursor().shape(), Qt::BlankCursor);
    SetCursor(before);
}

TEST_F(Boxes, TimersAndPaintsGoOnBehindThemAlsoAfterALoopWithinTheirOwn) {
    int after = 0;
    handlers[WM_TIMER] = [&](HWND, WPARAM timer, LPARAM) {
        if (timer == 1) { // the inner loop, which timer 2 ends
            KillTimer(window, 1);
            SetTimer(window, 2, 1, nullptr);
            test::runLoop();
            SetTimer(window, 3, 5, nullptr);
        } else if (timer == 2) {
            KillTimer(window, 2);
            PostQuitMessage(0);
        } else {
            InvalidateRect(window, nullptr, FALSE);
            if (++after == 4) {
                whenUp<QMessageBox>(answer);
            }
        }
        return LRESULT{0};
    };
    SetTimer(window, 1, 1, nullptr);
    EXPECT_EQ(MessageBoxA(window, "Outer", nullptr, MB_OK), IDOK);
    EXPECT_GE(after, 4) << "the box's own loop goes on dispatching";
    EXPECT_GE(test::seenAmong({WM_PAINT}).size(), 3U);
}

TEST_F(Boxes, AQuitAndAnExceptionEndThemAndComeOutOfThem) {
    test::onTimer(window, [] { PostQuitMessage(5); });
    EXPECT_EQ(MessageBoxA(window, "Wait", nullptr, MB_YESNOCANCEL), IDCANCEL);
    EXPECT_EQ(test::runLoop(), 5U);
    test::onTimer(window, [] { throw std::runtime_error("fault"); });
    EXPECT_THROW(MessageBoxA(window, "", "", MB_OK), std::runtime_error);
    EXPECT_EQ(QApplication::activeModalWidget(), nullptr);
}

} // namespace
