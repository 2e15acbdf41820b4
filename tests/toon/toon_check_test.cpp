// What `toon check` finds in Toons, good and bad.
#include "cli/check.h"
#include "tests/toon/toon_fixture.h"

#include <gmock/gmock.h>

namespace {

using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsEmpty;

using Lines = std::vector<std::string>;

class ToonCheck : public ScratchDirectory {
  protected:
    static Lines findings(const std::string& path) {
        Lines lines;
        for (const Finding& finding : CheckToon(path).findings) {
            lines.push_back((finding.fault ? "" : "note: ") + Where(finding.frame, finding.field) +
                            finding.what);
        }
        return lines;
    }

    void makeToon(const std::string& name, const std::vector<ToonFrame>& frames) const {
        Toon toon{NewHeader(), frames};
        toon.header.windowSize = MAKELONG(1024, 768);
        make(name, ToonBytes(toon));
    }
};

TEST_F(ToonCheck, NothingIsWrongWithTheShippedOnes) {
    int checked = 0;
    for (const auto& entry : std::filesystem::directory_iterator(test::toonDirectory)) {
        const ToonReport report = CheckToon(entry.path());
        EXPECT_THAT(report.findings, IsEmpty()) << entry.path();
        EXPECT_GT(report.seconds.value_or(0), report.pauses) << entry.path();
        EXPECT_NEAR(report.seconds.value_or(0), 60, 20) << entry.path();
        ++checked;
    }
    EXPECT_GE(checked, 8);
}

TEST_F(ToonCheck, BadToonsAreToldWhatIsWrongWithThem) {
    const std::string short1 = "its last byte is missing, and counts as zero";
    const std::string noNul = "it has no NUL; its last byte gives way to one";
    const std::string sight = " is out of sight; -150 to ";
    const std::pair<const char*, Lines> files[] = {
        {"empty", {"it is no Toon: of the header's 104 bytes it has 0"}},
        {"header-of-103-bytes", {"it is no Toon: of the header's 104 bytes it has 103"}},
        {"header-without-frames",
         {"frames: a Toon without a frame doesn't load; 1 to 251 would be right"}},
        {"version-of-tomorrow",
         {"it is no Toon of the version that loads: the bytes 32 to 35 aren't 01 00 02 00"}},
        {"last-byte-missing",
         {short1, "note: frame 2: its reserved bytes aren't zero",
          "the saver says \"Error reading last-byte-missing.zkt.\""}},
        {"last-two-bytes-missing",
         {"it has 90 bytes too many behind its last whole frame",
          "note: the header counts 2 frames, the file has 1"}},
        {"one-byte-too-many", {"it has 1 byte too many behind its last whole frame"}},
        {"ninety-one-bytes-too-many",
         {short1, "frame 3, x: 16843009" + sight + "1174 would be right",
          "frame 3, y: 16843009" + sight + "918 would be right",
          "frame 3, pose: 16843010 is no pose; 1 to 8 would be right",
          "frame 3, pause: 16843009 is no pause; 1 to 20 would be right",
          "frame 3, wink: 16843009 is no wink; true or false would be right",
          "note: the header counts 2 frames, the file has 3", "note: frame 3, text: " + noNul,
          "note: frame 3: its reserved bytes aren't zero",
          "the saver says \"Error reading ninety-one-bytes-too-many.zkt.\"",
          "frame 3: the walk to it would take 4648 strides; he takes 248, each longer",
          "note: frame 3: the show still goes on here after four hours"}},
        {"count-too-high", {"note: the header counts 1000 frames, the file has 2"}},
        {"magic-of-another", {"note: magic: it is not the usual one"}},
        {"caption-without-nul",
         {"caption: 51 characters are too many; a text of up to 48 characters would be right",
          "note: caption: " + noNul}},
        {"text-without-nul", {"note: frame 1, text: " + noNul}},
        {"numbers-lowest",
         {"speed: -2147483648 is no speed; 1 to 5 would be right",
          "background: -2147483648 is no background; 1 to 10 would be right",
          "frame 1, x: -2147483648" + sight + "1174 would be right",
          "frame 1, y: -2147483648" + sight + "918 would be right",
          "frame 1, pose: -2147483647 is no pose; 1 to 8 would be right",
          "frame 1, pause: -2147483648 is no pause; 1 to 20 would be right",
          "frame 1, wink: -2147483648 is no wink; true or false would be right",
          "frame 1: the walk to it would take 107374184 strides; he takes 248, each longer",
          "frame 1: he stands still here for ever"}},
    };
    for (const auto& [name, lines] : files) {
        const auto path = test::badDirectory / (std::string(name) + ".zkt");
        EXPECT_THAT(findings(path), ElementsAreArray(lines)) << name;
    }
}

TEST_F(ToonCheck, WhatTheSaverWouldNotPlayIsFound) {
    const ToonFrame frame{500, 300, 1, 1, 0, "", 0};
    const std::string passed = "the saver passes over a file of this name; a name that ends in "
                               ".zkt, of up to 127 bytes, would be right";
    const std::string many = " frames are more than the editor makes; 1 to 251 would be right";
    const std::string longName = std::string(124, 'n') + ".zkt";
    std::vector<ToonFrame> toAndFro(2500, frame);
    for (std::size_t i = 0; i < toAndFro.size(); i += 2) {
        toAndFro[i].x = 1100;
    }
    const std::tuple<std::string, std::vector<ToonFrame>, Lines> toons[] = {
        {"good.ZKT", {frame}, {}},
        {"toon.txt", {frame}, {passed}},
        {longName, {frame}, {passed}},
        {longName.substr(1), {frame}, {}},
        {"stays.zkt",
         {frame, {500, 300, 1, 0, 0, "", 0}, frame},
         {"frame 2, pause: 0 is no pause; 1 to 20 would be right",
          "frame 2: he stands still here for ever"}},
        {"many.zkt", std::vector<ToonFrame>(252, frame), {"frames: 252" + many}},
        {"walks-for-hours.zkt",
         toAndFro,
         {"frames: 2500" + many, "note: frame 2183: the show still goes on here after four hours"}},
        {"stays-for-hours.zkt",
         std::vector<ToonFrame>(2500, {500, 300, 1, 20, 0, "", 0}),
         {"frames: 2500" + many, "note: frame 688: the show still goes on here after four hours"}},
        {"long-way-off.zkt",
         {{32000, 300, 1, 1, 0, "", 0}},
         {"frame 1, x: 32000 is out of sight; -150 to 1174 would be right",
          "frame 1: the walk to it would take 1544 strides; he takes 248, each longer",
          "frame 1: the walk off would take 1544 strides; he takes 248, each longer"}},
    };
    for (const auto& [name, frames, lines] : toons) {
        makeToon(name, frames);
        EXPECT_THAT(findings(name), ElementsAreArray(lines)) << name;
    }
    setMode("good.ZKT", 0444);
    EXPECT_THAT(findings("good.ZKT"), ElementsAre("it is read-only; the saver loads no such file"));
    EXPECT_THAT(findings("."), ElementsAre("it can't be read: it is no regular file"));
}

TEST_F(ToonCheck, TheProgramPrintsLinesOrJsonAndItsCodeTellsWhetherAnythingIsWrong) {
    makeToon("one.zkt", {{500, 300, 1, 1, 0, "", 7}});
    makeToon("\xE9.zkt", {{500, 300, 8, 1, 0, "", 7}});
    const std::string pose = "frame 1, pose: 9 is no pose; 1 to 8 would be right\n";
    const std::string note = "note: frame 1: its reserved bytes aren't zero\n";
    const std::tuple<std::string, int, std::string> cases[] = {
        {"one.zkt", 0, "one.zkt: " + note + "one.zkt: 1 frame, 14 seconds (1 of pauses)\n"},
        {"\xE9.zkt no", 1,
         "\xE9.zkt: " + pose + "\xE9.zkt: " + note +
             "\xE9.zkt: 1 frame, 14 seconds (1 of pauses)\n"
             "no: it can't be read: No such file or directory\n"},
        {"--json \xE9.zkt no", 1,
         R"([
  {
    "file": "é.zkt",
    "ok": false,
    "frames": 1,
    "pauses": 1,
    "seconds": 13.700,
    "findings": [
      {"fault": true, "frame": 1, "field": "pose", "what": "9 is no pose; 1 to 8 would be right"},
      {"fault": false, "frame": 1, "what": "its reserved bytes aren't zero"}
    ]
  },
  {
    "file": "no",
    "ok": false,
    "findings": [
      {"fault": true, "what": "it can't be read: No such file or directory"}
    ]
  }
]
)"},
        {"--json", 2, ""},
        {"one.zkt --all", 2, ""},
    };
    for (const auto& [arguments, code, printed] : cases) {
        EXPECT_EQ(runLine(DORBO_TOON " check " + arguments + " >out 2>err"), code) << arguments;
        EXPECT_EQ(textOf("out"), printed);
        EXPECT_EQ(textOf("err").find("usage: toon check") != std::string::npos, code == 2);
    }
    EXPECT_EQ(runLine(DORBO_TOON " check one.zkt >/dev/full 2>err"), 1);
}

} // namespace
