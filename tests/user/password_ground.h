// A config directory of a test's own, for the password and what goes with it.
#pragma once

#include "platform/registry.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>
#include <string>

namespace test {

class PasswordGround : public testing::Test {
  protected:
    PasswordGround() {
        std::string pattern = testing::TempDir() + "/dorbo.XXXXXX";
        root_ = mkdtemp(pattern.data());
        setenv("XDG_CONFIG_HOME", root_.c_str(), 1);
    }

    ~PasswordGround() override {
        unsetenv("XDG_CONFIG_HOME");
        std::filesystem::remove_all(root_);
    }

    std::filesystem::path path(const std::string& name) const {
        return root_ / "dorbo" / name;
    }

    std::filesystem::file_status status(const std::string& name) const {
        return std::filesystem::status(path(name));
    }

    std::string textOf(const std::string& name) const {
        std::ifstream file(path(name), std::ios::binary);
        return {std::istreambuf_iterator<char>(file), {}};
    }

    void write(const std::string& name, const std::string& text) const {
        std::filesystem::create_directories(root_ / "dorbo");
        std::ofstream(path(name), std::ios::binary) << text;
    }

    /// What lies in the config directory.
    std::set<std::string> names() const {
        std::set<std::string> found;
        for (const auto& entry : std::filesystem::directory_iterator(root_ / "dorbo")) {
            found.insert(entry.path().filename());
        }
        return found;
    }

    /// Whether the registry has the saver ask for a password.
    static bool saverAsks() {
        HKEY key;
        DWORD value = 0;
        DWORD size = sizeof value;
        RegOpenKeyA(HKEY_CURRENT_USER, "Control Panel\\Desktop", &key);
        RegQueryValueExA(key, "ScreenSaveUsePassword", nullptr, nullptr,
                         reinterpret_cast<BYTE*>(&value), &size);
        RegCloseKey(key);
        return value != 0;
    }

  private:
    std::filesystem::path root_;
};

} // namespace test
