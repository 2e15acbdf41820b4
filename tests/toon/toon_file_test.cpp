// Toons are read from and written to files, good and bad ones.
#include "tests/toon/toon_fixture.h"

#include "platform/trace.h"

#include <gmock/gmock.h>

#include <sys/stat.h>

#include <cstring>

namespace {

using test::Box;
using test::errorBox;
using testing::ElementsAre;
using testing::IsEmpty;

constexpr char noMemory[] = "Not enough memory.";
constexpr char noOpening[] = "Error opening file";

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
        test::writeFile("good.zkt", wholeToon(frames));
        ASSERT_EQ(ToonOpenNamed(nullptr, "good.zkt"), 1);
        ToonDocHeader.frameCount = frames; // as a save leaves it
    }
};

// ---- Loading
// -------------------------------------------------------------------------------------

struct BadFile {
    const char* name;
    LONG result;
    std::vector<Box> boxes;
    LONG frameCount; // after a Toon of three frames
    LONG store;      // records
    LONG speed;      // in force; 3 before, 4 in the files
};

Box wrongVersion(const char* name) {
    return errorBox(std::string("Invalid ToonFile Version ") + name + ".zkt.", MB_ICONEXCLAMATION);
}

Box shortRead(const char* name) {
    return errorBox(std::string("Error reading ") + name + ".zkt.", MB_ICONEXCLAMATION);
}

const BadFile badFiles[] = {
    {"empty", 0, {errorBox(noMemory, MB_ICONHAND)}, 0, 0, 3},
    {"header-of-102-bytes", 0, {errorBox(noMemory, MB_ICONHAND)}, 0, 0, 3},
    {"header-of-103-bytes", 0, {}, 0, 0, 3},
    {"header-without-frames", 0, {}, 0, 0, 4},
    {"version-of-tomorrow", 0, {wrongVersion("version-of-tomorrow")}, 2, 2, 3},
    {"version-in-big-endian", 0, {wrongVersion("version-in-big-endian")}, 2, 2, 3},
    {"text-file", 0, {wrongVersion("text-file")}, 2, 2, 3},
    {"last-byte-missing", 2, {shortRead("last-byte-missing")}, 2, 2, 4},
    {"last-two-bytes-missing", 1, {}, 1, 1, 4},
    {"one-byte-too-many", 2, {}, 2, 2, 4},
    {"ninety-bytes-too-many", 2, {}, 2, 2, 4},
    {"ninety-one-bytes-too-many", 3, {shortRead("ninety-one-bytes-too-many")}, 3, 3, 4},
    {"count-too-high", 2, {}, 2, 2, 4},
    {"count-negative", 2, {}, 2, 2, 4},
    {"magic-of-another", 2, {}, 2, 2, 4},
    {"caption-without-nul", 2, {}, 2, 2, 4},
    {"text-without-nul", 2, {}, 2, 2, 4},
    {"numbers-lowest", 2, {}, 2, 2, INT32_MIN},
    {"numbers-highest", 2, {}, 2, 2, INT32_MAX},
};

TEST_F(ToonFile, BadFilesEndAsTheyShould) {
    std::filesystem::copy(test::badDirectory, directory);
    for (const BadFile& bad : badFiles) {
        SCOPED_TRACE(bad.name);
        loadGoodOne(3);
        boxes.clear();
        const HCURSOR arrow = LoadCursorA(nullptr, IDC_ARROW);
        SetCursor(arrow);
        name(std::string(bad.name) + ".zkt");
        EXPECT_EQ(ToonReload(nullptr), bad.result);
        EXPECT_EQ(boxes, bad.boxes);
        EXPECT_EQ(FrameCount, bad.frameCount);
        EXPECT_EQ(ToonSpeed, bad.speed);
        EXPECT_TRUE(SetCursor(arrow) == arrow);
        EXPECT_EQ(storeSize(), bad.store);
    }
}

TEST_F(ToonFile, EveryBadFileIsTried) {
    std::vector<std::string> tried;
    for (const BadFile& bad : badFiles) {
        tried.push_back(std::string(bad.name) + ".zkt");
    }
    std::vector<std::string> kept;
    for (const auto& entry : std::filesystem::directory_iterator(test::badDirectory)) {
        kept.push_back(entry.path().filename());
    }
    EXPECT_THAT(kept, testing::UnorderedElementsAreArray(tried));
}

TEST_F(ToonFile, FramesThatDidNotArriveAreZero) {
    std::filesystem::copy(test::badDirectory / "last-byte-missing.zkt", "x.zkt");
    name("x.zkt");
    FrameCount = ToonLoad(nullptr);
    const auto* frames = static_cast<const ToonFrame*>(GlobalLock(FrameStore));
    EXPECT_STREQ(frames[1].text, "Two");
    EXPECT_EQ(frames[1].reserved, 0x0007); // the byte before the missing one did
    GlobalUnlock(FrameStore);
}

TEST_F(ToonFile, TextsWithoutNulEndWithTheirFields) {
    std::filesystem::copy(test::badDirectory, directory);
    ASSERT_EQ(ToonOpenNamed(nullptr, "caption-without-nul.zkt"), 1);
    EXPECT_EQ(std::string(CaptionText), std::string(51, 'C'));
    ASSERT_EQ(ToonOpenNamed(nullptr, "text-without-nul.zkt"), 1);
    EXPECT_EQ(std::string(EditFrame.text), std::string(69, 'T'));
    const std::string before = test::readFile("text-without-nul.zkt");
    EXPECT_EQ(ToonSave(nullptr), 1);
    EXPECT_EQ(test::readFile("text-without-nul.zkt"), before); // the store keeps its bytes
}

TEST_F(ToonFile, WhatCannotBeOpenedChangesNothing) {
    test::writeFile("read-only.zkt", wholeToon(2));
    chmod("read-only.zkt", 0444);
    mkdir("directory.zkt", 0755);
    mkfifo("fifo.zkt", 0644);
    symlink("nowhere.zkt", "dangling.zkt");
    for (const char* bad : {"read-only.zkt", "directory.zkt", "fifo.zkt", "dangling.zkt",
                            "missing.zkt", "missing/x.zkt", "/dev/zero", "/dev/full"}) {
        SCOPED_TRACE(bad);
        loadGoodOne(3);
        boxes.clear();
        name(bad);
        EXPECT_EQ(ToonLoad(nullptr), 0);
        EXPECT_THAT(boxes, ElementsAre(errorBox(noOpening, MB_ICONHAND)));
        EXPECT_EQ(FrameCount, 3);
        EXPECT_THAT(positions(), ElementsAre(0, 1, 2));
    }
}

TEST_F(ToonFile, NoNameLoadsNothingAndSaysNothing) {
    loadGoodOne(3);
    name("");
    EXPECT_EQ(ToonLoad(nullptr), 0);
    EXPECT_EQ(ToonReload(nullptr), 0);
    EXPECT_THAT(boxes, IsEmpty());
    EXPECT_THAT(positions(), ElementsAre(0, 1, 2));
}

TEST_F(ToonFile, ManyFramesLoadAtOnce) {
    for (const LONG frames : {300, 100000}) {
        test::writeFile("many.zkt", wholeToon(frames));
        ASSERT_EQ(ToonOpenNamed(nullptr, "many.zkt"), 1);
        EXPECT_EQ(FrameCount, frames);
        ToonFrame last{};
        ASSERT_EQ(FrameGet(frames - 1, &last), 1);
        EXPECT_EQ(last.x, frames - 1);
    }
    EXPECT_THAT(boxes, IsEmpty());
}

TEST_F(ToonFile, FilesTooLargeForMemoryAreRefused) {
    // Sizes at which a count, or a count times 92, would wrap at 31 or 32 bits.
    const std::uint64_t gigabyte = 1ULL << 30;
    for (const std::uint64_t size :
         {2 * gigabyte + 200, 4 * gigabyte + 104 + 92, 200 * gigabyte, 8192 * gigabyte}) {
        loadGoodOne(3);
        boxes.clear();
        test::writeFile("huge.zkt", wholeToon(1));
        std::error_code unable;
        std::filesystem::resize_file("huge.zkt", size, unable);
        if (unable) {
            continue; // larger than this file system's files
        }
        name("huge.zkt");
        EXPECT_EQ(ToonLoad(nullptr), 0) << size;
        EXPECT_THAT(boxes, ElementsAre(errorBox(noMemory, MB_ICONHAND))) << size;
        EXPECT_FALSE(FrameStore) << size;
        EXPECT_EQ(FrameCount, 0) << size;
    }
}

TEST_F(ToonFile, TheLongestNameFitsTheMessages) {
    std::filesystem::copy(test::badDirectory / "text-file.zkt", "text.zkt");
    std::filesystem::create_directory("xx");
    std::string longest = "xx";
    while (longest.size() < 255 - std::strlen("/text.zkt")) {
        longest += "/.";
    }
    longest += "/text.zkt";
    ASSERT_EQ(longest.size(), 255U);
    std::filesystem::rename("text.zkt", longest);
    EXPECT_EQ(ToonOpenNamed(nullptr, longest.c_str()), 0);
    EXPECT_THAT(boxes, ElementsAre(errorBox("Invalid ToonFile Version " + longest + ".",
                                            MB_ICONEXCLAMATION)));
}

TEST_F(ToonFile, ANameThatDoesNotFitIsNotCutToAnothers) {
    std::filesystem::create_directory("x");
    std::string name = "x";
    while (name.size() < 247) {
        name += "/.";
    }
    name += "/one.zkt";
    ASSERT_EQ(name.size(), 255U);
    test::writeFile(name, wholeToon(1));
    EXPECT_EQ(ToonOpenNamed(nullptr, name.c_str()), 1);
    EXPECT_EQ(ToonOpenNamed(nullptr, (name + "x").c_str()), 0);
    EXPECT_STREQ(ToonFileName, "");
    EXPECT_THAT(boxes, IsEmpty());
}

TEST_F(ToonFile, OpenByNameSelectsTheFirstFrame) {
    CurrentFrameIndex = 9;
    ToonDirty = 1;
    std::vector<std::string> record;
    static std::vector<std::string>* sink = nullptr;
    sink = &record;
    TraceSink = [](const char* line) { sink->push_back(line); };
    const std::string intro = test::sourceDirectory / "toons/intro.zkt";
    std::filesystem::copy(intro, "intro.zkt");
    EXPECT_EQ(ToonOpenNamed(nullptr, "intro.zkt"), 1);
    TraceSink = nullptr;
    EXPECT_EQ(FrameCount, 5);
    EXPECT_EQ(CurrentFrameIndex, 0);
    EXPECT_EQ(EditFrame.x, 420);
    EXPECT_EQ(ToonDirty, 0U);
    EXPECT_EQ(BackgroundIndex, 4);
    EXPECT_STREQ(CaptionText, "Dorbo says hello (to the furniture, mostly)");
    EXPECT_EQ(ToonDocHeader.windowSize, MAKELONG(1920, 1080));
    EXPECT_THAT(record, ElementsAre(testing::EndsWith(" load file=intro.zkt count=5")));
}

TEST_F(ToonFile, AReloadDiscardsChangesAndTakesTheFilesCount) {
    loadGoodOne(3);
    FrameStoreDelete(0);
    ToonSpeed = 5;
    EXPECT_EQ(ToonReload(nullptr), 3);
    EXPECT_EQ(FrameCount, 3);
    EXPECT_THAT(positions(), ElementsAre(0, 1, 2));
    EXPECT_EQ(ToonSpeed, 3);

    test::writeFile("good.zkt", wholeToon(2)); // behind our back
    EXPECT_EQ(ToonReload(nullptr), 2);
    EXPECT_EQ(FrameCount, 2);
}

TEST_F(ToonFile, AFailedLoadNeverCountsMoreFramesThanTheStoreHas) {
    loadGoodOne(1);
    std::string wrong = wholeToon(4);
    wrong[32] = 9;
    test::writeFile("wrong.zkt", wrong);
    name("wrong.zkt");
    EXPECT_EQ(ToonLoad(nullptr), 0);
    EXPECT_EQ(FrameCount, 1); // what the header before it said
    ToonDocHeader.frameCount = 1000;
    EXPECT_EQ(ToonLoad(nullptr), 0);
    EXPECT_EQ(FrameCount, 4); // what the store has
    EXPECT_EQ(positions().size(), 4U);
}

// ---- Saving
// --------------------------------------------------------------------------------------

TEST_F(ToonFile, ASavedToonComesBackByteForByte) {
    for (const char* toon : {"intro", "lost-thought", "shortest-way"}) {
        const std::string path = test::sourceDirectory / "toons" / (std::string(toon) + ".zkt");
        const std::string bytes = test::readFile(path);
        test::writeFile("in.zkt", bytes);
        ASSERT_EQ(ToonOpenNamed(nullptr, "in.zkt"), 1);
        name("out.zkt");
        test::writeFile("out.zkt", std::string(5000, 'x')); // is cut
        ToonDirty = 1;
        EXPECT_EQ(ToonSave(nullptr), 1);
        EXPECT_EQ(ToonDirty, 0U);
        EXPECT_EQ(test::readFile("out.zkt"), bytes);
    }
    EXPECT_THAT(boxes, IsEmpty());
}

TEST_F(ToonFile, ASaveWritesTheCountAndKeepsTheRecordedSize) {
    StageSize = MAKELONG(640, 480);
    makeToon(1);
    ++FrameCount;
    FrameStoreGrow();
    StageSize = MAKELONG(800, 600);
    name("new.zkt");
    ASSERT_EQ(ToonSave(nullptr), 1);
    const std::string bytes = test::readFile("new.zkt");
    ASSERT_EQ(bytes.size(), 104U + 2U * 92U);
    ToonHeader header{};
    std::memcpy(&header, bytes.data(), sizeof header);
    EXPECT_EQ(header.frameCount, 2);
    EXPECT_EQ(header.windowSize, MAKELONG(640, 480));
    EXPECT_EQ(bytes.substr(0, 22), std::string("Dorbo Toon Frame File\0", 22));
}

TEST_F(ToonFile, WhatCannotBeCreatedStaysAsItWas) {
    test::writeFile("read-only.zkt", "precious");
    chmod("read-only.zkt", 0444);
    mkdir("directory.zkt", 0755);
    mkfifo("fifo.zkt", 0644);
    for (const std::string bad : {"read-only.zkt", "directory.zkt", "fifo.zkt", "missing/x.zkt"}) {
        makeToon(2);
        ToonDirty = 1;
        boxes.clear();
        name(bad);
        EXPECT_EQ(ToonSave(nullptr), 0);
        EXPECT_THAT(boxes,
                    ElementsAre(errorBox("Cannot write to " + bad + ".", MB_ICONEXCLAMATION)));
        EXPECT_EQ(ToonDirty, 1U);
        EXPECT_THAT(positions(), ElementsAre(0, 1));
    }
    EXPECT_EQ(test::readFile("read-only.zkt"), "precious");
}

TEST_F(ToonFile, AFileThatFailedToLoadIsNotEmptiedByASave) {
    std::filesystem::copy(test::badDirectory / "empty.zkt", "precious.zkt");
    name("precious.zkt");
    ToonLoad(nullptr);
    test::writeFile("precious.zkt", "back again");
    boxes.clear();
    EXPECT_EQ(ToonSave(nullptr), 0);
    EXPECT_THAT(boxes, ElementsAre(errorBox("Cannot write to precious.zkt.", MB_ICONEXCLAMATION)));
    EXPECT_EQ(test::readFile("precious.zkt"), "back again");
}

TEST_F(ToonFile, AShortWriteIsToldAndLeavesTheToonDirty) {
    makeToon(2);
    for (const rlim_t room : {0U, 50U, 104U, 104U + 91U, 104U + 183U}) {
        ToonDirty = 1;
        boxes.clear();
        name("full.zkt");
        {
            const test::FullDisk disk(room);
            EXPECT_EQ(ToonSave(nullptr), 0);
        }
        EXPECT_THAT(boxes, ElementsAre(errorBox("Error writing to full.zkt.", MB_ICONHAND)))
            << room;
        EXPECT_EQ(ToonDirty, 1U);
        EXPECT_EQ(std::filesystem::file_size("full.zkt"), room);
        EXPECT_THAT(positions(), ElementsAre(0, 1));
    }
    const test::FullDisk disk(104 + 184);
    EXPECT_EQ(ToonSave(nullptr), 1);
}

} // namespace
