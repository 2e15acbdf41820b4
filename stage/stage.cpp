#include "stage/stage.h"

#include "platform/trace.h"
#include "stage/bubble.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/walk.h"
#include "toon/toon_document.h"

DWORD SaverActive;
DWORD PreviewMode;

const char* StageTimerName(UINT_PTR timer) {
    switch (timer) {
    case TIMER_OPENING:
        return "OPENING";
    case TIMER_ARRIVAL:
        return "ARRIVAL";
    case TIMER_PAUSE:
        return "PAUSE";
    case TIMER_TALK:
        return "TALK";
    case TIMER_SHOWSTART:
        return "SHOWSTART";
    case TIMER_WALK:
        return "WALK";
    default:
        return nullptr;
    }
}

LONG OffStageSide(HWND stage, LONG x) {
    RECT client = {};
    GetClientRect(stage, &client);
    return OffStageX(client.right, x);
}

void StageBegin() {
    TraceTimerName = StageTimerName;
    WalkTimerRunning = 0;
    WalkStepIndex = 0;
    NextFrameIndex = 0;
    ShowStarted = 0;
    WalkingOff = 0;
    AwaitingArrival = 0;
    PlayIdle = 1;
    PendingPause = 0;
    PendingText[0] = '\0';
    Talking = 0;
    BubbleHidden = 1;
    RandomWalkActive = 0;
    WalkingOut = 0;
    ToonDocHeader.windowSize = 0; // no Toon is in memory that a walk about would be scaled by
}

void SendShowDone(HWND stage) {
    Trace("show_done");
    SendMessageA(stage, TM_SHOWDONE, 0, 0);
}
