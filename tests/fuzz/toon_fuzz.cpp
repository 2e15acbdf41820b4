// Any bytes for the loader of Toons and for the reader of JSON: they may refuse them, and must keep
// their promises.
//
//   cmake --preset debug -B build/fuzz -DDORBO_FUZZ=ON
//   cmake --build build/fuzz --target toon_fuzz
//   mkdir -p build/fuzz/corpus; export QT_QPA_PLATFORM=offscreen
//   build/fuzz/tests/fuzz/toon_fuzz -max_total_time=60 -dict=tests/fuzz/toon.dict build/fuzz/corpus
//   tests/toon/bad toons
#include "cli/toon_json.h"
#include "platform/harness.h"
#include "tests/fuzz/scratch_directory.h"
#include "toon/toon_document.h"

#include <cstdlib>
#include <cstring>

namespace {

void demand(bool kept) {
    if (!kept) {
        std::abort();
    }
}

/// Every frame in force can be read and has its NUL, and there is none behind them.
void checkFrames() {
    ToonFrame frame{};
    demand(FrameCount >= 0);
    for (LONG i = 0; i < FrameCount; ++i) {
        demand(FrameGet(i, &frame) == 1);
        demand(strnlen(frame.text, sizeof frame.text) < sizeof frame.text);
    }
    demand(FrameGet(FrameCount, &frame) == 0);
    demand(strnlen(CaptionText, sizeof CaptionText) < sizeof CaptionText);
}

/// What is shown of a Toon makes a Toon that shows the same.
void checkShown(const Toon& toon) {
    const std::string json = ToonToJson(toon);
    const ToonFromJson made = JsonToToon(json);
    demand(made.error.empty());
    demand(ToonToJson(made.toon) == json);
}

void checkJson(std::string_view bytes) {
    Toon toon{};
    if (ToonFromBytes(bytes, toon).empty()) {
        checkShown(toon);
    }
    const ToonFromJson made = JsonToToon(bytes);
    if (made.error.empty()) {
        checkShown(made.toon);
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    static const std::filesystem::path file = scratchDirectory() / "x.zkt";
    seam::answerBoxes([](const std::string&, const std::string&, UINT) { return IDOK; });
    writeBytes(file, bytes, size);
    const int opened = ToonOpenNamed(nullptr, file.c_str());
    checkFrames();
    if (opened == 1) {
        const LONG before = FrameCount;
        demand(before > 0);
        demand(ToonSave(nullptr) == 1);
        demand(ToonReload(nullptr) == before);
        FrameStoreInsert(before / 2);
        FrameStoreDelete(0);
        checkFrames();
    }
    checkJson({reinterpret_cast<const char*>(bytes), size});
    return 0;
}
