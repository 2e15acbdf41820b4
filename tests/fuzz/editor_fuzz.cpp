// A user at random in the Toon editor: its main window, the frame editor, the configuration, the
// pose picker, menus and boxes. What the bytes mean stands in user.h.

#include "editor/editor_shell.h"
#include "platform/kernel.h"
#include "stage/editor_host.h"
#include "tests/fuzz/fuzz.h"
#include "tests/fuzz/user.h"

void tryInput(std::string_view bytes) {
    fuzz::runWithUser(bytes, [] { RunEditor(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL); });
    demand(!EditorMainWindow && !EditorStage);
}

void prepare() {
    tryInput("");
}
