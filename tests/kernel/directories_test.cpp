#include "platform/kernel.h"
#include "platform/kernel/pattern.h"
#include "tests/kernel/scratch_directory.h"

#include <sys/stat.h>
#include <unistd.h>

namespace {

class Directories : public ScratchDirectory {
  protected:
    /// The names of a scan with a blank behind each.
    std::string scan(const std::string& pattern) {
        WIN32_FIND_DATAA found{};
        std::string names;
        const HANDLE search = FindFirstFileA(pattern.c_str(), &found);
        for (bool more = search != INVALID_HANDLE_VALUE; more;
             more = FindNextFileA(search, &found) != FALSE) {
            names += std::string(found.cFileName) + " ";
        }
        EXPECT_EQ(FindClose(search), search != INVALID_HANDLE_VALUE ? TRUE : FALSE);
        return names;
    }
};

TEST(Pattern, FitsNames) {
    const std::tuple<const char*, const char*, const char*> cases[] = {
        {"*.zkt", "a.ZKT", "a.zkt1"}, {"*.ZKT", ".zkt", "zkt"}, {"*.zkt", "a.zkt.zkt", "a.zk"},
        {"a?c", "abc", "ac"},         {"ab??", "AB", "a"},      {"a*b*c", "a-b-b-c", "acb"},
    };
    for (const auto& [pattern, fits, doesNot] : cases) {
        EXPECT_TRUE(seam::matchesPattern(fits, pattern)) << pattern;
        EXPECT_FALSE(seam::matchesPattern(doesNot, pattern)) << pattern;
    }
    EXPECT_TRUE(seam::matchesPattern("noextension", "*.*"));
    std::string stars = "b"; // takes no time
    for (int count = 0; count < 100; ++count) {
        stars.insert(0, "*a");
    }
    EXPECT_FALSE(seam::matchesPattern(std::string(250, 'a'), stars));
}

TEST_F(Directories, GiveTheirNamesInTheOrderOfBytes) {
    for (const char* name :
         {"b.zkt", "B.ZKT", "\xe9.zkt", ".hidden.zkt", "a\\b.zkt", "other.txt"}) {
        make(name);
    }
    mkdir("dir.zkt", 0755);
    std::filesystem::create_symlink("nowhere", "broken.zkt");
    const std::string toons = ".hidden.zkt B.ZKT b.zkt broken.zkt dir.zkt \xe9.zkt ";
    EXPECT_EQ(scan("*.zkt"), toons);
    EXPECT_EQ(scan(whole("*.ZKT")), toons);
    EXPECT_EQ(scan("..\\" + root_.filename().string() + "/*.zkt"), toons);
    EXPECT_EQ(scan("OTHER.TXT"), "other.txt ");
    for (const char* nothing :
         {"*.none", "none", "no\\*.zkt", "dir.zkt\\", "dir.zkt\\*", "\\", ""}) {
        EXPECT_EQ(scan(nothing), "") << nothing;
    }
}

TEST_F(Directories, TellTheKindAndSizeOfEachEntry) {
    make("plain", "12345");
    make("locked");
    make(".dot");
    mkdir("folder", 0555);
    std::filesystem::create_symlink("folder", "link");
    std::filesystem::create_symlink("nowhere", "broken");
    setMode("locked", 0444);
    const std::tuple<const char*, DWORD, DWORD> cases[] = {
        {"plain", FILE_ATTRIBUTE_ARCHIVE, 5},
        {"locked", FILE_ATTRIBUTE_ARCHIVE | FILE_ATTRIBUTE_READONLY, 0},
        {".dot", FILE_ATTRIBUTE_ARCHIVE | FILE_ATTRIBUTE_HIDDEN, 0},
        {"folder", FILE_ATTRIBUTE_DIRECTORY, 0},
        {"link", FILE_ATTRIBUTE_DIRECTORY, 0},
        {"broken", FILE_ATTRIBUTE_ARCHIVE, 0},
    };
    for (const auto& [name, attributes, size] : cases) {
        WIN32_FIND_DATAA found{};
        FindClose(FindFirstFileA(name, &found));
        EXPECT_EQ(found.dwFileAttributes, attributes) << name;
        EXPECT_EQ(found.nFileSizeLow, size) << name;
    }
    WIN32_FIND_DATAA found{};
    const HANDLE search = FindFirstFileA("l*", &found);
    std::filesystem::remove("locked"); // vanishes during the scan
    std::filesystem::remove("link");
    EXPECT_FALSE(FindNextFileA(search, &found));
    EXPECT_STREQ(found.cFileName, "link") << "what was found last still stands";
    EXPECT_TRUE(FindClose(search));
    EXPECT_FALSE(FindNextFileA(search, &found));
}

TEST_F(Directories, AreEnteredWhateverTheCaseAndToldInABufferThatHoldsThem) {
    make("Sub/Deep/x");
    const std::string deep = whole("Sub\\Deep");
    const auto length = static_cast<DWORD>(deep.size());
    std::string buffer(length + 1, '#');
    EXPECT_TRUE(SetCurrentDirectoryA("SUB\\deep\\"));
    EXPECT_EQ(GetCurrentDirectoryA(length, buffer.data()), length + 1);
    EXPECT_EQ(buffer, std::string(length + 1, '#'));
    EXPECT_EQ(GetCurrentDirectoryA(length + 1, buffer.data()), length);
    EXPECT_EQ(buffer.c_str(), deep);
    for (const char* refused : {"none", "x", "", "q:\\"}) {
        EXPECT_FALSE(SetCurrentDirectoryA(refused)) << refused;
    }
    EXPECT_EQ(GetCurrentDirectoryA(0, nullptr), length + 1);
    EXPECT_TRUE(SetCurrentDirectoryA("c:\\"));
    EXPECT_EQ(GetCurrentDirectoryA(length, buffer.data()), 3U);
    EXPECT_STREQ(buffer.c_str(), "C:\\");
}

TEST_F(Directories, AreNotToldWhenRemovedOrNotToBeExpressed) {
    make("back\\slash/a.zkt");
    std::filesystem::current_path("back\\slash");
    EXPECT_EQ(GetCurrentDirectoryA(0, nullptr), 0U);
    EXPECT_EQ(scan("*.zkt"), "a.zkt ");
    std::filesystem::remove_all(root_ / "back\\slash");
    EXPECT_EQ(GetCurrentDirectoryA(0, nullptr), 0U);
    EXPECT_EQ(scan("*.*"), "");
    EXPECT_EQ(OpenFile("x.zkt", nullptr, OF_CREATE), HFILE_ERROR);
    EXPECT_TRUE(SetCurrentDirectoryA(whole().c_str()));
}

} // namespace
