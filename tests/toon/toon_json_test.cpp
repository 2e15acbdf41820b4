// Toons as JSON, and the Toons that come with the program.
#include "cli/toon_json.h"
#include "tests/toon/toon_fixture.h"

#include <gmock/gmock.h>

#include <sys/stat.h>

#include <algorithm>
#include <random>
#include <set>

namespace {

using testing::ElementsAre;

/// What `toon write` makes of what `toon show` prints.
std::string throughJson(const std::string& bytes) {
    Toon toon{};
    EXPECT_EQ(ToonFromBytes(bytes, toon), "");
    const std::string json = ToonToJson(toon);
    const ToonFromJson made = JsonToToon(json);
    EXPECT_EQ(made.error, "") << json;
    return ToonBytes(made.toon);
}

/// A Toon of one frame for each text.
std::string toonOf(const std::vector<std::string>& texts) {
    Toon toon{NewHeader(), {}};
    for (const std::string& text : texts) {
        toon.frames.push_back(NewFrame());
        std::copy(text.begin(), text.end(), toon.frames.back().text);
    }
    return ToonBytes(toon);
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

class ToonJson : public test::ToonTest {};

TEST_F(ToonJson, ShippedToonsComeBackFitTheBubbleAndShowEveryPose) {
    constexpr int bubbleHeight = 71;
    ASSERT_GT(GetSystemMetrics(SM_CXSCREEN), 0); // fonts need a screen
    EXPECT_GT(heightInBubble("One\rtwo\rthree\rfour\rfive\rsix"), bubbleHeight);
    EXPECT_TRUE(std::filesystem::exists(test::toonDirectory / "intro.zkt"));
    std::set<LONG> poses;
    for (const auto& entry : std::filesystem::directory_iterator(test::toonDirectory)) {
        SCOPED_TRACE(entry.path());
        const std::string bytes = test::readFile(entry.path());
        EXPECT_TRUE(throughJson(bytes) == bytes);
        make("x.zkt", bytes);
        ASSERT_EQ(ToonOpenNamed(nullptr, "x.zkt"), 1);
        ToonFrame frame{};
        for (LONG i = 0; FrameGet(i, &frame); ++i) {
            poses.insert(frame.pose);
            EXPECT_GT(frame.pause, 0);
            EXPECT_LE(heightInBubble(frame.text), bubbleHeight) << frame.text;
        }
    }
    EXPECT_THAT(poses, ElementsAre(0, 1, 2, 3, 4, 5, 6, 7));
}

TEST_F(ToonJson, EveryByteOfATextButNulComesBack) {
    std::vector<std::string> texts{"\n",     "\r",           "\r\n",
                                   "\n\r\r", "\"\\\"",       "\\n",
                                   "/",      "\xEF\xBB\xBF", std::string(69, '\xFF')};
    for (int byte = 1; byte < 256; ++byte) {
        texts.emplace_back(1, static_cast<char>(byte));
    }
    for (int first = 1; first < 256; first += 64) {
        texts.emplace_back();
        for (int byte = first; byte < std::min(first + 64, 256); ++byte) {
            texts.back() += static_cast<char>(byte);
        }
    }
    const std::string bytes = toonOf(texts);
    EXPECT_TRUE(throughJson(bytes) == bytes);
}

/// The file with zeros where nobody reads, and without what is no whole frame.
std::string asRead(std::string bytes) {
    const std::size_t frames = (bytes.size() - 103) / 92;
    bytes.resize(104 + frames * 92);
    const auto cut = [&](std::size_t begin, std::size_t end) {
        const std::size_t nul = std::min(bytes.find('\0', begin), end);
        std::fill(bytes.begin() + static_cast<long>(nul), bytes.begin() + static_cast<long>(end),
                  '\0');
    };
    cut(0, 32);
    cut(36, 87);
    bytes[87] = '\0';
    for (std::size_t i = 0; i < 4; ++i) {
        bytes[92 + i] = static_cast<char>(frames >> 8 * i);
    }
    for (std::size_t frame = 104; frame < bytes.size(); frame += 92) {
        cut(frame + 20, frame + 89);
        std::fill_n(bytes.begin() + static_cast<long>(frame) + 89, 3, '\0');
    }
    return bytes;
}

TEST_F(ToonJson, AnyToonComesBackButForWhatNobodyReads) {
    const std::string version("\x01\0\x02\0", 4);
    int toons = 0;
    for (const auto& entry : std::filesystem::directory_iterator(test::badDirectory)) {
        SCOPED_TRACE(entry.path().filename());
        const std::string bytes = test::readFile(entry.path());
        if (bytes.size() >= sizeof(ToonHeader) && bytes.substr(32, 4) == version) {
            EXPECT_TRUE(throughJson(bytes) == asRead(bytes));
            ++toons;
        } else {
            Toon toon{};
            EXPECT_THAT(ToonFromBytes(bytes, toon), testing::StartsWith("it is no Toon"));
        }
    }
    EXPECT_GE(toons, 13);
    std::minstd_rand random(1); // any bytes behind the version
    for (const std::size_t size : {104U, 105U, 194U, 195U, 196U, 104U + 92U * 300U + 91U}) {
        std::string bytes(size, '\0');
        std::ranges::generate(bytes, [&] { return static_cast<char>(random() >> 8); });
        bytes.replace(32, 4, version);
        EXPECT_TRUE(throughJson(bytes) == asRead(bytes)) << size;
    }
}

TEST_F(ToonJson, AToonIsShownFieldByField) {
    Toon toon{NewHeader(), {{-40, 780, 0, 5, 1, "Hello\rthere \x81\x80\x7F\t", 9}, NewFrame()}};
    toon.header.windowSize = MAKELONG(1920, 1080);
    toon.frames[1].wink = 2;
    EXPECT_EQ(ToonToJson(toon), "{\n"
                                "  \"caption\": \"\",\n"
                                "  \"stage\": [1920, 1080],\n"
                                "  \"speed\": 3,\n"
                                "  \"background\": 1,\n"
                                "  \"frames\": [\n"
                                "    {\n"
                                "      \"x\": -40,\n"
                                "      \"y\": 780,\n"
                                "      \"pose\": 1,\n"
                                "      \"pause\": 5,\n"
                                "      \"wink\": true,\n"
                                "      \"text\": \"Hello\\nthere \\u0081\xE2\x82\xAC\\u007F\\t\"\n"
                                "    },\n"
                                "    {\n"
                                "      \"x\": 0,\n"
                                "      \"y\": 0,\n"
                                "      \"pose\": 1,\n"
                                "      \"pause\": 5,\n"
                                "      \"wink\": 2,\n"
                                "      \"text\": \"\"\n"
                                "    }\n"
                                "  ]\n"
                                "}\n");
    toon.frames.clear();
    toon.header.magic[0] = 'd';
    EXPECT_THAT(ToonToJson(toon),
                testing::StartsWith("{\n  \"magic\": \"dorbo Toon Frame File\",\n"));
    EXPECT_THAT(ToonToJson(toon), testing::EndsWith("1,\n  \"frames\": []\n}\n"));
}

TEST_F(ToonJson, AFewLinesMakeAToon) {
    const ToonFromJson made =
        JsonToToon("\xEF\xBB\xBF{\"frames\": [\r\n"
                   "  {\"text\": \"One\\nCaf\xC3\xA9 \\u20ac\",\r\n"
                   "   \"pose\": 3, \"y\": 7, \"x\": -5, \"wink\": true, \"pause\": 2},\r\n"
                   "  {\"x\": 1, \"y\": 2, \"pose\": 1, \"wink\": 0}],\r\n"
                   " \"caption\": \"Hm\"}");
    EXPECT_EQ(made.error, "");
    ToonHeader header{"Dorbo Toon Frame File", TOON_VERSION, "Hm", 0, 2, 3, 1};
    const ToonFrame frames[2]{{-5, 7, 2, 2, 1, "One\rCaf\xE9 \x80", 0}, {1, 2, 0, 5, 0, "", 0}};
    std::string expected(BytesOf(header), sizeof header);
    expected.append(BytesOf(frames[0]), sizeof frames);
    EXPECT_TRUE(ToonBytes(made.toon) == expected) << ToonToJson(made.toon);
}

/// A Toon whose second frame, in line 4, holds these fields.
std::string secondFrame(const std::string& fields) {
    return "{\"frames\": [\n"
           "  {\"x\": 1, \"y\": 2, \"pose\": 3},\n"
           "\n"
           "  {\"x\": 1, \"y\": 2, " +
           fields + "}]}";
}

TEST_F(ToonJson, MistakesAreToldWithLineFrameAndField) {
    const std::string at = "4: frame 2, ";
    const std::string text69 = "; a text of up to 69 characters would be right";
    const std::string pose = " is no pose; 1 to 8 would be right";
    const std::string place = " is no place; a whole number of 32 bits would be right";
    const std::string stage = "; [width, height], 0 to 65535 each, would be right";
    const std::string foreign = ", is not in Windows-1252; a character of that set would be right";
    const std::string escape = "the text holds a backslash or a control character that means "
                               "nothing; \\n, \\r, \\\", \\\\ or \\u00E9 would be right";
    const std::pair<std::string, std::string> cases[] = {
        // Values
        {secondFrame("\"pose\": \"two\""), at + "pose: \"two\"" + pose},
        {secondFrame("\"pose\": 1.5"), at + "pose: 1.5" + pose},
        {secondFrame("\"pose\": 1e2"), at + "pose: 1e2" + pose},
        {secondFrame("\"pose\": 2147483649"), at + "pose: 2147483649" + pose},
        {secondFrame("\"pose\": -2147483648"), at + "pose: -2147483648" + pose},
        {secondFrame("\"pose\": -9223372036854775808"), at + "pose: -9223372036854775808" + pose},
        {secondFrame("\"pose\": " + std::string(50, '9')),
         at + "pose: " + std::string(40, '9') + "..." + pose},
        {secondFrame("\"pose\": null"), at + "pose: null" + pose},
        {secondFrame("\"pose\": [1]"), at + "pose: [...]" + pose},
        {secondFrame("\"pose\": {}"), at + "pose: {...}" + pose},
        {"{\"frames\": [{\"x\":\n2147483648}]}", "2: frame 1, x: 2147483648" + place},
        {"{\"frames\": [{\"y\": true}]}", "1: frame 1, y: true" + place},
        {secondFrame("\"pause\": false"), at + "pause: false is no pause; 1 to 20 would be right"},
        {secondFrame("\"wink\": \"yes\""),
         at + "wink: \"yes\" is no wink; true or false would be right"},
        {"{\"speed\": 2.0}", "1: speed: 2.0 is no speed; 1 to 5 would be right"},
        {"{\n\"background\": []}", "2: background: [...] is no background; 1 to 10 would be right"},
        {"{\"stage\": 5}", "1: stage: 5 is no stage" + stage},
        {"{\"stage\": [5,\n 65536]}", "2: stage: 65536 is no side of a stage" + stage},
        {"{\"stage\": [-1]}", "1: stage: -1 is no side of a stage" + stage},
        {"{\"stage\": [5]}", "1: stage: there are less than two numbers" + stage},
        {"{\"stage\": [5, 6, 7]}", "1: stage: there are more than two numbers" + stage},
        // Texts
        {secondFrame("\"text\": 5"), at + "text: 5 is no text" + text69},
        {secondFrame("\"text\": \"" + std::string(70, 'x') + "\""),
         at + "text: 70 characters are too many" + text69},
        {"{\"caption\": \"" + std::string(52, 'x') + "\"}",
         "1: caption: 52 characters are too many; a text of up to 48 characters would be right"},
        {secondFrame("\"text\": \"a\\u0000b\""),
         at + "text: a \\u0000 would end the text; any other character would be right"},
        {secondFrame("\"text\": \"\xE2\x98\xBA\""),
         at + "text: \"\xE2\x98\xBA\", U+263A" + foreign},
        {secondFrame("\"text\": \"\\ud83d\\ude00\""),
         at + "text: \"\xF0\x9F\x98\x80\", U+1F600" + foreign},
        {secondFrame("\"text\": \"\\udc00\""), at + "text: U+DC00" + foreign.substr(1)},
        {secondFrame("\"text\": \"\\ufeff\""), at + "text: \"\xEF\xBB\xBF\", U+FEFF" + foreign},
        {secondFrame("\"text\": \"\\u0080\""), at + "text: \"\\u0080\", U+0080" + foreign},
        {secondFrame("\"text\": \"\xE9\""),
         at + "text: the text is no UTF-8; a file saved as UTF-8 would be right"},
        {secondFrame("\"text\": \"One\nTwo\""), at + "text: " + escape},
        {secondFrame("\"text\": \"\\x41\""), at + "text: " + escape},
        {secondFrame("\"text\": \"\\u00g1\""), at + "text: " + escape},
        {secondFrame("\"text\": \"\\ud83d\""), at + "text: " + escape},
        // Fields
        {secondFrame("\"wink\": true"), at + "pose: it is missing; 1 to 8 would be right"},
        {"{\"frames\": [\n{\"pose\": 1,\n\"x\": 1}]}",
         "2: frame 1, y: it is missing; a whole number of 32 bits would be right"},
        {secondFrame("\"pose\": 1, \"x\": 2"), at + "x: it stands twice; once would be right"},
        {"{\"speed\": 1, \"speed\": 1}", "1: speed: it stands twice; once would be right"},
        {"{\"frames\": [], \n\"frames\": []}", "2: frames: it stands twice; once would be right"},
        {secondFrame("\"Pose\": 1"), "4: frame 2: no field is called \"Pose\"; x, y, pose, pause, "
                                     "wink or text would be right"},
        {"{\"pose\": 1}",
         "1: no field is called \"pose\"; caption, stage, speed, background, magic "
         "or frames would be right"},
        {"{\"caption\": \"x\"}", "1: frames: it is missing; a list of frames would be right"},
        {"{\"frames\": {}}", "1: frames: {...} is no list of frames; a list of frames would be "
                             "right"},
        {"{\"frames\": [\n5]}", "2: frame 1: 5 is no frame; {\"x\": 420, \"y\": 780, \"pose\": 1} "
                                "would be right"},
        {"\n[]", "2: [...] is no Toon; {\"frames\": [...]} would be right"},
        // JSON
        {"", "1: nothing stands in the file; {\"frames\": [...]} would be right"},
        {"{\"frames\": []}\n\n}", "3: something stands behind the Toon; nothing would be right"},
        {std::string("{\"frames\": []}\n\0", 16),
         "2: something stands behind the Toon; nothing would be right"},
        {secondFrame("\"pose\": 1\n\"pause\": 2"),
         "5: frame 2, pose: the value doesn't end here; a comma or a } would be right"},
        {"{\"stage\": [1 2]}",
         "1: stage: the value doesn't end here; a comma or a ] would be right"},
        {"{speed: 1}", "1: this is no name of a field; a name in quotes would be right"},
        {"{\"speed\" 1}", "1: speed: no colon stands behind the name; a colon would be right"},
        {"{\"speed\": ten}", "1: speed: this is no value; a number, a text in quotes, true, "
                             "false, [ or { would be right"},
        {"{\"speed\": -}", "1: speed: this is no value; a number, a text in quotes, true, "
                           "false, [ or { would be right"},
        {"{\"speed\": 1.}",
         "1: speed: this is no number; a whole number of 32 bits would be right"},
        {"{\"caption\": \"Hm", "1: caption: the text has no end; a quote mark would be right"},
    };
    for (const auto& [json, error] : cases) {
        EXPECT_EQ(JsonToToon(json).error, error) << json;
    }
}

TEST_F(ToonJson, WhatTheEditorWouldNotMakeIsToldButMade) {
    const std::pair<std::string, std::string> cases[] = {
        {secondFrame("\"pose\": 9"), "4: frame 2, pose: 9 is no pose; 1 to 8 would be right"},
        {secondFrame("\"pose\": 1, \n\"pause\": 0"),
         "5: frame 2, pause: 0 is no pause; 1 to 20 would be right"},
        {secondFrame("\"pose\": 1, \"wink\": -1"),
         "4: frame 2, wink: -1 is no wink; true or false would be right"},
        {"{\"caption\": \"" + std::string(49, 'x') +
             "\",\n\"frames\": [{\"x\": 0, \"y\": 0, \"pose\": 1}]}",
         "1: caption: 49 characters are too many; a text of up to 48 characters would be right"},
        {"{\"stage\": [640, 480], \"frames\": [{\"x\": 790,\n\"y\": 631, \"pose\": 8}]}",
         "2: frame 1, y: 631 is out of sight; -150 to 630 would be right"},
        {"{\"frames\": [{\"x\": -151,\n\"y\": 99999, \"pose\": 8}]}",
         "1: frame 1, x: -151 is out of sight; -150 or more would be right"},
        {"{\n\"frames\": []}",
         "2: frames: a Toon without a frame doesn't load; 1 to 251 would be right"},
    };
    for (const auto& [json, warning] : cases) {
        const ToonFromJson made = JsonToToon(json);
        EXPECT_EQ(made.error, "");
        EXPECT_THAT(made.warnings, ElementsAre(warning)) << json;
        EXPECT_EQ(throughJson(ToonBytes(made.toon)), ToonBytes(made.toon));
    }
}

TEST_F(ToonJson, NestingIsRefusedHoweverDeep) {
    const std::string deep(10'000'000, '[');
    std::string objects;
    while (objects.size() < 10'000'000) {
        objects += "{\"frames\":";
    }
    EXPECT_THAT(JsonToToon(deep).error, testing::StartsWith("1: [...] is no Toon;"));
    EXPECT_THAT(JsonToToon(objects).error, testing::StartsWith("1: frames: {...} is no list"));
    EXPECT_THAT(JsonToToon(secondFrame("\"text\":" + deep)).error,
                testing::StartsWith("4: frame 2, text: [...] is no text;"));
    EXPECT_THAT(JsonToToon("{\"frames\":" + deep).error,
                testing::StartsWith("1: frame 1: [...] is no frame;"));
}

// ---- The program ------------------------------------------------------------------------------

class ToonProgram : public ScratchDirectory {
  protected:
    /// Gives the exit code; what was said lies in "out" and "err".
    static int run(const std::string& arguments) {
        const std::string command = DORBO_TOON " " + arguments + " 2>err";
        const int status = std::system(command.c_str());
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }
};

const char* const goodJson = R"({"frames": [{"x": 1, "y": 2, "pose": 3}]})";

TEST_F(ToonProgram, ShowsAndWritesTheSameFileOrFailsWithAReason) {
    make("intro.zkt", test::readFile(test::toonDirectory / "intro.zkt"));
    make("bad.json", "{\"frames\": [\n{\"pose\": 0.5}]}");
    make("odd.json", "{\"frames\": [],\n \"speed\": 6}");
    make("good.json", goodJson);
    make("locked.zkt", "x");
    setMode("locked.zkt", 0444);
    const std::tuple<const char*, int, const char*> cases[] = {
        {"show", 2, "usage: toon show FILE.zkt\n"},
        {"show intro.zkt good.json", 2, "usage: toon show FILE.zkt\n"},
        {"show good.json", 1,
         "toon show: good.json: it is no Toon: of the header's 104 bytes it has 41\n"},
        {"show missing", 1, "toon show: missing: it can't be read: No such file or directory\n"},
        {"show .", 1, "toon show: .: it can't be read: it is no regular file\n"},
        {"show intro.zkt >/dev/full", 1,
         "toon show: intro.zkt: it can't be printed: No space left on device\n"},
        {"show intro.zkt >intro.json", 0, ""},
        {"write intro.json -o again.zkt", 0, ""},
        {"write", 2, "usage: toon write FILE.json [-o FILE.zkt]\n"},
        {"write -o x.zkt", 2, "usage: toon write FILE.json [-o FILE.zkt]\n"},
        {"write good.json -o", 2, "usage: toon write FILE.json [-o FILE.zkt]\n"},
        {"write --fast good.json", 2, "usage: toon write FILE.json [-o FILE.zkt]\n"},
        {"write missing.json", 1,
         "toon write: missing.json: it can't be read: No such file or directory\n"},
        {"write bad.json", 1,
         "toon write: bad.json:2: frame 1, pose: 0.5 is no pose; 1 to 8 would be right\n"},
        {"write good.json -o missing/x.zkt", 1,
         "toon write: missing/x.zkt: it can't be written: No such file or directory\n"},
        {"write good.json -o /dev/full", 1,
         "toon write: /dev/full: it can't be written: it is no regular file\n"},
        {"write good.json -o locked.zkt", 1,
         "toon write: locked.zkt: it can't be written: Permission denied\n"},
        {"write good.json -o ./good.json", 1,
         "toon write: good.json: it would be written over itself; name a file with -o\n"},
        {"write odd.json", 0,
         "toon write: odd.json:2: warning: speed: 6 is no speed; 1 to 5 would be right\n"
         "toon write: odd.json:1: warning: frames: a Toon without a frame doesn't load; 1 to 251 "
         "would be right\n"},
    };
    for (const auto& [arguments, code, reason] : cases) {
        EXPECT_EQ(run(arguments), code) << arguments;
        EXPECT_THAT(textOf("err"), testing::HasSubstr(reason)) << arguments;
        EXPECT_TRUE(code != 0 || textOf("err") == reason) << textOf("err");
    }
    EXPECT_TRUE(textOf("again.zkt") == textOf("intro.zkt"));
    EXPECT_EQ(textOf("odd.zkt").size(), sizeof(ToonHeader));
    EXPECT_EQ(textOf("locked.zkt"), "x");
    EXPECT_EQ(textOf("good.json"), goodJson);
    std::vector<std::string> left;
    for (const auto& entry : std::filesystem::directory_iterator(".")) {
        left.push_back(entry.path().filename());
    }
    EXPECT_THAT(left, testing::UnorderedElementsAre("intro.zkt", "intro.json", "again.zkt",
                                                    "bad.json", "odd.json", "odd.zkt", "good.json",
                                                    "locked.zkt", "err"));
}

TEST_F(ToonProgram, ANewFileHasTheModeThatTheUserWantsAndAnOldOneKeepsIts) {
    make("a.b.json", goodJson);
    make("old.zkt", "old");
    setMode("old.zkt", 0620);
    const mode_t before = umask(027);
    EXPECT_EQ(run("write a.b.json"), 0);
    EXPECT_EQ(run("write a.b.json -o old.zkt"), 0);
    umask(before);
    EXPECT_EQ(modeOf("a.b.zkt"), 0640U);
    EXPECT_EQ(modeOf("old.zkt"), 0620U);
    EXPECT_EQ(textOf("old.zkt"), textOf("a.b.zkt"));
}

TEST_F(ToonProgram, AFullDiskLeavesTheOldFile) {
    make("x.json", goodJson);
    for (const char* old : {"", "old"}) {
        if (*old != '\0') {
            make("x.zkt", old);
        }
        {
            const FullDisk disk(150); // the file has 196 bytes
            EXPECT_EQ(run("write x.json"), 1);
        }
        EXPECT_EQ(textOf("err"), "toon write: x.zkt: it can't be written: File too large\n");
        EXPECT_EQ(textOf("x.zkt"), old);
        EXPECT_EQ(std::distance(std::filesystem::directory_iterator("."), {}),
                  *old == '\0' ? 2 : 3); // x.json, err, x.zkt
    }
}

} // namespace
