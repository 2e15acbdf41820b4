// The pose picker: a window with the eight poses in two rows of four, from which the user takes one
// by a key from 1 to 8 or by the mouse, which can't leave the window.
#pragma once

#include "platform/user.h"

/// Runs the picker and gives the chosen pose, 0 to 7; the current one, held to that range, if the
/// window was closed without a choice, and 0 if it can't be made. With a picker up already, the
/// current one as it is.
LONG RunPosePicker(HINSTANCE instance, HWND owner, LONG currentPose);

int PoseClassSetup(HINSTANCE instance);

/// 1, or 0 on failure.
int CreatePoseWindow(HINSTANCE instance, HWND owner);

LRESULT PoseWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
