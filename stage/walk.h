// Walks: a table of positions and pictures worked out in advance, then played back one entry per
// tick of TIMER_WALK. There is one walk at a time; it ends in a pose and in TM_WALKDONE.
//
// Positions are those of the character's top left corner, in pixels of the stage.
#pragma once

#include "stage/sprite.h"

#include <cstdint>

struct PathStep {
    LONG x;
    LONG y;
    HBITMAP bitmap; // borrowed from CharacterArt
};

constexpr int WALK_PATH_ENTRIES = 255;
constexpr LONG WALK_STRIDE = 20;        // pixels aimed at per stride
constexpr LONG WALK_MOST_STRIDES = 248; // the last multiple of 8 whose entries fit the table

/// The walk under way: entry 0 is where it starts, entry n ends the movement, entry n + 1 holds the
/// pose. Written by BuildWalkPath.
extern PathStep WalkPath[WALK_PATH_ENTRIES];

/// The entry last drawn, 0 for a walk just planned. Written here and by StageBegin.
extern LONG WalkStepIndex;

/// The walk's last entry. Written by BuildWalkPath.
extern LONG WalkLastIndex;

/// Milliseconds between ticks, kept for ResumeWalkTimer. Written by StartWalkTimer.
extern LONG WalkInterval;

/// Nonzero while TIMER_WALK runs. Written here and by StageBegin.
extern DWORD WalkTimerRunning;

constexpr LONG WALK_TO_RIGHT = 1;
constexpr LONG WALK_TO_LEFT = 2; // also straight up and down
/// Where the last walk went to. Written by WalkTo.
extern LONG WalkDirection;

/// Plans a walk, counts its paces and starts it at ToonSpeed. Nonzero if it has begun. While
/// another walk runs it gives 0 and leaves no trace: that walk goes on, and neither the odometer
/// nor WalkDirection changes. A walk that was stopped on its way is replaced.
UINT_PTR WalkTo(HWND stage, LONG fromX, LONG fromY, LONG toX, LONG toY, LONG pose);

/// Strides that a way asks for: 1, or a multiple of 8 that can be more than the table holds.
std::int64_t StridesWanted(LONG fromX, LONG fromY, LONG toX, LONG toY, LONG stepLength);

/// Fills WalkPath; gives WalkLastIndex, at least 2, or 0, and nothing touched, while a walk runs. A
/// walk has 1 stride or a multiple of 8, 248 at most. Only a walk whose way divides by its
/// strides without remainder reaches its target; any other stops short of it by up to n - 1 pixels
/// an axis. The pose is held to 0..7.
LONG BuildWalkPath(LONG fromX, LONG fromY, LONG toX, LONG toY, LONG stepLength, Sprite* sprite,
                   const HBITMAP* art, LONG pose);

/// Starts the ticks; `notifyMessage` is sent to the stage at the end. The speed is held to 1..5,
/// 190 to 110 ms a tick. Gives what SetTimer gave, 0 while a walk runs.
UINT_PTR StartWalkTimer(HWND stage, UINT notifyMessage, LONG speed);

/// Stops the walk on its way, to be gone on with by ResumeWalkTimer. Always 0.
int StopWalkTimer(HWND stage);

/// Goes on with a stopped walk. Gives what SetTimer gave, 0 if the walk runs.
UINT_PTR ResumeWalkTimer(HWND stage);

/// The handler of TIMER_WALK: draws the next entry. One tick after the last it ends the walk and
/// sends its message. Nothing moves while the stage is iconic.
void WalkStep(HWND stage);

/// Shows the entry's picture and moves the Sprite by the difference between it and the entry
/// before, from wherever the Sprite stands. index is at least 1.
void ShowWalkStep(HWND stage, Sprite* sprite, const PathStep* table, LONG index);
