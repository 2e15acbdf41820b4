#include "tests/kernel/scratch_directory.h"

#include <cerrno>

namespace {

using Paths = ScratchDirectory;

std::string mounted(const std::string& at) {
    return "36 35 98:0 / " + at + " rw,noatime master:1 - vfat /dev/sdb1 rw\n";
}

TEST(Drives, AreTheMountedMediaOfTheUserInTheOrderOfTheirBytes) {
    std::string many;
    std::string letters = "C= ";
    for (int i = 0; i < 26; ++i) {
        const std::string root = std::string("/media/ann/") + static_cast<char>('a' + i);
        many += mounted(root);
        letters += i < 23 ? static_cast<char>('D' + i) + ("=" + root + " ") : "";
    }
    const std::pair<std::string, std::string> cases[] = {
        {"", "C= "},
        {mounted("/home") + mounted("/media/ann/b") + mounted("/run/media/ann/a") +
             mounted("/media/ann/B") + mounted("/media/ann/b"),
         "C= D=/media/ann/B E=/media/ann/b F=/run/media/ann/a "},
        {mounted("/media/bob/x") + mounted("/media/ann") + mounted("/media/ann/x/inner"), "C= "},
        {mounted("/media/ann/MY\\040DISK\\134x\\9"), "C= D=/media/ann/MY DISK\\x\\9 "},
        {"short line\n\n" + mounted("/media/ann/x"), "C= D=/media/ann/x "},
        {many, letters}, // up to Z
    };
    for (const auto& [mountInfo, expected] : cases) {
        std::string told;
        for (const seam::Drive& drive : seam::drivesFrom(mountInfo, "ann")) {
            told += drive.letter + ("=" + drive.root + " ");
        }
        EXPECT_EQ(told, expected);
    }
}

TEST(PlatformPath, TellsEachPathByTheLetterOfItsMedium) {
    const std::vector<seam::Drive> drives{{'C', ""}, {'D', "/media/ann/usb"}};
    const std::pair<std::string, std::string> cases[] = {
        {"/", "C:\\"},
        {"/media/ann/usb", "D:\\"},
        {"/media/ann/usb/Toons/a", "D:\\Toons\\a"},
        {"/media/ann/usb2/a", "C:\\media\\ann\\usb2\\a"},
        {"/home/na\\me/x", ""},
        {"", ""},
    };
    for (const auto& [path, expected] : cases) {
        EXPECT_EQ(seam::platformPath(path, drives), expected) << path;
    }
}

TEST_F(Paths, AreFoundByTheExactNameFirstThenWhateverTheCase) {
    for (const char* name :
         {"Toons/Intro.zkt", "toons/b.zkt", "UP/Mid/\xe9T.txt", "a:b", "usb/deep/on.zkt"}) {
        make(name);
    }
    std::filesystem::create_symlink("nowhere", "Broken");
    const std::string here = root_.string();
    const std::vector<seam::Drive> drives{{'C', ""}, {'D', here + "/usb"}};
    // The current directory behind the root, a path, and what it finds behind the root: "!" stands
    // for an error, "+" in front of what is missing.
    const std::tuple<std::string, std::string, std::string> cases[] = {
        {"", "Toons\\intro.ZKT", "/Toons/Intro.zkt"},
        {"", "TOONS\\intro.zkt", "/Toons/Intro.zkt"}, // the first in the order of bytes
        {"", "up/mid\\\xe9t.TXT", "/UP/Mid/\xe9T.txt"},
        {"", "up/mid\\\xc9t.TXT", "+/UP/Mid/\xc9t.TXT"}, // A to Z only
        {"", ".\\up\\.\\..\\toons\\b.zkt", "/toons/b.zkt"},
        {"", "BROKEN", "/Broken"},
        {"", "no\\new.zkt", "!"},
        {"", "a:b", "/a:b"},
        {"", "a:c", "!"},
        {"", "d:\\DEEP", "/usb/deep"},
        {"", "d:\\..\\..\\deep", "/usb/deep"},
        {"", "\\\\host\\share", "!"},
        {"", std::string(300, 'x'), "!"},
        {"/usb/deep", "d:ON.zkt", "/usb/deep/on.zkt"},
        {"/usb/deep", "\\deep", "/usb/deep"},
        {"/usb/deep", "..\\..\\..", "/usb"},
    };
    for (const auto& [directory, path, expected] : cases) {
        const seam::PathLookup found = seam::lookUpPath(path, drives, here + directory);
        std::string told = found.path;
        if (told.starts_with(here)) {
            told.erase(0, here.size());
        }
        EXPECT_EQ(found.error != 0 ? "!" : (found.exists ? "" : "+") + told, expected) << path;
    }
    EXPECT_EQ(seam::lookUpPath("x", drives, std::nullopt).error, ENOENT);
    EXPECT_EQ(seam::lookUpPath("C:\\", drives, std::nullopt).path, "/");
}

} // namespace
