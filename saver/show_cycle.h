// The endless cycle of shows: what comes next, and the start and the end of a stage.
//
// A show is a Toon played through or one walk about. The player of a single Toon uses the same
// start and end, but not the choice.
#pragma once

#include "platform/user.h"

constexpr int NEXT_TOON_SIZE = 128; // bytes, NUL included

/// The bare name of the Toon that the next show plays, in the current directory; empty for a walk
/// about. Written here and by the player of a single Toon.
extern char NextToonFile[NEXT_TOON_SIZE];

/// How many entries matched "*.zkt" at the last count. Written by CountToonFiles.
extern LONG ToonFileCount;

/// How many tiles the resources hold; 0 until counted. Written by CountBackgrounds.
extern LONG BackgroundCount;

/// What the last random choice of a tile gave; lives on from stage to stage. Written by
/// PickBackground.
extern LONG LastBackground;

/// Handed to PaintStage, which clears it; 1 at program start. Set by the player of a single Toon.
extern DWORD StageRepaintFlag;

/// The middle procedure of the saver window's chain; hands on to SaverDefaultProc.
LRESULT ShowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

/// Begins a stage in a window: settings, art, fonts, backdrop, and TIMER_SHOWSTART.
void ShowSetup(HWND window, HINSTANCE instance);

/// Ends it: frees all that, and saves the settings.
void ShowTeardown(HWND window);

/// Answers WM_TIMER of a stage: the show starts, or the stage's own timers go on. Gives 0.
LRESULT ShowTimer(HWND window, HINSTANCE instance, UINT_PTR timer);

/// Answers WM_SIZE of a stage: at another size its picture is made anew, and a walk under way goes
/// on. `size` is the width and, in the high word, the height. Gives 0.
LRESULT ShowResize(HWND window, HINSTANCE instance, DWORD size);

/// Clears the counters between two shows and parks the character.
void ShowReset(HWND window);

/// Decides what the next show is, and starts nothing. Without any Toon WalkingStyle becomes 0.
void ChooseNextShow(HWND window);

/// Starts what was decided. A Toon that doesn't load leaves the stage still; in a window of a
/// program that hosts savers he walks about instead.
void StartNextShow(HWND window, HINSTANCE instance);

/// Counts the entries of the current directory that match "*.zkt", whatever they are. Names that
/// NextToonFile doesn't hold are passed over.
LONG CountToonFiles();

/// Each gives 1 if it found a name, else 0. PickIntroToon finds "intro.zkt" while the odometer is
/// 0. PickToonFile never gives the same one twice in a row while there are two, unless 100 draws
/// bring no other.
int PickRandomToonFile(char* name);
int PickIntroToon();
int PickToonFile();

void CountBackgrounds(HWND window);

/// Picks a tile other than the last, if the settings want one.
void PickBackground(HWND window);
