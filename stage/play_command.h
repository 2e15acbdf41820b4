// Play, Stop and Continue: what the editor's Play button and the loss of the keyboard do to a show
// on the editor's stage.
#pragma once

#include "platform/user.h"

/// A press of the Play button. PlayIdle and AwaitingArrival say what it means: stop or continue a
/// walk to a frame, stop at a frame (also in the half second before he speaks), play from the
/// start, or continue at the frame where he stands. Nothing while he walks off, walks to a click or
/// about, or where the Toon has no frames.
void PlayCommand(HWND mainWindow, HINSTANCE instance);

/// Stops a walk to a frame, as a press of the button would. Nothing in any other state: a pause
/// runs on.
void SuspendPlayback(HWND stage);
