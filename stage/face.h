// The character's face: cells of 10 x 10 pixels with eyes and mouths, copied straight to the screen
// over the standing figure, and the timer that moves his mouth while he talks.
//
// A cell stays until he is next drawn: the next step of a walk or a repaint shows the plain
// picture.
#pragma once

#include "toon/toon_document.h"

#include "platform/user.h"

constexpr int EXPRESSION_EYES_SHUT = 1; // 1 and 2 are shown only for a frame with `wink`
constexpr int EXPRESSION_EYES_OPEN = 2;
constexpr int EXPRESSION_MOUTH_FIRST = 3;
constexpr int EXPRESSION_MOUTH_CLOSED = 5; // as in the pose picture

constexpr UINT TALK_INTERVAL = 250; // ms

/// The sheet of cells, null while not loaded. Written by LoadExpressionSheet, FreeExpressionSheet.
extern HBITMAP ExpressionSheet;

/// 1 while TIMER_TALK runs. Written here and by StageBegin.
extern DWORD Talking;

/// Ticks since the talk began, and the tick on which it ends. Written here.
extern LONG TalkTicks;
extern LONG TalkTicksTotal;

/// The mouth that the last ordinary tick drew; lives on from talk to talk. Written here.
extern LONG LastMouthShape;

/// Each stage's host loads the sheet at its start and frees it at its end.
void LoadExpressionSheet(HINSTANCE instance);
void FreeExpressionSheet();

/// The frame that is acted out: WalkFrame during a random walk, else PlayFrame.
const ToonFrame* FollowedFrame();

/// Draws expression 1 to 5 for the pose of the followed frame. 1 if a cell was drawn, 0 if the
/// frame doesn't wink and the expression is one of the eyes.
int ShowExpression(HWND stage, int expression);

/// Copies the expression's cell of the followed frame's pose, held to 0..7, to the character's
/// draw position plus the offsets, in pixels. 1, or 0 for expression 0, which draws nothing.
int StampFaceCell(HWND stage, LONG xOffset, LONG yOffset, int expression);

/// Starts to move the mouth for the followed frame's text. 1 if it did, 0 if he talks already or
/// has nothing to say.
int StartTalking(HWND stage);

/// Ends a talk where it stands; safe at any time.
void StopTalking(HWND stage);

/// The handler of TIMER_TALK: another mouth than the last one, or the closing one at the end. A
/// text of 1 to 4 characters has no end of its own and is talked until StopTalking.
void TalkTick(HWND stage);
