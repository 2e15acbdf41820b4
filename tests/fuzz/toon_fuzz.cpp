// Any bytes for a Toon's file: a load may refuse them and keeps its promises, and what loads is
// saved, loaded again and shown to its end, or for the first minute of it. How it is run:
// docs/fuzzing.md.
#include "cli/replay.h"
#include "tests/fuzz/fuzz.h"
#include "toon/toon_document.h"

#include <cstring>

namespace {

constexpr std::int64_t longestShow = 60'000; // ms

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

void show(const std::filesystem::path& file, ReplayMode mode, bool faulty) {
    ReplayOptions options;
    options.mode = mode;
    options.toons = {file};
    options.width = 320;
    options.height = 240;
    options.paces = 100;
    options.longest = longestShow;
    const seam::HandleCounts before = seam::liveHandles();
    const ReplayEnd end = Replay(options, {});
    demand(seam::liveHandles() == before);
    demand(end.message.empty() != faulty);
    demand(end.moment <= longestShow);
}

} // namespace

extern "C" int LLVMFuzzerInitialize(int* /*count*/, char*** /*words*/) {
    standAlone();
    for (const ReplayMode mode : {ReplayMode::player, ReplayMode::saver}) {
        ReplayOptions options;
        options.mode = mode;
        options.longest = 1;
        Replay(options, {}); // what is made once for the process
    }
    return 0;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    static const std::filesystem::path file = scratchDirectory() / "x.zkt";
    const std::string_view text = textOf(bytes, size);
    writeBytes(file, text);
    const bool faulty = load(file);
    writeBytes(file, text);
    const bool odd = size > 0 && bytes[size - 1] % 2 == 1; // a byte that a frame doesn't use
    show(file, odd ? ReplayMode::saver : ReplayMode::player, faulty);
    return 0;
}
