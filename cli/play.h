// `toon play` and `toon edit`: Toons on the real screen.
#pragma once

#include <string>
#include <vector>

/// Shows one Toon on the whole screen, once, as a double-click in the setup does; a key or a click
/// ends it. What is played is a copy in memory, so that neither the file's name nor its mode
/// matters. Gives the exit code.
int PlayToonCommand(const std::vector<std::string>& arguments);

/// Opens the Toon editor, with a Toon in it if one is named, and runs it until it is closed. Gives
/// the exit code.
int EditToonCommand(const std::vector<std::string>& arguments);
