// Any bytes for the settings file: every load ends, and what is saved is read back.
//
//   cmake --preset debug -B build/fuzz -DDORBO_FUZZ=ON
//   cmake --build build/fuzz --target profile_fuzz
//   mkdir -p build/fuzz/profiles; dict=tests/fuzz/profile.dict
//   corpus="build/fuzz/profiles tests/fuzz/profiles"
//   build/fuzz/tests/fuzz/profile_fuzz -max_total_time=60 -max_len=400 -dict=$dict $corpus
#include "tests/fuzz/scratch_directory.h"
#include "toon/settings.h"

#include <cstdlib>
#include <cstring>

namespace {

void demand(bool kept) {
    if (!kept) {
        std::abort();
    }
}

void checkDirectory() {
    const std::size_t length = strnlen(Directory, sizeof Directory);
    demand(length > 0 && length < sizeof Directory && Directory[length - 1] == '\\');
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    static const std::filesystem::path& scratch = scratchDirectory();
    static const std::filesystem::path folder = scratch / "dorbo";
    setenv("XDG_CONFIG_HOME", scratch.c_str(), 1);
    std::filesystem::create_directories(folder);
    writeBytes(folder / "Dorbo95.ini", bytes, size);
    SettingsLoad();
    checkDirectory();

    const LONG style = WalkingStyle;
    PacesWalked += 12345;
    const DWORD paces = PacesWalked;
    char directory[sizeof Directory];
    std::strcpy(directory, Directory);
    SettingsSave();
    SettingsLoad();
    checkDirectory();
    demand(WalkingStyle == style && PacesWalked == paces);
    demand(std::strcmp(Directory, directory) == 0);
    return 0;
}
