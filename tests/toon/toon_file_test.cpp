// Toons are read from and written to files, good and bad ones.
#include "tests/toon/toon_fixture.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cstring>
#include <map>

namespace {

using test::Box;
using testing::ElementsAre;
using testing::IsEmpty;

using Boxes = std::vector<Box>;

const Box noMemory{"Not enough memory.", MB_ICONHAND};

Box warning(const std::string& text) {
    return {text, MB_ICONEXCLAMATION};
}

std::string wholeToon(LONG frames) {
    ToonHeader header{};
    header.version = TOON_VERSION;
    header.speed = 3;
    std::string bytes(reinterpret_cast<const char*>(&header), sizeof header);
    for (LONG i = 0; i < frames; ++i) {
        const ToonFrame frame{i, 0, 0, 5, 0, "", 0};
        bytes.append(reinterpret_cast<const char*>(&frame), sizeof frame);
    }
    return bytes;
}

class ToonFile : public test::ToonTest {
  protected:
    void loadGoodOne(LONG frames) {
        make("good.zkt", wholeToon(frames));
        ASSERT_EQ(ToonOpenNamed(nullptr, "good.zkt"), 1);
        ToonDocHeader.frameCount = frames; // as a save leaves it
        boxes.clear();
    }
};

TEST_F(ToonFile, BadFilesEndAsTheyShould) {
    const std::string version = "Invalid ToonFile Version x.zkt.";
    const std::string reading = "Error reading x.zkt.";
    // Result, boxes, frames after a Toon of three (as many records are in the store), and the speed
    // in force: 3 before, 4 in the files.
    using Ending = std::tuple<LONG, Boxes, LONG, LONG>;
    const Ending good{2, {}, 2, 4};
    const std::map<std::string, Ending> others{
        {"empty", {0, {noMemory}, 0, 3}},
        {"header-of-102-bytes", {0, {noMemory}, 0, 3}},
        {"header-of-103-bytes", {0, {}, 0, 3}},
        {"header-without-frames", {0, {}, 0, 4}},
        {"version-of-tomorrow", {0, {warning(version)}, 2, 3}},
        {"version-in-big-endian", {0, {warning(version)}, 2, 3}},
        {"text-file", {0, {warning(version)}, 2, 3}},
        {"last-byte-missing", {2, {warning(reading)}, 2, 4}},
        {"last-two-bytes-missing", {1, {}, 1, 4}},
        {"ninety-one-bytes-too-many", {3, {warning(reading)}, 3, 4}},
        {"numbers-lowest", {2, {}, 2, INT32_MIN}},
        {"numbers-highest", {2, {}, 2, INT32_MAX}},
    };
    for (const auto& entry : std::filesystem::directory_iterator(test::badDirectory)) {
        SCOPED_TRACE(entry.path());
        const auto other = others.find(entry.path().stem());
        const auto& [result, told, count, speed] = other == others.end() ? good : other->second;
        loadGoodOne(3);
        make("x.zkt", textOf(entry.path()));
        name("x.zkt");
        const HCURSOR arrow = LoadCursorA(nullptr, IDC_ARROW);
        SetCursor(arrow);
        EXPECT_EQ(ToonReload(nullptr), result);
        EXPECT_EQ(boxes, told);
        EXPECT_EQ(FrameCount, count);
        EXPECT_EQ(ToonSpeed, speed);
        EXPECT_TRUE(SetCursor(arrow) == arrow);
        ToonFrame frame{};
        EXPECT_EQ(FramePut(count - 1, &frame), count > 0 ? 1 : 0);
        EXPECT_EQ(FramePut(count, &frame), 0);
    }
}

TEST_F(ToonFile, BytesArriveAsFarAsTheyGoAndTextsEndWithTheirFields) {
    std::filesystem::copy(test::badDirectory, root_);
    name("last-byte-missing.zkt");
    FrameCount = ToonLoad(nullptr);
    const auto* frames = static_cast<const ToonFrame*>(GlobalLock(FrameStore));
    EXPECT_STREQ(frames[1].text, "Two");
    EXPECT_EQ(frames[1].reserved, 0x0007); // the byte before the missing one did
    GlobalUnlock(FrameStore);
    ASSERT_EQ(ToonOpenNamed(nullptr, "caption-without-nul.zkt"), 1);
    EXPECT_EQ(std::string(CaptionText), std::string(51, 'C'));
    ASSERT_EQ(ToonOpenNamed(nullptr, "text-without-nul.zkt"), 1);
    EXPECT_EQ(std::string(EditFrame.text), std::string(69, 'T'));
    const std::string before = textOf("text-without-nul.zkt");
    EXPECT_EQ(ToonSave(nullptr), 1);
    EXPECT_EQ(textOf("text-without-nul.zkt"), before); // the store keeps its bytes
}

TEST_F(ToonFile, WhatCannotBeOpenedOrCreatedChangesNothing) {
    make("read-only.zkt", wholeToon(2));
    setMode("read-only.zkt", 0444);
    loadGoodOne(3);
    for (const std::string bad : {"read-only.zkt", "missing/x.zkt"}) {
        SCOPED_TRACE(bad);
        boxes.clear();
        ToonDirty = 1;
        name(bad);
        EXPECT_EQ(ToonLoad(nullptr), 0);
        EXPECT_EQ(ToonSave(nullptr), 0);
        EXPECT_THAT(boxes, ElementsAre(Box{"Error opening file", MB_ICONHAND},
                                       warning("Cannot write to " + bad + ".")));
        EXPECT_EQ(ToonDirty, 1U);
        EXPECT_THAT(positions(), ElementsAre(0, 1, 2));
    }
    EXPECT_EQ(textOf("read-only.zkt"), wholeToon(2));
    boxes.clear();
    name("");
    EXPECT_EQ(ToonLoad(nullptr), 0);
    EXPECT_THAT(boxes, IsEmpty());
}

TEST_F(ToonFile, FilesTooLargeForMemoryAreRefused) {
    // A count that would wrap at 32 bits, and one that would when taken 92 times.
    for (const std::uint64_t size : {0x1000000C4U, 0x3200000000U}) {
        loadGoodOne(3);
        std::filesystem::resize_file("good.zkt", size);
        EXPECT_EQ(ToonLoad(nullptr), 0) << size;
        EXPECT_THAT(boxes, ElementsAre(noMemory)) << size;
        EXPECT_FALSE(FrameStore) << size;
        EXPECT_EQ(FrameCount, 0) << size;
    }
}

TEST_F(ToonFile, TheLongestNameFitsTheMessagesAndALongerOneIsNotCut) {
    make("x/text.zkt", "Dear Dorbo" + std::string(200, '.'));
    const std::string longest = "x" + std::string(244, '/') + "./text.zkt";
    EXPECT_EQ(ToonOpenNamed(nullptr, longest.c_str()), 0);
    EXPECT_THAT(boxes, ElementsAre(warning("Invalid ToonFile Version " + longest + ".")));
    boxes.clear();
    EXPECT_EQ(ToonOpenNamed(nullptr, (longest + "x").c_str()), 0);
    EXPECT_STREQ(ToonFileName, "");
    EXPECT_THAT(boxes, IsEmpty());
}

TEST_F(ToonFile, AReloadDiscardsChangesAndCountsWhatTheStoreHas) {
    loadGoodOne(3);
    FrameStoreDelete(0);
    EXPECT_EQ(ToonReload(nullptr), 3);
    EXPECT_THAT(positions(), ElementsAre(0, 1, 2));
    make("good.zkt", wholeToon(300)); // behind our back, and more than the editor makes
    EXPECT_EQ(ToonReload(nullptr), 300);
    EXPECT_EQ(positions().size(), 300U);
    make("good.zkt", wholeToon(4).replace(32, 1, "9")); // another version
    for (const LONG before : {-1, 1, 1000}) {
        ToonDocHeader.frameCount = before;
        EXPECT_EQ(ToonLoad(nullptr), 0);
        EXPECT_EQ(FrameCount, std::clamp(before, 0, 4));
    }
}

TEST_F(ToonFile, ASavedToonComesBackByteForByte) {
    const std::string bytes = textOf(test::toonDirectory / "intro.zkt");
    make("x.zkt", bytes);
    CurrentFrameIndex = 9;
    ASSERT_EQ(ToonOpenNamed(nullptr, "x.zkt"), 1);
    EXPECT_EQ(CurrentFrameIndex, 0);
    EXPECT_EQ(EditFrame.x, 430);
    EXPECT_EQ(BackgroundIndex, 4);
    EXPECT_STREQ(CaptionText, "Dorbo Says Hello (to the Furniture, Mostly)");
    make("x.zkt", std::string(5000, 'x')); // is cut
    ToonDirty = 1;
    EXPECT_EQ(ToonSave(nullptr), 1);
    EXPECT_EQ(ToonDirty, 0U);
    EXPECT_EQ(textOf("x.zkt"), bytes);
    make("x.zkt");
    ToonLoad(nullptr);
    make("x.zkt", "back again");
    EXPECT_EQ(ToonSave(nullptr), 0) << "a file that failed to load isn't emptied";
    EXPECT_THAT(boxes, ElementsAre(noMemory, warning("Cannot write to x.zkt.")));
    EXPECT_EQ(textOf("x.zkt"), "back again");
}

TEST_F(ToonFile, ANewToonTakesStageAndCaptionInForceAndKeepsItsSize) {
    StageSize = MAKELONG(640, 480);
    ToonSpeed = 5;
    std::memset(ToonDocHeader.magic, '+', sizeof ToonDocHeader.magic);
    std::strcpy(CaptionText, "Before");
    makeToon(1);
    FrameStoreInsert(1);
    StageSize = MAKELONG(800, 600);
    name("new.zkt");
    ASSERT_EQ(ToonSave(nullptr), 1);
    std::string header("Dorbo Toon Frame File\0++++++++++\x01\0\x02\0Before", 42);
    header.resize(88, '\0');
    header += std::string("\x80\x02\xE0\x01\x02\0\0\0\x03\0\0\0\x01\0\0\0", 16);
    EXPECT_EQ(textOf("new.zkt").substr(0, 104), header);
    EXPECT_EQ(textOf("new.zkt").size(), 104U + 2U * 92U);
    EXPECT_EQ(ToonSpeed, 5);
}

TEST_F(ToonFile, AShortWriteIsToldAndLeavesTheToonDirty) {
    makeToon(2);
    name("full.zkt");
    for (const rlim_t room : {50U, 104U, 104U + 183U}) {
        ToonDirty = 1;
        boxes.clear();
        {
            const FullDisk disk(room);
            EXPECT_EQ(ToonSave(nullptr), 0);
        }
        EXPECT_THAT(boxes, ElementsAre(Box{"Error writing to full.zkt.", MB_ICONHAND})) << room;
        EXPECT_EQ(ToonDirty, 1U);
        EXPECT_EQ(std::filesystem::file_size("full.zkt"), room);
        EXPECT_THAT(positions(), ElementsAre(0, 1));
    }
    const FullDisk disk(104 + 184);
    EXPECT_EQ(ToonSave(nullptr), 1);
}

} // namespace
