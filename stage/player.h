// The frame player: acts the open Toon out, frame by frame, and holds the pause at each of them.
// Every timer tick and every end of a walk of a stage window passes through here, also those of
// random walks.
#pragma once

#include "toon/toon_document.h"

#include "platform/user.h"

// ---- State: written here and by StageBegin unless a line says otherwise -------------------------

/// The frame that the next walk goes to; 0 when no show runs. The show cycle also clears it.
extern LONG NextFrameIndex;

/// 1 from the moment when he has been brought on for a show until he walks off.
extern DWORD ShowStarted;

/// 1 while he walks off at the end of a show.
extern DWORD WalkingOff;

/// 1 while the walk under way leads to a frame, also while it stands stopped. The Play command also
/// sets it.
extern DWORD AwaitingArrival;

/// 0 while a press of the Play button means Stop. SetPlayButton also writes it.
extern DWORD PlayIdle;

/// Seconds of the pause to come, during the half second between arrival and speech; else 0.
extern LONG PendingPause;

/// What he says at this arrival, from its start until the pause is cancelled.
extern char PendingText[TOON_TEXT_SIZE];

/// Where the last walk was aimed: his top left corner. He is drawn short of it by what the walks
/// since his entrance have left over. The random walker also writes these.
extern LONG CharacterX;
extern LONG CharacterY;

/// The frame that is acted out.
extern ToonFrame PlayFrame;

// ---- Shows --------------------------------------------------------------------------------------

/// Starts the walk to the next frame, or off the stage after the last one, and ends the pause of
/// the frame before. Brings him on first if no show has started.
void PlayNextFrame(HWND stage);

/// Brings him on: parks him off the stage, on the side nearer to the first frame as recorded.
void EnterShow(HWND stage);

/// Starts the walk to frame NextFrameIndex and counts on, even where the walk is refused. 1, or 0
/// if the frame can't be read.
int WalkToNextFrame(HWND stage);

/// Starts the walk off by the nearer side and ends the show's counting. Gives what WalkTo gave.
UINT_PTR WalkOffStage(HWND stage);

/// A walk has ended: the pause of a frame begins, or the show is over and TM_SHOWDONE goes out.
void FrameArrival(HWND stage);

/// Three uses. seconds 0 cancels a pause: bubble off, talking stopped, TIMER_PAUSE killed. seconds
/// above 0 with no pause pending begins an arrival with `text` (null: none): eyes shut, and the
/// second stage half a second later. Any other seconds with a pause pending is that second stage:
/// eyes open, talking, bubble, TIMER_PAUSE. A negative number with none pending does nothing.
void ArrivalPause(HWND stage, const char* text, LONG seconds);

/// Ends an arrival in any stage, the half second before the speech included: as the cancelling
/// ArrivalPause, and neither a tick nor a pause is left pending.
void CancelArrival(HWND stage);

/// Puts an end to whatever runs on the stage and parks him where the show would bring him on. A
/// random walk's flag stays. Nothing at all while no art is loaded.
void ResetShow(HWND stage);

/// Whether a show has begun and the walk off hasn't ended: also while it stands stopped at its
/// first frame.
bool ShowUnderWay();

/// The part of `range` that the show has come through, the frame walked to included.
LONG PlayProgress(LONG range);

// ---- The window's messages ----------------------------------------------------------------------

/// Gives the stage the wait cursor or the arrow, at once. Nothing while SaverActive is 1.
void SetBusyCursor(HWND stage, BOOL busy);

/// Handles WM_TIMER; an id that isn't the stage's does nothing.
void StageTimerDispatch(HWND stage, UINT_PTR timer);

/// Handles TM_WALKDONE.
void WalkDoneDispatch(HWND stage);

/// Handles WM_LBUTTONDOWN of the editor's stage: he walks to the click, or the frame that is being
/// edited gets its place. Nothing for a click on him, and without a frame editor nothing while a
/// show or a random walk is under way. Always 0.
LRESULT StageClick(HWND stage, LPARAM coordinates);
