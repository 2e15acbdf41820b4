#include "platform/kernel.h"
#include "tests/kernel/scratch_directory.h"

#include <sys/resource.h>
#include <sys/stat.h>

#include <cerrno>
#include <csignal>

namespace {

/// While it lives no file grows beyond a size, as on a full disk.
class SmallFilesOnly {
  public:
    explicit SmallFilesOnly(rlim_t bytes) : handler_(std::signal(SIGXFSZ, SIG_IGN)) {
        getrlimit(RLIMIT_FSIZE, &before_);
        const rlimit small{bytes, before_.rlim_max};
        setrlimit(RLIMIT_FSIZE, &small);
    }

    SmallFilesOnly(const SmallFilesOnly&) = delete;
    SmallFilesOnly& operator=(const SmallFilesOnly&) = delete;

    ~SmallFilesOnly() {
        setrlimit(RLIMIT_FSIZE, &before_);
        std::signal(SIGXFSZ, handler_);
    }

  private:
    rlimit before_{};
    void (*handler_)(int);
};

class Files : public ScratchDirectory {
  protected:
    /// Opens, closes, and gives the error.
    int errorOf(const std::string& name, UINT style) {
        OFSTRUCT found{};
        const HFILE file = OpenFile(name.c_str(), &found, style);
        EXPECT_EQ(file == HFILE_ERROR, found.nErrCode != 0) << name;
        if (file != HFILE_ERROR) {
            EXPECT_FALSE(_lclose(file));
        }
        return found.nErrCode;
    }
};

TEST_F(Files, OnlyRegularFilesOpenAndNoneWaits) {
    make("plain.zkt", "x");
    make("locked.zkt", "x");
    chmod((root_ / "locked.zkt").c_str(), 0444);
    mkdir((root_ / "folder").c_str(), 0755);
    mkfifo((root_ / "pipe").c_str(), 0666);
    std::filesystem::create_symlink("circle", root_ / "circle");

    const struct {
        const char* name;
        int read;
        int readWrite;
        int create;
    } cases[] = {
        {"plain.zkt", 0, 0, 0},
        {"PLAIN.ZKT", 0, 0, 0},
        {"locked.zkt", 0, EACCES, EACCES},
        {"folder", EISDIR, EISDIR, EISDIR},
        {"folder\\", EISDIR, EISDIR, EISDIR},
        {"plain.zkt\\", EISDIR, EISDIR, EISDIR},
        {"new\\", EISDIR, EISDIR, EISDIR},
        {"pipe", EINVAL, EINVAL, EINVAL},
        {"\\dev\\null", EINVAL, EINVAL, EINVAL},
        {"circle", ELOOP, ELOOP, ELOOP},
        {"none\\x", ENOENT, ENOENT, ENOENT},
        {"missing", ENOENT, ENOENT, 0},
        {"", ENOENT, ENOENT, ENOENT},
    };

    for (const auto& one : cases) {
        EXPECT_EQ(errorOf(one.name, OF_READ), one.read) << one.name;
        EXPECT_EQ(errorOf(one.name, OF_READWRITE), one.readWrite) << one.name;
        EXPECT_EQ(errorOf(one.name, OF_CREATE | OF_PROMPT | OF_CANCEL), one.create) << one.name;
    }
    EXPECT_EQ(textOf("locked.zkt"), "x");
    EXPECT_EQ(textOf("plain.zkt"), "");
    EXPECT_FALSE(std::filesystem::exists(root_ / "new"));
    EXPECT_EQ(OpenFile(nullptr, nullptr, OF_READ), HFILE_ERROR);
}

TEST_F(Files, TellTheirWholePathAndCutOneThatIsTooLong) {
    make("Intro.zkt");
    OFSTRUCT found{};
    _lclose(OpenFile("intro.ZKT", &found, OF_READ));
    EXPECT_EQ(found.szPathName, whole("Intro.zkt"));
    EXPECT_EQ(found.cBytes, 136);
    EXPECT_EQ(found.fFixedDisk, 1);
    const std::string name(200, 'n');
    _lclose(OpenFile(name.c_str(), &found, OF_CREATE));
    EXPECT_EQ(found.szPathName, whole(name).substr(0, 127));
    EXPECT_TRUE(std::filesystem::exists(root_ / name));
}

TEST_F(Files, ReadAndWriteWhatTheyAreAskedFor) {
    const HFILE file = OpenFile("a.zkt", nullptr, OF_CREATE);
    EXPECT_EQ(_hwrite(file, "0123456789", 10), 10);
    EXPECT_EQ(_hwrite(file, "", 0), 0);
    EXPECT_EQ(GetFileSize(file, nullptr), 10U);
    EXPECT_FALSE(_lclose(file));

    char buffer[16] = {};
    const HFILE again = OpenFile("a.zkt", nullptr, OF_READ);
    EXPECT_EQ(_hread(again, buffer, 4), 4);
    EXPECT_EQ(_hread(again, buffer + 4, 12), 6);
    EXPECT_STREQ(buffer, "0123456789");
    EXPECT_EQ(_hread(again, buffer, 1), 0);
    EXPECT_EQ(_hread(again, buffer, -1), -1);
    EXPECT_EQ(_hwrite(again, "x", 1), -1); // opened for reading
    _lclose(again);
}

TEST_F(Files, CreatedOverALongerFileHoldNothingOfIt) {
    make("A.zkt", "long text");
    const HFILE file = OpenFile("a.zkt", nullptr, OF_CREATE);
    _hwrite(file, "new", 3);
    _lclose(file);
    EXPECT_EQ(textOf("A.zkt"), "new");
    EXPECT_FALSE(std::filesystem::exists(root_ / "a.zkt"));
}

TEST_F(Files, WriteShortOnAFullDisk) {
    const HFILE file = OpenFile("a.zkt", nullptr, OF_CREATE);
    const std::string text(4000, 't');
    {
        const SmallFilesOnly small(1000);
        EXPECT_EQ(_hwrite(file, text.data(), 4000), 1000);
        EXPECT_EQ(_hwrite(file, text.data(), 4000), -1);
    }
    _lclose(file);
}

TEST_F(Files, OfMoreThanFourGigabytesTellBothHalvesOfTheirSize) {
    make("huge.zkt");
    std::filesystem::resize_file(root_ / "huge.zkt", 0x140000005);
    const HFILE file = OpenFile("huge.zkt", nullptr, OF_READWRITE);
    DWORD high = 0;
    EXPECT_EQ(GetFileSize(file, &high), 0x40000005U);
    EXPECT_EQ(high, 1U);
    _lclose(file);
}

TEST_F(Files, RefuseStaleHandles) {
    make("a.zkt", "text");
    const HFILE file = OpenFile("a.zkt", nullptr, OF_READ);
    _lclose(file);
    char byte = 0;
    for (const HFILE none : {file, HFILE_ERROR, HFILE{}}) {
        EXPECT_EQ(_hread(none, &byte, 1), -1);
        EXPECT_EQ(_hwrite(none, &byte, 1), -1);
        EXPECT_EQ(_lclose(none), HFILE_ERROR);
        EXPECT_EQ(GetFileSize(none, nullptr), 0xFFFFFFFFU);
    }
}

} // namespace
