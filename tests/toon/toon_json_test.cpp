// Toons as JSON, and the Toons that come with the program.
#include "cli/toon_json.h"
#include "tests/toon/toon_fixture.h"

#include <gmock/gmock.h>

#include <sys/stat.h>

#include <algorithm>
#include <random>

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

class ToonJson : public test::ToonTest {};

TEST_F(ToonJson, ShippedToonsComeBack) {
    EXPECT_TRUE(std::filesystem::exists(test::toonDirectory / "intro.zkt"));
    for (const auto& entry : std::filesystem::directory_iterator(test::toonDirectory)) {
        const std::string bytes = textOf(entry.path());
        EXPECT_TRUE(throughJson(bytes) == bytes) << entry.path();
    }
}

TEST_F(ToonJson, EveryByteOfATextButNulComesBack) {
    std::vector<std::string> texts{"\n",     "\r",           "\r\n",
                                   "\n\r\r", "\"\\\"",       "\\n",
                                   "/",      "\xEF\xBB\xBF", std::string(69, '\xFF')};
    for (int byte = 1; byte < 256; ++byte) {
        texts.emplace_back(1, static_cast<char>(byte));
    }
    Toon toon{NewHeader(), {}};
    for (const std::string& text : texts) {
        toon.frames.push_back(NewFrame());
        std::copy(text.begin(), text.end(), toon.frames.back().text);
    }
    const std::string bytes = ToonBytes(toon);
    EXPECT_TRUE(throughJson(bytes) == bytes);
}

TEST_F(ToonJson, WhateverIsReadOfAToonComesBack) {
    std::vector<std::string> toons;
    for (const auto& entry : std::filesystem::directory_iterator(test::badDirectory)) {
        toons.push_back(textOf(entry.path()));
    }
    std::minstd_rand random(1); // any bytes behind the version
    for (const std::size_t size : {104U, 105U, 194U, 195U, 196U, 104U + 92U * 300U + 91U}) {
        std::string& bytes = toons.emplace_back(size, '\0');
        std::ranges::generate(bytes, [&] { return static_cast<char>(random() >> 8); });
        bytes.replace(32, 4, std::string("\x01\0\x02\0", 4));
    }
    for (const std::string& bytes : toons) {
        Toon toon{NewHeader(), {}}; // which what is no Toon leaves
        ToonFromBytes(bytes, toon);
        const std::string json = ToonToJson(toon);
        EXPECT_EQ(ToonToJson(JsonToToon(json).toon), json);
    }
}

TEST_F(ToonJson, AToonIsShownFieldByField) {
    Toon toon{NewHeader(), {{-40, 780, 0, 5, 1, "Hello\rthere \x81\x80\x7F\t", 9}}};
    toon.header.windowSize = MAKELONG(1920, 1080);
    EXPECT_EQ(ToonToJson(toon), R"({
  "caption": "",
  "stage": [1920, 1080],
  "speed": 3,
  "background": 1,
  "frames": [
    {
      "x": -40,
      "y": 780,
      "pose": 1,
      "pause": 5,
      "wink": true,
      "text": "Hello\nthere \u0081€\u007F\t"
    }
  ]
}
)");
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

/// The text with quote marks for its single ones.
std::string quoted(std::string text) {
    std::ranges::replace(text, '\'', '"');
    return text;
}

/// A Toon whose second frame, in line 4, holds these fields.
std::string secondFrame(const std::string& fields) {
    return quoted("{'frames': [\n"
                  "  {'x': 1, 'y': 2, 'pose': 3},\n"
                  "\n"
                  "  {'x': 1, 'y': 2, " +
                  fields + "}]}");
}

TEST_F(ToonJson, MistakesInAFrameAreToldWithLineFrameAndField) {
    const std::string text69 = "; a text of up to 69 characters would be right";
    const std::string pose = " is no pose; 1 to 8 would be right";
    const std::string foreign = ", is not in Windows-1252; a character of that set would be right";
    const std::string escape = "text: the text holds a backslash or a control character that means "
                               "nothing; \\n, \\r, \\\", \\\\ or \\u00E9 would be right";
    const std::pair<std::string, std::string> cases[] = {
        // Values
        {"'pose': 'two'", "pose: 'two'" + pose},
        {"'pose': 1.5", "pose: 1.5" + pose},
        {"'pose': -2147483648", "pose: -2147483648" + pose},
        {"'pose': " + std::string(50, '9'), "pose: " + std::string(40, '9') + "..." + pose},
        {"'pose': {}", "pose: {...}" + pose},
        {"'pause': false", "pause: false is no pause; 1 to 20 would be right"},
        {"'wink': 'yes'", "wink: 'yes' is no wink; true or false would be right"},
        // Texts
        {"'text': 5", "text: 5 is no text" + text69},
        {"'text': '" + std::string(70, 'x') + "'", "text: 70 characters are too many" + text69},
        {"'text': 'a\\u0000b'",
         "text: a \\u0000 would end the text; any other character would be right"},
        {"'text': '\xE2\x98\xBA'", "text: '\xE2\x98\xBA', U+263A" + foreign},
        {"'text': '\\ud83d\\ude00'", "text: '\xF0\x9F\x98\x80', U+1F600" + foreign},
        {"'text': '\\u0080'", "text: '\\u0080', U+0080" + foreign},
        {"'text': '\xE9'", "text: the text is no UTF-8; a file saved as UTF-8 would be right"},
        {"'text': 'One\nTwo'", escape},
        {"'text': '\\ud83d'", escape},
        // Fields
        {"'wink': true", "pose: it is missing; 1 to 8 would be right"},
        {"'pose': 1, 'x': 2", "x: it stands twice; once would be right"},
    };
    for (const auto& [fields, error] : cases) {
        EXPECT_EQ(quoted(JsonToToon(secondFrame(fields)).error), quoted("4: frame 2, " + error))
            << fields;
    }
}

TEST_F(ToonJson, MistakesInTheRestAreToldWithTheirLine) {
    const std::string stage = "; [width, height], 0 to 65535 each, would be right";
    const std::string value = "this is no value; a number, a text in quotes, true, false, [ or { "
                              "would be right";
    const std::pair<std::string, std::string> cases[] = {
        {"{'frames': [{'x':\n2147483648}]}",
         "2: frame 1, x: 2147483648 is no place; a whole number of 32 bits would be right"},
        {"{'speed': 2.0}", "1: speed: 2.0 is no speed; 1 to 5 would be right"},
        {"{'stage': 5}", "1: stage: 5 is no stage" + stage},
        {"{'stage': [5,\n 65536]}", "2: stage: 65536 is no side of a stage" + stage},
        {"{'stage': [5]}", "1: stage: there are less than two numbers" + stage},
        {"{'caption': '" + std::string(52, 'x') + "'}",
         "1: caption: 52 characters are too many; a text of up to 48 characters would be right"},
        // Fields
        {"{'frames': [], \n'frames': []}", "2: frames: it stands twice; once would be right"},
        {secondFrame("'Pose': 1"), "4: frame 2: no field is called 'Pose'; x, y, pose, pause, wink "
                                   "or text would be right"},
        {"{'pose': 1}", "1: no field is called 'pose'; caption, stage, speed, background, magic or "
                        "frames would be right"},
        {"{'caption': 'x'}", "1: frames: it is missing; a list of frames would be right"},
        {"{'frames': [\n5]}",
         "2: frame 1: 5 is no frame; {'x': 420, 'y': 780, 'pose': 1} would be right"},
        {"\n[]", "2: [...] is no Toon; {'frames': [...]} would be right"},
        // JSON
        {"", "1: nothing stands in the file; {'frames': [...]} would be right"},
        {"{'frames': []}\n\n}", "3: something stands behind the Toon; nothing would be right"},
        {secondFrame("'pose': 1\n'pause': 2"),
         "5: frame 2, pose: the value doesn't end here; a comma or a } would be right"},
        {"{'stage': [1 2]}", "1: stage: the value doesn't end here; a comma or a ] would be right"},
        {"{speed: 1}", "1: this is no name of a field; a name in quotes would be right"},
        {"{'speed' 1}", "1: speed: no colon stands behind the name; a colon would be right"},
        {"{'speed': ten}", "1: speed: " + value},
        {"{'speed': 1.}", "1: speed: this is no number; a whole number of 32 bits would be right"},
        {"{'caption': 'Hm", "1: caption: the text has no end; a quote mark would be right"},
    };
    for (const auto& [json, error] : cases) {
        EXPECT_EQ(quoted(JsonToToon(quoted(json)).error), quoted(error)) << json;
    }
}

TEST_F(ToonJson, WhatTheEditorWouldNotMakeIsToldButMade) {
    const std::pair<std::string, std::string> cases[] = {
        {"{'stage': [640, 480], 'frames': [{'x': 790,\n'y': 631, 'pose': 8}]}",
         "2: frame 1, y: 631 is out of sight; -150 to 630 would be right"},
        {"{'frames': [{'x': -151,\n'y': 99999, 'pose': 8}]}",
         "1: frame 1, x: -151 is out of sight; -150 or more would be right"},
        {"{\n'frames': []}",
         "2: frames: a Toon without a frame doesn't load; 1 to 251 would be right"},
    };
    for (const auto& [json, warning] : cases) {
        const ToonFromJson made = JsonToToon(quoted(json));
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
}

// ---- The program ------------------------------------------------------------------------------

class ToonProgram : public ScratchDirectory {
  protected:
    /// Gives the exit code; what was said lies in "err".
    static int run(const std::string& arguments) {
        return runLine(DORBO_TOON " " + arguments + " 2>err");
    }
};

const char* const goodJson = R"({"frames": [{"x": 1, "y": 2, "pose": 3}]})";

TEST_F(ToonProgram, ShowsAndWritesTheSameFileOrFailsWithAReason) {
    make("intro.zkt", textOf(test::toonDirectory / "intro.zkt"));
    make("bad.json", "{\"frames\": [\n{\"pose\": 0.5}]}");
    make("odd.json", "{\"frames\": [],\n \"speed\": 6}");
    make("good.json", goodJson);
    make("locked.zkt", "x");
    setMode("locked.zkt", 0444);
    const std::tuple<const char*, int, const char*> cases[] = {
        {"", 2, "toon: which command?\nTry: toon --help\n"},
        {"fly", 2, "toon: there is no command fly\nTry: toon --help\n"},
        {"show", 2, "usage: toon show FILE.zkt\n"},
        {"show good.json", 1,
         "toon show: good.json: it is no Toon: of the header's 104 bytes it has 41\n"},
        {"show intro.zkt >/dev/full", 1,
         "toon show: intro.zkt: it can't be printed: No space left on device\n"},
        {"show intro.zkt >intro.json", 0, ""},
        {"write intro.json -o again.zkt", 0, ""},
        {"write -o x.zkt", 2, "usage: toon write FILE.json [-o FILE.zkt]\n"},
        {"write good.json -o", 2, "usage: toon write FILE.json [-o FILE.zkt]\n"},
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
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator("."), {}), 9)
        << "the five above, err, intro.json, again.zkt and odd.zkt";
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
    make("old.zkt", "old");
    for (const char* target : {"old.zkt", "new.zkt"}) {
        const FullDisk disk(150); // the file has 196 bytes
        EXPECT_EQ(run(std::string("write x.json -o ") + target), 1);
        EXPECT_THAT(textOf("err"), testing::EndsWith("it can't be written: File too large\n"));
    }
    EXPECT_EQ(textOf("old.zkt"), "old");
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator("."), {}), 3); // and x.json, err
}

} // namespace
