// Any bytes for a Toon's file: a load may refuse them and keeps its promises, and what loads is
// saved, loaded again and shown to its end, or for the first minute of it.
#include "cli/replay.h"
#include "tests/fuzz/fuzz.h"
#include "toon/toon_document.h"

#include <cstring>

namespace {

/// Every frame in force can be read and has its NUL, and there is none behind them.
void checkFrames() {
    ToonFrame frame{};
    demand(FrameCount >= 0);
    for (LONG i = 0; i < FrameCount; ++i) {
        demand(FrameGet(i, &frame) == 1);
        demand(strnlen(frame.text, sizeof frame.text) < sizeof frame.text);
    }
    demand(FrameGet(FrameCount, &frame) == 0 && FrameGet(-1, &frame) == 0);
    demand(FrameStoreDelete(FrameCount) == 0 && FrameStoreInsert(FrameCount + 1) == 0);
    demand(strnlen(CaptionText, sizeof CaptionText) < sizeof CaptionText);
}

/// Loads it; if that can be done, saves it and loads it again. Gives whether a box complained of
/// it.
bool load(const std::filesystem::path& file) {
    bool complained = false;
    seam::answerBoxes([&](const std::string&, const std::string&, UINT) {
        complained = true;
        return IDOK;
    });
    const bool opened = ToonOpenNamed(nullptr, file.c_str()) == 1;
    checkFrames();
    const bool faulty = complained;
    if (opened) {
        const LONG before = FrameCount;
        demand(before > 0);
        demand(ToonSave(nullptr) == 1);
        demand(ToonReload(nullptr) == before);
        FrameStoreInsert(before / 2);
        FrameStoreDelete(0);
        checkFrames();
    }
    FrameStoreFree();
    return faulty;
}

/// As the program shows it, for so many ms at most; without a Toon a walk about.
void show(const std::vector<std::string>& toons, ReplayMode mode, std::int64_t longest,
          bool faulty) {
    ReplayOptions options;
    options.mode = mode;
    options.toons = toons;
    options.width = 320;
    options.height = 240;
    options.paces = 100;
    options.longest = longest;
    const seam::HandleCounts before = seam::liveHandles();
    const ReplayEnd end = Replay(options, {});
    demand(!prepared || seam::liveHandles() == before);
    demand(end.message.empty() != faulty);
    demand(end.moment <= longest);
}

} // namespace

void prepare() {
    show({}, ReplayMode::player, 1, false);
    show({}, ReplayMode::saver, 1, false);
}

void tryInput(std::string_view bytes) {
    const ReplayGround ground;
    const std::filesystem::path file = ground.toons() / "x.zkt";
    writeBytes(file, bytes);
    const bool faulty = load(file);
    writeBytes(file, bytes);
    const bool odd = !bytes.empty() && bytes.back() % 2 != 0; // a byte that a frame doesn't use
    show({file}, odd ? ReplayMode::saver : ReplayMode::player, 60'000, faulty);
}
