// The editor's buttons and progress bar, as far as the stage asks for them. There is no editor
// window yet, so there is nothing to change.
#include "stage/editor_host.h"

void SetPlayButton(int /*state*/) {}

void DisableButtons() {}

void RestoreButtons() {}

void DrawProgress(HWND /*mainWindow*/) {}
