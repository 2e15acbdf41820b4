// dorbo-start, installed in a prefix of its own: what it starts, and where.
#include "tests/kernel/scratch_directory.h"

namespace {

namespace fs = std::filesystem;

constexpr const char* home = "data/dorbo/toons";

class Start : public ScratchDirectory {
  protected:
    void SetUp() override {
        make("prefix/share/dorbo/toons/a.zkt", "first");
        make("prefix/share/dorbo/toons/b.zkt", "second");
        make("prefix/share/dorbo/toons/README", "no Toon");
        setMode("prefix/share/dorbo/toons/a.zkt", 0444);
        make("prefix/libexec/dorbo/dorbo-start");
        make("elsewhere/bin/dorbo-start");
        for (const char* place : {"prefix/libexec/dorbo", "elsewhere/bin"}) {
            fs::copy(DORBO_START, root_ / place, fs::copy_options::overwrite_existing);
        }
        make("prefix/bin/tell", "#!/bin/sh\nprintf '%s,' \"$@\"; pwd -P\n");
        setMode("prefix/bin/tell", 0755);
        setenv("XDG_DATA_HOME", (root_ / "data").c_str(), 1);
        setenv("HOME", root_.c_str(), 1);
    }

    void TearDown() override {
        unsetenv("XDG_DATA_HOME");
        setenv("HOME", homeBefore_.c_str(), 1);
        ScratchDirectory::TearDown();
    }

    /// What a run of `dorbo-start ARGUMENTS` prints, without the line end.
    std::string output(const std::string& arguments = "tell",
                       const std::string& program = "prefix/libexec/dorbo/dorbo-start") const {
        EXPECT_EQ(runLine(program + " " + arguments + " >out 2>err"), 0);
        std::string text = textOf("out");
        return text.substr(0, text.find('\n'));
    }

    std::string path(const std::string& name) const {
        return (root_ / name).string();
    }

    /// How many names a directory holds; 0 if there is none.
    std::ptrdiff_t entries(const char* directory) const {
        std::error_code none;
        return std::distance(fs::directory_iterator(root_ / directory, none), {});
    }

  private:
    std::string homeBefore_ = std::getenv("HOME") == nullptr ? "" : std::getenv("HOME");
};

TEST_F(Start, CopiesTheToonsOnceAndGoesThere) {
    EXPECT_EQ(output("tell S 'a b'"), "S,a b," + path(home));
    EXPECT_EQ(textOf("data/dorbo/toons/a.zkt"), "first");
    EXPECT_EQ(modeOf("data/dorbo/toons/a.zkt"), 0644U);
    EXPECT_EQ(entries(home), 2);
    EXPECT_EQ(entries("data/dorbo"), 1);
    for (const char* removed : {"data/dorbo/toons/a.zkt", "data/dorbo/toons/b.zkt"}) {
        fs::remove(removed);
        EXPECT_EQ(output(), "," + path(home));
        EXPECT_FALSE(fs::exists(removed));
    }
    EXPECT_EQ(textOf("err"), "");
}

TEST_F(Start, SeveralAtOnceMakeOneHome) {
    EXPECT_EQ(
        runLine("for i in 1 2 3 4 5 6 7 8; do prefix/libexec/dorbo/dorbo-start tell >$i 2>>err & "
                "done; wait"),
        0);
    for (const char* one : {"1", "2", "3", "4", "5", "6", "7", "8"}) {
        EXPECT_EQ(textOf(one), "," + path(home) + "\n");
    }
    EXPECT_EQ(entries("data/dorbo"), 1);
    EXPECT_EQ(entries(home), 2);
    EXPECT_EQ(textOf("err"), "");
}

TEST_F(Start, WithoutAHomeItStaysWhereItIsAndSaysSo) {
    const auto stays = [&](const char* why) {
        EXPECT_EQ(output("prefix/bin/tell"), "," + root_.string()) << why;
        EXPECT_NE(textOf("err"), "") << why;
    };
    {
        const FullDisk disk(0);
        EXPECT_EQ(runLine("prefix/libexec/dorbo/dorbo-start true 2>/dev/null"), 0);
    }
    EXPECT_EQ(entries("data/dorbo"), 0) << "half a copy";
    make(home, "a file");
    stays("no directory");
    fs::remove_all("data");
    make("data", "a file");
    stays("nowhere to make one");
    fs::remove("data");
    EXPECT_EQ(output("prefix/bin/tell", "elsewhere/bin/dorbo-start"), "," + root_.string());
    EXPECT_EQ(entries("data/dorbo"), 0) << "nothing to copy";
}

TEST_F(Start, TheHomeIsUnderTheUsersOwnWithoutAnAbsoluteDirectory) {
    for (const char* chosen : {"", "data"}) {
        setenv("XDG_DATA_HOME", chosen, 1);
        EXPECT_EQ(output(), "," + path(".local/share/dorbo/toons")) << chosen;
    }
}

TEST_F(Start, TellsWhatItCannotRun) {
    const struct {
        const char* arguments;
        int code;
    } cases[] = {{"", 2}, {"no-such-program", 127}, {"/", 126}, {"sh -c 'exit 7'", 7}};

    for (const auto& one : cases) {
        EXPECT_EQ(
            runLine(std::string("prefix/libexec/dorbo/dorbo-start ") + one.arguments + " 2>err"),
            one.code)
            << one.arguments;
    }
}

} // namespace
