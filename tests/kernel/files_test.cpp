#include "platform/kernel.h"
#include "tests/kernel/scratch_directory.h"

#include <sys/stat.h>

#include <cerrno>

namespace {

class Files : public ScratchDirectory {
  protected:
    /// Opens, closes, and gives the error.
    int errorOf(const std::string& name, UINT style) {
        OFSTRUCT found{};
        const HFILE file = OpenFile(name.c_str(), &found, style);
        EXPECT_EQ(file == HFILE_ERROR, found.nErrCode != 0) << name;
        EXPECT_EQ(_lclose(file) == HFILE_ERROR, file == HFILE_ERROR) << name;
        return found.nErrCode;
    }
};

TEST_F(Files, OnlyRegularFilesOpenAndNoneWaits) {
    make("Plain.zkt", "x");
    make("locked.zkt", "x");
    setMode("locked.zkt", 0444);
    mkdir("folder", 0755);
    mkfifo("pipe", 0666);
    std::filesystem::create_symlink("circle", "circle");
    const std::tuple<const char*, int, int, int> cases[] = {
        {"PLAIN.ZKT", 0, 0, 0},
        {"locked.zkt", 0, EACCES, EACCES},
        {"folder", EISDIR, EISDIR, EISDIR},
        {"new\\", EISDIR, EISDIR, EISDIR},
        {"pipe", EINVAL, EINVAL, EINVAL},
        {"circle", ELOOP, ELOOP, ELOOP},
        {"none\\x", ENOENT, ENOENT, ENOENT},
        {"missing", ENOENT, ENOENT, 0},
        {"", ENOENT, ENOENT, ENOENT},
    };
    for (const auto& [name, read, readWrite, create] : cases) {
        EXPECT_EQ(errorOf(name, OF_READ), read) << name;
        EXPECT_EQ(errorOf(name, OF_READWRITE), readWrite) << name;
        EXPECT_EQ(errorOf(name, OF_CREATE | OF_PROMPT | OF_CANCEL), create) << name;
    }
    EXPECT_EQ(textOf("locked.zkt"), "x");
    EXPECT_EQ(textOf("Plain.zkt"), "");
    EXPECT_FALSE(std::filesystem::exists("PLAIN.ZKT"));
}

TEST_F(Files, TellTheirWholePathAndCutOneThatIsTooLong) {
    OFSTRUCT found{};
    for (const std::string& one : {std::string("short"), std::string(200, 'n')}) {
        _lclose(OpenFile(one.c_str(), &found, OF_CREATE));
        EXPECT_EQ(found.szPathName, whole(one).substr(0, 127));
        EXPECT_TRUE(std::filesystem::exists(one));
    }
}

TEST_F(Files, ReadAndWriteWhatTheyAreAskedForUntilTheDiskIsFull) {
    make("a.zkt", std::string(3000, '#'));
    const HFILE file = OpenFile("a.zkt", nullptr, OF_CREATE);
    const std::string text(4000, 't');
    {
        const FullDisk disk(1000);
        EXPECT_EQ(_hwrite(file, text.data(), 600), 600);
        EXPECT_EQ(_hwrite(file, text.data(), 600), 400);
        EXPECT_EQ(_hwrite(file, text.data(), 600), -1);
    }
    EXPECT_EQ(GetFileSize(file, nullptr), 1000U);
    _lclose(file);

    char buffer[1000];
    const HFILE again = OpenFile("a.zkt", nullptr, OF_READ);
    EXPECT_EQ(_hread(again, buffer, 600), 600);
    EXPECT_EQ(_hread(again, buffer + 600, 1000), 400);
    EXPECT_EQ(std::string(buffer, 1000), text.substr(0, 1000));
    EXPECT_EQ(_hread(again, buffer, 1), 0);
    EXPECT_EQ(_hread(again, buffer, -1), -1);
    EXPECT_EQ(_hwrite(again, "x", 1), -1); // opened for reading
    _lclose(again);
    for (const HFILE none : {again, HFILE_ERROR, HFILE{}}) {
        EXPECT_EQ(_hread(none, buffer, 1), -1);
        EXPECT_EQ(_hwrite(none, buffer, 1), -1);
        EXPECT_EQ(_lclose(none), HFILE_ERROR);
        EXPECT_EQ(GetFileSize(none, nullptr), 0xFFFFFFFFU);
    }
}

TEST_F(Files, OfMoreThanFourGigabytesTellBothHalvesOfTheirSize) {
    make("huge.zkt");
    std::filesystem::resize_file("huge.zkt", 0x140000005);
    const HFILE file = OpenFile("huge.zkt", nullptr, OF_READWRITE);
    DWORD high = 0;
    EXPECT_EQ(GetFileSize(file, &high), 0x40000005U);
    EXPECT_EQ(high, 1U);
    _lclose(file);
}

} // namespace
