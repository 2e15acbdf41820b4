#include "saver/saver_main.h"

#include <gtest/gtest.h>

#include <utility>

TEST(CommandLine, DropsTheProgramsName) {
    const std::pair<const char*, const char*> cases[] = {
        {"", ""},
        {"/opt/dorbo \t\x01\x1F\r\n /p 12 ", "/p 12 "},
        {"d\xF6rbo\x80 /s", "/s"}, // a top bit isn't a sign
        {"\"/opt/my dorbo/dorbo\"  /a 7", "/a 7"},
        {"\"/opt/my dorbo /s", ""},
    };
    for (const auto& [line, rest] : cases) {
        EXPECT_STREQ(SkipProgramName(line), rest) << line;
    }
}

TEST(CommandLine, ReadsAWindowInDecimal) {
    EXPECT_EQ(ParseWindowHandle("0042:9").number, 42U);
    EXPECT_EQ(ParseWindowHandle("-5").number, 0U);
}
