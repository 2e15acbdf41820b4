#include "tests/stage/stage_fixture.h"

#include "platform/drawing_kit.h"
#include "platform/trace.h"
#include "stage/backdrop.h"
#include "stage/character.h"
#include "stage/editor_host.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/walk.h"
#include "toon/settings.h"

#include <algorithm>

std::vector<std::string> Record;
std::vector<std::string> HostCalls;
std::function<void()> OnShowDone;
DWORD RepaintFlag = 1;

// ---- The host -----------------------------------------------------------------------------------

HWND EditorDialog;

void SetPlayButton(int state) {
    HostCalls.push_back("SetPlayButton " + std::to_string(state));
    PlayIdle = state == PLAY_BUTTON_STOP ? 0 : 1;
}

void DisableButtons() {
    HostCalls.emplace_back("DisableButtons");
}

void RestoreButtons() {
    HostCalls.emplace_back("RestoreButtons");
}

void DrawProgress(HWND /*mainWindow*/) {}

void SetEditedPosition(LONG x, LONG y) {
    HostCalls.push_back("SetEditedPosition " + std::to_string(x) + " " + std::to_string(y));
}

// ---- The window ---------------------------------------------------------------------------------

static LRESULT stageProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    switch (message) {
    case WM_PAINT:
        return PaintStage(window, &RepaintFlag);
    case WM_ERASEBKGND:
        return 1;
    case WM_TIMER:
        StageTimerDispatch(window, wParam);
        return 0;
    case TM_WALKDONE:
        WalkDoneDispatch(window);
        return 0;
    case TM_SHOWDONE:
        if (OnShowDone) {
            OnShowDone();
        }
        return 0;
    default:
        return DefWindowProcA(window, message, wParam, lParam);
    }
}

static void keepLine(const char* line) {
    Record.emplace_back(line);
}

static const char* const className = "StageTestClass";

static void registerClass() {
    static bool done = false;
    if (!done) {
        WNDCLASSA windowClass = {};
        windowClass.lpfnWndProc = stageProc;
        windowClass.hInstance = GetModuleHandleA(nullptr);
        windowClass.lpszClassName = className;
        done = RegisterClassA(&windowClass) != 0;
    }
}

void StageTest::openStage(int width, int height) {
    if (stage) {
        closeStage();
    }
    StageSize = MAKELONG(width, height);
    const HINSTANCE instance = GetModuleHandleA(nullptr);
    stage = CreateWindowExA(0, className, "", WS_POPUP | WS_VISIBLE, 0, 0, width, height, nullptr,
                            nullptr, instance, nullptr);
    ASSERT_TRUE(stage);
    opened = seam::clockNow();
    TraceStart();
    LoadExpressionSheet(instance);
    TitleFont = MakeFont(32, 700, "MS Serif");
    BylineFont = MakeFont(20, 400, "MS Serif");
    LoadCharacterArt(stage, instance);
    RebuildBackdrop(stage, instance);
    UpdateWindow(stage);
    Record.clear();
}

void StageTest::closeStage() {
    DestroyWindow(stage);
    stage = nullptr;
    FrameStoreFree();
    FreeExpressionSheet();
    DeleteObject(TitleFont);
    DeleteObject(BylineFont);
    ReleaseStageArt();
    DeleteObject(BackdropBitmap);
    BackdropBitmap = nullptr;
}

static seam::HandleCounts baseline;

void StageTest::SetUp() {
    seam::useManualClock(1000);
    registerClass();
    baseline = seam::liveHandles();
    HostCalls.clear();
    OnShowDone = nullptr;
    EditorDialog = nullptr;
    TraceSink = keepLine;
    StageBegin();
    SaverActive = 1;
    PreviewMode = 0;
    OpeningDone = 1;
    TitleShown = 1;
    CaptionText[0] = '\0';
    BackgroundIndex = 0;
    Backgrounds = 1;
    PacesWalked = 0;
    RepaintFlag = 1;
    ToonDocHeader = {};
    FrameCount = 0;
    PlayFrame = {};
    ToonSpeed = 3;
    SeedRandom(1);
    openStage(1024, 768);
}

void StageTest::TearDown() {
    closeStage();
    TraceSink = nullptr;
    EXPECT_TRUE(seam::liveHandles() == baseline) << "a handle or timer was left behind";
}

void StageTest::openToon(const std::vector<ToonFrame>& frames) {
    FrameCount = static_cast<LONG>(frames.size());
    ASSERT_EQ(FrameStoreAlloc(FrameCount), 1);
    for (std::size_t index = 0; index < frames.size(); ++index) {
        FramePut(static_cast<LONG>(index), &frames[index]);
    }
    ToonDocHeader.windowSize = StageSize;
}

ToonFrame StageTest::frame(LONG x, LONG y, LONG pose, LONG pause, LONG wink, const char* text) {
    ToonFrame made = {x, y, pose, pause, wink, {}, 0};
    CopyText(made.text, text, sizeof(made.text));
    return made;
}

void StageTest::runTo(std::int64_t milliseconds) const {
    seam::runUntil(opened + milliseconds);
}

static std::string withoutTime(const std::string& line) {
    return line.substr(line.find(' ') + 1);
}

static bool isEvent(const std::string& line, const std::string& event) {
    return line == event || line.rfind(event + ' ', 0) == 0;
}

bool StageTest::runUntilEvent(const std::string& event) const {
    constexpr std::int64_t step = 10;
    constexpr std::int64_t patience = 120000;
    Record.clear();
    for (std::int64_t waited = 0; waited < patience; waited += step) {
        seam::runUntil(seam::clockNow() + step);
        if (count(event) != 0) {
            return true;
        }
    }
    return false;
}

std::vector<std::string> StageTest::events(const std::vector<std::string>& names) {
    std::vector<std::string> found;
    for (const std::string& line : Record) {
        const std::string event = withoutTime(line);
        if (std::any_of(names.begin(), names.end(),
                        [&](const std::string& name) { return isEvent(event, name); })) {
            found.push_back(event);
        }
    }
    return found;
}

int StageTest::count(const std::string& event) {
    return static_cast<int>(events({event}).size());
}

std::vector<DWORD> StageTest::pixels(RECT area) const {
    const seam::Picture picture = seam::windowPicture(stage);
    std::vector<DWORD> found;
    for (LONG y = area.top; y < area.bottom; ++y) {
        for (LONG x = area.left; x < area.right; ++x) {
            found.push_back(picture.pixels[static_cast<std::size_t>(y * picture.width + x)] &
                            0xFFFFFF);
        }
    }
    return found;
}
