#include "platform/kernel/registry.h"
#include "platform/registry.h"
#include "tests/kernel/scratch_directory.h"

#include <cstdlib>
#include <cstring>

namespace {

constexpr const char* file = "dorbo/registry.ini";
constexpr const char* desktop = "Control Panel\\Desktop";

class Registry : public ScratchDirectory {
  protected:
    Registry() {
        setenv("XDG_CONFIG_HOME", root_.c_str(), 1);
    }

    ~Registry() override {
        unsetenv("XDG_CONFIG_HOME");
    }
};

/// A value as the program reads its numbers: into 4 bytes, of which `size` are told of.
struct Read {
    LONG error;
    DWORD type = 0;
    DWORD size = 0;
    BYTE bytes[5] = {'#', '#', '#', '#', '#'};
};

Read readValue(const char* name, DWORD size = 4, bool sizeOnly = false) {
    Read read{};
    HKEY key;
    read.error = RegOpenKeyA(HKEY_CURRENT_USER, desktop, &key);
    if (read.error == ERROR_SUCCESS) {
        read.size = size;
        read.error = RegQueryValueExA(key, name, nullptr, &read.type,
                                      sizeOnly ? nullptr : read.bytes, &read.size);
        EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
    }
    return read;
}

TEST_F(Registry, ReadsNumbersAndTexts) {
    make(file, "[control panel\\DESKTOP]\r\nOne=1\nBig=4294967295\nToo big=4294967296\n"
               "Word=yes\nMixed=1x\nNone=\nMinus=-1\n[Other]\nElsewhere=1\n");

    const struct {
        const char* name;
        DWORD room;
        LONG error;
        DWORD type;
        std::string bytes;
    } cases[] = {
        {"one", 4, ERROR_SUCCESS, REG_DWORD, {"\1\0\0\0", 4}},
        {"Big", 4, ERROR_SUCCESS, REG_DWORD, "\xFF\xFF\xFF\xFF"},
        {"One", 3, ERROR_MORE_DATA, REG_DWORD, "####"},
        {"Too big", 4, ERROR_MORE_DATA, REG_SZ, "###########"},
        {"Word", 4, ERROR_SUCCESS, REG_SZ, {"yes", 4}},
        {"Mixed", 4, ERROR_SUCCESS, REG_SZ, {"1x", 3}},
        {"Minus", 4, ERROR_SUCCESS, REG_SZ, {"-1", 3}},
        {"None", 4, ERROR_SUCCESS, REG_SZ, {"", 1}},
        {"Elsewhere", 4, ERROR_FILE_NOT_FOUND, 0, "####"},
        {nullptr, 4, ERROR_FILE_NOT_FOUND, 0, "####"},
    };

    for (const auto& c : cases) {
        const Read read = readValue(c.name, c.room);
        const std::string told = c.name != nullptr ? c.name : "no name";
        EXPECT_EQ(read.error, c.error) << told;
        EXPECT_EQ(read.type, c.type) << told;
        EXPECT_EQ(read.size, c.bytes.size()) << told;
        EXPECT_EQ(std::memcmp(read.bytes, c.bytes.data(), std::min<std::size_t>(c.bytes.size(), 5)),
                  0)
            << told;
    }
    EXPECT_EQ(readValue("Too big", 0, true).size, 11U);
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

TEST_F(Registry, KeepsANumberThatIsSet) {
    EXPECT_TRUE(seam::setRegistryNumber(desktop, "ScreenSaveUsePassword", 1));
    EXPECT_EQ(readValue("ScreenSaveUsePassword").bytes[0], 1);
    EXPECT_TRUE(seam::setRegistryNumber(desktop, "ScreenSaveUsePassword", 0));
    EXPECT_EQ(readValue("ScreenSaveUsePassword").bytes[0], 0);
    EXPECT_EQ(textOf(file), "[Control Panel\\Desktop]\r\nScreenSaveUsePassword=0\r\n");
}

} // namespace
