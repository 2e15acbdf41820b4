// What `toon` tells of itself.
#pragma once

#include <string>

/// Prints how the command is used, with examples, on the standard output; of all commands for an
/// empty name. False if there is no such command.
bool PrintHelp(const std::string& command);

/// The command's line of usage, "toon NAME ARGUMENTS", for error messages.
std::string UsageOf(const std::string& command);
