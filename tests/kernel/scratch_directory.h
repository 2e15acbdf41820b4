// A directory of a test's own, which is the current directory while the test runs.
#pragma once

#include "platform/harness.h"
#include "platform/kernel/paths.h"

#include <gtest/gtest.h>

#include <sys/resource.h>

#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>

/// Also holds the count of live handles against that at the test's start.
class ScratchDirectory : public testing::Test {
  protected:
    ScratchDirectory() : before_(std::filesystem::current_path()) {
        std::string pattern = (std::filesystem::canonical(testing::TempDir()) / "dorbo.XXXXXX");
        root_ = mkdtemp(pattern.data());
        std::filesystem::current_path(root_);
        seam::countKernelHandles(handles_);
    }

    ~ScratchDirectory() override {
        std::filesystem::current_path(before_);
        std::filesystem::remove_all(root_);
    }

    void TearDown() override {
        seam::HandleCounts now;
        seam::countKernelHandles(now);
        EXPECT_EQ(now, handles_);
    }

    /// Makes a file, and the directories above it.
    void make(const std::string& name, const std::string& text = "") const {
        std::filesystem::create_directories((root_ / name).parent_path());
        std::ofstream(root_ / name, std::ios::binary) << text;
    }

    std::string textOf(const std::string& name) const {
        std::ifstream file(root_ / name, std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }

    /// Sets what the owner and others may do with a file.
    void setMode(const std::string& name, unsigned mode) const {
        std::filesystem::permissions(root_ / name, std::filesystem::perms{mode});
    }

    unsigned modeOf(const std::string& name) const {
        return static_cast<unsigned>(std::filesystem::status(root_ / name).permissions());
    }

    /// A name in the directory as a whole path of the platform.
    std::string whole(const std::string& name = "") const {
        const std::string path = seam::platformPath(root_.string(), {{'C', ""}});
        return name.empty() ? path : path + "\\" + name;
    }

    std::filesystem::path root_;

  private:
    std::filesystem::path before_;
    seam::HandleCounts handles_;
};

/// One in which the user's settings lie.
class ConfigDirectory : public ScratchDirectory {
  protected:
    ConfigDirectory() {
        setenv("XDG_CONFIG_HOME", root_.c_str(), 1);
    }

    ~ConfigDirectory() override {
        unsetenv("XDG_CONFIG_HOME");
    }
};

/// Runs a line of the shell; gives its exit code, -1 if a signal ended it.
inline int runLine(const std::string& line) {
    const int status = std::system(line.c_str());
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

/// While it lives no file grows beyond a size, as on a full disk.
class FullDisk {
  public:
    explicit FullDisk(rlim_t bytes) : handler_(std::signal(SIGXFSZ, SIG_IGN)) {
        getrlimit(RLIMIT_FSIZE, &before_);
        const rlimit limit{bytes, before_.rlim_max};
        setrlimit(RLIMIT_FSIZE, &limit);
    }

    FullDisk(const FullDisk&) = delete;
    FullDisk& operator=(const FullDisk&) = delete;

    ~FullDisk() {
        setrlimit(RLIMIT_FSIZE, &before_);
        std::signal(SIGXFSZ, handler_);
    }

  private:
    rlimit before_{};
    void (*handler_)(int);
};
