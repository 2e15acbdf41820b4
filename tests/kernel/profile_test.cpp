#include "platform/kernel.h"
#include "platform/kernel/profile_text.h"
#include "tests/kernel/scratch_directory.h"

#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>

namespace {

constexpr const char* file = "Dorbo95.ini";
constexpr const char* section = "Fenky Dorbo Screen Saver";
constexpr const char* ini = "dorbo/Dorbo95.ini";
const std::string heading = "[Fenky Dorbo Screen Saver]\r\n";

class Profile : public ConfigDirectory {
  protected:
    static std::string value(const char* key) {
        char buffer[128] = "?";
        GetPrivateProfileStringA(section, key, "none", buffer, sizeof buffer, file);
        return buffer;
    }

    static bool write(const char* key, const char* text) {
        return WritePrivateProfileStringA(section, key, text, file) != FALSE;
    }
};

TEST(ProfileText, GivesTheValueOfAKey) {
    const std::pair<std::string, const char*> cases[] = {
        {"k=v", "none"},
        {"[S]\nK=v", "v"},
        {"\xEF\xBB\xBF[s]\nk=v", "v"},
        {" [ s ] \r\n\t k \t=  v w \t\r\n", "v w"},
        {"[s]\nk=a=b", "a=b"},
        {"[s]\nk=first\nk=second", "first"},
        {"[s]\n;k=no\n[other]\nk=no\n[s]\nk=no", "none"}, // the first section holds
        {"[s\nk=no\n[s]]\nk=v", "v"},
        {std::string("[s]\nk=v\0w", 9), "v"},
        {std::string("\0\0[s]\n\0\n[s]\nk=v", 15), "v"},
        {"[s]\n" + std::string(1 << 20, 'x') + "\nk=v", "v"},
    };
    for (const auto& [text, expected] : cases) {
        EXPECT_EQ(seam::profileValue(text, "s", "k").value_or("none"), expected)
            << text.substr(0, 40);
    }
}

TEST(ProfileText, TakesAValueInAndKeepsEverythingElse) {
    const std::pair<std::string, std::string> cases[] = {
        {"", "[s]\r\nk=v\r\n"},
        {"[s]\r\nk=old\r\nm=1\r\n", "[s]\r\nk=v\r\nm=1\r\n"},
        {"[S]\n; note\nK = old", "[S]\n; note\nk=v\r\n"},
        {"[s]\nm=1\n\n[a]\nk=a\n", "[s]\nm=1\nk=v\r\n\n[a]\nk=a\n"},
        {"[s]\nm=1\n[s]\nk=2\n", "[s]\nm=1\nk=v\r\n[s]\nk=2\n"},
        {std::string("\0\xff junk", 7), std::string("\0\xff junk\r\n[s]\r\nk=v\r\n", 19)},
    };
    for (const auto& [text, expected] : cases) {
        EXPECT_EQ(seam::profileWithValue(text, "s", "k", "v"), expected) << text;
    }
    for (const char* value : {"", " ", "a ", "\"a\"", "'a'", "\"", "[s]", "=", " \"a\" ", "'"}) {
        const std::string text = seam::profileWithValue("", "s", "k", value);
        EXPECT_EQ(seam::profileValue(text, "s", "k"), value) << text;
    }
}

TEST_F(Profile, ReadsNumbersThatWrapAtThirtyTwoBits) {
    const std::pair<const char*, UINT> cases[] = {{"4294967297", 1}, {"12abc", 12}, {"", 0},
                                                  {"-5", 0},         {"\" 5\"", 0}, {"'5'", 5}};
    for (const auto& [text, expected] : cases) {
        make(ini, heading + "k=" + text);
        EXPECT_EQ(GetPrivateProfileIntA(section, "K", 77, file), expected) << text;
    }
    EXPECT_EQ(GetPrivateProfileIntA(section, "missing", -1, file), 4294967295U);
}

TEST_F(Profile, LiesWithTheUsersSettingsForTheUserAlone) {
    const char* known = std::getenv("HOME");
    const std::string home = known != nullptr ? known : "";
    setenv("HOME", (root_ / "home").c_str(), 1);
    setenv("XDG_CONFIG_HOME", "relative", 1);
    EXPECT_EQ(value("k"), "none");
    EXPECT_FALSE(std::filesystem::exists("home"));
    EXPECT_TRUE(write("k", "v"));
    EXPECT_EQ(textOf("home/.config/dorbo/Dorbo95.ini"), heading + "k=v\r\n");
    EXPECT_EQ(modeOf("home/.config/dorbo"), 0700U);
    EXPECT_EQ(modeOf("home/.config/dorbo/Dorbo95.ini"), 0600U);
    unsetenv("XDG_CONFIG_HOME");
    EXPECT_EQ(value("k"), "v");
    setenv("HOME", home.c_str(), 1);
    EXPECT_TRUE(WritePrivateProfileStringA("s", "k", "v", whole("own.ini").c_str()));
    EXPECT_EQ(textOf("own.ini"), "[s]\r\nk=v\r\n");
    EXPECT_EQ(GetPrivateProfileIntA("s", "k", 9, whole("OWN.INI").c_str()), 0U);
    EXPECT_FALSE(WritePrivateProfileStringA("s", "k", "v", whole("none\\own.ini").c_str()));
}

TEST_F(Profile, IsNotWrittenForAValueThatStandsAndElseReplacedWithItsMode) {
    make(ini, heading + "Paces Walked = 12 \n");
    setMode(ini, 0640);
    const std::filesystem::path second = root_ / "second";
    std::filesystem::create_hard_link(ini, second); // shows whether it was replaced
    EXPECT_TRUE(write("Paces Walked", "12"));
    EXPECT_EQ(std::filesystem::hard_link_count(second), 2U);
    EXPECT_TRUE(write("Paces Walked", "13"));
    EXPECT_EQ(std::filesystem::hard_link_count(second), 1U);
    EXPECT_EQ(textOf(ini), heading + "Paces Walked=13\r\n");
    EXPECT_EQ(modeOf(ini), 0640U);
}

TEST_F(Profile, KeepsTheLinksThatLeadToIt) {
    make("there.ini", "[a]\r\n");
    make("dorbo/x");
    std::filesystem::create_symlink("../second", ini);
    for (const char* target : {"there.ini", "missing.ini"}) {
        std::filesystem::remove("second");
        std::filesystem::create_symlink(target, "second");
        EXPECT_TRUE(write("k", "v"));
        EXPECT_TRUE(std::filesystem::is_symlink(ini));
        EXPECT_TRUE(std::filesystem::is_symlink("second"));
        EXPECT_TRUE(textOf(target).ends_with(heading + "k=v\r\n")) << target;
    }
}

TEST_F(Profile, IsLeftAloneWhereItCannotBeWritten) {
    make("dorbo", "a file");
    EXPECT_FALSE(write("k", "new"));
    EXPECT_EQ(textOf("dorbo"), "a file");
    std::filesystem::remove("dorbo");
    const std::string old = heading + "k=old\r\n" + std::string(5000, '.');
    make(ini, old);
    {
        const FullDisk disk(1000);
        EXPECT_FALSE(write("k", "new"));
    }
    setMode(ini, 0444);
    EXPECT_FALSE(write("k", "new"));
    EXPECT_EQ(value("k"), "old");
    EXPECT_EQ(textOf(ini), old);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator("dorbo"), {}), 1);
    for (const bool pipe : {false, true}) {
        std::filesystem::remove(ini);
        pipe ? mkfifo(ini, 0600) : mkdir(ini, 0700);
        EXPECT_EQ(value("k"), "none");
        EXPECT_FALSE(write("k", "new"));
    }
}

TEST_F(Profile, KeepsWhatTwoProcessesWriteAtOnce) {
    for (int round = 0; round < 50; ++round) {
        const std::string now = std::to_string(round);
        const pid_t other = fork();
        if (other == 0) {
            _exit(write("theirs", now.c_str()) ? 0 : 1);
        }
        EXPECT_TRUE(write("ours", now.c_str()));
        int status = -1;
        waitpid(other, &status, 0);
        EXPECT_EQ(status, 0);
        ASSERT_EQ(value("theirs") + value("ours"), now + now);
    }
}

TEST_F(Profile, RefusesWhatItCouldNotFindAgain) {
    for (const char* key : {"a=b", "", " k", "[k]", "k\r"}) {
        EXPECT_FALSE(write(key, "v")) << key;
    }
    EXPECT_FALSE(write("k", "a\nb"));
    EXPECT_FALSE(write("k", nullptr));
    EXPECT_FALSE(WritePrivateProfileStringA("s]", "k", "v", file));
    EXPECT_FALSE(std::filesystem::exists("dorbo"));
}

TEST_F(Profile, OfSixteenMegabytesIsReadAndALargerOneCountsAsEmpty) {
    constexpr std::uintmax_t limit = 16 << 20;
    make(ini, heading + "k=v\n");
    std::filesystem::resize_file(ini, limit); // the rest is NULs
    EXPECT_EQ(value("k"), "v");
    for (const std::uintmax_t size : {limit + 1, std::uintmax_t{1} << 40}) {
        std::filesystem::resize_file(ini, size);
        EXPECT_EQ(value("k"), "none");
        EXPECT_FALSE(write("k", "w"));
        EXPECT_EQ(std::filesystem::file_size(ini), size);
    }
}

} // namespace
