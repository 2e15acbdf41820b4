// What runs of the real program have in common.
#pragma once

#include "tests/program/ground.h"

#include <fstream>

#include <gtest/gtest.h>

namespace ground {

class Run : public testing::Test {
  protected:
    explicit Run(QSize screen = {800, 600}) : ground(screen.width(), screen.height()) {}

    void addToon(const std::string& name) {
        std::filesystem::copy_file(std::string(DORBO_TOONS "/") + name, ground.toons() / name);
    }

    /// Waits until the saver's title stands on the screen.
    void waitForSaver() {
        const QRgb corner = loadPicture("bg01").pixel(0, 0);
        ASSERT_TRUE(waitFor([&] { return ground.grab().pixel(0, 0) == corner; }));
    }

    /// The value of a key in the settings file, empty if there is none.
    std::string setting(const std::string& key) const {
        std::ifstream file(ground.settings());
        std::string line;
        while (std::getline(file, line) && line.rfind(key + "=", 0) != 0) {
        }
        return file ? line.substr(key.size() + 1, line.find('\r') - key.size() - 1) : "";
    }

    Ground ground;
    QImage bare = ground.grab();
};

} // namespace ground
