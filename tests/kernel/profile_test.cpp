#include "platform/kernel.h"
#include "platform/kernel/profile_text.h"
#include "tests/kernel/scratch_directory.h"

#include <sys/resource.h>
#include <sys/stat.h>
#include <unistd.h>

#include <csignal>
#include <cstdlib>

namespace {

constexpr const char* file = "Dorbo95.ini";
constexpr const char* section = "Fenky Dorbo Screen Saver";
constexpr const char* iniName = "dorbo/Dorbo95.ini";
const std::string heading = "[Fenky Dorbo Screen Saver]\r\n";

/// The settings lie in the test's own directory.
class Profile : public ScratchDirectory {
  protected:
    Profile() {
        setenv("XDG_CONFIG_HOME", root_.c_str(), 1);
    }

    void makeIni(const std::string& text) const {
        make(iniName, text);
    }

    std::string ini() const {
        return textOf(iniName);
    }

    ino_t iniNumber() const {
        struct stat status = {};
        stat((root_ / iniName).c_str(), &status);
        return status.st_ino;
    }

    static std::string value(const char* key, const char* otherwise = "none") {
        char buffer[128] = "?";
        const DWORD length =
            GetPrivateProfileStringA(section, key, otherwise, buffer, sizeof buffer, file);
        EXPECT_EQ(length, std::string(buffer).size());
        return buffer;
    }

    static bool write(const char* key, const char* text) {
        return WritePrivateProfileStringA(section, key, text, file) != FALSE;
    }
};

TEST(ProfileText, GivesTheValueOfAKey) {
    const struct {
        std::string text;
        const char* expected;
    } cases[] = {
        {"", "none"},
        {"k=v", "none"},
        {"[s]\r\nk=v\r\n", "v"},
        {"[S]\nK=v", "v"},
        {"\xEF\xBB\xBF[s]\nk=v", "v"},
        {" [ s ] \r\n\t k \t=  v w \t\r\n", "v w"},
        {"[s]\nk=", ""},
        {"[s]\nk=\"  v \"", "  v "},
        {"[s]\nk='v'", "v"},
        {"[s]\nk=\"v'", "\"v'"},
        {"[s]\nk=\"", "\""},
        {"[s]\nk=a=b", "a=b"},
        {"[s]\nk=first\nk=second", "first"},
        {"[s]\n;k=no\n[other]\nk=no\n[s]\nk=no", "none"}, // the first section holds
        {"[s\nk=no\n[s]]\nk=v", "v"},
        {std::string("[s]\nk=v\0w", 9), "v"},
        {std::string("\0\0[s]\n\0\n[s]\nk=v", 15), "v"},
        {"[s]\n" + std::string(1 << 20, 'x') + "\nk=v", "v"},
    };

    for (const auto& one : cases) {
        EXPECT_EQ(seam::profileValue(one.text, "s", "k").value_or("none"), one.expected)
            << one.text.substr(0, 40);
    }
}

TEST(ProfileText, TakesAValueInAndKeepsEverythingElse) {
    const struct {
        std::string text;
        std::string expected;
    } cases[] = {
        {"", "[s]\r\nk=v\r\n"},
        {"[a]\r\nx=1", "[a]\r\nx=1\r\n[s]\r\nk=v\r\n"},
        {"[s]\r\nk=old\r\nm=1\r\n", "[s]\r\nk=v\r\nm=1\r\n"},
        {"[S]\n; note\nK = old", "[S]\n; note\nk=v\r\n"},
        {"[s]\nm=1\n\n[a]\nk=a\n", "[s]\nm=1\nk=v\r\n\n[a]\nk=a\n"},
        {"[s]", "[s]\r\nk=v\r\n"},
        {"[s]\nm=1\n[s]\nk=2\n", "[s]\nm=1\nk=v\r\n[s]\nk=2\n"},
        {std::string("\0\xff junk", 7), std::string("\0\xff junk\r\n[s]\r\nk=v\r\n", 19)},
    };

    for (const auto& one : cases) {
        EXPECT_EQ(seam::profileWithValue(one.text, "s", "k", "v"), one.expected) << one.text;
    }
}

TEST(ProfileText, GivesBackEachValueAsItWasSet) {
    for (const char* value : {"", " ", "a ", "\"a\"", "'a'", "\"", "\"\"", "[s]", "=", "c:\\a\\",
                              "\xe9", " \"a\" ", "'"}) {
        const std::string text = seam::profileWithValue("", "s", "k", value);
        EXPECT_EQ(seam::profileValue(text, "s", "k"), value) << text;
    }
}

TEST_F(Profile, ReadsNumbersThatWrapAtThirtyTwoBits) {
    const struct {
        const char* text;
        UINT expected;
    } cases[] = {
        {"1", 1},      {"0", 0},          {"4294967295", 4294967295U},
        {"007", 7},    {"4294967297", 1}, {"99999999999999999999", 1661992959U},
        {"12abc", 12}, {"", 0},           {"abc", 0},
        {"-5", 0},     {"\" 5\"", 0},     {"'5'", 5},
    };

    for (const auto& one : cases) {
        makeIni(heading + "k=" + one.text);
        EXPECT_EQ(GetPrivateProfileIntA(section, "K", 77, file), one.expected) << one.text;
    }
    EXPECT_EQ(GetPrivateProfileIntA(section, "missing", -1, file), 4294967295U);
}

TEST_F(Profile, CutsAValueToTheBuffer) {
    makeIni(heading + "Directory=c:\\toons\\\r\n");
    char buffer[8] = "#######";
    EXPECT_EQ(GetPrivateProfileStringA(section, "directory", "", buffer, 4, file), 3U);
    EXPECT_STREQ(buffer, "c:\\");
    EXPECT_EQ(buffer[4], '#');
    EXPECT_EQ(GetPrivateProfileStringA(section, "none", "longer than it", buffer, 8, file), 7U);
    EXPECT_EQ(GetPrivateProfileStringA(section, "Directory", "", nullptr, 0, file), 0U);
    EXPECT_EQ(GetPrivateProfileStringA(section, "none", nullptr, buffer, 8, file), 0U);
    EXPECT_STREQ(buffer, "");
}

TEST_F(Profile, WritesItsFirstFileForTheUserAlone) {
    setenv("XDG_CONFIG_HOME", (root_ / "home/.config").c_str(), 1);
    EXPECT_EQ(value("Statements"), "none");
    EXPECT_FALSE(std::filesystem::exists(root_ / "home"));
    EXPECT_TRUE(write("Statements", "1"));
    EXPECT_EQ(textOf("home/.config/dorbo/Dorbo95.ini"), heading + "Statements=1\r\n");
    struct stat status = {};
    stat((root_ / "home/.config/dorbo").c_str(), &status);
    EXPECT_EQ(status.st_mode & 07777U, 0700U);
    stat((root_ / "home/.config/dorbo/Dorbo95.ini").c_str(), &status);
    EXPECT_EQ(status.st_mode & 07777U, 0600U);
}

TEST_F(Profile, LiesInTheHomeDirectoryWhereNoOtherIsSet) {
    const char* known = std::getenv("HOME");
    const std::string home = known != nullptr ? known : "";
    setenv("HOME", root_.c_str(), 1);
    make(".config/dorbo/Dorbo95.ini", heading + "k=home");
    for (const char* notAbsolute : {"", "relative", "."}) {
        setenv("XDG_CONFIG_HOME", notAbsolute, 1);
        EXPECT_EQ(value("k"), "home") << notAbsolute;
    }
    unsetenv("XDG_CONFIG_HOME");
    EXPECT_EQ(value("k"), "home");
    setenv("HOME", home.c_str(), 1);
}

TEST_F(Profile, NamedWithADirectoryLiesThere) {
    EXPECT_TRUE(WritePrivateProfileStringA("s", "k", "v", whole("own.ini").c_str()));
    EXPECT_EQ(textOf("own.ini"), "[s]\r\nk=v\r\n");
    EXPECT_EQ(GetPrivateProfileIntA("s", "k", 9, whole("OWN.INI").c_str()), 0U);
    EXPECT_FALSE(WritePrivateProfileStringA("s", "k", "v", whole("none\\own.ini").c_str()));
}

TEST_F(Profile, IsNotWrittenForAValueThatStands) {
    makeIni(heading + "Paces Walked = 12 \n");
    const ino_t before = iniNumber();
    EXPECT_TRUE(write("Paces Walked", "12"));
    EXPECT_EQ(iniNumber(), before);
    EXPECT_EQ(ini(), heading + "Paces Walked = 12 \n");
    EXPECT_TRUE(write("Paces Walked", "13"));
    EXPECT_EQ(ini(), heading + "Paces Walked=13\r\n");
}

TEST_F(Profile, KeepsItsModeWhenWritten) {
    makeIni("[a]\n");
    chmod((root_ / iniName).c_str(), 0640);
    EXPECT_TRUE(write("k", "v"));
    struct stat status = {};
    stat((root_ / iniName).c_str(), &status);
    EXPECT_EQ(status.st_mode & 07777U, 0640U);
}

TEST_F(Profile, KeepsTheLinksThatLeadToIt) {
    make("there.ini", "[a]\r\n");
    for (const std::string target : {"there.ini", "missing.ini"}) {
        std::filesystem::create_directories(root_ / "dorbo");
        std::filesystem::remove(root_ / iniName);
        std::filesystem::create_symlink("../second", root_ / iniName);
        std::filesystem::remove(root_ / "second");
        std::filesystem::create_symlink(target, root_ / "second");
        EXPECT_TRUE(write("k", "v"));
        EXPECT_TRUE(std::filesystem::is_symlink(root_ / iniName));
        EXPECT_TRUE(std::filesystem::is_symlink(root_ / "second"));
        EXPECT_TRUE(textOf(target).ends_with(heading + "k=v\r\n")) << target;
    }
}

TEST_F(Profile, IsLeftAloneWhenReadOnlyOrNoRegularFile) {
    makeIni(heading + "k=old\n");
    chmod((root_ / iniName).c_str(), 0444);
    EXPECT_EQ(value("k"), "old");
    EXPECT_FALSE(write("k", "new"));
    EXPECT_EQ(value("k"), "old");
    for (const bool pipe : {false, true}) {
        std::filesystem::remove(root_ / iniName);
        pipe ? mkfifo((root_ / iniName).c_str(), 0600) : mkdir((root_ / iniName).c_str(), 0700);
        EXPECT_EQ(value("k"), "none");
        EXPECT_FALSE(write("k", "new"));
    }
}

TEST_F(Profile, CannotBeWrittenWhereItsDirectoryIsAFile) {
    make("dorbo", "a file");
    EXPECT_FALSE(write("k", "v"));
    EXPECT_EQ(textOf("dorbo"), "a file");
}

TEST_F(Profile, StaysAsItWasOnAFullDisk) {
    const std::string old = heading + "k=old\r\n" + std::string(5000, '.');
    makeIni(old);
    rlimit before{};
    getrlimit(RLIMIT_FSIZE, &before);
    const rlimit small{1000, before.rlim_max};
    auto* const handler = std::signal(SIGXFSZ, SIG_IGN);
    setrlimit(RLIMIT_FSIZE, &small);
    const bool written = write("k", "new");
    setrlimit(RLIMIT_FSIZE, &before);
    std::signal(SIGXFSZ, handler);
    EXPECT_FALSE(written);
    EXPECT_EQ(ini(), old);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator(root_ / "dorbo"), {}), 1);
}

TEST_F(Profile, RefusesWhatItCouldNotFindAgain) {
    const struct {
        const char* section;
        const char* key;
        const char* value;
    } cases[] = {
        {"s", "k", "a\nb"},  {"s", "k", "a\rb"},  {"s", "a=b", "v"}, {"s", "", "v"},
        {"s", " k", "v"},    {"s]", "k", "v"},    {"s", "[k]", "v"}, {nullptr, "k", "v"},
        {"s", nullptr, "v"}, {"s", "k", nullptr},
    };

    for (const auto& one : cases) {
        EXPECT_FALSE(WritePrivateProfileStringA(one.section, one.key, one.value, file));
    }
    EXPECT_FALSE(std::filesystem::exists(root_ / "dorbo"));
}

TEST_F(Profile, OfSixteenMegabytesIsReadAndALargerOneCountsAsEmpty) {
    constexpr std::uintmax_t limit = 16 << 20;
    makeIni(heading + "k=v\n");
    std::filesystem::resize_file(root_ / iniName, limit); // the rest is NULs
    EXPECT_EQ(value("k"), "v");
    for (const std::uintmax_t size : {limit + 1, std::uintmax_t{1} << 40}) {
        std::filesystem::resize_file(root_ / iniName, size);
        EXPECT_EQ(value("k"), "none");
        EXPECT_FALSE(write("k", "w"));
        EXPECT_EQ(std::filesystem::file_size(root_ / iniName), size);
    }
}

} // namespace
