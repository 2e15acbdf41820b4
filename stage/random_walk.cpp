#include "stage/random_walk.h"

#include "platform/kernel.h"
#include "platform/trace.h"
#include "stage/bubble.h"
#include "stage/character.h"
#include "stage/editor_host.h"
#include "stage/player.h"
#include "stage/stage.h"
#include "stage/walk.h"
#include "toon/settings.h"

#include <algorithm>
#include <random>

ToonFrame WalkFrame;
DWORD RandomWalkActive;
DWORD WalkingOut;
DWORD OpeningDone;
LONG PreviousStatement;

static std::mt19937 Generator;

static constexpr LONG EDGE_MARGIN = 100;

void SeedRandom(DWORD seed) {
    Generator.seed(seed);
}

LONG RandomInt(LONG low, LONG high) {
    constexpr unsigned surplusBits = 32 - 15;
    constexpr LONG divisor = 10;
    if (low > high || low > RANDOM_HIGHEST || high < 0) {
        return low;
    }
    LONG value = 0;
    do {
        value = static_cast<LONG>(Generator() >> surplusBits) / divisor;
    } while (value < low || value > high);
    return value;
}

/// Both coordinates move the same way from the middle: to its lower right or its upper left.
static void PickPlace(HWND stage) {
    RECT client = {};
    GetClientRect(stage, &client);
    const LONG x = std::max<LONG>(client.right / 2 - EDGE_MARGIN, 1);
    const LONG y = std::max<LONG>(client.bottom / 2 - EDGE_MARGIN, 1);
    if (RandomInt(1, 100) < 50) {
        WalkFrame.x = x + RandomInt(1, x);
        WalkFrame.y = y + RandomInt(1, y);
    } else {
        WalkFrame.x = x - RandomInt(1, x);
        WalkFrame.y = y - RandomInt(1, y);
    }
}

/// The paces come in 4 of 100 walks, also where the table is switched off; nothing is said twice in
/// a row.
static LONG PickStatement(DWORD allowStatements) {
    if (RandomInt(1, 100) < 5 && PreviousStatement != STATEMENT_PACES) {
        return STATEMENT_PACES;
    }
    if (allowStatements == 0) {
        return STATEMENT_NONE;
    }
    LONG statement = 0;
    do {
        statement = RandomInt(FIRST_STATEMENT, LastStatementId);
    } while (statement == PreviousStatement);
    return statement;
}

static void BeginRandomWalk(HWND stage, LONG statement) {
    Trace("random_walk target=[%d,%d] pose=%d wink=%d statement=%d", WalkFrame.x, WalkFrame.y,
          WalkFrame.pose, WalkFrame.wink, statement);
    if (PrepareRandomWalk(stage, statement) != 0) {
        WalkToRandomFrame(stage);
    }
}

static int RefuseRandomWalk() {
    Trace("random_walk_refused");
    return 0;
}

int PickRandomWalk(HWND stage, DWORD allowStatements) {
    constexpr LONG secondsOfPause = 5;
    if (ShowUnderWay() || EditorDialog || WalkTimerRunning != 0) {
        return RefuseRandomWalk();
    }
    PickPlace(stage);
    WalkFrame.pose = RandomInt(0, 7);
    WalkFrame.pause = secondsOfPause;
    WalkFrame.wink = RandomInt(0, 100) < 25 ? 1 : 0;
    PreviousStatement = PickStatement(allowStatements);
    BeginRandomWalk(stage, PreviousStatement);
    return 1;
}

static void FillStatement(HINSTANCE instance, LONG statement) {
    if (statement == STATEMENT_PACES) {
        BuildPacesStatement();
    } else if (statement <= STATEMENT_NONE) {
        WalkFrame.text[0] = '\0';
    } else {
        LoadStringA(instance, static_cast<UINT>(statement), WalkFrame.text, sizeof(WalkFrame.text));
    }
}

int PrepareRandomWalk(HWND stage, LONG statement) {
    if (RandomWalkActive != 0) {
        return RefuseRandomWalk();
    }
    const HINSTANCE instance = WindowInstance(stage);
    if (CharacterArtLoaded == 0) {
        LoadCharacterArt(stage, instance);
    }
    FillStatement(instance, statement);
    SetBusyCursor(stage, 1);
    DisableButtons();
    CharacterX = OffStageSide(stage, WalkFrame.x);
    CharacterY = WalkFrame.y;
    PlaceCharacterOffStage(stage, CharacterX, CharacterY);
    WalkingOut = 0;
    BubbleHidden = 1;
    return 1;
}

void BuildPacesStatement() {
    wsprintfA(WalkFrame.text, "Since starting here, I've walked a total of %u Paces!!",
              PacesWalked);
}

int WalkToRandomFrame(HWND stage) {
    POINT target = {WalkFrame.x, WalkFrame.y};
    ScaleToStage(stage, &target);
    WalkTo(stage, CharacterX, CharacterY, target.x, target.y, WalkFrame.pose);
    RandomWalkActive = 1;
    CharacterX = target.x;
    CharacterY = target.y;
    return 1;
}

void RandomPauseOver(HWND stage) {
    if (BubbleHidden == 0) {
        ArrivalPause(stage, nullptr, 0);
    }
    if (WalkingOut == 0) {
        WalkFrame.x = OffStageSide(stage, WalkFrame.x);
        WalkToRandomFrame(stage);
    }
    WalkingOut = 1;
}

void RandomWalkArrived(HWND stage) {
    if (WalkingOut == 0) {
        ArrivalPause(stage, WalkFrame.text, WalkFrame.pause);
        return;
    }
    RandomWalkActive = 0;
    WalkingOut = 0;
    SetBusyCursor(stage, 0);
    RestoreButtons();
    SendShowDone(stage);
}

void EndRandomWalk() {
    RandomWalkActive = 0;
    WalkingOut = 0;
}

void FinishOpening(HWND stage) {
    if (WalkingOut == 0) {
        return;
    }
    OpeningDone = 1;
    // Meant: RandomWalkActive still stands, so that a walk asked for by the handler is turned away
    // by PrepareRandomWalk; it is the second message, of RandomWalkArrived, that starts the next.
    SendShowDone(stage);
    InvalidateRect(stage, nullptr, FALSE);
    Trace("invalidate");
}

static void SetFixedWalk(LONG x, LONG y, LONG pause) {
    constexpr LONG pose = 6;
    WalkFrame.x = x;
    WalkFrame.y = y;
    WalkFrame.pose = pose;
    WalkFrame.wink = 1;
    WalkFrame.pause = pause;
}

static bool FirstWalkRefused() {
    return OpeningDone != 0 || ShowUnderWay() || RandomWalkActive != 0 || WalkTimerRunning != 0;
}

int StartOpeningWalk(HWND stage) {
    constexpr LONG secondsOfPause = 7;
    if (FirstWalkRefused()) {
        return RefuseRandomWalk();
    }
    RECT client = {};
    GetClientRect(stage, &client);
    SetFixedWalk(client.right / 2 - EDGE_MARGIN, client.bottom / 2, secondsOfPause);
    BeginRandomWalk(stage, STATEMENT_PACES);
    return 1;
}

int StartPreviewWalk(HWND stage) {
    constexpr LONG secondsOfPause = 3;
    constexpr LONG nearLeftEdge = 10;
    if (FirstWalkRefused()) {
        return RefuseRandomWalk();
    }
    SetFixedWalk(nearLeftEdge, 0, secondsOfPause);
    BeginRandomWalk(stage, STATEMENT_NONE);
    return 1;
}
