#include "stage/play_command.h"

#include "stage/character.h"
#include "stage/editor_host.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/walk.h"
#include "toon/toon_document.h"

static void ShowStopped(HWND stage) {
    SetBusyCursor(stage, 0);
    SetPlayButton(PLAY_BUTTON_CONTINUE);
}

static void ShowPlaying(HWND stage) {
    SetBusyCursor(stage, 1);
    SetPlayButton(PLAY_BUTTON_STOP);
}

static void StopWalk(HWND stage) {
    StopWalkTimer(stage);
    ShowStopped(stage);
}

static void ContinueWalk(HWND stage) {
    ResumeWalkTimer(stage);
    ShowPlaying(stage);
}

/// To be continued with the same frame.
static void StopAtFrame(HWND stage) {
    --NextFrameIndex;
    CancelArrival(stage);
    ShowStopped(stage);
}

static void PlayOn(HWND stage, HWND mainWindow, HINSTANCE instance) {
    // He is on his way off, to a click, or about: that walk can't be replaced.
    if (WalkTimerRunning != 0 || RandomWalkActive != 0 || FrameCount == 0) {
        return;
    }
    if (CharacterArtLoaded == 0) {
        LoadCharacterArt(stage, instance);
    }
    AwaitingArrival = 1;
    PlayNextFrame(stage);
    ShowPlaying(stage);
    DrawProgress(mainWindow);
}

void PlayCommand(HWND mainWindow, HINSTANCE instance) {
    if (AwaitingArrival == 1) {
        if (PlayIdle == 0) {
            StopWalk(EditorStage);
        } else {
            ContinueWalk(EditorStage);
        }
    } else if (PlayIdle == 0) {
        StopAtFrame(EditorStage);
    } else {
        PlayOn(EditorStage, mainWindow, instance);
    }
}

void SuspendPlayback(HWND stage) {
    if (AwaitingArrival == 1 && PlayIdle == 0) {
        StopWalk(stage);
    }
}
