#include "tests/kernel/scratch_directory.h"

#include <cerrno>

namespace {

using Paths = ScratchDirectory;

std::string lettersOf(const std::string& mountInfo, const std::string& user = "ann") {
    std::string text;
    for (const seam::Drive& drive : seam::drivesFrom(mountInfo, user)) {
        text += drive.letter + ("=" + drive.root + " ");
    }
    return text;
}

std::string mounted(const std::string& at) {
    return "36 35 98:0 / " + at + " rw,noatime master:1 - vfat /dev/sdb1 rw\n";
}

TEST(Drives, AreTheMountedMediaOfTheUserInTheOrderOfTheirBytes) {
    EXPECT_EQ(lettersOf(""), "C= ");
    EXPECT_EQ(lettersOf(mounted("/") + mounted("/home") + mounted("/media/ann/b") +
                        mounted("/run/media/ann/a") + mounted("/media/ann/B") +
                        mounted("/media/ann/b")),
              "C= D=/media/ann/B E=/media/ann/b F=/run/media/ann/a ");
    EXPECT_EQ(lettersOf(mounted("/media/bob/x") + mounted("/media/ann") +
                        mounted("/media/ann/x/inner") + mounted("/mnt/media/ann/x")),
              "C= ");
    EXPECT_EQ(lettersOf(mounted("/media/ann/MY\\040DISK\\134x\\9")),
              "C= D=/media/ann/MY DISK\\x\\9 ");
    EXPECT_EQ(lettersOf("short line\n\n" + mounted("/media/ann/x")), "C= D=/media/ann/x ");
    EXPECT_EQ(lettersOf(mounted("/media//x"), ""), "C= ");
}

TEST(Drives, EndAtZ) {
    std::string mounts;
    for (char name = 'a'; name <= 'z'; ++name) {
        mounts += mounted(std::string("/media/ann/") + name);
    }
    const std::vector<seam::Drive> drives = seam::drivesFrom(mounts, "ann");
    EXPECT_EQ(drives.size(), 24U);
    EXPECT_EQ(drives.back().letter, 'Z');
}

TEST(PlatformPath, TellsEachPathByTheLetterOfItsMedium) {
    const std::vector<seam::Drive> drives{{'C', ""}, {'D', "/media/ann/usb"}};

    const struct {
        std::string path;
        std::string expected;
    } cases[] = {
        {"/", "C:\\"},
        {"/home/ann", "C:\\home\\ann"},
        {"/media/ann/usb", "D:\\"},
        {"/media/ann/usb/Toons/a", "D:\\Toons\\a"},
        {"/media/ann/usb2/a", "C:\\media\\ann\\usb2\\a"},
        {"/home/na\\me/x", ""},
        {"", ""},
    };

    for (const auto& one : cases) {
        EXPECT_EQ(seam::platformPath(one.path, drives), one.expected) << one.path;
    }
}

TEST_F(Paths, AreFoundByTheExactNameFirstThenWhateverTheCase) {
    make("Toons/Intro.zkt");
    make("toons/b.zkt");
    make("UP/Mid/\xe9T.txt");
    make("a:b");
    make("usb/on.zkt");
    std::filesystem::create_symlink("nowhere", root_ / "Broken");
    std::filesystem::create_symlink("UP/Mid", root_ / "link");
    const std::vector<seam::Drive> drives{{'C', ""}, {'D', root_ / "usb"}};

    const struct {
        std::string path;
        std::string expected; // behind the root; "!" for an error, "+" in front of what is missing
    } cases[] = {
        {"Toons\\intro.ZKT", "/Toons/Intro.zkt"},
        {"TOONS\\intro.zkt", "/Toons/Intro.zkt"}, // the first in the order of bytes
        {"toons\\intro.zkt", "+/toons/intro.zkt"},
        {"up/mid\\\xe9t.TXT", "/UP/Mid/\xe9T.txt"},
        {".\\up\\.\\..\\toons\\b.zkt", "/toons/b.zkt"},
        {"link\\..\\toons", "/toons"}, // by the names alone
        {"BROKEN", "/Broken"},
        {"up\\new.zkt", "+/UP/new.zkt"},
        {"no\\new.zkt", "!"},
        {"toons\\b.zkt\\x", "!"},
        {"a:b", "/a:b"},
        {"a:c", "!"},
        {"d:\\ON.zkt", "/usb/on.zkt"},
        {"D:on.zkt", "/usb/on.zkt"},
        {"d:\\..\\..\\on.zkt", "/usb/on.zkt"},
        {"c:up", "/UP"},
        {"e:\\x", "!"},
        {"\\\\host\\share", "!"},
        {"", "!"},
        {std::string(300, 'x'), "!"},
    };

    for (const auto& one : cases) {
        const seam::PathLookup found = seam::lookUpPath(one.path, drives, root_.string());
        std::string told = found.path;
        if (told.starts_with(root_.string())) {
            told.erase(0, root_.string().size());
        }
        EXPECT_EQ(found.error != 0 ? "!" : (found.exists ? "" : "+") + told, one.expected)
            << one.path;
    }
}

TEST_F(Paths, WithoutARootStartOnTheDriveOfTheCurrentDirectory) {
    make("usb/deep/on.zkt");
    const std::string usb = root_ / "usb";
    const std::vector<seam::Drive> drives{{'C', ""}, {'D', usb}};
    const auto found = [&](const char* path) {
        return seam::lookUpPath(path, drives, usb + "/deep").path;
    };
    EXPECT_EQ(found("on.zkt"), usb + "/deep/on.zkt");
    EXPECT_EQ(found("d:ON.zkt"), usb + "/deep/on.zkt");
    EXPECT_EQ(found("\\deep"), usb + "/deep");
    EXPECT_EQ(found("..\\..\\.."), usb);
    EXPECT_EQ(found("c:"), "/");
}

TEST_F(Paths, WithoutARootMeanNothingWithoutACurrentDirectory) {
    const std::vector<seam::Drive> drives{{'C', ""}};
    EXPECT_EQ(seam::lookUpPath("x", drives, std::nullopt).error, ENOENT);
    EXPECT_EQ(seam::lookUpPath("\\tmp", drives, std::nullopt).error, ENOENT);
    EXPECT_EQ(seam::lookUpPath("C:\\", drives, std::nullopt).path, "/");
}

} // namespace
