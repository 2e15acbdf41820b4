// Any bytes for the settings file and for the registry: every load ends, what is saved is read
// back, and the setup dialog and the saver bear what they find.
#include "cli/replay.h"
#include "platform/dialogs.h"
#include "platform/kernel.h"
#include "saver/saver_guard.h"
#include "saver/saver_main.h"
#include "saver/setup_dialog.h"
#include "stage/backdrop.h"
#include "tests/fuzz/fuzz.h"
#include "toon/settings.h"

#include <cstring>

namespace {

namespace fs = std::filesystem;

void checkDirectory() {
    const std::size_t length = strnlen(Directory, sizeof Directory);
    demand(length > 0 && length < sizeof Directory && Directory[length - 1] == '\\');
}

void checkRoundTrip() {
    SettingsLoad();
    checkDirectory();
    const LONG style = WalkingStyle;
    PacesWalked += 12345;
    const DWORD paces = PacesWalked;
    const std::string directory = Directory;
    SettingsSave();
    SettingsLoad();
    checkDirectory();
    demand(WalkingStyle == style && PacesWalked == paces);
    demand(Directory == directory);
}

/// The dialog opens, and takes what it shows.
void setUp() {
    const HWND dialog =
        CreateDialogParamA(GetModuleHandleA(nullptr), SETUP_DIALOG, nullptr, SetupDialogProc, 0);
    demand(IsWindow(dialog) != FALSE);
    seam::runUntil(seam::clockNow());
    const std::string directory = Directory;
    PostMessageA(dialog, WM_COMMAND, IDOK, 0);
    seam::runUntil(seam::clockNow());
    DestroyWindow(dialog);
    SettingsLoad();
    demand(Directory == directory);
}

/// The saver starts, and has its password's module if the registry says so.
void startSaver() {
    constexpr std::int64_t longest = 8'000; // ms: titles, and a walk or a frame
    static WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = SaverGuardProc;
    windowClass.lpszClassName = "FuzzedSaver";
    RegisterClassA(&windowClass); // refused, and none the worse, from the second time on
    LoadPasswordModule();
    const HWND stage = CreateWindowExA(0, windowClass.lpszClassName, "", WS_VISIBLE | WS_POPUP, 0,
                                       0, 320, 240, nullptr, nullptr, HINSTANCE{}, nullptr);
    seam::runUntil(seam::clockNow() + longest);
    DestroyWindow(stage);
    seam::runUntil(seam::clockNow()); // takes the quit
    UnloadPasswordModule();
    DeleteObject(BackdropBitmap); // the next stage's start would free it
    BackdropBitmap = nullptr;
}

} // namespace

void tryInput(std::string_view bytes) {
    const ReplayGround ground;
    const auto putSettings = [&] { writeBytes(ground.settingsFile(), bytes); };
    fs::create_directories(ground.settingsFile().parent_path());
    writeBytes(ground.settingsFile().parent_path() / "registry.ini", bytes);
    writeBytes(ground.toons() / "bad.zkt", "no Toon");
    const seam::HandleCounts before = seam::liveHandles();
    ForgetEarlierStages();
    WalkingStyle = Statements = Backgrounds = 1;
    seam::useManualClock(1);
    putSettings();
    checkRoundTrip();
    putSettings();
    setUp();
    fs::current_path(ground.toons());
    putSettings();
    startSaver();
    demand(!prepared || seam::liveHandles() == before);
}

void prepare() {
    seam::answerBoxes([](const std::string&, const std::string&, UINT) { return IDOK; });
    tryInput("");
}
