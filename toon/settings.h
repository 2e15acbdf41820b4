// The choices and the odometer that outlast a run, in the profile file "Dorbo95.ini".
//
// All values are those of the process; each load overwrites them from the file. No failure shows.
#pragma once

#include "platform/types.h"

constexpr std::size_t DIRECTORY_SIZE = 128; // bytes, NUL included

extern LONG WalkingStyle;       // 1: play Toons, 0: walk about; load, setup and show cycle write it
extern LONG WalkingStyleChoice; // as the setup dialog's buttons stand; load and setup write it
extern LONG Statements;         // nonzero: wise statements; load and setup write it
extern LONG Backgrounds;  // nonzero: a random tile a walk; load, setup and show cycle write it
extern DWORD PacesWalked; // the odometer; load and WalkTo write it
extern char Directory[DIRECTORY_SIZE]; // of the Toons, ends in a backslash; load and setup write it

/// Reads all values. A missing switch keeps what memory holds, a missing odometer is 0, a missing
/// directory is the current one. A directory that doesn't fit with its backslash becomes a single
/// backslash.
void SettingsLoad();

/// Whether the file names a directory; the first save of all makes it.
bool SettingsNameDirectory();

/// Writes all values. A write that fails leaves the file as it was; so does one of a value that the
/// load couldn't read.
void SettingsSave();

/// Writes one number in decimal, as unsigned, into the settings file.
void WriteIntSetting(const char* section, const char* key, DWORD value);

/// Adds a backslash unless the text ends in one; an empty text becomes a single backslash. The
/// buffer must have room for one character more.
void EnsureTrailingBackslash(char* text);
