#include "tests/editor/editor_fixture.h"

#include "platform/kernel.h"
#include "platform/user/controls/control.h"
#include "platform/user/window.h"
#include "stage/editor_host.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "toon/settings.h"

#include <QTest>
#include <QWidget>
#include <QWindow>

#include <fstream>
#include <utility>

// "Held" is a walk that was stopped, "stands" a frame without a pause.
const std::vector<EditorState> editorStates = {
    {"idle", "", "&Play: FPW"},
    {"to a frame", "", "show, arriving, busy, &Stop: P"},
    {"held", "", "show, arriving, &Continue: FP"},
    {"half", "timer_set timer=ARRIVAL", "show, busy, &Stop: P"},
    {"pause", "timer_set timer=PAUSE", "show, busy, &Stop: P"},
    {"stands", "walk_done", "show, busy, &Stop: P"},
    {"at frame", "timer_set timer=PAUSE", "show, &Continue: FP"},
    {"off", "walk_off", "&Stop: FPW"},
    {"to a click", "", "&Play: FPW"},
    {"about", "", "about, &Play: "},
    {"half about", "timer_set timer=ARRIVAL", "about, &Play: "},
    {"pause about", "timer_set timer=PAUSE", "about, &Play: "},
};

bool editorStands() {
    return EditorStage != HWND{};
}

HWND modalDialog() {
    HWND found;
    seam::forEachWindow([&found](const seam::Window& window) {
        found = window.dialog && window.handle != EditorDialog ? window.handle : found;
    });
    return found;
}

bool dialogStands() {
    return modalDialog() != HWND{};
}

void EditorTest::SetUp() {
    ground_ = std::make_unique<ReplayGround>();
    ForgetEarlierStages();
    PacesWalked = 100;
    SettingsSave();
    putToons();
    filesAsked = 0;
    fileGiven = nameGiven = "";
    answerGiven = IDCANCEL;
    boxes.clear();
    seam::answerBoxes([](const std::string& text, const std::string&, UINT type) {
        boxes.push_back(text);
        return (type & MB_YESNOCANCEL) == MB_YESNOCANCEL ? answerGiven : IDOK;
    });
    seam::answerFileDialogs([](const std::string& title) {
        ++filesAsked;
        const std::string& name = title == "Save Toon File" ? nameGiven : fileGiven;
        return name.empty() ? std::nullopt : std::optional(name);
    });
    static bool classes = false;
    if (!std::exchange(classes, true)) { // as in the program: the first run sets them up
        once(editorStands, [] { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); });
        runEditor();
    }
    RecordedStage::SetUp();
}

void EditorTest::TearDown() {
    close();
    RecordedStage::TearDown();
    seam::answerBoxes(nullptr);
    seam::answerFileDialogs(nullptr);
    ground_.reset();
}

void EditorTest::putToons() {
    putToon("two.zkt", {{200, 300, 1, 2, 0, "One", 0}, {300, 300, 2, 2, 1, "Two and more", 0}});
    putToon("one.zkt", {{600, 400, 3, 1, 1, "", 0}});
    putToon("still.zkt", {{400, 400, 3, 0, 0, "", 0}, {500, 500, 3, 1, 0, "", 0}});
    std::ofstream("none.zkt") << "no Toon";
}

void EditorTest::open() {
    ASSERT_EQ(CreateEditorWindows(GetModuleHandleA(nullptr), SW_SHOWNORMAL), 1);
    stage = EditorStage;
    pass(0);
}

int EditorTest::runEditor() {
    return RunEditor(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL);
}

void EditorTest::openAtRest() {
    constexpr std::int64_t openingWalk = 20'000;
    open();
    pass(openingWalk);
}

void EditorTest::close() {
    DestroyWindow(EditorMainWindow);
    pass(0); // takes the quit
}

void EditorTest::reach(const std::string& state) {
    close();
    openAtRest();
    openToon(state == "stands" ? "still.zkt" : "two.zkt");
    if (state == "to a click") {
        click(300, 200);
    } else if (state != "idle") {
        press(state.find("about") != std::string::npos ? WalkButton : PlayButton);
    }
    const std::string& event = std::ranges::find(editorStates, state, &EditorState::name)->event;
    if (!event.empty()) {
        runUntilEvent(event);
    }
    if (state == "held" || state == "at frame") {
        press(PlayButton);
    }
}

std::string EditorTest::looks() {
    std::string now = ShowStarted != 0 ? "show, " : "";
    now += AwaitingArrival != 0 ? "arriving, " : "";
    now += PlayIdle != 0 ? "" : "busy, ";
    now += RandomWalkActive != 0 ? "about, " : "";
    now += NextFrameIndex > (ShowStarted != 0 ? FrameCount : 0) ? "beyond its frames, " : "";
    now += seam::findWindow(PlayButton)->control->text() + ": ";
    now += IsWindowEnabled(FileButton) != FALSE ? "F" : "";
    now += IsWindowEnabled(PlayButton) != FALSE ? "P" : "";
    now += IsWindowEnabled(WalkButton) != FALSE ? "W" : "";
    EXPECT_EQ(IsWindowEnabled(MinimizeButton), IsWindowEnabled(WalkButton));
    EXPECT_NE(IsWindowEnabled(CloseButton), FALSE);
    return now;
}

std::string EditorTest::looksOf(const std::string& state) {
    return std::ranges::find(editorStates, state, &EditorState::name)->looks;
}

void EditorTest::expectClosed(const std::string& how) {
    MSG message{};
    EXPECT_FALSE(EditorMainWindow || EditorStage || EditorDialog) << how;
    EXPECT_FALSE(PeekMessageA(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE)) << how;
}

QWidget& widgetOf(HWND window) {
    return seam::widgetOf(*seam::findWindow(window));
}

QWindow* toolkitWindowOf(HWND window) {
    return seam::toolkitWindow(*seam::findWindow(window));
}

void EditorTest::press(HWND button) {
    QTest::mouseClick(&widgetOf(button), Qt::LeftButton);
    pass(0);
}

void EditorTest::click(int x, int y) {
    QTest::mousePress(toolkitWindowOf(EditorStage), Qt::LeftButton, {}, {x, y});
    pass(0);
}

void EditorTest::key(int command) {
    PostMessageA(EditorMainWindow, WM_COMMAND, static_cast<WPARAM>(MAKELONG(command, 1)), 0);
    pass(0);
}

void EditorTest::openToon(const std::string& name) {
    fileGiven = name;
    key(KEY_OPEN);
}
