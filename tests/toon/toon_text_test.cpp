// The text form of Toons, and the Toons that come with the program.
#include "cli/toon_text.h"
#include "tests/toon/toon_fixture.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <random>
#include <set>

namespace {

using testing::ElementsAre;

const std::filesystem::path toonDirectory = test::sourceDirectory / "toons";

void expectRoundTrip(const std::string& bytes) {
    const std::optional<std::string> text = ToonToText(bytes);
    ASSERT_TRUE(text);
    const ToonFromText again = TextToToon(*text);
    EXPECT_EQ(again.error, "");
    EXPECT_TRUE(again.bytes == bytes) << *text;
}

/// Height in pixels of a text as the speech bubble draws it.
int heightInBubble(const char* text) {
    const HDC dc = CreateCompatibleDC(nullptr);
    const HFONT font = CreateFontA(-14, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, "MS Serif");
    SelectObject(dc, font);
    RECT area{0, 0, 120, 0};
    const int height = DrawTextA(dc, text, -1, &area, DT_CENTER | DT_WORDBREAK | DT_NOPREFIX);
    DeleteDC(dc);
    DeleteObject(font);
    return height;
}

class ToonText : public test::ToonTest {};

TEST_F(ToonText, ShippedToonsAreMadeFromTheirTextsFitTheBubbleAndShowEveryPose) {
    constexpr int bubbleHeight = 71;
    ASSERT_GT(GetSystemMetrics(SM_CXSCREEN), 0); // fonts need a screen
    EXPECT_GT(heightInBubble("One\rtwo\rthree\rfour\rfive\rsix"), bubbleHeight);
    EXPECT_TRUE(std::filesystem::exists(toonDirectory / "intro.zkt"));
    std::set<LONG> poses;
    for (const auto& entry : std::filesystem::directory_iterator(toonDirectory / "src")) {
        SCOPED_TRACE(entry.path());
        const std::string toon = entry.path().stem().string() + ".zkt";
        const ToonFromText made = TextToToon(test::readFile(entry.path()));
        EXPECT_EQ(made.error, "");
        EXPECT_THAT(made.warnings, testing::IsEmpty());
        EXPECT_TRUE(made.bytes == test::readFile(toonDirectory / toon));
        expectRoundTrip(made.bytes);
        make(toon, made.bytes);
        ASSERT_EQ(ToonOpenNamed(nullptr, toon.c_str()), 1);
        ToonFrame frame{};
        for (LONG i = 0; FrameGet(i, &frame); ++i) {
            poses.insert(frame.pose);
            EXPECT_GT(frame.pause, 0);
            EXPECT_LE(heightInBubble(frame.text), bubbleHeight) << frame.text;
        }
    }
    EXPECT_THAT(poses, ElementsAre(0, 1, 2, 3, 4, 5, 6, 7));
}

TEST_F(ToonText, BadToonsWithAWholeHeaderComeBackByteForByte) {
    const std::string version("\x01\0\x02\0", 4);
    for (const auto& entry : std::filesystem::directory_iterator(test::badDirectory)) {
        SCOPED_TRACE(entry.path().filename());
        const std::string bytes = test::readFile(entry.path());
        if (bytes.size() >= sizeof(ToonHeader) && bytes.substr(32, 4) == version) {
            expectRoundTrip(bytes);
        } else {
            EXPECT_FALSE(ToonToText(bytes));
        }
    }
    std::minstd_rand random(1); // any bytes behind the version
    for (const std::size_t size : {104U, 105U, 195U, 196U, 104U + 92U * 30U + 91U}) {
        std::string bytes(size, '\0');
        std::ranges::generate(bytes, [&] { return static_cast<char>(random() >> 8); });
        expectRoundTrip(bytes.replace(32, 4, version));
    }
}

TEST_F(ToonText, AFewLinesMakeAToon) {
    const ToonFromText made = TextToToon("\xEF\xBB\xBF# Hello\r\n"
                                         "caption \"Caf\xC3\xA9 \xE2\x82\xAC \\\"\\\\\"\r\n"
                                         "\r\n"
                                         "frame\r\n"
                                         "  text \"One\\rTwo\\x00\\xff\"\r\n"
                                         "  at -5   7\r\n"
                                         "  pause 3\r\n"
                                         "frame");
    EXPECT_EQ(made.error, "");
    ToonHeader header{"Dorbo Toon Frame File", TOON_VERSION, "Caf\xE9 \x80 \"\\", 0, 2, 3, 1};
    ToonFrame frames[2]{};
    frames[0] = {-5, 7, 0, 3, 0, "One\rTwo\0\xFF", 0};
    std::string expected(reinterpret_cast<const char*>(&header), sizeof header);
    expected.append(reinterpret_cast<const char*>(frames), sizeof frames);
    EXPECT_TRUE(made.bytes == expected) << *ToonToText(made.bytes);
}

TEST_F(ToonText, MistakesAreToldWithTheirLine) {
    const std::string quotes = "line 1: a text stands in quotes";
    const std::string escapes = "line 1: only \\r, \\\", \\\\ and \\xNN stand for something else";
    const std::string foreign = "line 1: a character that Windows-1252 hasn't got";
    const std::pair<std::string, std::string> cases[] = {
        {"speed 3x", "line 1: speed takes 1 number"},
        {"speed 3 4", "line 1: too much behind speed"},
        {"speed 2147483648", "line 1: speed takes 1 number"},
        {"stage 1024 65536", "line 1: stage takes 2 numbers"},
        {"\nspeed 1\nspeed 2", "line 3: speed stands twice"},
        {"pose 3", "line 1: before the first frame there is no pose"},
        {"frame\nspeed 3", "line 2: a frame has no speed"},
        {"frame 1", "line 1: before the first frame there is no frame"},
        {"caption \"Hello\" there", quotes},
        {"caption \"Hello\\\"", quotes},
        {"caption \"\\n\"", escapes},
        {"caption \"\\x4\"", escapes},
        {"caption \"\xE2\x98\xBA\"", foreign},
        {"rest \"\"\nframe", "line 2: nothing stands behind the rest"},
        {"frame\ntext \"" + std::string(71, 'x') + "\"",
         "line 2: text is longer than its 70 bytes"},
    };
    for (const auto& [text, error] : cases) {
        EXPECT_EQ(TextToToon(text).error, error) << text;
        EXPECT_EQ(TextToToon(text).bytes, "") << text;
    }
}

TEST_F(ToonText, WhatTheEditorWouldNotMakeIsToldButMade) {
    const std::string words(70, 'x');
    const std::pair<std::string, const char*> cases[] = {
        {"frame\npose 8", "line 2: pose is outside 0 to 7"},
        {"frame\ntext \"" + words + "\"", "line 2: text is longer than 69 characters"},
        {"caption \"" + words.substr(21) + "\"\nframe",
         "line 1: caption is longer than 48 characters"},
        {"speed 6\nframe", "line 1: speed is outside 1 to 5"},
        {"speed 3", "line 1: a Toon without a frame doesn't load"},
    };
    for (const auto& [text, warning] : cases) {
        const ToonFromText made = TextToToon(text);
        EXPECT_EQ(made.error, "");
        EXPECT_THAT(made.warnings, ElementsAre(warning)) << text;
        expectRoundTrip(made.bytes);
    }
}

using ToonProgram = ScratchDirectory;

TEST_F(ToonProgram, PrintsAndMakesTheSameFileOrFailsWithAReason) {
    make("intro.zkt", test::readFile(toonDirectory / "intro.zkt"));
    make("bad.txt", "frame\npose many\n");
    make("good.txt", "frame\npause 1\n");
    const std::tuple<const char*, int, const char*> cases[] = {
        {"", 2, "usage: toon make TEXT FILE.zkt"},
        {"make good.txt", 2, "usage"},
        {"make missing.txt x.zkt", 1, "toon: can't read missing.txt"},
        {"make . x.zkt", 1, "toon: can't read ."},
        {"make bad.txt x.zkt", 1, "bad.txt: line 2: pose takes 1 number"},
        {"make good.txt missing/x.zkt", 1, "toon: can't write missing/x.zkt"},
        {"print good.txt", 1, "toon: good.txt is no Toon file"},
        {"print intro.zkt >intro.txt", 0, ""},
        {"make intro.txt again.zkt", 0, ""},
    };
    for (const auto& [arguments, code, reason] : cases) {
        const std::string command = DORBO_TOON " " + std::string(arguments) + " 2>err";
        const int status = std::system(command.c_str());
        EXPECT_EQ(WIFEXITED(status) ? WEXITSTATUS(status) : -1, code) << arguments;
        EXPECT_THAT(textOf("err"), testing::HasSubstr(reason)) << arguments;
        EXPECT_FALSE(std::filesystem::exists("x.zkt")) << arguments;
    }
    EXPECT_TRUE(textOf("again.zkt") == textOf("intro.zkt"));
}

} // namespace
