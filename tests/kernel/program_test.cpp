#include "platform/harness.h"
#include "platform/kernel.h"
#include "platform/kernel/string_table.h"

#include <gtest/gtest.h>

#include <string>

namespace {

std::string bytesOf(HRSRC resource) {
    const HGLOBAL loaded = LoadResource(nullptr, resource);
    const void* bytes = LockResource(loaded);
    const DWORD size = SizeofResource(nullptr, resource);
    std::string text =
        bytes != nullptr ? std::string(static_cast<const char*>(bytes), size) : "none";
    EXPECT_EQ(FreeResource(loaded), bytes != nullptr ? TRUE : FALSE);
    return text;
}

TEST(Resource, IsFoundByNameOrNumberWhateverTheCase) {
    const std::tuple<ResourceName, ResourceName, const char*> cases[] = {
        {"TINY", RT_BITMAP, "INFOHEADER"}, // without the header of its file
        {2003, RT_DIALOG, "a dialog"},     {"aBOUT", RT_DIALOG, "a dialog"},
        {"tiny", RT_DIALOG, "none"},       {"tin", RT_BITMAP, "none"},
        {"", RT_BITMAP, "none"},           {"../dialog/2003", RT_BITMAP, "none"},
        {"headless", RT_BITMAP, "none"},
    };
    for (const auto& [name, type, expected] : cases) {
        const std::string told = name.text != nullptr ? name.text : "a number";
        EXPECT_EQ(bytesOf(FindResourceA(nullptr, name, type)), expected) << told;
    }
    seam::HandleCounts after;
    seam::countKernelHandles(after);
    EXPECT_EQ(after, seam::HandleCounts{});
    EXPECT_EQ(FindResourceA(nullptr, "tiny", RT_BITMAP), FindResourceA(nullptr, "Tiny", RT_BITMAP));
}

TEST(StringTable, GivesTextsCutToTheBuffer) {
    const std::tuple<UINT, int, std::string> cases[] = {
        {1, 11, "First text"},       {1, 10, "First tex"},   {1, 1, ""},
        {2, 30, "one\rtwo \\r \\x"}, {65535, 30, "caf\xe9"}, {4, 30, ""}};
    for (const auto& [id, size, expected] : cases) {
        char buffer[30] = "untouched";
        EXPECT_EQ(LoadStringA(nullptr, id, buffer, size), static_cast<int>(expected.size()));
        EXPECT_EQ(buffer, expected);
    }
    EXPECT_EQ(LoadStringA(nullptr, 1, nullptr, 0), 0);
    const seam::StringTable table =
        seam::parseStringTable("\n7\n8\t\n-1\tx\n99999999999\ty\n\t\n9\ta\tb\\");
    EXPECT_EQ(table, (seam::StringTable{{8, ""}, {9, "a\tb\\"}}));
}

TEST(Program, PutsItsArgumentsTogether) {
    const std::pair<std::vector<const char*>, const char*> cases[] = {
        {{"dorbo", "", "a b"}, "\"dorbo\"  a b"},
        {{"/a\" /s \"/dorbo", "-c"}, "\"/a /s /dorbo\" -c"}};
    for (const auto& [arguments, expected] : cases) {
        SetCommandLineArguments(static_cast<int>(arguments.size()), arguments.data());
        EXPECT_STREQ(GetCommandLineA(), expected);
    }
}

TEST(Format, WritesTextsAndNumbersUpToTheLengthOfThePlatform) {
    std::string buffer(2001, '#');
    EXPECT_EQ(wsprintfA(buffer.data(), "%s|%d|%u|%%", "text", -5, 4000000000U), 20);
    EXPECT_STREQ(buffer.c_str(), "text|-5|4000000000|%");
    const std::string text(2000, 't');
    EXPECT_EQ(wsprintfA(buffer.data(), "%s", text.c_str()), 1023);
    EXPECT_EQ(buffer, text.substr(0, 1023) + '\0' + std::string(977, '#'));
}

} // namespace
