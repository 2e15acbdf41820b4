// The sub-command that tells a show line by line.
#pragma once

#include <string>
#include <vector>

/// What stands behind `toon trace`, for the user.
extern const char* const traceUsage;

/// toon trace FILE.zkt... or --walk-about: prints the record of the show; gives the exit code.
int TraceCommand(const std::vector<std::string>& line);
