// A user at random in the Toon editor: its main window, the frame editor, the configuration, the
// pose picker, menus and boxes. What the bytes mean stands in user.h; how it is run:
// docs/fuzzing.md.
#include "editor/editor_shell.h"
#include "platform/kernel.h"
#include "stage/editor_host.h"
#include "tests/fuzz/fuzz.h"
#include "tests/fuzz/ground.h"

namespace {

void edit(std::string_view bytes) {
    fuzz::runWithUser(bytes, {[] { RunEditor(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL); },
                              [] { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); },
                              fuzz::checkFrameEditor});
    demand(!EditorMainWindow && !EditorStage);
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int* /*count*/, char*** /*words*/) {
    standAlone();
    edit("");
    fuzz::warm = true;
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    edit(textOf(bytes, size));
    return 0;
}
