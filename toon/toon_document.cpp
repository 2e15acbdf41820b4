#include "toon/toon_document.h"

#include "platform/menus.h"
#include "platform/trace.h"

#include <algorithm>
#include <cstring>

const char ToonMagic[22] = "Dorbo Toon Frame File";

ToonHeader ToonDocHeader;
HGLOBAL FrameStore;
LONG FrameCount = 1;
LONG CurrentFrameIndex = 0;
char ToonFileName[TOON_PATH_SIZE];
DWORD ToonDirty = 0;
LONG ToonSpeed = 3;
LONG BackgroundIndex = 0;
char CaptionText[TOON_CAPTION_SIZE];
DWORD StageSize = 0;
ToonFrame EditFrame;
OPENFILENAME ToonFileDialog;

/// Records that FrameStore has room for, 0 while it is absent.
static LONG FrameStoreSize = 0;

static constexpr UINT SAVE_MENU_ITEM = 113;
static constexpr std::size_t MESSAGE_SIZE = 512; // the longest message with the longest name in it

// ---- Frames -----------------------------------------------------------------------------------

void CopyText(char* target, const char* source, std::size_t size) {
    const std::size_t length = std::min(strnlen(source, size), size - 1);
    std::memcpy(target, source, length);
    target[length] = '\0';
}

static void CopyFrame(ToonFrame* target, const ToonFrame* source) {
    target->x = source->x;
    target->y = source->y;
    target->pose = source->pose;
    target->pause = source->pause;
    target->wink = source->wink;
    CopyText(target->text, source->text, TOON_TEXT_SIZE);
}

/// Bytes of that many records, or 0 if one transfer, which counts in 31 bits, can't move them.
static LONG FrameBytes(LONG count) {
    constexpr LONG size = sizeof(ToonFrame);
    constexpr LONG most = INT32_MAX / size;
    return count >= 0 && count <= most ? count * size : 0;
}

static void HoldFrameCount() {
    FrameCount = std::clamp(FrameCount, 0, FrameStoreSize);
}

void FrameStoreFree() {
    GlobalFree(FrameStore);
    FrameStore = nullptr;
    FrameStoreSize = 0;
}

int FrameStoreAlloc(LONG count) {
    FrameStoreFree();
    const LONG bytes = FrameBytes(count);
    if (bytes == 0 && count != 0) {
        return 0;
    }
    FrameStore = GlobalAlloc(GMEM_MOVEABLE | GMEM_ZEROINIT, static_cast<std::size_t>(bytes));
    if (!FrameStore) {
        return 0;
    }
    FrameStoreSize = count;
    return 1;
}

int FrameStoreGrow() {
    const LONG bytes = FrameBytes(FrameCount);
    if (!FrameStore || bytes == 0 ||
        !GlobalReAlloc(FrameStore, static_cast<std::size_t>(bytes), GMEM_ZEROINIT)) {
        HoldFrameCount();
        return 0;
    }
    FrameStoreSize = FrameCount;
    return 1;
}

int FrameStoreInsert(LONG index) {
    if (index < 0 || index > FrameCount || FrameCount >= TOON_FRAME_LIMIT) {
        return 0;
    }
    const LONG behind = FrameCount - index;
    ++FrameCount;
    if (!FrameStoreGrow()) {
        return 0;
    }
    ToonFrame* frames = static_cast<ToonFrame*>(GlobalLock(FrameStore));
    if (frames == nullptr) {
        return 0;
    }
    std::memmove(frames + index + 1, frames + index, static_cast<std::size_t>(FrameBytes(behind)));
    frames[index] = {};
    GlobalUnlock(FrameStore);
    return 1;
}

int FrameStoreDelete(LONG index) {
    if (index < 0 || index >= FrameCount || FrameCount > FrameStoreSize) {
        return 0;
    }
    ToonFrame* frames = static_cast<ToonFrame*>(GlobalLock(FrameStore));
    if (frames == nullptr) {
        return 0;
    }
    const LONG behind = FrameCount - index - 1;
    std::memmove(frames + index, frames + index + 1, static_cast<std::size_t>(FrameBytes(behind)));
    frames[FrameCount - 1] = {};
    GlobalUnlock(FrameStore);
    if (FrameCount > 1) {
        --FrameCount;
        FrameStoreGrow(); // a store that can't shrink serves as well
    }
    return 1;
}

/// Locks the store for one record; null if it has no such record. GlobalUnlock ends it.
static ToonFrame* LockFrame(LONG index) {
    if (index < 0 || index >= FrameStoreSize) {
        return nullptr;
    }
    ToonFrame* frames = static_cast<ToonFrame*>(GlobalLock(FrameStore));
    return frames == nullptr ? nullptr : frames + index;
}

int FrameGet(LONG index, ToonFrame* out) {
    const ToonFrame* frame = index < FrameCount ? LockFrame(index) : nullptr;
    if (frame == nullptr) {
        return 0;
    }
    CopyFrame(out, frame);
    GlobalUnlock(FrameStore);
    return 1;
}

int FramePut(LONG index, const ToonFrame* in) {
    ToonFrame* frame = LockFrame(index);
    if (frame == nullptr) {
        return 0;
    }
    CopyFrame(frame, in);
    GlobalUnlock(FrameStore);
    return 1;
}

// ---- The Toon ---------------------------------------------------------------------------------

void ToonSetDirty(HWND window, DWORD dirty) {
    ToonDirty = dirty;
    EnableMenuItem(GetMenu(window), SAVE_MENU_ITEM, dirty != 0 ? MF_ENABLED : MF_GRAYED);
}

/// position * present / recorded, truncated toward zero. Meant: the product wraps at 32 bits, which
/// decides where a far-off position comes to lie, and a recorded size of 0 leaves the axis alone.
static LONG ScaleAxis(LONG position, LONG present, WORD recorded) {
    if (recorded == 0) {
        return position;
    }
    const DWORD product = static_cast<DWORD>(present) * static_cast<DWORD>(position);
    return static_cast<LONG>(product) / recorded;
}

int ScaleToStage(HWND stage, POINT* point) {
    const DWORD size = ToonDocHeader.windowSize;
    if (size == 0) {
        return 0;
    }
    RECT area{};
    GetClientRect(stage, &area);
    point->x = ScaleAxis(point->x, area.right - area.left, LOWORD(size));
    point->y = ScaleAxis(point->y, area.bottom - area.top, HIWORD(size));
    return 1;
}

void ToonNewDefaults() {
    std::memcpy(ToonDocHeader.magic, ToonMagic, sizeof ToonMagic);
    ToonDocHeader.version = TOON_VERSION;
    CopyText(ToonDocHeader.caption, CaptionText, TOON_CAPTION_SIZE);
    ToonDocHeader.windowSize = StageSize;
    ToonDocHeader.frameCount = 1;
    ToonDocHeader.speed = TOON_DEFAULT_SPEED;
    ToonDocHeader.background = TOON_DEFAULT_BACKGROUND;
}

int ToonFileSetup(HWND owner) {
    static const char filter[] = "Dorbo Toon Files (*.zkt)\0*.zkt\0";
    static char customFilter[40];
    ToonFileDialog = {};
    ToonFileDialog.lStructSize = 76;
    ToonFileDialog.hwndOwner = owner;
    ToonFileDialog.lpstrFilter = filter;
    ToonFileDialog.lpstrCustomFilter = customFilter;
    ToonFileDialog.nMaxCustFilter = sizeof customFilter;
    ToonFileDialog.nFilterIndex = 1;
    ToonFileDialog.lpstrFile = ToonFileName;
    ToonFileDialog.nMaxFile = sizeof ToonFileName;
    ToonFileDialog.lpstrInitialDir = "";
    ToonSetDirty(owner, 0);
    return 1;
}

// ---- Its file ---------------------------------------------------------------------------------

static void TellError(HWND owner, const char* text, UINT icon) {
    MessageBoxA(owner, text, nullptr, icon);
}

static HCURSOR ShowWaitCursor() {
    return SetCursor(LoadCursorA(nullptr, IDC_WAIT));
}

int ToonWriteHeader(HFILE file) {
    constexpr LONG size = sizeof ToonDocHeader;
    ToonDocHeader.frameCount = FrameCount;
    return _hwrite(file, &ToonDocHeader, size) == size;
}

int ToonReadHeader(HWND owner, HFILE file) {
    constexpr LONG size = sizeof ToonDocHeader;
    FrameCount = ToonDocHeader.frameCount;
    if (_hread(file, &ToonDocHeader, size) < size) {
        return 0;
    }
    if (ToonDocHeader.version != TOON_VERSION) {
        char message[MESSAGE_SIZE];
        wsprintfA(message, "Invalid ToonFile Version %s.", ToonFileName);
        TellError(owner, message, MB_ICONEXCLAMATION);
        return 0;
    }
    ToonSpeed = ToonDocHeader.speed;
    BackgroundIndex = ToonDocHeader.background;
    CopyText(CaptionText, ToonDocHeader.caption, TOON_CAPTION_SIZE);
    return 1;
}

/// Writes header and frames; 1 if all went out.
static int WriteToon(HFILE file, const void* frames) {
    const HCURSOR before = ShowWaitCursor();
    const int header = ToonWriteHeader(file);
    const LONG bytes = FrameBytes(FrameCount);
    const LONG written = bytes == 0 ? 0 : _hwrite(file, frames, bytes);
    _lclose(file);
    SetCursor(before);
    return header == 1 && written == bytes;
}

int ToonSave(HWND owner) {
    char message[MESSAGE_SIZE];
    HoldFrameCount();
    OFSTRUCT found;
    const HFILE file = FrameStore
                           ? OpenFile(ToonFileName, &found, OF_CREATE | OF_PROMPT | OF_CANCEL)
                           : HFILE_ERROR;
    if (file == HFILE_ERROR) {
        wsprintfA(message, "Cannot write to %s.", ToonFileName);
        TellError(owner, message, MB_ICONEXCLAMATION);
        return 0;
    }
    const int written = WriteToon(file, GlobalLock(FrameStore));
    if (written == 1) {
        ToonSetDirty(owner, 0);
    } else {
        wsprintfA(message, "Error writing to %s.", ToonFileName);
        TellError(owner, message, MB_ICONHAND);
    }
    GlobalUnlock(FrameStore);
    return written;
}

/// How many records a file's size stands for; -1 if it is too small for a header or too large for
/// a count. The header counts as 103 bytes, so that a last record short of one byte is a record
/// too. Meant.
static LONG CountFrames(HFILE file) {
    constexpr std::uint64_t headerSize = sizeof(ToonHeader) - 1;
    DWORD high = 0;
    const DWORD low = GetFileSize(file, &high);
    const std::uint64_t size = static_cast<std::uint64_t>(high) << 32 | low;
    if (size < headerSize) {
        return -1;
    }
    const std::uint64_t count = (size - headerSize) / sizeof(ToonFrame);
    return count <= INT32_MAX ? static_cast<LONG>(count) : -1;
}

/// Reads `count` records into the store and closes the file; what doesn't come stays zero, after a
/// message.
static void ReadFrames(HWND owner, HFILE file, LONG count) {
    const LONG bytes = FrameBytes(count);
    const HCURSOR before = ShowWaitCursor();
    void* frames = GlobalLock(FrameStore);
    const LONG read = frames == nullptr ? 0 : _hread(file, frames, bytes);
    SetCursor(before);
    if (read < bytes) {
        char message[MESSAGE_SIZE];
        wsprintfA(message, "Error reading %s.", ToonFileName);
        TellError(owner, message, MB_ICONEXCLAMATION);
    }
    _lclose(file);
    GlobalUnlock(FrameStore);
}

/// Loads an open file and closes it. Gives its number of frames, 0 for failure.
static LONG ReadToon(HWND owner, HFILE file) {
    const LONG count = CountFrames(file);
    if (!FrameStoreAlloc(count)) {
        TellError(owner, "Not enough memory.", MB_ICONHAND);
        _lclose(file);
        return 0;
    }
    if (!ToonReadHeader(owner, file)) {
        _lclose(file);
        return 0;
    }
    ReadFrames(owner, file, count);
    return count;
}

LONG ToonLoad(HWND owner) {
    if (ToonFileName[0] == '\0') {
        return 0;
    }
    OFSTRUCT found;
    const HFILE file = OpenFile(ToonFileName, &found, OF_READWRITE);
    if (file == HFILE_ERROR) {
        TellError(owner, "Error opening file", MB_ICONHAND);
        return 0;
    }
    const LONG count = ReadToon(owner, file);
    if (count == 0) {
        HoldFrameCount();
        return 0;
    }
    FrameCount = count;
    Trace("load file=%s count=%d", ToonFileName, count);
    return count;
}

LONG ToonReload(HWND owner) {
    return ToonLoad(owner);
}

int ToonOpenNamed(HWND stage, const char* name) {
    const bool fits = std::strlen(name) < sizeof ToonFileName;
    CopyText(ToonFileName, fits ? name : "", sizeof ToonFileName);
    ToonFileSetup(stage);
    const LONG count = ToonReload(stage);
    if (count == 0) {
        return 0;
    }
    FrameCount = count;
    CurrentFrameIndex = 0;
    FrameGet(0, &EditFrame);
    return 1;
}
