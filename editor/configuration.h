// The configuration of a Toon: its caption, its background and its speed, in a modal dialog over
// the frame editor.
#pragma once

#include "toon/toon_document.h"

#include "platform/dialogs.h"

/// Runs the dialog and shows what came of it, after Cancel too. Always 1.
int ConfigureToon(HINSTANCE instance, HWND editorDialog);

LRESULT ConfigureProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);

/// Shows the header in the dialog. Always 1.
int ConfigureInit(HWND dialog, const ToonHeader* header);

/// Takes caption, background and speed into the header and into force, and marks the Toon as
/// changed. A list without a selection stands for background 0. Always 1.
int ConfigureCommit(HWND dialog, ToonHeader* header);

/// Fills the list with pictures of the tiles bg01, bg02 and so on, up to the first number that
/// there isn't. The items' values are bitmaps, which FreeBackgroundList deletes.
void FillBackgroundList(HWND dialog);
void FreeBackgroundList(HWND dialog);
