// What a show does to the editor's buttons, and how they come back.
#include "editor/button_states.h"

#include "editor/chrome.h"
#include "editor/editor_shell.h"
#include "platform/trace.h"
#include "stage/player.h"
#include "stage/stage.h"

#include <cstddef>

DWORD ButtonsSaved;

constexpr std::size_t BUTTON_PAIRS = 2;
static BOOL SavedMainStates[BUTTON_PAIRS]; // of File and Play
static BOOL SavedSysStates[BUTTON_PAIRS];  // of walk about and minimise

static HWND MainButton(std::size_t index) {
    return index == 0 ? FileButton : PlayButton;
}

static HWND SysButton(std::size_t index) {
    return index == 0 ? WalkButton : MinimizeButton;
}

void SetPlayButton(int state) {
    static const char* const labels[] = {"&Play", "&Continue", "&Stop"};
    if (SaverActive == 1) {
        return;
    }
    Trace("play_button label=%s", labels[state]);
    SetWindowTextA(PlayButton, labels[state]);
    PlayIdle = state == PLAY_BUTTON_STOP ? 0 : 1;
    EnableWindow(FileButton, state == PLAY_BUTTON_STOP ? FALSE : TRUE);
}

void DisableButtons() {
    if (SaverActive == 1 || ButtonsSaved == 1) {
        return;
    }
    for (std::size_t i = 0; i < BUTTON_PAIRS; ++i) {
        SavedMainStates[i] = IsWindowEnabled(MainButton(i));
        SavedSysStates[i] = IsWindowEnabled(SysButton(i));
        if (AwaitingArrival == 0) {
            EnableWindow(MainButton(i), FALSE);
        }
        EnableWindow(SysButton(i), FALSE);
    }
    ButtonsSaved = 1;
}

void RestoreButtons() {
    if (SaverActive == 1 || ButtonsSaved != 1) {
        return;
    }
    for (std::size_t i = 0; i < BUTTON_PAIRS; ++i) {
        EnableWindow(MainButton(i), SavedMainStates[i]);
        EnableWindow(SysButton(i), SavedSysStates[i]);
    }
    ButtonsSaved = 0;
}

void EndShow() {
    if (!EditorMainWindow || !ShowUnderWay()) {
        return;
    }
    const BOOL play = IsWindowEnabled(PlayButton);
    SetBusyCursor(EditorStage, 0);
    ResetShow(EditorStage);
    RestoreButtons();
    EnableWindow(PlayButton, play); // no show disables it, but the frame editor does
    DrawProgress(EditorMainWindow);
}
