// A directory of its own to work in, a fresh open Toon, and the boxes that were shown.
#pragma once

#include "tests/kernel/scratch_directory.h"
#include "toon/toon_document.h"

#include <string>
#include <vector>

namespace test {

/// The text and the icon of a box; its caption is "Error".
using Box = std::pair<std::string, UINT>;

inline const std::filesystem::path badDirectory = DORBO_SOURCE_DIR "/tests/toon/bad";
inline const std::filesystem::path toonDirectory = DORBO_TOONS;

class ToonTest : public ScratchDirectory {
  protected:
    ToonTest() {
        seam::answerBoxes([this](const std::string& text, const std::string& caption, UINT type) {
            boxes.emplace_back(text, type);
            EXPECT_EQ(caption, "Error");
            return IDOK;
        });
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

    void TearDown() override {
        FrameStoreFree();
        seam::answerBoxes(nullptr);
        ScratchDirectory::TearDown();
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

    static void name(const std::string& path) {
        CopyText(ToonFileName, path.c_str(), sizeof ToonFileName);
    }

    std::vector<Box> boxes;
};

} // namespace test
