// Files, devices, memory blocks, modules, resources, profile and process services of the platform.
//
// Paths have the platform's form: drive C: is the root of the file system, each mounted medium of
// the user has a letter from D: on, a backslash parts the elements and a slash counts as one. An
// element is found by its exact spelling first, else by the first name, in the order of bytes,
// that is the same but for case. Bytes of names pass through unchanged. A name that holds a
// backslash can't be expressed and is passed over.
#pragma once

#include "platform/types.h"

// ---- Files ---------------------------------------------------------------------------------

constexpr HFILE HFILE_ERROR{0xFFFFFFFF};

constexpr UINT OF_READ = 0x0000;
constexpr UINT OF_READWRITE = 0x0002;
constexpr UINT OF_CANCEL = 0x0800;
constexpr UINT OF_CREATE = 0x1000;
constexpr UINT OF_PROMPT = 0x2000;

/// What OpenFile found; szPathName is the whole path, cut at its end if it doesn't fit.
struct OFSTRUCT {
    BYTE cBytes;
    BYTE fFixedDisk;
    WORD nErrCode; // 0, or the errno of the failure
    WORD Reserved1;
    WORD Reserved2;
    char szPathName[128];
};

/// Opens a regular file; HFILE_ERROR for anything else, and it never waits (a FIFO is refused at
/// once). OF_READWRITE refuses a file none of whose mode bits allows writing, also for root.
/// OF_CREATE makes the file or cuts it to nothing, and opens it for reading and writing; it too
/// refuses a read-only file. OF_PROMPT and OF_CANCEL ask nothing more of this system.
HFILE OpenFile(const char* name, OFSTRUCT* found, UINT style);

/// Reads or writes up to `bytes` bytes at the file's position and moves it; gives the number
/// transferred, which is short at the end of the file or on a full disk, or -1 on an error before
/// the first byte.
LONG _hread(HFILE file, void* buffer, LONG bytes);
LONG _hwrite(HFILE file, const void* buffer, LONG bytes);

/// Closes; HFILE_ERROR if the handle is none, else a null handle.
HFILE _lclose(HFILE file);

/// The low 32 bits of the file's size in bytes; 0xFFFFFFFF on failure. high, if not null, gets
/// the upper 32.
DWORD GetFileSize(HFILE file, DWORD* high);

// ---- Directories ---------------------------------------------------------------------------

constexpr DWORD FILE_ATTRIBUTE_READONLY = 0x01;
constexpr DWORD FILE_ATTRIBUTE_HIDDEN = 0x02;
constexpr DWORD FILE_ATTRIBUTE_DIRECTORY = 0x10;
constexpr DWORD FILE_ATTRIBUTE_ARCHIVE = 0x20;

struct WIN32_FIND_DATAA {
    DWORD dwFileAttributes;
    DWORD nFileSizeLow;
    char cFileName[MAX_PATH];
};

using HANDLE = Handle<struct SystemObjectKind>; // a search or a device
constexpr HANDLE INVALID_HANDLE_VALUE{0xFFFFFFFF};

/// Starts a scan for a pattern, with or without a directory in front: `*` stands for any run of
/// characters, `?` for one or none at the end of the name, and "*.*" for every name; case doesn't
/// matter. Names come in the order of their bytes, directories among them. Names of MAX_PATH bytes
/// and more are passed over, and so are "." and "..". A link tells of what it leads to, one that
/// leads nowhere of itself. A pattern without `*` and `?` gives the one entry that the path means.
/// INVALID_HANDLE_VALUE if nothing matches.
HANDLE FindFirstFileA(const char* pattern, WIN32_FIND_DATAA* found);
BOOL FindNextFileA(HANDLE search, WIN32_FIND_DATAA* found); ///< FALSE behind the last one
BOOL FindClose(HANDLE search);                              ///< FALSE if there is no such search

/// Writes the process's current directory with its NUL if `size` bytes hold it, and gives its
/// length; else writes nothing and gives the size needed. 0 if it can't be told.
DWORD GetCurrentDirectoryA(DWORD size, char* buffer);

/// TRUE if the directory was entered; else the current directory stays.
BOOL SetCurrentDirectoryA(const char* path);

// ---- Devices -------------------------------------------------------------------------------

constexpr DWORD GENERIC_READ = 0x80000000;
constexpr DWORD GENERIC_WRITE = 0x40000000;
constexpr DWORD FILE_SHARE_READ = 1;
constexpr DWORD FILE_SHARE_WRITE = 2;
constexpr DWORD OPEN_EXISTING = 3;

/// Opens a device of the seam by its whole name ("\\\\.\\" and a word), whatever its case; files
/// are opened by OpenFile. `disposition` must be OPEN_EXISTING; the rest may be anything.
/// INVALID_HANDLE_VALUE if there is no such device.
HANDLE CreateFileA(const char* name, DWORD access, DWORD share, void* security, DWORD disposition,
                   DWORD flags, HANDLE model);

/// Hands a control code to the device. No device of the seam takes or gives bytes: the buffers are
/// left alone and `returned`, if not null, gets 0. FALSE if the device doesn't know the code.
BOOL DeviceIoControl(HANDLE device, DWORD code, void* input, DWORD inputBytes, void* output,
                     DWORD outputBytes, DWORD* returned, void* overlapped);

/// Closes a device; FALSE if the handle is none.
BOOL CloseHandle(HANDLE device);

// ---- Memory blocks -------------------------------------------------------------------------

constexpr UINT GMEM_MOVEABLE = 0x0002;
constexpr UINT GMEM_ZEROINIT = 0x0040;

/// A movable block of under 2 GiB; null on failure. A block of 0 bytes is given and can't be
/// locked.
HGLOBAL GlobalAlloc(UINT flags, std::size_t bytes);

/// Changes the size and keeps the contents; GMEM_ZEROINIT clears what is new. On failure null,
/// and the old block stays as it was; so does a locked one. The handle stays the same.
HGLOBAL GlobalReAlloc(HGLOBAL block, std::size_t bytes, UINT flags);

/// The block's first byte, good until the matching GlobalUnlock; null on failure.
void* GlobalLock(HGLOBAL block);
BOOL GlobalUnlock(HGLOBAL block); ///< TRUE while more locks stand

/// Frees; null on success, else the handle. Null is taken and does nothing.
HGLOBAL GlobalFree(HGLOBAL block);

// ---- The program, its resources and texts ----------------------------------------------------

constexpr ResourceName RT_BITMAP{2};
constexpr ResourceName RT_DIALOG{5};
constexpr ResourceName RT_ACCELERATOR{9};

/// The handle of a module that is in the process, whatever its name's case: null stands for the
/// program file itself. Null if it isn't there; nothing is loaded.
HMODULE GetModuleHandleA(const char* name);

/// The process's arguments, the program's name first and in quotes, with one blank between them.
const char* GetCommandLineA();

/// Keeps the arguments for GetCommandLineA. Called once, before anything else of the seam.
void SetCommandLineArguments(int count, const char* const* arguments);

/// Finds a resource of the program file by name or number; null if there is none.
HRSRC FindResourceA(HINSTANCE instance, ResourceName name, ResourceName type);

/// Gives a copy of the resource's bytes a handle, until FreeResource. A bitmap's bytes begin with
/// its BITMAPINFOHEADER.
HGLOBAL LoadResource(HINSTANCE instance, HRSRC resource);
const void* LockResource(HGLOBAL resource);
BOOL FreeResource(HGLOBAL resource);
DWORD SizeofResource(HINSTANCE instance, HRSRC resource);

/// Copies string `id` of the string table into buffer, cut to size - 1 characters, and gives its
/// length; 0 and an empty text if there is no such string.
int LoadStringA(HINSTANCE instance, UINT id, char* buffer, int size);

/// Formats with %s, %d, %u and %%; the caller's buffer must hold the result. Gives its length.
[[gnu::format(printf, 2, 3)]] int wsprintfA(char* buffer, const char* format, ...);

/// Loads a module of the seam by name, whatever its case, never one of a directory; null if the
/// seam has none of that name. It is in the process until as many calls of FreeLibrary.
HMODULE LoadLibraryA(const char* name);
BOOL FreeLibrary(HMODULE module); ///< FALSE if nobody has it loaded

/// An entry of a module that is in the process, by its exact name; null if there is none.
using FARPROC = void (*)();
FARPROC GetProcAddress(HMODULE module, const char* name);

/// Seconds since 1970, from the clock of the wall, or from the clock moved by hand.
DWORD WallClockSeconds();

// ---- Profile ---------------------------------------------------------------------------------
//
// A profile file named without a directory lies in $XDG_CONFIG_HOME/dorbo (~/.config/dorbo). It
// is text: "[section]" lines, "key=value" lines, CR LF at each end; names match whatever their
// case, blanks round names and values are dropped, and one pair of quotes round a value is.
// A file is written whole beside the old one and renamed into its place; one that is read-only
// by its mode bits is left alone. Lines that are neither are kept as they stand. A file of over
// 16 MiB counts as one without keys and is left alone too. Of two sections or keys of the same
// name the first holds.

/// The key's value as a number, read as decimal digits up to the first other character, wrapping
/// at 32 bits; `otherwise` if the key is missing.
UINT GetPrivateProfileIntA(const char* section, const char* key, int otherwise, const char* file);

/// Copies the key's value, or `otherwise` if the key is missing, cut to size - 1 characters;
/// gives the length copied.
DWORD GetPrivateProfileStringA(const char* section, const char* key, const char* otherwise,
                               char* buffer, DWORD size, const char* file);

/// Sets the key's value. FALSE, and the file as it was, if it can't be written whole, if the value
/// holds a line end, or if it was asked for when the file couldn't be read: what the caller took
/// for it then is no value to keep, until it has been read. A value that stands already is not
/// written again. Of several processes that write at once none loses what another has written.
BOOL WritePrivateProfileStringA(const char* section, const char* key, const char* value,
                                const char* file);
