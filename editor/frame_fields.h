// The list of frames and the fields of the frame editor: what they show, and what is read from
// them. Operations give 1 for done, 0 for not done.
#pragma once

#include "platform/dialogs.h"
#include "toon/toon_document.h"

/// The pose that the pose button shows, from 0, and as unchecked as a file's may be: what goes into
/// the frame at the next commit.
/// Written here and by the commands.
extern LONG EditPose;

// ---- The list -----------------------------------------------------------------------------------

/// Fills it with the numbers 1 to FrameCount and selects the current frame.
void FillFrameList(HWND dialog);

/// Adds a number, from 1 on, in its place.
void AddFrameListItem(HWND dialog, LONG number);

void SelectListedFrame(HWND dialog, LONG index);

/// The index of the selected frame; -1 if none is.
LONG FrameListSelection(HWND dialog);

/// Makes the selected frame the current one and shows it. Fields that weren't committed are gone.
int SelectFrame(HWND dialog);

/// The same, unless it is the current one already.
int FrameSelectionChanged(HWND dialog);

// ---- The fields ---------------------------------------------------------------------------------

/// Shows a frame, and the Toon's name in the title. Always 1.
int ShowFrameFields(HWND dialog, const ToonFrame* frame);

/// Reads the current frame and shows it.
int ShowCurrentFrame(HWND dialog);

void ShowEditorTitle(HWND dialog);
void ShowPoseLabel(HWND dialog, LONG pose);

/// Reads the fields, holds them to their ranges and puts the frame into the store as the current
/// one. A place of 0 is the middle of the stage, else -150 to 150 beyond the screen; a pause of 0
/// is 5, else 1 to 20 seconds.
int ReadFrameFields(HWND dialog, ToonFrame* frame);

/// Takes the fields into the selected frame, which becomes the current one, and marks the Toon as
/// changed.
int CommitFrame(HWND dialog);
