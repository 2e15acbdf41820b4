// The registry of the platform: keys with values, of which the program reads and the seam writes.
//
// It is a text file, registry.ini, that lies and reads as a profile file does (kernel.h): a section
// is a key, named by its path, and its lines are the key's values. A key is there if its section
// is. Results are error numbers of the platform, 0 for success.
#pragma once

#include "platform/types.h"

constexpr LONG ERROR_SUCCESS = 0;
constexpr LONG ERROR_FILE_NOT_FOUND = 2;
constexpr LONG ERROR_INVALID_HANDLE = 6;
constexpr LONG ERROR_MORE_DATA = 234;

using HKEY = Handle<struct KeyKind>;
constexpr HKEY HKEY_CURRENT_USER{0x80000001};

/// Opens a key by its path, whatever its case; `key` must be HKEY_CURRENT_USER. `result` is null
/// after a failure. ERROR_FILE_NOT_FOUND if there is no such key.
LONG RegOpenKeyA(HKEY key, const char* path, HKEY* result);

constexpr DWORD REG_SZ = 1;
constexpr DWORD REG_DWORD = 4;

/// Reads a value of an open key: one of digits alone that fits in 32 bits is a number of 4 bytes
/// (REG_DWORD), any other a text with its NUL (REG_SZ). `size` holds the buffer's bytes and gets
/// the value's; with ERROR_MORE_DATA, the buffer being too small, nothing is written to it. A null
/// `data` asks for type and size alone. `reserved` must be null; it, `type`, and `size` if `data`
/// is null, may be null. ERROR_FILE_NOT_FOUND if there is no such value.
LONG RegQueryValueExA(HKEY key, const char* name, DWORD* reserved, DWORD* type, BYTE* data,
                      DWORD* size);

LONG RegCloseKey(HKEY key); ///< ERROR_INVALID_HANDLE if it is no open key
