#include "tests/editor/editor_fixture.h"

#include "platform/kernel.h"
#include "platform/user/controls/control.h"
#include "platform/user/window.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "toon/settings.h"

#include <QCoreApplication>
#include <QMouseEvent>
#include <QTest>
#include <QTimer>
#include <QWidget>
#include <QWindow>

#include <fstream>
#include <sstream>

static constexpr NextFrame none = NextFrame::none;
static constexpr NextFrame behind = NextFrame::behind;
static constexpr NextFrame at = NextFrame::at;

// "Held" is a walk that was stopped, "stands" a frame without a pause.
const std::vector<EditorState> editorStates = {
    {"idle", 0, 0, 1, none, 0, "&Play", {}, "FPW", "to a frame"},
    {"to a frame", 1, 1, 0, behind, 0, "&Stop", {"WALK"}, "P", "held"},
    {"held", 1, 1, 1, behind, 0, "&Continue", {}, "FP", "to a frame"},
    {"half", 1, 0, 0, behind, 0, "&Stop", {"ARRIVAL"}, "P", "at frame"},
    {"pause", 1, 0, 0, behind, 0, "&Stop", {"PAUSE"}, "P", "at frame"},
    {"stands", 1, 0, 0, behind, 0, "&Stop", {}, "P", "at frame"},
    {"at frame", 1, 0, 1, at, 0, "&Continue", {}, "FP", "to a frame"},
    {"off", 0, 0, 1, none, 0, "&Stop", {"WALK"}, "FPW", "off"},
    {"to a click", 0, 0, 1, none, 0, "&Play", {"WALK"}, "FPW", "to a click"},
    {"about", 0, 0, 1, none, 1, "&Play", {"WALK"}, "", "about"},
    {"half about", 0, 0, 1, none, 1, "&Play", {"ARRIVAL"}, "", "half about"},
    {"pause about", 0, 0, 1, none, 1, "&Play", {"PAUSE"}, "", "pause about"},
};

static std::set<std::string> running; // timers, by the record
static bool playCame;                 // a Toon has been opened, so that Play is alive

static void follow(const std::string& line) {
    std::istringstream words(line);
    std::string time, event, timer;
    words >> time >> event >> timer;
    timer.erase(0, timer.find('=') + 1);
    if (event == "timer_set") {
        running.insert(timer);
    } else if (event == "timer_kill") {
        running.erase(timer);
    }
    playCame = playCame || event == "load";
}

void once(const std::function<bool()>& stands, const std::function<void()>& act) {
    QTimer::singleShot(0, [stands, act] { stands() ? act() : once(stands, act); });
}

bool editorStands() {
    return EditorStage != HWND{};
}

/// As in the program: the first run does.
static void setUpClasses() {
    static bool done = false;
    if (!done) {
        once(editorStands, [] { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); });
        RunEditor(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL);
        done = true;
    }
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
    setUpClasses();
    RecordedStage::SetUp();
    TraceSink = [](const char* line) {
        record.emplace_back(line);
        follow(record.back());
    };
}

void EditorTest::TearDown() {
    close();
    RecordedStage::TearDown();
    seam::answerBoxes(nullptr);
    seam::answerFileDialogs(nullptr);
    ground_.reset();
}

void EditorTest::putToons() const {
    putToon("two.zkt", {{200, 300, 1, 2, 0, "One", 0}, {300, 300, 2, 2, 1, "Two and more", 0}});
    putToon("one.zkt", {{600, 400, 3, 1, 1, "", 0}});
    putToon("still.zkt", {{400, 400, 3, 0, 0, "", 0}, {500, 500, 3, 1, 0, "", 0}});
    std::ofstream(toons() / "none.zkt") << "no Toon";
}

void EditorTest::open() {
    running.clear();
    playCame = false;
    ASSERT_EQ(CreateEditorWindows(GetModuleHandleA(nullptr), SW_SHOWNORMAL), 1);
    stage = EditorStage;
    pass(0);
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
    static const std::map<std::string, std::string> events = {
        {"half", "timer_set timer=ARRIVAL"},
        {"pause", "timer_set timer=PAUSE"},
        {"half about", "timer_set timer=ARRIVAL"},
        {"pause about", "timer_set timer=PAUSE"},
        {"at frame", "timer_set timer=PAUSE"},
        {"off", "walk_off"},
        {"stands", "walk_done"},
    };
    close();
    openAtRest();
    openToon(state == "stands" ? "still.zkt" : "two.zkt");
    if (state == "to a click") {
        click(300, 200);
    } else if (state != "idle") {
        press(state.find("about") != std::string::npos ? WalkButton : PlayButton);
    }
    if (events.contains(state)) {
        runUntilEvent(events.at(state));
    }
    if (state == "held" || state == "at frame") {
        press(PlayButton);
    }
}

static std::string enabledButtons() {
    std::string enabled;
    enabled += IsWindowEnabled(FileButton) != FALSE ? "F" : "";
    enabled += IsWindowEnabled(PlayButton) != FALSE ? "P" : "";
    enabled += IsWindowEnabled(WalkButton) != FALSE ? "W" : "";
    EXPECT_EQ(IsWindowEnabled(MinimizeButton), IsWindowEnabled(WalkButton));
    EXPECT_NE(IsWindowEnabled(CloseButton), FALSE);
    return enabled;
}

static bool fits(const EditorState& state) {
    std::set<std::string> timers = running;
    timers.erase("OPENING");
    if (state.timers.contains("PAUSE")) {
        timers.erase("TALK");
    }
    std::string enabled = state.enabled;
    if (!playCame) {
        std::erase(enabled, 'P');
    }
    const LONG lowest = state.next == behind ? 1 : 0;
    const LONG highest = state.next == none ? 0 : state.next == at ? FrameCount - 1 : FrameCount;
    return ShowStarted == state.showStarted && AwaitingArrival == state.awaitingArrival &&
           PlayIdle == state.playIdle && NextFrameIndex >= lowest && NextFrameIndex <= highest &&
           RandomWalkActive == state.about && timers == state.timers && enabled == enabledButtons();
}

void EditorTest::playIsAlive(bool alive) {
    playCame = alive;
}

static std::string label() {
    return seam::findWindow(PlayButton)->control->text();
}

std::string EditorTest::stateNow() {
    for (const EditorState& state : editorStates) {
        if (fits(state) && label() == state.label) {
            return state.name;
        }
    }
    std::ostringstream found;
    found << "started " << ShowStarted << " awaiting " << AwaitingArrival << " idle " << PlayIdle
          << " next " << NextFrameIndex << " about " << RandomWalkActive << ' ' << label() << ' '
          << enabledButtons() << testing::PrintToString(running);
    return found.str();
}

QWidget& widgetOf(HWND window) {
    return seam::widgetOf(*seam::findWindow(window));
}

void sendMouse(HWND window, QEvent::Type type, QPoint point) {
    const auto held = type == QEvent::MouseButtonRelease ? Qt::NoButton : Qt::LeftButton;
    auto* target = seam::toolkitWindow(*seam::findWindow(window));
    QMouseEvent event(type, point, target->mapToGlobal(point), Qt::LeftButton, held,
                      Qt::NoModifier);
    QCoreApplication::sendEvent(target, &event);
}

void EditorTest::press(HWND button) {
    QTest::mouseClick(&widgetOf(button), Qt::LeftButton);
    pass(0);
}

void EditorTest::click(int x, int y) {
    sendMouse(EditorStage, QEvent::MouseButtonPress, QPoint(x, y));
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
