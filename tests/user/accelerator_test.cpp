// Keys that stand for commands: which loop has them, and who else keeps them.
#include "platform/dialogs.h"
#include "platform/user/accelerators.h"
#include "tests/user/test_window.h"

#include <QTest>

namespace {

using test::handlers;

constexpr UINT_PTR endTimer = 9;
constexpr UINT clickTime = 250; // a button that its letter has pressed tells of it after 100 ms

std::vector<int> dialogCommands;

LRESULT dialogProc(HWND dialog, UINT message, WPARAM wParam, LPARAM /*lParam*/) {
    const int id = LOWORD(static_cast<DWORD>(wParam));
    if (message == WM_COMMAND && id <= IDCANCEL) {
        dialogCommands.push_back(id);
        EndDialog(dialog, id);
        return 1;
    }
    return message == WM_INITDIALOG ? 1 : 0;
}

struct Press {
    Qt::Key key;
    Qt::KeyboardModifiers held;
};

class Accelerators : public test::WindowTest {
  protected:
    void SetUp() override {
        WindowTest::SetUp();
        seam::useSystemClock();
        dialog = CreateDialogParamA(nullptr, "controls", window, dialogProc, 0);
        ShowWindow(dialog, SW_SHOWNORMAL);
        test::handleWaiting();
        dialogCommands.clear();
        commands.clear();
        handlers[WM_COMMAND] = [this](HWND, WPARAM wParam, LPARAM) {
            const auto word = static_cast<DWORD>(wParam);
            EXPECT_EQ(HIWORD(word), 1);
            commands.push_back(LOWORD(word));
            if (onCommand) {
                onCommand();
            }
            return LRESULT{1};
        };
        handlers[WM_TIMER] = [this](HWND, WPARAM, LPARAM) {
            KillTimer(window, endTimer);
            PostQuitMessage(0);
            return LRESULT{0};
        };
    }

    void TearDown() override {
        DestroyWindow(dialog);
        WindowTest::TearDown();
    }

    /// Presses keys in the window with the keyboard once a loop runs.
    static void pressSoon(const std::vector<Press>& presses) {
        QTimer::singleShot(0, [presses] {
            if (QApplication::focusWindow() == nullptr) {
                pressSoon(presses);
                return;
            }
            for (const Press& one : presses) {
                const char text = one.held != Qt::NoModifier ? '\0' : QTest::keyToAscii(one.key);
                QTest::sendKeyEvent(QTest::Click, QApplication::focusWindow(), one.key, text,
                                    one.held);
            }
        });
    }

    /// Runs a loop for a moment in which the keys are pressed.
    void run(const std::vector<Press>& presses) const {
        pressSoon(presses);
        SetTimer(window, endTimer, clickTime, nullptr);
        const HACCEL table = LoadAcceleratorsA(nullptr, "BUTTONS");
        MSG message{};
        while (GetMessageA(&message, nullptr, 0, 0)) {
            if (TranslateAcceleratorA(window, table, &message) == 0) {
                DispatchMessageA(&message);
            }
        }
    }

    HWND dialog;
    std::vector<int> commands;
    std::function<void()> onCommand;
};

const Press altC{Qt::Key_C, Qt::AltModifier};      // of the table, and "&Cancel" in the dialog
const Press ctrlO{Qt::Key_O, Qt::ControlModifier}; // of the table

TEST_F(Accelerators, AreTakenWithJustTheirModifiersWhereverTheFocusIs) {
    char typed[8];
    run({altC,
         ctrlO,
         {Qt::Key_C, Qt::NoModifier},
         {Qt::Key_C, Qt::ControlModifier},
         {Qt::Key_E, Qt::AltModifier},
         {Qt::Key_E, Qt::ControlModifier},
         {Qt::Key_E, Qt::AltModifier | Qt::ControlModifier},
         {Qt::Key_C, Qt::AltModifier | Qt::ShiftModifier},
         {Qt::Key_O, Qt::AltModifier}}); // of the dialog alone: "&OK"
    EXPECT_EQ(commands, (std::vector<int>{124, 126, 128, 127}));
    EXPECT_EQ(dialogCommands, std::vector<int>{IDOK});
    GetDlgItemTextA(dialog, 10, typed, sizeof typed);
    EXPECT_STREQ(static_cast<const char*>(typed), "c");

    SetForegroundWindow(window);
    run({altC});
    EXPECT_EQ(commands.back(), 124) << "also in a window that isn't a dialog";
    EXPECT_EQ(commands.size(), 5U);
}

TEST_F(Accelerators, AreLeftToADialogWithinTheirLoopAndNoLonger) {
    onCommand = [&] {
        onCommand = nullptr;
        pressSoon({altC});
        EXPECT_EQ(DialogBoxParamA(nullptr, "controls", window, dialogProc, 0), IDCANCEL);
        SetForegroundWindow(dialog);
        pressSoon({ctrlO});
    };
    run({ctrlO});
    EXPECT_EQ(commands, (std::vector<int>{126, 126})) << "the outer loop still has them";
    EXPECT_EQ(dialogCommands, std::vector<int>{IDCANCEL});
}

TEST_F(Accelerators, AreReadAsAWholeOrNotAtAll) {
    const auto read = seam::parseAccelerators("# keys\n\nalt C 124 # one\nctrl 7\t65535");
    ASSERT_TRUE(read && read->size() == 2);
    EXPECT_EQ(read->at(0).key, (seam::KeyStroke{'C', seam::altHeld}));
    EXPECT_EQ(read->at(1).command, 65535);
    for (const char* wrong : {"C 124", "shift C 1", "alt CC 1", "alt c 1", "alt C 65536",
                              "alt C 1x", "alt C 1 2", "alt C -1", "alt C 1\nalt"}) {
        EXPECT_FALSE(seam::parseAccelerators(wrong)) << wrong;
    }
}

} // namespace
