// The home of the user's Toons.
#pragma once

#include <string>

/// Goes to the directory of the user's Toons, $XDG_DATA_HOME/dorbo/toons (by default under
/// ~/.local/share). If there is none the Toons that are installed with the running program are
/// copied there first, for the user to change; all of them, or there still is none. What the user
/// has removed from it doesn't come back. If that fails the process stays where it is, a line on
/// stderr says why, and the result is false.
bool EnterToonHome();

/// The Toons that are installed with a program: share/dorbo/toons beside the directory that holds
/// it, or beside one above that; in the build tree toons/. Empty if there are none. `program` is
/// its path.
std::string FindInstalledToons(const std::string& program);
