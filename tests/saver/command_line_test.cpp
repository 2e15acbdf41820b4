#include "saver/saver_main.h"

#include <gtest/gtest.h>

TEST(CommandLine, DropsTheProgramsName) {
    const struct {
        const char* line;
        const char* rest;
    } cases[] = {
        {"", ""},
        {"dorbo", ""},
        {"/opt/dorbo \t\x01\x1F\r\n /p 12 ", "/p 12 "},
        {"d\xF6rbo\x80 /s", "/s"}, // a top bit isn't a sign
        {"\"/opt/my dorbo/dorbo\"  /a 7", "/a 7"},
        {"\"dor\tbo\"/s", "/s"},
        {"\"/opt/my dorbo /s", ""},
        {"\"\" /s", "/s"},
        {"dor\"bo /s\"", "/s\""},
        {"  /s", "/s"}, // a name of no characters
    };

    for (const auto& one : cases) {
        EXPECT_STREQ(SkipProgramName(one.line), one.rest) << one.line;
    }
}

TEST(CommandLine, ReadsAWindowInDecimal) {
    const struct {
        const char* text;
        DWORD number;
    } cases[] = {{"", 0},           {"0042", 42},
                 {"123 456", 123},  {"12:34", 12},
                 {"9/", 9},         {"12\xB2", 12},
                 {"-5", 0},         {"+5", 0},
                 {" 5", 0},         {":5", 0},
                 {"0x1F", 0},       {"4294967295", 4294967295U},
                 {"4294967299", 3}, {"99999999999", 1215752191}};

    for (const auto& one : cases) {
        EXPECT_EQ(ParseWindowHandle(one.text).number, one.number) << one.text;
    }
}
