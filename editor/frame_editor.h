// The frame editor. It isn't written yet: a box says so.
#pragma once

#include "platform/dialogs.h"

/// Says over the main window that there is no frame editor yet.
void OpenFrameEditor(HWND mainWindow, HINSTANCE instance);

/// A key of the main window's table while the frame editor is open: 1 if it took it.
int FrameEditorAccelerator(HINSTANCE instance, int id);
