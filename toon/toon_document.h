// The open Toon of the process: its header, its frames, its name, and its file.
//
// A Toon file is one ToonHeader and behind it the ToonFrames, integers little-endian, text in
// Windows-1252. docs/toon-format.md tells it for those who write tools.
//
// Operations give 1 or a count for success and 0 for failure. `owner` is the window over which
// message boxes stand.
#pragma once

#include "platform/common_dialogs.h"
#include "platform/kernel.h"
#include "platform/user.h"

#include <bit>

static_assert(std::endian::native == std::endian::little,
              "records are read as they stand in a file");

// ---- Records ----------------------------------------------------------------------------------

constexpr std::size_t TOON_MAGIC_SIZE = 32;
constexpr std::size_t TOON_CAPTION_SIZE = 52; // NUL included
constexpr std::size_t TOON_TEXT_SIZE = 70;    // NUL included
constexpr std::size_t TOON_PATH_SIZE = 256;   // NUL included
constexpr DWORD TOON_VERSION = 0x20001;
constexpr LONG TOON_DEFAULT_SPEED = 3;
constexpr LONG TOON_DEFAULT_BACKGROUND = 1;
constexpr LONG TOON_FRAME_LIMIT =
    251; // frames that the editor makes; a longer file loads and plays

struct ToonHeader {
    char magic[TOON_MAGIC_SIZE]; // ToonMagic, never looked at
    DWORD version;               // TOON_VERSION, the one field that a load checks
    char caption[TOON_CAPTION_SIZE];
    DWORD windowSize; // pixels of the stage it was made on: width below, height above
    LONG frameCount;  // as of the last save; a file's size decides, not this
    LONG speed;       // 1 (slow) to 5 (fast), unchecked
    LONG background;  // n for the tile bgNN, unchecked
};

struct ToonFrame {
    LONG x; // where the character's centre is to stand on the stage it was made on, in pixels
    LONG y;
    LONG pose;  // 0 to 7, unchecked
    LONG pause; // seconds to stay
    LONG wink;  // nonzero: he blinks on arrival
    char text[TOON_TEXT_SIZE];
    WORD reserved; // never written
};

static_assert(sizeof(ToonHeader) == 104 && offsetof(ToonHeader, version) == 32 &&
              offsetof(ToonHeader, caption) == 36 && offsetof(ToonHeader, windowSize) == 88 &&
              offsetof(ToonHeader, frameCount) == 92 && offsetof(ToonHeader, speed) == 96 &&
              offsetof(ToonHeader, background) == 100);
static_assert(sizeof(ToonFrame) == 92 && offsetof(ToonFrame, y) == 4 &&
              offsetof(ToonFrame, pose) == 8 && offsetof(ToonFrame, pause) == 12 &&
              offsetof(ToonFrame, wink) == 16 && offsetof(ToonFrame, text) == 20 &&
              offsetof(ToonFrame, reserved) == 90);

/// "Dorbo Toon Frame File", 22 bytes with its NUL: what a new header begins with.
extern const char ToonMagic[22];

// ---- The open Toon ----------------------------------------------------------------------------

/// The header in memory. Loads and the configuration dialog write it.
extern ToonHeader ToonDocHeader;

/// The frames, null while absent. Only this file's operations write it.
extern HGLOBAL FrameStore;

/// Frames in force, 1 at program start. Only this file and the editor write it.
extern LONG FrameCount;

/// The frame that is edited or walked to. The editor, loads and the player write it.
extern LONG CurrentFrameIndex;

/// Path of the Toon, empty while untitled. ToonOpenNamed, the editor and file dialogs write it.
extern char ToonFileName[TOON_PATH_SIZE];

/// 1 while changes are unsaved. ToonSetDirty writes it.
extern DWORD ToonDirty;

/// Speed in force, 3 at program start. Loads and the configuration dialog write it.
extern LONG ToonSpeed;

/// Tile in force. Loads, stage starts, the walk about and the editor write it.
extern LONG BackgroundIndex;

/// Caption in force. Loads and the editor write it.
extern char CaptionText[TOON_CAPTION_SIZE];

/// Size of the present stage in pixels: low 16 bits width, high 16 bits height. Its host writes it.
extern DWORD StageSize;

/// What the frame editor shows. Loads and the editor write it.
extern ToonFrame EditFrame;

/// The record of both file dialogs. ToonFileSetup fills it, each use sets its title.
extern OPENFILENAME ToonFileDialog;

// ---- Frames -----------------------------------------------------------------------------------

/// Copies a text with its NUL into a field of `size` bytes, and stops at the field's last byte,
/// which then is the NUL. Bytes behind the NUL stay.
void CopyText(char* target, const char* source, std::size_t size);

/// Frees the store if there is one.
void FrameStoreFree();

/// Frees the old store and makes one of `count` frames, all zero. 0 if that can't be had, for a
/// negative count too; there is no store then. FrameCount stays.
int FrameStoreAlloc(LONG count);

/// Fits the store to FrameCount, new frames all zero. On failure, also without a store, 0: the
/// store is as it was, and FrameCount is held to what it has.
int FrameStoreGrow();

/// Puts an all-zero frame before frame `index`, 0 to FrameCount. 0 and no change if the index is
/// out of range, at TOON_FRAME_LIMIT, or without memory.
int FrameStoreInsert(LONG index);

/// Takes frame `index` out. The only frame isn't taken out but cleared: a Toon has one at least.
/// 0 and no change if there is no such frame.
int FrameStoreDelete(LONG index);

/// Copies frame `index` out of the store, or into it: field by field, the text up to its NUL. 0
/// and no change without such a frame. FramePut goes by the store alone, not by FrameCount.
int FrameGet(LONG index, ToonFrame* out);
int FramePut(LONG index, const ToonFrame* in);

// ---- The Toon and its file --------------------------------------------------------------------

/// Notes whether changes are unsaved, and enables or greys File, Save in the window's menu.
void ToonSetDirty(HWND window, DWORD dirty);

/// Scales a point of the Toon's stage to the stage window, toward zero, wrapping at 32 bits. 0 and
/// no change if the Toon has no size. With one half of its size zero that axis stays.
int ScaleToStage(HWND stage, POINT* point);

/// Makes the header that of a new Toon on this stage, with the caption in force.
void ToonNewDefaults();

/// Fills ToonFileDialog but for its title, and clears ToonDirty. Always 1.
int ToonFileSetup(HWND owner);

/// Writes the header with FrameCount in it, 1 if all of it went out.
int ToonWriteHeader(HFILE file);

/// Sets FrameCount from the header in memory, then reads the file's header over it and puts its
/// speed, background and caption into force. 0 if the file ends within it (silently), or after a
/// message for a version that isn't TOON_VERSION.
int ToonReadHeader(HWND owner, HFILE file);

/// Writes the Toon to ToonFileName, over what was there. 0 after a message; without a store that
/// is all, and the file stays. FrameCount is held to what the store has.
int ToonSave(HWND owner);

/// Reads the file ToonFileName. Its size decides how many frames there are, (size - 103) / 92: a
/// last record that lacks one byte counts too. Gives that number, 0 for none and for failure,
/// mostly after a message. Past its opening the frames of before are gone. FrameCount never exceeds
/// the store afterwards.
LONG ToonLoad(HWND owner);

/// Reads the file again, 0 without a name.
LONG ToonReload(HWND owner);

/// Loads a Toon by name for the saver and the player, and selects its first frame. 1, or 0 as
/// ToonLoad. A name that doesn't fit ToonFileName is never cut to another's: 0.
int ToonOpenNamed(HWND stage, const char* name);
