// What tests, benchmarks, replays and film makers ask of the seam. The program never does.
#pragma once

#include "platform/gdi/surface.h"
#include "platform/kernel/faults.h"
#include "platform/types.h"

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <vector>

namespace seam {

// ---- Clock -------------------------------------------------------------------------------------

/// From now on time stands still at 0 and moves by itself only where a loop would wait, straight
/// to the earliest deadline. WallClockSeconds gives `seconds` plus what has passed.
void useManualClock(DWORD seconds);
void useSystemClock();

/// Milliseconds of the clock in use.
std::int64_t clockNow();

/// When the next timer is due; nothing while none runs.
std::optional<std::int64_t> nextDeadline();

/// Handles messages until the clock moved by hand has come to `milliseconds`, or until a loop has
/// been asked to end; gives false then. Deadlines at `milliseconds` itself are met.
bool runUntil(std::int64_t milliseconds);

// ---- Handles -----------------------------------------------------------------------------------

/// Live objects by kind.
struct HandleCounts {
    std::size_t windows = 0;
    std::size_t deviceContexts = 0;
    std::size_t gdiObjects = 0; // without the stock objects
    std::size_t palettes = 0;
    std::size_t memoryBlocks = 0;
    std::size_t files = 0;
    std::size_t searches = 0;
    std::size_t devices = 0;
    std::size_t keys = 0;
    std::size_t modules = 0; // loads that nobody has freed
    std::size_t timers = 0;
    std::size_t menus = 0;

    friend bool operator==(const HandleCounts&, const HandleCounts&) = default;
};

HandleCounts liveHandles();

// Each part of the seam tells of its own.
void countKernelHandles(HandleCounts& counts);
void countGdiHandles(HandleCounts& counts);
void countUserHandles(HandleCounts& counts);

// ---- Boxes, pictures, input --------------------------------------------------------------------

/// Answers message boxes in the user's place while set; gets text, caption and type.
using BoxAnswer = std::function<int(const std::string&, const std::string&, UINT)>;
void answerBoxes(BoxAnswer answer);

/// Answers file dialogs in the user's place while set; gets the title, gives the path that was
/// typed, or nothing for Cancel.
using FileAnswer = std::function<std::optional<std::string>(const std::string& title)>;
void answerFileDialogs(FileAnswer answer);

/// Minimises a top-level window or brings it back, as its window manager would.
void minimise(HWND window, bool minimised);

/// Drops a window class that the program has registered, for it to do so again as a fresh process
/// does. No window of the class may live.
void forgetClass(const std::string& name);

/// A copy of a window's picture, row by row, 0x00rrggbb.
struct Picture {
    int width = 0;
    int height = 0;
    std::vector<DWORD> pixels;
};

Picture windowPicture(HWND window);

/// Told, while set, each time what handlers drew becomes visible, also where no screen shows it:
/// the window, the bounds of what was drawn since it was last told, and the whole picture, which is
/// good until it returns. Nothing is drawn on that window meanwhile.
using PictureWatcher =
    std::function<void(HWND window, const RECT& drawn, const PixelView& picture)>;
void watchPictures(PictureWatcher watcher);

/// The same of a bitmap; monochrome pixels come as 0 and 1.
Picture bitmapPicture(HBITMAP bitmap);

// ---- Faults
// -----------------------------------------------------------------------------------------

/// From now on operations are counted, and the `at`th one of this kind fails; none for 0.
void makeFault(Operation operation, std::size_t at, Fault fault = Fault::error);

/// How many of a kind have been asked for since makeFault, refused ones too.
std::size_t operationsSeen(Operation operation);

void endFaults();

} // namespace seam
