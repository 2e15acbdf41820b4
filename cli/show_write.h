// The sub-commands that go between a Toon file and its JSON. They give the exit code.
#pragma once

#include "cli/toon_record.h"

#include <string>
#include <vector>

/// `toon show FILE.zkt`: prints a Toon as JSON.
int ShowCommand(const std::vector<std::string>& arguments);

/// `toon write FILE.json [-o FILE.zkt]`: writes the Toon that JSON tells, by itself beside it.
/// Nothing is written if anything is wrong.
int WriteCommand(const std::vector<std::string>& arguments);

/// Reads a Toon's file; gives why it can't be read or is no Toon, or nothing. `size` is the file's,
/// in bytes.
std::string ReadToon(const std::string& path, Toon& toon, std::size_t& size);
