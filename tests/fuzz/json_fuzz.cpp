// Any bytes for the reader of JSON, and for the other way round: what is shown of a Toon makes a
// Toon that shows the same.
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

void prepare() {}

void tryInput(std::string_view bytes) {
    Toon toon{};
    if (ToonFromBytes(bytes, toon).empty()) {
        checkShown(toon);
    }
    const ToonFromJson made = JsonToToon(bytes);
    if (made.error.empty()) {
        checkShown(made.toon);
        checkWritten(made.toon);
    } else {
        demand(made.error.front() >= '1' && made.error.front() <= '9'); // it names a line
    }
}
