// The sub-commands that go between a Toon file and its JSON. They give the exit code.
#pragma once

#include <string>
#include <vector>

/// `toon show FILE.zkt`: prints a Toon as JSON.
int ShowCommand(const std::vector<std::string>& arguments);

/// `toon write FILE.json [-o FILE.zkt]`: writes the Toon that JSON tells, by itself beside it.
/// Nothing is written if anything is wrong.
int WriteCommand(const std::vector<std::string>& arguments);

/// Reads a regular file of any size that a Toon can have; gives why it can't be read, or nothing.
std::string ReadWholeFile(const std::string& path, std::string& bytes);
