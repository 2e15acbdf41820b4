// A user at random in the setup dialog, and in the player and the editor that it opens. What the
// bytes mean stands in user.h.
#include "editor/editor_shell.h"
#include "platform/kernel.h"
#include "saver/saver_main.h"
#include "saver/toon_player.h"
#include "tests/fuzz/fuzz.h"
#include "tests/fuzz/user.h"

void tryInput(std::string_view bytes) {
    fuzz::runWithUser(bytes, [] { demand(RunSetup(nullptr) == 1); });
    demand(!EditorMainWindow && !IsWindow(PlayerWindow));
}

void prepare() {
    SaverInstance = GetModuleHandleA(nullptr);
    tryInput("");
}
