// The text form of Toons, and the Toons that come with the program.
#include "cli/toon_text.h"
#include "tests/toon/toon_fixture.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cstring>
#include <random>
#include <set>

namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

const std::filesystem::path toonDirectory = test::sourceDirectory / "toons";

std::vector<std::string> shippedToons() {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(toonDirectory)) {
        if (entry.path().extension() == ".zkt") {
            names.push_back(entry.path().stem());
        }
    }
    return names;
}

void expectRoundTrip(const std::string& bytes) {
    const std::optional<std::string> text = ToonToText(bytes);
    ASSERT_TRUE(text);
    const ToonFromText again = TextToToon(*text);
    EXPECT_EQ(again.error, "");
    EXPECT_TRUE(again.bytes == bytes) << *text;
}

TEST(ToonText, ShippedToonsAreMadeFromTheirTexts) {
    for (const std::string& name : shippedToons()) {
        SCOPED_TRACE(name);
        const ToonFromText made =
            TextToToon(test::readFile(toonDirectory / "src" / (name + ".txt")));
        EXPECT_EQ(made.error, "");
        EXPECT_THAT(made.warnings, IsEmpty());
        const std::string bytes = test::readFile(toonDirectory / (name + ".zkt"));
        EXPECT_TRUE(made.bytes == bytes);
        expectRoundTrip(bytes);
    }
}

TEST(ToonText, ShippedToonsShowEveryPoseAndAnIntro) {
    EXPECT_THAT(shippedToons(), testing::Contains("intro"));
    std::set<LONG> poses;
    for (const std::string& name : shippedToons()) {
        const std::string bytes = test::readFile(toonDirectory / (name + ".zkt"));
        for (std::size_t at = sizeof(ToonHeader); at < bytes.size(); at += sizeof(ToonFrame)) {
            ToonFrame frame{};
            std::memcpy(&frame, bytes.data() + at, sizeof frame);
            poses.insert(frame.pose);
            EXPECT_GT(frame.pause, 0) << name;
        }
    }
    EXPECT_THAT(poses, ElementsAre(0, 1, 2, 3, 4, 5, 6, 7));
}

/// Height in pixels of a text as the speech bubble draws it.
int heightInBubble(const char* text) {
    constexpr LONG bubbleWidth = 120;
    const HDC dc = CreateCompatibleDC(nullptr);
    const HFONT font = CreateFontA(-14, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, "MS Serif");
    const HGDIOBJ before = SelectObject(dc, font);
    RECT area{0, 0, bubbleWidth, 0};
    const int height = DrawTextA(dc, text, static_cast<int>(std::strlen(text)), &area,
                                 DT_CENTER | DT_WORDBREAK | DT_NOPREFIX);
    SelectObject(dc, before);
    DeleteObject(font);
    DeleteDC(dc);
    return height;
}

TEST(ToonText, ShippedTextsFitTheBubble) {
    constexpr int bubbleHeight = 71;
    ASSERT_GT(GetSystemMetrics(SM_CXSCREEN), 0); // fonts need a screen
    ToonFrame frame{};
    for (const std::string& name : shippedToons()) {
        ASSERT_EQ(ToonOpenNamed(nullptr, (toonDirectory / (name + ".zkt")).c_str()), 1);
        for (LONG i = 0; FrameGet(i, &frame); ++i) {
            EXPECT_LE(heightInBubble(frame.text), bubbleHeight) << name << ": " << frame.text;
        }
    }
    FrameStoreFree();
    // A text that doesn't fit is told from one that does.
    EXPECT_GT(heightInBubble("One\rtwo\rthree\rfour\rfive\rsix"), bubbleHeight);
}

TEST(ToonText, BadToonsWithAWholeHeaderComeBackByteForByte) {
    for (const auto& entry : std::filesystem::directory_iterator(test::badDirectory)) {
        SCOPED_TRACE(entry.path().filename());
        const std::string bytes = test::readFile(entry.path());
        ToonHeader header{};
        std::memcpy(&header, bytes.data(), std::min(bytes.size(), sizeof header));
        if (bytes.size() >= sizeof header && header.version == TOON_VERSION) {
            expectRoundTrip(bytes);
        } else {
            EXPECT_FALSE(ToonToText(bytes));
        }
    }
}

TEST(ToonText, AnyBytesBehindTheVersionComeBack) {
    std::minstd_rand random(1);
    for (const std::size_t size : {104U, 105U, 195U, 196U, 104U + 92U * 30U + 91U}) {
        std::string bytes(size, '\0');
        std::ranges::generate(bytes, [&] { return static_cast<char>(random() >> 8); });
        std::memcpy(&bytes[32], &TOON_VERSION, sizeof TOON_VERSION);
        expectRoundTrip(bytes);
    }
}

TEST(ToonText, EveryByteCanStandInAText) {
    std::string bytes = test::readFile(toonDirectory / "intro.zkt");
    for (int first = 0; first < 256; first += 64) {
        for (int i = 0; i < 64; ++i) {
            bytes[124U + static_cast<unsigned>(i)] = static_cast<char>(first + i);
        }
        expectRoundTrip(bytes);
    }
}

TEST(ToonText, AFewLinesMakeAToon) {
    const ToonFromText made = TextToToon("\xEF\xBB\xBF# Hello\r\n"
                                         "caption \"Caf\xC3\xA9 \xE2\x82\xAC \\\"\\\\\"\r\n"
                                         "\r\n"
                                         "frame\r\n"
                                         "  text \"One\\rTwo\\x00\\xff\"\r\n"
                                         "  at -5   7\r\n"
                                         "  pause 3\r\n"
                                         "frame");
    ASSERT_EQ(made.error, "");
    ToonHeader header{};
    ToonFrame frames[2]{};
    ASSERT_EQ(made.bytes.size(), sizeof header + sizeof frames);
    std::memcpy(&header, made.bytes.data(), sizeof header);
    std::memcpy(frames, made.bytes.data() + sizeof header, sizeof frames);
    EXPECT_STREQ(header.magic, "Dorbo Toon Frame File");
    EXPECT_STREQ(header.caption, "Caf\xE9 \x80 \"\\");
    EXPECT_EQ(header.frameCount, 2);
    EXPECT_EQ(header.speed, 3);
    EXPECT_EQ(header.background, 1);
    EXPECT_EQ(header.windowSize, 0U);
    EXPECT_EQ(frames[0].x, -5);
    EXPECT_EQ(frames[0].y, 7);
    EXPECT_EQ(frames[0].pause, 3);
    EXPECT_EQ(std::memcmp(frames[0].text, "One\rTwo\0\xFF\0", 10), 0);
    EXPECT_EQ(frames[1].text[0], '\0');
}

TEST(ToonText, MistakesAreToldWithTheirLine) {
    struct Case {
        const char* text;
        const char* error;
    };

    const Case cases[] = {
        {"speed", "line 1: speed takes 1 number"},
        {"speed 3x", "line 1: speed takes 1 number"},
        {"speed 3 4", "line 1: too much behind speed"},
        {"speed 2147483648", "line 1: speed takes 1 number"},
        {"stage 1024", "line 1: stage takes 2 numbers"},
        {"stage 1024 65536", "line 1: stage takes 2 numbers"},
        {"stage -1 768", "line 1: stage takes 2 numbers"},
        {"\nspeed 1\nspeed 2", "line 3: speed stands twice"},
        {"pose 3", "line 1: before the first frame there is no pose"},
        {"frame\nspeed 3", "line 2: a frame has no speed"},
        {"frame 1", "line 1: before the first frame there is no frame"},
        {"caption Hello", "line 1: a text stands in quotes"},
        {"caption \"Hello", "line 1: a text stands in quotes"},
        {"caption \"Hello\" there", "line 1: a text stands in quotes"},
        {"caption \"Hello\\\"", "line 1: a text stands in quotes"},
        {"caption \"\\n\"", "line 1: only \\r, \\\", \\\\ and \\xNN stand for something else"},
        {"caption \"\\x4\"", "line 1: only \\r, \\\", \\\\ and \\xNN stand for something else"},
        {"caption \"\xE2\x98\xBA\"", "line 1: a character that Windows-1252 hasn't got"},
        {"caption \"\xFF\"", "line 1: a character that Windows-1252 hasn't got"},
        {"rest \"\"\nframe", "line 2: nothing stands behind the rest"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(TextToToon(c.text).error, c.error) << c.text;
        EXPECT_EQ(TextToToon(c.text).bytes, "") << c.text;
    }
    const std::string tooLong(71, 'x');
    EXPECT_EQ(TextToToon("frame\ntext \"" + tooLong + "\"").error,
              "line 2: text is longer than its 70 bytes");
}

TEST(ToonText, WhatTheEditorWouldNotMakeIsToldButMade) {
    struct Case {
        std::string text;
        const char* warning;
    };

    const Case cases[] = {
        {"frame\npose 8", "line 2: pose is outside 0 to 7"},
        {"frame\npause 0", "line 2: pause is outside 1 to 20"},
        {"frame\nwink 2", "line 2: wink is outside 0 to 1"},
        {"frame\ntext \"" + std::string(70, 'x') + "\"",
         "line 2: text is longer than 69 characters"},
        {"caption \"" + std::string(49, 'x') + "\"\nframe",
         "line 1: caption is longer than 48 characters"},
        {"speed 6\nframe", "line 1: speed is outside 1 to 5"},
        {"background 11\nframe", "line 1: background is outside 1 to 10"},
        {"speed 3", "line 1: a Toon without a frame doesn't load"},
    };
    for (const Case& c : cases) {
        const ToonFromText made = TextToToon(c.text);
        EXPECT_EQ(made.error, "");
        EXPECT_THAT(made.warnings, ElementsAre(c.warning)) << c.text;
        expectRoundTrip(made.bytes);
    }
}

// ---- The program
// ---------------------------------------------------------------------------------

class ToonProgram : public test::InDirectory {
  protected:
    /// Runs `toon` with these arguments, gives its exit code; what it prints is in "out".
    static int run(const std::string& arguments) {
        const int status = std::system((DORBO_TOON " " + arguments + " >out 2>&1").c_str());
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }
};

TEST_F(ToonProgram, PrintsAndMakesTheSameFile) {
    const std::string intro = toonDirectory / "intro.zkt";
    ASSERT_EQ(run("print " + intro), 0);
    std::filesystem::rename("out", "intro.txt");
    ASSERT_EQ(run("make intro.txt again.zkt"), 0);
    EXPECT_TRUE(test::readFile("again.zkt") == test::readFile(intro));
    EXPECT_EQ(test::readFile("out"), "");
}

TEST_F(ToonProgram, FailsWithAReason) {
    test::writeFile("bad.txt", "frame\npose many\n");
    test::writeFile("good.txt", "frame\npause 1\n");

    struct Case {
        const char* arguments;
        int code;
        const char* reason;
    };

    const Case cases[] = {
        {"", 2, "usage: toon make TEXT FILE.zkt"},
        {"frob x", 2, "usage: toon print FILE.zkt"},
        {"make good.txt", 2, "usage"},
        {"make missing.txt x.zkt", 1, "toon: can't read missing.txt"},
        {"make . x.zkt", 1, "toon: can't read ."},
        {"make bad.txt x.zkt", 1, "bad.txt: line 2: pose takes 1 number"},
        {"make good.txt missing/x.zkt", 1, "toon: can't write missing/x.zkt"},
        {"print good.txt", 1, "toon: good.txt is no Toon file"},
        {"print missing.zkt", 1, "toon: can't read missing.zkt"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(run(c.arguments), c.code) << c.arguments;
        EXPECT_THAT(test::readFile("out"), HasSubstr(c.reason)) << c.arguments;
        EXPECT_FALSE(std::filesystem::exists("x.zkt")) << c.arguments;
    }
}

} // namespace
