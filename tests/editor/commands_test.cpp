// What can be pressed when, what each command does, and what drags the window.
#include "tests/editor/editor_fixture.h"

#include "platform/user/window.h"

#include <QAccessible>
#include <QTimer>
#include <QWidget>

namespace {

TEST_F(EditorTest, ButtonsLabelAndTimersAreThoseOfEachState) {
    openAtRest();
    EXPECT_EQ(stateNow(), "idle") << "no Toon is open";
    const std::string stop = "&Stop";
    for (const EditorState& state : editorStates) {
        reach(state.name);
        EXPECT_EQ(stateNow(), state.name);
        const DWORD pointer = SetClassLongA(EditorStage, GCL_HCURSOR, 0);
        EXPECT_EQ(pointer == DWORD{IDC_WAIT.number}, state.about != 0 || state.label == stop)
            << state.name;
        press(PlayButton);
        EXPECT_EQ(stateNow(), state.afterPlay) << state.name;
        // Only a walk to a frame stops when another window is active.
        reach(state.name);
        SendMessageA(EditorMainWindow, WM_ACTIVATE, WA_ACTIVE, 0);
        SendMessageA(EditorMainWindow, WM_ACTIVATE, WA_CLICKACTIVE, 0);
        EXPECT_EQ(stateNow(), state.name);
        SendMessageA(EditorMainWindow, WM_ACTIVATE, 0x10001, 0); // minimised
        EXPECT_EQ(stateNow(), std::string("to a frame") == state.name ? "held" : state.name);
    }
}

class Command : public EditorTest {
  protected:
    /// The one thing that the command does in a state; "" stands for an editor without a Toon.
    std::string effect(const std::string& state, int command) {
        close();
        state.empty() ? openAtRest() : reach(state);
        filesAsked = 0;
        fileGiven = "";
        boxes.clear();
        key(command);
        if (!EditorMainWindow || filesAsked != 0 || EditorDialog) {
            return !EditorMainWindow ? "closes" : filesAsked != 0 ? "asks" : "edits";
        }
        const std::string after = stateNow();
        return after == (state.empty() ? "idle" : state) ? "" : after;
    }
};

TEST_F(Command, AKeyDoesWhatItsButtonMayDoAndElseNothing) {
    const std::tuple<int, const char*, const char*> cases[] = {
        {KEY_PLAY, "to a frame", ""}, {KEY_CONTINUE, "to a frame", ""},
        {KEY_STOP, "to a frame", ""}, {KEY_OPEN, "asks", "asks"},
        {KEY_EDIT, "edits", "edits"}, {KEY_WALK, "about", "about"},
    };
    for (const auto& [command, withToon, withoutToon] : cases) {
        EXPECT_EQ(effect("idle", command), withToon) << command;
        EXPECT_EQ(effect("", command), withoutToon) << command;
        EXPECT_EQ(effect("about", command), "") << command;
    }
    EXPECT_EQ(effect("pause", KEY_OPEN), "") << "Stop shows: File can't be pressed";
    EXPECT_EQ(effect("held", KEY_WALK), "");
    for (const int editorsKey : {108, 128, 129, 130, 131, 132, 133, 134}) {
        EXPECT_EQ(effect("idle", editorsKey), "") << editorsKey;
    }
}

TEST_F(Command, AnItemOfTheMenuDoesWhatItSays) {
    EXPECT_EQ(effect("idle", POPUP_OPEN), "asks");
    EXPECT_EQ(effect("idle", POPUP_EDIT), "edits");
    EXPECT_EQ(effect("idle", POPUP_PLAY), "to a frame");
    EXPECT_EQ(effect("pause", POPUP_EXIT), "closes");
    EXPECT_EQ(effect("idle", POPUP_EXIT + 1), "");
}

TEST_F(EditorTest, OnlyOkClosesTheAboutBox) {
    openAtRest();
    int asked = 0;
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, [&] {
        seam::forEachWindow([&](const seam::Window& window) {
            if (window.dialog) {
                PostMessageA(window.handle, WM_COMMAND, ++asked == 1 ? IDCANCEL : IDOK, 0);
            }
        });
    });
    timer.start(0);
    key(5003);
    EXPECT_GE(asked, 2);
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

TEST_F(EditorTest, BarsAndCaptionDragTheWindowAndNothingElseDoes) {
    openAtRest();
    const LONG text = CaptionTextRect.left;
    const LONG end = CaptionTextRect.right;
    const std::tuple<LONG, LONG, LRESULT> cases[] = {
        {43, 10, HTNOWHERE},       {44, 10, HTCAPTION},       {100, 2, HTNOWHERE},
        {100, 3, HTCAPTION},       {100, 19, HTCAPTION},      {100, 20, HTNOWHERE},
        {text - 6, 10, HTCAPTION}, {text - 5, 10, HTNOWHERE}, {text, 2, HTCAPTION},
        {end - 1, 21, HTCAPTION},  {end, 10, HTNOWHERE},      {end + 5, 10, HTCAPTION},
        {726, 10, HTCAPTION},      {727, 10, HTNOWHERE},      {300, 740, HTNOWHERE},
    };
    for (const auto& [x, y, what] : cases) {
        RECT window{};
        GetWindowRect(EditorMainWindow, &window); // with a border of one pixel
        const auto point = static_cast<LPARAM>(MAKELONG(window.left + 1 + x, window.top + 1 + y));
        EXPECT_EQ(SendMessageA(EditorMainWindow, WM_NCHITTEST, 0, point), what) << x << ' ' << y;
    }
    EXPECT_EQ(SendMessageA(EditorStage, WM_NCHITTEST, 0, 0), HTCLIENT);
}

} // namespace
