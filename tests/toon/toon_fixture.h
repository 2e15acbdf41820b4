// A directory of its own to work in, a fresh open Toon, and the boxes that were shown.
#pragma once

#include "platform/harness.h"
#include "toon/toon_document.h"

#include <gtest/gtest.h>

#include <sys/resource.h>

#include <csignal>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <string>
#include <vector>

namespace test {

struct Box {
    std::string text;
    std::string caption;
    UINT type;

    friend bool operator==(const Box&, const Box&) = default;
};

inline std::ostream& operator<<(std::ostream& out, const Box& box) {
    return out << '"' << box.text << "\", \"" << box.caption << "\", " << box.type;
}

/// A box as the errors of Toons are shown.
inline Box errorBox(const std::string& text, UINT icon) {
    return {text, "Error", icon};
}

inline std::string readFile(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
}

inline void writeFile(const std::filesystem::path& path, const std::string& bytes) {
    std::ofstream(path, std::ios::binary) << bytes;
}

inline const std::filesystem::path sourceDirectory = DORBO_SOURCE_DIR;
inline const std::filesystem::path badDirectory = sourceDirectory / "tests/toon/bad";

/// Lets no file grow beyond a size, as a full disk would.
class FullDisk {
  public:
    explicit FullDisk(rlim_t bytes) {
        getrlimit(RLIMIT_FSIZE, &before_);
        const rlimit limit{bytes, before_.rlim_max};
        handler_ = std::signal(SIGXFSZ, SIG_IGN);
        setrlimit(RLIMIT_FSIZE, &limit);
    }

    ~FullDisk() {
        setrlimit(RLIMIT_FSIZE, &before_);
        std::signal(SIGXFSZ, handler_);
    }

    FullDisk(const FullDisk&) = delete;
    FullDisk& operator=(const FullDisk&) = delete;

  private:
    rlimit before_{};
    void (*handler_)(int) = nullptr;
};

/// A current directory that is empty at first and goes at the end.
class InDirectory : public testing::Test {
  protected:
    InDirectory() {
        std::string name = std::filesystem::temp_directory_path() / "dorbo-test-XXXXXX";
        directory = mkdtemp(name.data());
        std::filesystem::current_path(directory);
    }

    ~InDirectory() override {
        std::filesystem::current_path("/");
        std::filesystem::remove_all(directory);
    }

    std::filesystem::path directory;
};

class ToonTest : public InDirectory {
  protected:
    ToonTest() {
        seam::answerBoxes([this](const std::string& text, const std::string& caption, UINT type) {
            boxes.push_back({text, caption, type});
            return IDOK;
        });
        FrameStoreFree();
        ToonDocHeader = {};
        FrameCount = 1;
        CurrentFrameIndex = 0;
        ToonFileName[0] = '\0';
        ToonDirty = 0;
        ToonSpeed = 3;
        BackgroundIndex = 0;
        CaptionText[0] = '\0';
        StageSize = 0;
        EditFrame = {};
    }

    ~ToonTest() override {
        FrameStoreFree();
        seam::answerBoxes(nullptr);
        seam::HandleCounts counts;
        seam::countKernelHandles(counts);
        EXPECT_EQ(counts.files, 0U);
        EXPECT_EQ(counts.memoryBlocks, 0U);
    }

    /// Begins an untitled Toon of frames at (0, 0), (1, 10), (2, 20) and so on.
    static void makeToon(LONG frames) {
        FrameStoreAlloc(frames);
        FrameCount = frames;
        ToonNewDefaults();
        for (LONG i = 0; i < frames; ++i) {
            const ToonFrame frame{i, i * 10, 1, 5, 0, "Hello", 0};
            FramePut(i, &frame);
        }
    }

    static std::vector<LONG> positions() {
        std::vector<LONG> result;
        ToonFrame frame{};
        for (LONG i = 0; FrameGet(i, &frame); ++i) {
            result.push_back(frame.x);
        }
        return result;
    }

    /// How many records the store takes.
    static LONG storeSize() {
        const ToonFrame frame{};
        LONG size = 0;
        while (FramePut(size, &frame)) {
            ++size;
        }
        return size;
    }

    static void name(const std::string& path) {
        CopyText(ToonFileName, path.c_str(), sizeof ToonFileName);
    }

    std::vector<Box> boxes;
};

} // namespace test
