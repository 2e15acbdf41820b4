// Which of the editor's buttons can be pressed. SetPlayButton, DisableButtons and RestoreButtons
// stand in stage/editor_host.h: the stage asks for them.
#pragma once

#include "stage/editor_host.h"

/// 1 from DisableButtons to RestoreButtons. Also cleared at the start of the editor.
extern DWORD ButtonsSaved;

/// Puts an end to a show that is under way, whose frames are about to go or have gone: he is
/// parked, and the buttons are as before it. Nothing while no editor is open.
void EndShow();
