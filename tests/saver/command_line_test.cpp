#include "saver/saver_main.h"

#include <gtest/gtest.h>

TEST(CommandLine, DropsTheProgramsName) {
    const struct {
        const char* line;
        const char* rest;
    } cases[] = {
        {"", ""},
        {"/opt/dorbo \t\x01\x1F\r\n /p 12 ", "/p 12 "},
        {"d\xF6rbo\x80 /s", "/s"}, // a top bit isn't a sign
        {"\"/opt/my dorbo/dorbo\"  /a 7", "/a 7"},
        {"\"/opt/my dorbo /s", ""},
        {"\"\" /s", "/s"},
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
    } cases[] = {{"", 0},   {"0042", 42}, {"12:34", 12},    {"12\xB2", 12},
                 {"-5", 0}, {" 5", 0},    {"4294967299", 3}};

    for (const auto& one : cases) {
        EXPECT_EQ(ParseWindowHandle(one.text).number, one.number) << one.text;
    }
}
