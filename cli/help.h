// What `toon` tells of itself.
#pragma once

#include <string>

/// Prints how the command is used, with examples, on the standard output; of all commands for an
/// empty name. False if there is no such command.
bool PrintHelp(const std::string& command);

/// Says on stderr what is wrong with a command line, if it isn't empty, and how the command is
/// used; gives the exit code.
int TellWrongUsage(const std::string& command, const std::string& wrong);
