// The settings survive from run to run, whatever has become of their file.
#include "tests/toon/toon_fixture.h"

#include "toon/settings.h"

#include <sys/stat.h>

#include <cstdlib>
#include <cstring>
#include <regex>

namespace {

class Settings : public test::InDirectory {
  protected:
    Settings() {
        setenv("XDG_CONFIG_HOME", (directory / "config").c_str(), 1);
        file = directory / "config/dorbo/Dorbo95.ini";
        WalkingStyle = 1;
        WalkingStyleChoice = 0;
        Statements = 1;
        Backgrounds = 1;
        PacesWalked = 0;
        std::strcpy(Directory, "");
    }

    ~Settings() override {
        unsetenv("XDG_CONFIG_HOME");
    }

    void write(const std::string& lines) const {
        std::filesystem::create_directories(file.parent_path());
        test::writeFile(file, "[Fenky Dorbo Screen Saver]\r\n" + lines);
    }

    /// The current directory in the platform's form, with its backslash.
    std::string here() const {
        const std::string path = "C:" + directory.string() + "/";
        return std::regex_replace(path, std::regex("/"), "\\");
    }

    std::filesystem::path file;
};

TEST_F(Settings, AFirstRunHasItsDefaultsAndPinsTheDirectory) {
    SettingsLoad();
    EXPECT_EQ(WalkingStyle, 1);
    EXPECT_EQ(WalkingStyleChoice, 1);
    EXPECT_EQ(Statements, 1);
    EXPECT_EQ(Backgrounds, 1);
    EXPECT_EQ(PacesWalked, 0U);
    EXPECT_EQ(Directory, here());
    SettingsSave();
    std::filesystem::current_path("/");
    SettingsLoad();
    EXPECT_EQ(Directory, here());
}

TEST_F(Settings, AreWrittenInTheirFormAndReadBack) {
    WalkingStyle = 0;
    Statements = 0;
    Backgrounds = 1;
    PacesWalked = 0xFFFFFFFF;
    std::strcpy(Directory, "C:\\My Toons\\");
    SettingsSave();
    EXPECT_EQ(test::readFile(file), "[Fenky Dorbo Screen Saver]\r\n"
                                    "Walking Style=0\r\n"
                                    "Statements=0\r\n"
                                    "Backgrounds=1\r\n"
                                    "Paces Walked=4294967295\r\n"
                                    "Directory=C:\\My Toons\\\r\n");
    WalkingStyle = Statements = 1;
    Backgrounds = 0;
    PacesWalked = 5;
    SettingsLoad();
    EXPECT_EQ(WalkingStyle, 0);
    EXPECT_EQ(WalkingStyleChoice, 0);
    EXPECT_EQ(Statements, 0);
    EXPECT_EQ(Backgrounds, 1);
    EXPECT_EQ(PacesWalked, 0xFFFFFFFFU);
    EXPECT_STREQ(Directory, "C:\\My Toons\\");
}

TEST_F(Settings, MissingSwitchesKeepWhatMemoryHoldsAndAMissingOdometerIsZero) {
    write("Backgrounds=0\r\n");
    WalkingStyle = 0;
    Statements = 0;
    WalkingStyleChoice = 1;
    PacesWalked = 77;
    SettingsLoad();
    EXPECT_EQ(WalkingStyle, 0);
    EXPECT_EQ(WalkingStyleChoice, 0);
    EXPECT_EQ(Statements, 0);
    EXPECT_EQ(Backgrounds, 0);
    EXPECT_EQ(PacesWalked, 0U);
}

TEST_F(Settings, NoValueIsTestedAgainstARange) {
    write("Walking Style=7\r\nStatements=4294967295\r\nBackgrounds=oops\r\nPaces Walked=12x\r\n");
    SettingsLoad();
    EXPECT_EQ(WalkingStyle, 7);
    EXPECT_EQ(Statements, -1);
    EXPECT_EQ(Backgrounds, 0);
    EXPECT_EQ(PacesWalked, 12U);
}

TEST_F(Settings, ADirectoryGetsItsBackslashOnce) {
    const std::string fits(126, 'd');

    struct Case {
        std::string stored;
        std::string loaded;
    };

    const Case cases[] = {
        {"C:\\Toons", "C:\\Toons\\"},
        {"C:\\Toons\\", "C:\\Toons\\"},
        {"", "\\"},
        {"\\", "\\"},
        {"D:/Toons/", "D:/Toons/\\"},
        {fits, fits + "\\"},
        {fits + "\\", fits + "\\"},
        {fits + "d", "\\"},            // 127 bytes and no room for the backslash
        {fits + "d\\", "\\"},          // would be cut before it
        {fits + "\\and more\\", "\\"}, // would be cut to another directory
        {std::string(100000, 'd'), "\\"},
    };
    for (const Case& c : cases) {
        write("Directory=" + c.stored + "\r\n");
        SettingsLoad();
        EXPECT_EQ(Directory, c.loaded);
    }
    write("Directory=C:\\Toons\r\n");
    SettingsLoad();
    SettingsSave();
    EXPECT_NE(test::readFile(file).find("Directory=C:\\Toons\\\r\n"), std::string::npos);
}

TEST_F(Settings, ACurrentDirectoryThatDoesNotFitBecomesABackslash) {
    // As the platform writes it, with "C:" in front.
    for (const std::size_t length : {126U, 127U, 128U, 200U}) {
        const std::size_t name = length - 2 - directory.string().size() - 1;
        const std::filesystem::path deep = directory / std::string(name, 'd');
        std::filesystem::create_directory(deep);
        std::filesystem::current_path(deep);
        SettingsLoad();
        const std::string whole = here() + std::string(name, 'd') + "\\";
        EXPECT_EQ(Directory, length < 127 ? whole : "\\") << length;
    }
}

TEST_F(Settings, TheBackslashIsAddedInPlace) {
    struct Case {
        const char* before;
        const char* after;
    };

    for (const Case& c : {Case{"", "\\"}, Case{"\\", "\\"}, Case{"a", "a\\"}, Case{"a\\", "a\\"},
                          Case{"a/", "a/\\"}}) {
        char text[8];
        std::strcpy(text, c.before);
        EnsureTrailingBackslash(text);
        EXPECT_STREQ(text, c.after);
    }
}

// ---- Files that have come to harm
// ----------------------------------------------------------------

TEST_F(Settings, HarmedFilesReadAsFilesWithoutKeys) {
    std::string garbage;
    for (int i = 0; i < 10000; ++i) {
        garbage += static_cast<char>(i * 7919 >> 3);
    }
    for (const std::string& text :
         {std::string(), garbage, std::string(1 << 20, '='), std::string(1 << 20, '['),
          std::string(1 << 20, '\0'), std::string("Statements=0\r\nPaces Walked=5\r\n")}) {
        std::filesystem::create_directories(file.parent_path());
        test::writeFile(file, text);
        PacesWalked = 5;
        SettingsLoad();
        EXPECT_EQ(Statements, 1);
        EXPECT_EQ(PacesWalked, 0U);
        EXPECT_EQ(Directory, here());
        PacesWalked = 9;
        SettingsSave();
        SettingsLoad();
        EXPECT_EQ(PacesWalked, 9U);
    }
}

TEST_F(Settings, KeysAreFoundBetweenMegabyteLines) {
    const std::string line = std::string(1 << 20, 'x') + "\r\n";
    write(line + "Paces Walked=41\r\n" + line + "Statements=0\r\n" + line);
    SettingsLoad();
    EXPECT_EQ(PacesWalked, 41U);
    EXPECT_EQ(Statements, 0);
    PacesWalked = 42;
    SettingsSave();
    const std::string text = test::readFile(file);
    EXPECT_NE(text.find("Paces Walked=42\r\n"), std::string::npos);
    EXPECT_GT(text.size(), 3U << 20); // what we don't know is kept
}

TEST_F(Settings, ADirectoryInTheFilesPlaceIsLeftAlone) {
    std::filesystem::create_directories(file);
    SettingsLoad();
    EXPECT_EQ(WalkingStyle, 1);
    EXPECT_EQ(Directory, here());
    SettingsSave();
    EXPECT_TRUE(std::filesystem::is_directory(file));
    EXPECT_TRUE(std::filesystem::is_empty(file));
}

TEST_F(Settings, AReadOnlyFileIsReadButNotWritten) {
    write("Paces Walked=41\r\n");
    const std::string before = test::readFile(file);
    chmod(file.c_str(), 0444);
    SettingsLoad();
    EXPECT_EQ(PacesWalked, 41U);
    PacesWalked = 42;
    SettingsSave();
    EXPECT_EQ(test::readFile(file), before);
}

TEST_F(Settings, ASaveThatFindsNoRoomLeavesTheFile) {
    write("Paces Walked=41\r\n");
    const std::string before = test::readFile(file);
    PacesWalked = 42;
    {
        const test::FullDisk disk(20);
        SettingsSave();
    }
    EXPECT_EQ(test::readFile(file), before);
}

} // namespace
