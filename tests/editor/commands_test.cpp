// The editor's main window: what can be pressed when, what each command does, and how runs begin
// and end without leaving anything to the next.
#include "tests/editor/editor_fixture.h"

#include "stage/backdrop.h"
#include "stage/random_walk.h"

#include <QAccessible>
#include <QApplication>
#include <QMenu>
#include <QTest>

namespace {

// What each state leads to is held by the recorded scenes.
TEST_F(EditorTest, ButtonsAndLabelAreThoseOfEachState) {
    openAtRest();
    EXPECT_EQ(looks(), "&Play: FW") << "no Toon is open";
    for (const EditorState& state : editorStates) {
        reach(state.name);
        EXPECT_EQ(looks(), state.looks) << state.name;
        const bool waits = state.looks.find("Stop") != std::string::npos || RandomWalkActive != 0;
        EXPECT_EQ(SetClassLongA(EditorStage, GCL_HCURSOR, 0) == DWORD{IDC_WAIT.number}, waits)
            << state.name;
    }
}

TEST_F(EditorTest, CommandsDoWhatTheirButtonMayDoAndElseNothing) {
    // The state, "" for an editor without a Toon, the command, and how it looks then.
    const std::tuple<std::string, int, std::string> cases[] = {
        {"", KEY_PLAY, "&Play: FW"},
        {"", KEY_OPEN, "asks"},
        {"", KEY_EDIT, "edits"},
        {"", KEY_WALK, looksOf("about")},
        {"idle", KEY_SAVE, looksOf("idle")},
        {"idle", KEY_STOP, looksOf("to a frame")},
        {"pause", KEY_OPEN, looksOf("pause")},
        {"about", KEY_EDIT, looksOf("about")},
        {"idle", POPUP_OPEN, "asks"},
        {"idle", POPUP_EDIT, "edits"},
        {"idle", POPUP_PLAY, looksOf("to a frame")},
    };
    for (const auto& [state, command, then] : cases) {
        close();
        state.empty() ? openAtRest() : reach(state);
        filesAsked = 0;
        fileGiven = "";
        key(command);
        EXPECT_EQ(EditorDialog      ? "edits"
                  : filesAsked != 0 ? "asks"
                                    : looks(),
                  then)
            << state << ' ' << command;
    }
}

TEST_F(EditorTest, TheMenuStandsAboveTheFileButtonAndGreysWhatCantBeChosen) {
    openAtRest();
    fileGiven = "two.zkt";
    std::string items;
    const auto choose = [&items] {
        auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget());
        for (const QAction* item : menu->actions()) {
            items += item->isSeparator() ? "-" : item->isEnabled() ? "o" : ".";
        }
        EXPECT_EQ(menu->x(), 14 + 11);
        EXPECT_GE(783 - 44 - menu->y(), 6 * 12); // above the button
        menu->setActiveAction(menu->actions().first());
        QTest::keyClick(menu, Qt::Key_Return);
    };
    const auto menuStands = [] { return QApplication::activePopupWidget() != nullptr; };
    once(menuStands, choose);
    press(FileButton);
    once(menuStands, choose);
    key(KEY_FILE); // there is a Toon now
    EXPECT_EQ(items, "oo.-ooooo-oo");
    EXPECT_EQ(filesAsked, 2);
}

TEST_F(EditorTest, OnlyOkClosesTheAboutBox) {
    openAtRest();
    once(dialogStands, [] {
        QTest::keyClick(&widgetOf(modalDialog()), Qt::Key_Escape);
        QTimer::singleShot(10, [] {
            EXPECT_TRUE(dialogStands());
            QTest::keyClick(&widgetOf(modalDialog()), Qt::Key_Return);
        });
    });
    key(POPUP_ABOUT);
    EXPECT_FALSE(dialogStands());
}

TEST_F(EditorTest, ButtonsThatShowAPictureTellTheirNames) {
    openAtRest();
    std::string names;
    for (const HWND button : {FileButton, PlayButton, WalkButton, MinimizeButton, CloseButton}) {
        auto* heard = QAccessible::queryAccessibleInterface(&widgetOf(button));
        names += heard->text(QAccessible::Name).toStdString() + '|';
    }
    EXPECT_EQ(names, "File|Play|Walk about|Minimize|Close|");
}

TEST_F(EditorTest, OpeningWhatIsNoToonChangesNothing) {
    openAtRest();
    for (const char* name : {"", "missing.zkt", "none.zkt"}) {
        openToon(name);
        EXPECT_EQ(IsWindowEnabled(PlayButton), FALSE) << name;
        EXPECT_STREQ(ToonFileName, "") << name;
    }
    EXPECT_EQ(boxes.size(), 2U);
}

// ---- Runs ---------------------------------------------------------------------------------------

TEST_F(EditorTest, ARunEndsWithItsWindowHoweverThatGoes) {
    const std::tuple<HWND*, UINT, WPARAM> ways[] = {
        {&EditorMainWindow, WM_COMMAND, POPUP_EXIT},
        {&EditorStage, WM_CLOSE, 0},
        {&EditorMainWindow, WM_ENDSESSION, TRUE},
        {&EditorMainWindow, WM_CLOSE, 0}, // behind the about box
    };
    for (const auto& way : ways) {
        const auto [window, message, wParam] = way;
        once(editorStands, [&way, behindBox = message == WM_CLOSE && window == &EditorMainWindow] {
            PostMessageA(EditorMainWindow, WM_COMMAND, behindBox ? POPUP_ABOUT : 0, 0);
            once(behindBox ? dialogStands : editorStands, [&way] {
                PostMessageA(*std::get<0>(way), std::get<1>(way), std::get<2>(way), 0);
            });
        });
        EXPECT_EQ(runEditor(), 0);
        expectClosed(std::to_string(message));
    }
}

TEST_F(EditorTest, ClosedInAnyStateItsStageBeginsClean) {
    for (const EditorState& state : editorStates) {
        reach(state.name);
        press(CloseButton);
        expectClosed(state.name);
        open();
        EXPECT_EQ(looks(), "&Play: FW") << state.name;
        EXPECT_EQ(SetClassLongA(EditorStage, GCL_HCURSOR, 0), IDC_ARROW.number) << state.name;
        EXPECT_STREQ(ToonFileName, "");
        EXPECT_STREQ(CaptionText, "Fenky Dorbo's Rematch");
        EXPECT_EQ(FrameCount, 1);
        EXPECT_EQ(CurrentFrameIndex + BackgroundIndex, 0);
    }
}

} // namespace
