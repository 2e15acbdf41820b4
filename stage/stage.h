// What all rooms of the stage share: its messages and timers, who runs it, and its clean start.
//
// The stage is a window that a host owns: the saver, the player of a single Toon, or the editor.
// The stage keeps no copy of the handle; every operation gets it. The host passes WM_TIMER to
// StageTimerDispatch, TM_WALKDONE to WalkDoneDispatch, and paints with PaintStage.
#pragma once

#include "platform/user.h"

// ---- Messages -----------------------------------------------------------------------------------

// Those to the editor's main window, 1028 to 1030, stand in toon/toon_prompts.h.
constexpr UINT TM_SHOWDONE = 1031;          // to the stage: a show or walk about has ended
constexpr UINT TM_WALKDONE = 1032;          // to the stage: a walk has ended
constexpr UINT TM_VERIFYPASSWORD = 0x8000U; // to the saver: run the password verifier

// ---- Timers -------------------------------------------------------------------------------------

constexpr UINT_PTR TIMER_OPENING = 0; // on the editor's main window, all others on the stage
constexpr UINT_PTR TIMER_ARRIVAL = 1;
constexpr UINT_PTR TIMER_PAUSE = 2;
constexpr UINT_PTR TIMER_TALK = 10;
constexpr UINT_PTR TIMER_SHOWSTART = 11;
constexpr UINT_PTR TIMER_WALK = 101;

/// The name under which a timer stands in the record, without TIMER_; null for an unknown id.
const char* StageTimerName(UINT_PTR timer);

// ---- Who runs the stage -------------------------------------------------------------------------

/// 1 while the stage runs in a saver or player window and leaves the editor's buttons and cursors
/// alone, else 0. Written by the saver's start and end of a show.
extern DWORD SaverActive;

// What PreviewMode says.
constexpr DWORD PREVIEW_NONE = 0;  // the whole show on the whole screen
constexpr DWORD PREVIEW_WALK = 1;  // one walk in a window of the program that shows the preview
constexpr DWORD PREVIEW_WHOLE = 2; // the whole show in a window of a program that hosts savers

/// Other than PREVIEW_NONE once the saver runs as a child of a given window. Written by the saver.
extern DWORD PreviewMode;

/// Puts the whole stage at rest before a new stage window has set a timer, and forgets the stage on
/// which the last Toon was made: none is in memory by which to scale. What outlives a stage
/// stays: the last mouth shape, the last statement and background, the speed and the caption, where
/// he last stood and walked to. OpeningDone and TitleShown are the host's to clear. Art, fonts and
/// backdrop aren't touched. Timers stand under their
/// names in the record from here on.
void StageBegin();

/// Tells the stage window that a show or walk about has ended. Its handler may start the next one
/// before this returns.
void SendShowDone(HWND stage);

// ---- Positions ----------------------------------------------------------------------------------

/// Sum and difference, wrapping at 32 bits: a Toon file may put the character anywhere.
constexpr LONG WrapAdd(LONG a, LONG b) {
    return static_cast<LONG>(static_cast<DWORD>(a) + static_cast<DWORD>(b));
}

constexpr LONG WrapSubtract(LONG a, LONG b) {
    return static_cast<LONG>(static_cast<DWORD>(a) - static_cast<DWORD>(b));
}

/// Left position of a character who waits off the stage on the left; he is 130 pixels wide.
constexpr LONG OFF_LEFT_X = -150;

/// The same on the side that is nearer to x, on a stage `width` pixels wide. Half the width itself
/// belongs to the right side.
constexpr LONG OffStageX(LONG width, LONG x) {
    constexpr LONG beyondRightEdge = 50;
    return width / 2 <= x ? width + beyondRightEdge : OFF_LEFT_X;
}

/// The same on the side of the stage that is nearer to x.
LONG OffStageSide(HWND stage, LONG x);
