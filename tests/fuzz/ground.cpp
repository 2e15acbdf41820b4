#include "tests/fuzz/ground.h"

#include "cli/replay.h"
#include "cli/toon_record.h"
#include "editor/command_ids.h"
#include "editor/frame_fields.h"
#include "platform/kernel.h"
#include "platform/menus.h"
#include "stage/editor_host.h"
#include "tests/fuzz/fuzz.h"
#include "toon/settings.h"

#include <QClipboard>
#include <QGuiApplication>

#include <cstring>
#include <iterator>
#include <limits>

namespace fuzz {

namespace fs = std::filesystem;

/// One that loads, with numbers and texts that the editor would not have made.
static Toon oddToon(LONG number) {
    ToonFrame frame{number, number, number, number, number, "", 0};
    std::memset(frame.text, 'W', sizeof frame.text);
    Toon toon{NewHeader(), {frame, {300, 200, 1, 1, 0, "Well", 0}, frame}};
    std::memset(toon.header.magic, 'M', sizeof toon.header.magic);
    std::memset(toon.header.caption, 'C', sizeof toon.header.caption);
    toon.header.speed = toon.header.background = number;
    return toon;
}

void beginAnew(const fs::path& toons) {
    const std::pair<const char*, std::vector<ToonFrame>> plain[] = {
        {"two.zkt", {{200, 300, 1, 2, 0, "One", 0}, {300, 300, 2, 2, 1, "Two", 0}}},
        {"one.zkt", {{600, 400, 3, 1, 1, "", 0}}},
        {"still.zkt", {{400, 400, 3, 0, 0, "", 0}, {500, 500, 3, 1, 0, "", 0}}},
        {"locked.zkt", {{400, 400, 3, 1, 0, "", 0}}},
        {"Sub/deep.zkt", {{400, 400, 3, 1, 0, "", 0}}},
    };
    fs::create_directories(toons / "Sub");
    for (const auto& [name, frames] : plain) {
        Toon toon{NewHeader(), frames};
        toon.header.windowSize = MAKELONG(1500, 1400);
        toon.header.speed = 5;
        writeBytes(toons / name, ToonBytes(toon));
    }
    fs::permissions(toons / "locked.zkt", fs::perms::owner_read);
    writeBytes(toons / "high.zkt", ToonBytes(oddToon(std::numeric_limits<LONG>::max())));
    writeBytes(toons / "low.zkt", ToonBytes(oddToon(std::numeric_limits<LONG>::min())));
    writeBytes(toons / "none.zkt", "no Toon");
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

void checkToons(const fs::path& toons) {
    for (const auto& entry : fs::recursive_directory_iterator(toons)) {
        if (entry.is_regular_file() && entry.path().filename() != "none.zkt") {
            std::ifstream in(entry.path(), std::ios::binary);
            const std::string bytes(std::istreambuf_iterator<char>(in), {});
            Toon toon{};
            demand(ToonFromBytes(bytes, toon).empty() && !toon.frames.empty());
        }
    }
}

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
    const auto pose = static_cast<std::int32_t>(static_cast<std::uint32_t>(EditPose) + 1);
    demand(label == "Frame P&ose = " + std::to_string(pose));
}

} // namespace fuzz
