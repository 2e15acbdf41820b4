// Any bytes for the reader of JSON, and for the other way round: what is shown of a Toon makes a
// Toon that shows the same. How it is run: docs/fuzzing.md.
#include "cli/toon_json.h"
#include "tests/fuzz/fuzz.h"

namespace {

void checkShown(const Toon& toon) {
    const std::string json = ToonToJson(toon);
    const ToonFromJson made = JsonToToon(json);
    demand(made.error.empty());
    demand(ToonToJson(made.toon) == json);
    demand(made.warnings.size() <= OddValues(toon).size());
}

/// A file that was written loads as the same bytes.
void checkWritten(const Toon& toon) {
    const std::string file = ToonBytes(toon);
    Toon again{};
    demand(ToonFromBytes(file, again).empty());
    demand(ToonBytes(again) == file);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const std::string_view text = textOf(bytes, size);
    Toon toon{};
    if (ToonFromBytes(text, toon).empty()) {
        checkShown(toon);
    }
    const ToonFromJson made = JsonToToon(text);
    if (made.error.empty()) {
        checkShown(made.toon);
        checkWritten(made.toon);
    } else {
        demand(made.error.front() >= '1' && made.error.front() <= '9'); // it names a line
    }
    return 0;
}
