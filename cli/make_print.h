// The sub-commands that go between a Toon file and its text form. They give the exit code.
#pragma once

#include <string>
#include <vector>

/// toon make TEXT FILE.zkt: writes the Toon that a text tells.
int MakeCommand(const std::vector<std::string>& arguments);

/// toon print FILE.zkt: prints a Toon as text.
int PrintCommand(const std::vector<std::string>& arguments);
