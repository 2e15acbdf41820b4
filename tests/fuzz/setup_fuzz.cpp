// A user at random in the setup dialog, and in the player and the editor that it opens. What the
// bytes mean stands in user.h; how it is run: docs/fuzzing.md.
#include "editor/editor_shell.h"
#include "platform/kernel.h"
#include "saver/saver_main.h"
#include "saver/toon_player.h"
#include "tests/fuzz/fuzz.h"
#include "tests/fuzz/ground.h"
#include "toon/settings.h"

namespace {

/// One window at a time, from the innermost loop outwards.
void closeOne() {
    constexpr const char* title = "Fenky Dorbo's Rematch";
    if (IsWindow(PlayerWindow)) {
        PostMessageA(PlayerWindow, WM_CLOSE, 0, 0);
    } else if (EditorMainWindow) {
        PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0);
    } else {
        PostMessageA(FindWindowA("dialog", title), WM_COMMAND, IDCANCEL, 0);
    }
}

void setUp(std::string_view bytes) {
    fuzz::runWithUser(bytes,
                      {[] { demand(RunSetup(nullptr) == 1); }, closeOne, fuzz::checkFrameEditor});
    demand(!EditorMainWindow && !IsWindow(PlayerWindow));
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int* /*count*/, char*** /*words*/) {
    standAlone();
    SaverInstance = GetModuleHandleA(nullptr);
    setUp("");
    fuzz::warm = true;
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    setUp(textOf(bytes, size));
    return 0;
}
