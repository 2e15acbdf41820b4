// The sub-command that tells a show line by line.
#pragma once

#include <string>
#include <vector>

/// toon trace FILE.zkt..., or --walk-about, or --mode editor: prints the record of the show; gives
/// the exit code.
int TraceCommand(const std::vector<std::string>& line);
