// Writing to the registry: what the program itself never does.
#pragma once

#include "platform/types.h"

namespace seam {

/// Sets a value of a key of the current user to a number, and makes the key if need be. False, and
/// the registry as it was, if it can't be written.
bool setRegistryNumber(const char* path, const char* name, DWORD number);

} // namespace seam
