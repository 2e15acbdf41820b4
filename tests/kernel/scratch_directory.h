// A directory of a test's own, which is the current directory while the test runs.
#pragma once

#include "platform/harness.h"
#include "platform/kernel/paths.h"

#include <gtest/gtest.h>

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
