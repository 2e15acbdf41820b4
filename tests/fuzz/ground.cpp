#include "tests/fuzz/ground.h"

#include "cli/replay.h"
#include "cli/toon_record.h"
#include "editor/command_ids.h"
#include "editor/editor_shell.h"
#include "editor/frame_fields.h"
#include "platform/harness.h"
#include "platform/kernel.h"
#include "platform/menus.h"
#include "stage/backdrop.h"
#include "stage/editor_host.h"
#include "tests/fuzz/fuzz.h"
#include "toon/settings.h"

#include <QApplication>
#include <QClipboard>

#include <cstring>
#include <iterator>
#include <limits>

namespace fuzz {

namespace {

namespace fs = std::filesystem;

void writeToon(const fs::path& path, const std::vector<ToonFrame>& frames) {
    Toon toon{NewHeader(), frames};
    toon.header.windowSize = MAKELONG(1500, 1400);
    toon.header.speed = 5;
    writeBytes(path, ToonBytes(toon));
}

/// A Toon that loads, with numbers and texts that the editor would not have made.
void writeOddToon(const fs::path& path, LONG number) {
    ToonFrame frame{number, number, number, number, number, "", 0};
    std::memset(frame.text, 'W', sizeof frame.text);
    Toon toon{NewHeader(), {frame, {300, 200, 1, 1, 0, "Well", 0}, frame}};
    std::memset(toon.header.magic, 'M', sizeof toon.header.magic);
    std::memset(toon.header.caption, 'C', sizeof toon.header.caption);
    toon.header.speed = toon.header.background = number;
    writeBytes(path, ToonBytes(toon));
}

void putToons(const fs::path& toons) {
    fs::create_directories(toons / "Sub");
    writeToon(toons / "two.zkt", {{200, 300, 1, 2, 0, "One", 0}, {300, 300, 2, 2, 1, "Two", 0}});
    writeToon(toons / "one.zkt", {{600, 400, 3, 1, 1, "", 0}});
    writeToon(toons / "still.zkt", {{400, 400, 3, 0, 0, "", 0}, {500, 500, 3, 1, 0, "", 0}});
    writeToon(toons / "locked.zkt", {{400, 400, 3, 1, 0, "", 0}});
    writeToon(toons / "Sub" / "deep.zkt", {{400, 400, 3, 1, 0, "", 0}});
    fs::permissions(toons / "locked.zkt", fs::perms::owner_read);
    writeOddToon(toons / "high.zkt", std::numeric_limits<LONG>::max());
    writeOddToon(toons / "low.zkt", std::numeric_limits<LONG>::min());
    writeBytes(toons / "none.zkt", "no Toon");
}

void checkToons(const fs::path& toons) {
    for (const auto& entry : fs::recursive_directory_iterator(toons)) {
        if (!entry.is_regular_file() || entry.path().filename() == "none.zkt") {
            continue;
        }
        std::ifstream in(entry.path(), std::ios::binary);
        const std::string bytes(std::istreambuf_iterator<char>(in), {});
        Toon toon{};
        demand(ToonFromBytes(bytes, toon).empty());
        demand(!toon.frames.empty());
    }
}

/// As in a fresh process of a user who has the program for a while.
void beginAnew() {
    ForgetEarlierStages();
    ToonDirty = 0;
    WalkingStyle = Statements = Backgrounds = 1;
    PacesWalked = 100;
    GetCurrentDirectoryA(sizeof Directory, Directory);
    SettingsSave();
    seam::useManualClock(1);
    if (QGuiApplication::instance() != nullptr) {
        QGuiApplication::clipboard()->clear();
    }
}

/// The quit that a window's end has posted, and what the toolkit puts off.
void takeWhatIsLeft() {
    seam::runUntil(seam::clockNow());
    DeleteObject(BackdropBitmap); // the next stage's start would free it
    BackdropBitmap = nullptr;
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

} // namespace

void checkFrameEditor() {
    if (!EditorDialog) {
        return;
    }
    ToonFrame frame{};
    demand(FrameCount >= 1 && CurrentFrameIndex >= 0 && CurrentFrameIndex < FrameCount);
    demand(FrameGet(FrameCount - 1, &frame) == 1);
    demand(FramePut(FrameCount, &frame) == 0); // the store has no more
    demand(SendDlgItemMessageA(EditorDialog, FRAME_LIST, CB_GETCOUNT, 0, 0) == FrameCount);
    demand(FrameListSelection(EditorDialog) == CurrentFrameIndex);
    const HMENU menu = GetMenu(EditorDialog);
    const BOOL grey = EnableMenuItem(menu, ITEM_SAVE, MF_GRAYED);
    EnableMenuItem(menu, ITEM_SAVE, static_cast<UINT>(grey));
    demand((grey == MF_GRAYED) == (ToonDirty == 0));
    char label[40];
    GetDlgItemTextA(EditorDialog, POSE_BUTTON, label, sizeof label);
    demand(label == "Frame P&ose = " + std::to_string(static_cast<std::int32_t>(
                                           static_cast<std::uint32_t>(EditPose) + 1)));
}

void runWithUser(std::string_view bytes, const Place& place) {
    const ReplayGround ground;
    putToons(ground.toons());
    beginAnew();
    GetSystemMetrics(SM_CXSCREEN); // makes the toolkit
    const seam::HandleCounts handles = seam::liveHandles();
    const auto widgets = QApplication::topLevelWidgets().size();
    const auto windows = QGuiApplication::topLevelWindows().size();
    {
        const User user(bytes, ground.toons(), place);
        place.run();
    }
    takeWhatIsLeft();
    demand(!warm || seam::liveHandles() == handles);
    demand(!warm || QApplication::topLevelWidgets().size() == widgets);
    demand(!warm || QGuiApplication::topLevelWindows().size() == windows);
    checkToons(ground.toons());
}

} // namespace fuzz
