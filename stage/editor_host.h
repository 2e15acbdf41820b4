// What the stage asks of the editor round it. The editor defines these; while SaverActive is 1 all
// but DrawProgress do nothing.
#pragma once

#include "platform/user.h"

/// The editor's stage, a child of its main window; null while there is none. Defined and written by
/// the editor.
extern HWND EditorStage;

/// The open frame editor, null while none is open. Defined and written by the editor.
extern HWND EditorDialog;

constexpr int PLAY_BUTTON_PLAY = 0;     // "&Play": nothing runs
constexpr int PLAY_BUTTON_CONTINUE = 1; // "&Continue": the user has stopped the show
constexpr int PLAY_BUTTON_STOP = 2;     // "&Stop": a show runs

/// Labels the Play button for one of the three states, sets PlayIdle to 0 for PLAY_BUTTON_STOP and
/// to 1 for the others, and enables the File button where PlayIdle is 1.
void SetPlayButton(int state);

/// Disables the buttons that must not be pressed during a show or walk, and remembers how they
/// stood. While AwaitingArrival is 1 File and Play stay enabled. A second call does nothing until
/// RestoreButtons.
void DisableButtons();

/// Brings the buttons back to how DisableButtons found them, if it has disabled any.
void RestoreButtons();

/// Draws the bar of the present show's progress on the editor's main window.
void DrawProgress(HWND mainWindow);

/// Takes the frame editor's fields, and with them a point of the stage as the frame's place.
/// Nothing while no frame editor is open.
void FrameFromClick(LONG x, LONG y);
