// The settings survive from run to run, whatever has become of their file.
#include "toon/settings.h"

#include "platform/kernel.h"
#include "tests/kernel/scratch_directory.h"

#include <gmock/gmock.h>

#include <cstring>

namespace {

constexpr const char* file = "dorbo/Dorbo95.ini";

// Taken before anything else runs.
const LONG switchesAtStart[] = {WalkingStyle, Statements, Backgrounds};

class Settings : public ConfigDirectory {
  protected:
    Settings() {
        WalkingStyle = Statements = Backgrounds = 1;
        WalkingStyleChoice = 0;
        PacesWalked = 77;
        std::strcpy(Directory, "");
    }

    void write(const std::string& lines) const {
        make(file, "[Fenky Dorbo Screen Saver]\r\n" + lines);
    }
};

TEST_F(Settings, AFirstRunHasItsDefaultsAndPinsTheDirectory) {
    EXPECT_THAT(switchesAtStart, testing::Each(1));
    SettingsLoad();
    EXPECT_FALSE(SettingsNameDirectory());
    EXPECT_EQ(WalkingStyle + WalkingStyleChoice + Statements + Backgrounds, 4);
    EXPECT_EQ(PacesWalked, 0U);
    EXPECT_EQ(Directory, whole() + "\\");
    SettingsSave();
    EXPECT_TRUE(SettingsNameDirectory());
    std::filesystem::current_path("/");
    SettingsLoad();
    EXPECT_EQ(Directory, whole() + "\\");
}

TEST_F(Settings, AreWrittenInTheirFormAndReadBackWithoutARange) {
    const std::string text = "[Fenky Dorbo Screen Saver]\r\n"
                             "Walking Style=7\r\n"
                             "Statements=4294967295\r\n"
                             "Backgrounds=0\r\n"
                             "Paces Walked=4294967294\r\n"
                             "Directory=C:\\My Toons\\\r\n";
    WalkingStyle = 7;
    Statements = -1;
    Backgrounds = 0;
    PacesWalked = 0xFFFFFFFE;
    std::strcpy(Directory, "C:\\My Toons\\");
    SettingsSave();
    EXPECT_EQ(textOf(file), text);
    WalkingStyle = Statements = Backgrounds = 5;
    PacesWalked = 5;
    std::strcpy(Directory, "");
    SettingsLoad();
    EXPECT_EQ(WalkingStyleChoice, 7);
    SettingsSave();
    EXPECT_EQ(textOf(file), text);
}

TEST_F(Settings, MissingSwitchesKeepWhatMemoryHoldsAndAMissingOdometerIsZero) {
    write("Backgrounds=0\r\n");
    WalkingStyle = Statements = 3;
    SettingsLoad();
    EXPECT_EQ(WalkingStyle + WalkingStyleChoice + Statements + Backgrounds, 9);
    EXPECT_EQ(PacesWalked, 0U);
}

TEST_F(Settings, ADirectoryGetsItsBackslashOnceOrBecomesOne) {
    const std::string fits(126, 'd');
    const std::pair<std::string, std::string> cases[] = {
        {"C:\\Toons", "C:\\Toons\\"},
        {"", "\\"},
        {"D:/Toons/", "D:/Toons/\\"},
        {fits, fits + "\\"},
        {fits + "\\", fits + "\\"},
        {fits + "d", "\\"},            // 127 bytes and no room for the backslash
        {fits + "d\\", "\\"},          // would be cut before it
        {fits + "\\and more\\", "\\"}, // would be cut to another directory
        {std::string(100000, 'd'), "\\"},
    };
    for (const auto& [stored, loaded] : cases) {
        write("Directory=" + stored + "\r\n");
        SettingsLoad();
        EXPECT_EQ(Directory, loaded);
    }
    std::filesystem::remove(file);
    for (const std::size_t length : {126U, 127U, 128U, 200U}) { // of a current directory
        const std::string deep(length - whole("").size() - 1, 'd');
        std::filesystem::create_directory(root_ / deep);
        std::filesystem::current_path(root_ / deep);
        SettingsLoad();
        EXPECT_EQ(Directory, length < 127 ? whole(deep) + "\\" : "\\") << length;
    }
}

} // namespace
