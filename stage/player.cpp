#include "stage/player.h"

#include "platform/trace.h"
#include "stage/bubble.h"
#include "stage/character.h"
#include "stage/editor_host.h"
#include "stage/face.h"
#include "stage/random_walk.h"
#include "stage/stage.h"
#include "stage/walk.h"

#include <algorithm>
#include <cstdint>
#include <limits>

LONG NextFrameIndex;
DWORD ShowStarted;
DWORD WalkingOff;
DWORD AwaitingArrival;
DWORD PlayIdle = 1;
LONG PendingPause;
char PendingText[TOON_TEXT_SIZE];
LONG CharacterX;
LONG CharacterY;
ToonFrame PlayFrame;

static constexpr UINT ARRIVAL_INTERVAL = 500; // ms
static constexpr LONG WALK_OFF_POSE = 0;
static constexpr LONG CLICK_POSE = 0;

void EnterShow(HWND stage) {
    NextFrameIndex = 0;
    FrameGet(0, &PlayFrame);
    // Meant: the place is taken as recorded, neither scaled nor turned from centre to corner.
    CharacterY = PlayFrame.y;
    CharacterX = OffStageSide(stage, PlayFrame.x);
    PlaceCharacterOffStage(stage, CharacterX, CharacterY);
    ShowStarted = 1;
}

int WalkToNextFrame(HWND stage) {
    if (FrameGet(NextFrameIndex, &PlayFrame) == 0) {
        return 0;
    }
    POINT target = {WrapSubtract(PlayFrame.x, CharacterSprite.cx / 2),
                    WrapSubtract(PlayFrame.y, CharacterSprite.cy / 2)};
    ScaleToStage(stage, &target);
    Trace("frame index=%d target=[%d,%d]", NextFrameIndex, target.x, target.y);
    WalkTo(stage, CharacterX, CharacterY, target.x, target.y, PlayFrame.pose);
    CharacterX = target.x;
    CharacterY = target.y;
    CurrentFrameIndex = NextFrameIndex;
    ++NextFrameIndex;
    return 1;
}

UINT_PTR WalkOffStage(HWND stage) {
    // Meant: the nearer side is that of his corner, not of his middle.
    const LONG targetX = OffStageSide(stage, CharacterX);
    Trace("walk_off target=[%d,%d]", targetX, CharacterY);
    const UINT_PTR begun =
        WalkTo(stage, CharacterX, CharacterY, targetX, CharacterY, WALK_OFF_POSE);
    NextFrameIndex = 0;
    ShowStarted = 0;
    WalkingOff = 1;
    AwaitingArrival = 0;
    PlayIdle = 1;
    return begun;
}

void PlayNextFrame(HWND stage) {
    if (BubbleHidden == 0) {
        AwaitingArrival = 1;
    }
    if (ShowStarted == 0) {
        EnterShow(stage);
        AwaitingArrival = 1;
        DisableButtons(); // reads AwaitingArrival
    }
    if (NextFrameIndex != FrameCount) {
        SetPlayButton(PLAY_BUTTON_STOP);
        WalkToNextFrame(stage);
    } else {
        WalkOffStage(stage);
        RestoreButtons();
    }
    ArrivalPause(stage, nullptr, 0);
}

void FrameArrival(HWND stage) {
    if (AwaitingArrival == 1) {
        AwaitingArrival = 0;
        ArrivalPause(stage, PlayFrame.text, PlayFrame.pause);
        return;
    }
    WalkingOff = 0;
    SetBusyCursor(stage, 0);
    SetPlayButton(PLAY_BUTTON_PLAY);
    SendShowDone(stage);
}

static void CancelPause(HWND stage) {
    if (PendingText[0] != '\0') {
        HideBubble(stage);
    }
    PendingText[0] = '\0';
    StopTalking(stage);
    KillTimer(stage, TIMER_PAUSE);
}

/// A pause that a file asks for can be longer than a timer takes.
static UINT PauseMilliseconds(LONG seconds) {
    constexpr std::int64_t second = 1000;
    constexpr std::int64_t longest = std::numeric_limits<LONG>::max();
    return static_cast<UINT>(std::min(seconds * second, longest));
}

static void BeginPause(HWND stage) {
    ShowExpression(stage, EXPRESSION_EYES_OPEN);
    StartTalking(stage);
    KillTimer(stage, TIMER_ARRIVAL);
    SetTimer(stage, TIMER_PAUSE, PauseMilliseconds(PendingPause), nullptr);
    PendingPause = 0;
    if (PendingText[0] != '\0') {
        PlaceBubble(stage);
        ShowBubble(stage, PendingText);
    }
    BubbleHidden = 0;
}

static void BeginArrival(HWND stage, const char* text, LONG seconds) {
    ShowExpression(stage, EXPRESSION_EYES_SHUT);
    PendingPause = seconds;
    SetTimer(stage, TIMER_ARRIVAL, ARRIVAL_INTERVAL, nullptr);
    CopyText(PendingText, text != nullptr ? text : "", sizeof(PendingText));
}

void ArrivalPause(HWND stage, const char* text, LONG seconds) {
    // Meant: a frame without a pause comes here as a cancelling call, and the show stands for good.
    if (seconds == 0) {
        CancelPause(stage);
    } else if (PendingPause != 0) {
        BeginPause(stage);
    } else if (seconds > 0) {
        BeginArrival(stage, text, seconds);
    }
}

void CancelArrival(HWND stage) {
    KillTimer(stage, TIMER_ARRIVAL);
    PendingPause = 0;
    ArrivalPause(stage, nullptr, 0);
}

void ResetShow(HWND stage) {
    if (CharacterArtLoaded == 0) {
        return;
    }
    StopWalkTimer(stage);
    CancelArrival(stage);
    if (BubbleHidden == 0) {
        HideBubble(stage);
    }
    EnterShow(stage);
    SetPlayButton(PLAY_BUTTON_PLAY);
    ShowStarted = 0;
    WalkingOff = 0;
    AwaitingArrival = 0;
}

bool ShowUnderWay() {
    return NextFrameIndex != 0 || ShowStarted != 0 || WalkingOff != 0;
}

LONG PlayProgress(LONG range) {
    const std::int64_t walked = static_cast<std::int64_t>(range) * NextFrameIndex;
    return static_cast<LONG>(walked / std::max<LONG>(FrameCount, 1));
}

void SetBusyCursor(HWND stage, BOOL busy) {
    if (SaverActive != 0) {
        return;
    }
    const HCURSOR cursor = LoadCursorA(nullptr, busy != 0 ? IDC_WAIT : IDC_ARROW);
    SetClassLongA(stage, GCL_HCURSOR, static_cast<LONG>(cursor.number));
    // The pointer takes its new shape when it moves, even to where it is.
    POINT position = {};
    GetCursorPos(&position);
    SetCursorPos(position.x, position.y);
}

void StageTimerDispatch(HWND stage, UINT_PTR timer) {
    switch (timer) {
    case TIMER_ARRIVAL:
        ArrivalPause(stage, nullptr, -1);
        break;
    case TIMER_PAUSE:
        if (RandomWalkActive != 0) {
            RandomPauseOver(stage);
        } else {
            PlayNextFrame(stage);
        }
        break;
    case TIMER_TALK:
        TalkTick(stage);
        break;
    case TIMER_WALK:
        WalkStep(stage);
        break;
    default:
        break;
    }
}

void WalkDoneDispatch(HWND stage) {
    if (OpeningDone == 0) {
        FinishOpening(stage);
    }
    if (RandomWalkActive != 0) {
        RandomWalkArrived(stage);
    } else {
        FrameArrival(stage);
    }
}

static POINT ClickPoint(LPARAM coordinates) {
    const auto packed = static_cast<DWORD>(coordinates);
    return {static_cast<std::int16_t>(LOWORD(packed)), static_cast<std::int16_t>(HIWORD(packed))};
}

LRESULT StageClick(HWND stage, LPARAM coordinates) {
    if (!EditorDialog && (ShowUnderWay() || RandomWalkActive != 0)) {
        return 0;
    }
    const POINT click = ClickPoint(coordinates);
    if (SpriteHitTest(&CharacterSprite, click) != 0) {
        return 0;
    }
    if (EditorDialog) {
        FrameFromClick(click.x, click.y);
        return 0;
    }
    WalkTo(stage, CharacterSprite.drawX, CharacterSprite.drawY, click.x - CharacterSprite.cx / 2,
           click.y - CharacterSprite.cy / 2, CLICK_POSE);
    return 0;
}
