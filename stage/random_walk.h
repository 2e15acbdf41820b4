// Walks about: the character comes in to a random place, strikes a random pose, says a statement
// or tells how far he has walked, and goes out again. Also the program's one random number.
#pragma once

#include "toon/toon_document.h"

#include "platform/user.h"

/// The present random walk: x and y are where his top left corner is to stand. Written here.
extern ToonFrame WalkFrame;

/// 1 from the start of the walk in until the walk out has ended. Written here and by StageBegin;
/// a reset between two shows leaves it alone.
extern DWORD RandomWalkActive;

/// 1 from the end of the pause until the walk out has ended. Written here and by StageBegin.
extern DWORD WalkingOut;

/// 1 once the first random walk of this run of the stage has ended. Set here, cleared by the
/// stage's host at its start.
extern DWORD OpeningDone;

/// The statement that was picked last; lives on from stage to stage. Written by PickRandomWalk.
extern LONG PreviousStatement;

// Statements: a string of the string table, or one of these.
constexpr LONG STATEMENT_PACES = -1; // how far he has walked
constexpr LONG STATEMENT_NONE = 0;   // he stands and says nothing
constexpr LONG FIRST_STATEMENT = 4;
constexpr LONG LastStatementId = 65;

constexpr LONG RANDOM_HIGHEST = 3276;

/// Starts the random numbers anew: the same seed gives the same ones, whatever the compiler.
void SeedRandom(DWORD seed);

/// A random number from low to high, both included; values above 3276 never come. Bounds that
/// can't be met give the lower one.
LONG RandomInt(LONG low, LONG high);

/// Chooses a walk and starts it. 0, and nothing changed, while a show is under way, he is walking,
/// or the frame editor is open, else 1; during the pause of a walk about too, whose WalkFrame is
/// then overwritten: whoever may ask at that time keeps the user from it. `allowStatements` nonzero
/// lets him say one of the table.
int PickRandomWalk(HWND stage, DWORD allowStatements);

/// Brings him to his starting place with the statement in WalkFrame. 0, and nothing changed, while
/// a random walk is under way, else 1.
int PrepareRandomWalk(HWND stage, LONG statement);

/// Writes the odometer statement into WalkFrame.
void BuildPacesStatement();

/// Starts the walk to WalkFrame, scaled as a place of the open Toon. Always 1.
int WalkToRandomFrame(HWND stage);

/// The pause of a random walk is over: he leaves by the side from which he came.
void RandomPauseOver(HWND stage);

/// A walk of a random walk has ended: the pause begins, or TM_SHOWDONE is sent.
void RandomWalkArrived(HWND stage);

/// The first random walk of the run has ended: sends TM_SHOWDONE, which RandomWalkArrived then
/// sends once more, and asks for the repaint that takes the title off. Before its end: nothing.
void FinishOpening(HWND stage);

/// Forgets a random walk that ResetShow has put an end to.
void EndRandomWalk();

/// The first walk of the editor, and of the preview. 0 once OpeningDone is 1, and while a walk or
/// show is under way, else 1.
int StartOpeningWalk(HWND stage);
int StartPreviewWalk(HWND stage);
