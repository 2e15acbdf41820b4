// The command line and the run modes: one process, one mode, one exit code.
//
// One letter in either case, behind any number of blanks, minus signs and slashes, says what is
// wanted: S the saver on the whole screen, P or L a preview and A the password change, each
// followed by a window in decimal; C, or nothing at all, the setup dialog. Exit codes: 0 for the
// saver, the preview and the password change, what the setup dialog ends with, -1 for anything
// else.
#pragma once

#include "platform/user.h"

/// The program's instance; set before the command line is looked at.
extern HINSTANCE SaverInstance;

/// The saver window, null until it has been made. Written by RunSaver.
extern HWND SaverWindow;

/// The class and the title by which a running saver is found.
constexpr const char* SAVER_CLASS = "WindowsScreenSaverClass";
constexpr const char* SAVER_TITLE = "Screen Saver";

constexpr WORD SETUP_DIALOG = 2003; // the setup dialog's resource

/// Drops the program's name from the process's command line and runs SaverMain on the rest; gives
/// the exit code.
int ProcessStart();

/// What follows the program's name in a command line: the name is one word, or stands in quotes,
/// and the blanks and control characters behind it belong to it.
const char* SkipProgramName(const char* line);

/// Runs the mode that the command text asks for and gives its exit code.
int SaverMain(HINSTANCE instance, const char* commandText);

/// The decimal digits at the very start of the text as a window, wrapping at 32 bits; null if there
/// are none.
HWND ParseWindowHandle(const char* text);

/// The saver on the whole screen, or as a child of `parent`; runs until its window has gone. Gives
/// the quit message's value (0), 0 at once after bringing a saver that already runs to the front,
/// and -1 if the window can't be made.
int RunSaver(HWND parent);

/// The whole show as a child of a window that another program owns, the desktop among them. It
/// takes no input, asks for no password and looks for no saver that runs already: there may be one
/// for each monitor. Runs until it or that window has gone, and gives 0, or -1 if it can't be made.
int RunHostedShow(HWND host);

/// The preview in the window that the text names; -1 if it names none.
int RunPreview(const char* text);

/// The setup dialog; what it ends with, or -1 if it can't be made.
int RunSetup(HWND parent);

/// Changes the password with the window that the text names as owner, else the foreground window.
/// Always 0.
int RunPasswordChange(const char* text);

/// Asks the system to change the saver's password; does nothing where it has no way to.
void ChangePassword(HWND parent);
