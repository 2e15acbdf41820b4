#include "tests/stage/stage_fixture.h"

#include "platform/drawing_kit.h"
#include "stage/backdrop.h"
#include "stage/character.h"
#include "stage/editor_host.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/walk.h"
#include "toon/settings.h"

std::vector<std::string> HostCalls;
DWORD RepaintFlag = 1;

HWND EditorStage;
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

void FrameFromClick(LONG x, LONG y) {
    HostCalls.push_back("FrameFromClick " + std::to_string(x) + " " + std::to_string(y));
}

static const char* const className = "StageTestClass";

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
    default:
        return DefWindowProcA(window, message, wParam, lParam);
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
    LoadExpressionSheet(instance);
    TitleFont = MakeFont(32, 700, "MS Serif");
    BylineFont = MakeFont(20, 400, "MS Serif");
    LoadCharacterArt(stage, instance);
    RebuildBackdrop(stage, instance);
    UpdateWindow(stage);
    record.clear();
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

void StageTest::SetUp() {
    RecordedStage::SetUp();
    WNDCLASSA windowClass = {};
    windowClass.lpfnWndProc = stageProc;
    windowClass.lpszClassName = className;
    RegisterClassA(&windowClass); // refused, and none the worse, from the second test on
    HostCalls.clear();
    EditorDialog = nullptr;
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
    openStage();
}

void StageTest::TearDown() {
    closeStage();
    RecordedStage::TearDown();
}

void StageTest::openToon(const std::vector<ToonFrame>& frames) {
    FrameCount = static_cast<LONG>(frames.size());
    ASSERT_EQ(FrameStoreAlloc(FrameCount), 1);
    for (LONG index = 0; index < FrameCount; ++index) {
        FramePut(index, &frames[static_cast<std::size_t>(index)]);
    }
    ToonDocHeader.windowSize = StageSize;
}

void StageTest::stand(LONG x, LONG y) {
    CharacterSprite.x = CharacterSprite.drawX = x;
    CharacterSprite.y = CharacterSprite.drawY = y;
}

void StageTest::repaint() const {
    InvalidateRect(stage, nullptr, FALSE);
    UpdateWindow(stage);
}
