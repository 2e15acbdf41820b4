// The Toon editor's frame: its main window with the stage in it, what a run makes and frees, its
// message loop, the about box.
#pragma once

#include "platform/dialogs.h"

/// The main window; null while no editor is open. Written here.
extern HWND EditorMainWindow;

/// The cursor of the stage while the frame editor is open. Written at the start of a run.
extern HCURSOR TargetCursor;

/// Opens the editor over its owner and runs it until its main window goes. 0; also if it can't
/// start, and then nothing shows. The window classes are set up once a process.
int RunEditor(HINSTANCE instance, HWND owner, int showCommand);

/// The same, with the Toon of that path open from the start; none for an empty path.
int RunEditorWith(HINSTANCE instance, HWND owner, int showCommand, const char* toon);

/// Nonzero if at least one of the two classes could be set up.
int EditorClassSetup(HINSTANCE instance);

/// The main window, then the keys, then the stage in it. 0 if there is no main window.
int CreateEditorWindows(HINSTANCE instance, int showCommand);

/// Fixes StageSize, and with it the main window's size, by that of the screen, and centres it.
void SizeMainWindow(HWND mainWindow);

/// Makes a clean start: the random numbers, the state of the run, all that it draws with.
void EditorStartup(HWND mainWindow, HINSTANCE instance);
void EditorShutdown();

/// Puts a window into the middle of the screen.
void CentreDialog(HWND window);

LRESULT MainWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
LRESULT StageWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);

/// The about box, which closes by OK alone.
LRESULT AboutProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);
