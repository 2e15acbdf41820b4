#include "platform/registry.h"
#include "tests/kernel/scratch_directory.h"

#include <cstring>

namespace {

constexpr const char* file = "dorbo/registry.ini";
constexpr const char* desktop = "Control Panel\\Desktop";

using Registry = ConfigDirectory;

TEST_F(Registry, ReadsNumbersAndTexts) {
    make(file, "[control panel\\DESKTOP]\r\nOne=1\nBig=4294967295\nToo big=4294967296\n"
               "Word=1x\nNone=\nMinus=-1\n[Other]\nElsewhere=1\n");
    const std::tuple<const char*, DWORD, LONG, DWORD, std::string> cases[] = {
        {"one", 4, ERROR_SUCCESS, REG_DWORD, {"\1\0\0\0", 4}},
        {"Big", 4, ERROR_SUCCESS, REG_DWORD, "\xFF\xFF\xFF\xFF"},
        {"One", 3, ERROR_MORE_DATA, REG_DWORD, "####"},
        {"Too big", 4, ERROR_MORE_DATA, REG_SZ, "###########"},
        {"Word", 4, ERROR_SUCCESS, REG_SZ, {"1x", 3}},
        {"Minus", 4, ERROR_SUCCESS, REG_SZ, {"-1", 3}},
        {"None", 4, ERROR_SUCCESS, REG_SZ, {"", 1}},
        {"Elsewhere", 4, ERROR_FILE_NOT_FOUND, 0, "####"},
        {nullptr, 4, ERROR_FILE_NOT_FOUND, 0, "####"},
    };

    HKEY key;
    ASSERT_EQ(RegOpenKeyA(HKEY_CURRENT_USER, desktop, &key), ERROR_SUCCESS);
    for (const auto& [name, room, error, type, bytes] : cases) {
        SCOPED_TRACE(name != nullptr ? name : "no name");
        DWORD kind = 0;
        DWORD size = room;
        BYTE read[5] = {'#', '#', '#', '#', '#'};
        EXPECT_EQ(RegQueryValueExA(key, name, nullptr, &kind, read, &size), error);
        EXPECT_EQ(kind, type);
        EXPECT_EQ(size, bytes.size());
        EXPECT_EQ(std::memcmp(read, bytes.data(), std::min<std::size_t>(size, 5)), 0);
    }
    DWORD size = 0;
    EXPECT_EQ(RegQueryValueExA(key, "Too big", nullptr, nullptr, nullptr, &size), ERROR_SUCCESS);
    EXPECT_EQ(size, 11U);
    RegCloseKey(key);
}

TEST_F(Registry, HasTheKeysOfItsFileAlone) {
    HKEY key{1};
    EXPECT_EQ(RegOpenKeyA(HKEY_CURRENT_USER, desktop, &key), ERROR_FILE_NOT_FOUND);
    EXPECT_FALSE(key);
    make(file, "[Control Panel\\Desktop]\n");
    EXPECT_EQ(RegOpenKeyA(HKEY_CURRENT_USER, "Control Panel", &key), ERROR_FILE_NOT_FOUND);
    EXPECT_EQ(RegOpenKeyA(HKEY{}, desktop, &key), ERROR_INVALID_HANDLE);
    ASSERT_EQ(RegOpenKeyA(HKEY_CURRENT_USER, desktop, &key), ERROR_SUCCESS);
    EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
    EXPECT_EQ(RegCloseKey(key), ERROR_INVALID_HANDLE);
    EXPECT_EQ(RegQueryValueExA(key, "One", nullptr, nullptr, nullptr, nullptr),
              ERROR_INVALID_HANDLE);
}

} // namespace
