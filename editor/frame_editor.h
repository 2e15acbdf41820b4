// The frame editor, where a Toon is written: a small dialog over the stage that shows one frame.
//
// Its fields are a scratch pad. CommitFrame takes them into the frame store, ToonSave writes the
// store to the file; File, Save takes no fields. While it is open, the main window's keys are its
// own, and a click on the stage gives the frame its place (FrameFromClick, stage/editor_host.h).
//
// Operations give 1 for done, 0 for not done, and take the dialog's window unless a line says
// otherwise.
#pragma once

#include "platform/dialogs.h"

/// Opens it over the main window; nothing if it is open.
void OpenFrameEditor(HWND mainWindow, HINSTANCE instance);

LRESULT FrameEditorProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);

/// A key of the main window's table while it is open: 1 if it took it.
int FrameEditorAccelerator(HINSTANCE instance, int id);

/// Begins a new Toon of one frame where the open one has no name; shows the current frame.
int StartFrameEditor(HWND dialog);

/// Asks about unsaved changes, and closes.
int ExitFrameEditor(HWND dialog);

/// Closes without a question. Changes that are still unsaved give way to the file's state; if that
/// can't be read the Toon has no name any more.
int CloseFrameEditor(HWND dialog);

/// Adds a frame of zeros at the end and shows it; above 250 frames a message instead.
int NewFrame(HWND dialog);

/// Adds a frame of zeros before the one that the list names and shows it; above 250 frames a
/// message instead.
int InsertFrame(HWND dialog);

/// Takes the frame that the list names out and shows the one that takes its place, or the last; the
/// only frame is cleared instead.
int DeleteFrame(HWND dialog);

/// Has the user pick a pose. Marks the Toon as changed whatever comes of it.
void ChoosePose(HINSTANCE instance, HWND dialog);

/// Asks for a name and writes the Toon under it, without the fields. The name stays also if the
/// write fails. 1 if it has been written.
int SaveToonAs(HWND dialog);

/// Asks for a name if there is none. 0 also if there is nothing to save.
int SaveToonCommand(HWND dialog);

/// Opens another Toon. One that doesn't load leaves a new untitled one behind the fields, so that
/// no save can write over its file.
int OpenToonInEditor(HWND dialog);

/// Begins a new Toon, once the user has been asked about unsaved changes. 1, also if he stopped it.
int NewToonInEditor(HWND dialog);
