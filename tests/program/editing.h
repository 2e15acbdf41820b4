// What runs of the editor have in common: its windows are found by their titles, and used by clicks
// and keys.
#pragma once

#include "tests/program/run.h"

#include <chrono>
#include <cstring>
#include <fstream>
#include <thread>

#include <QPainter>

namespace ground {

/// A Toon's file: length|caption|stage|frames|speed|tile, and "x,y pose pause wink text" of each
/// frame.
inline std::vector<std::string> told(const std::filesystem::path& toon) {
    std::ifstream file(toon, std::ios::binary);
    std::string bytes{std::istreambuf_iterator<char>(file), {}};
    const std::string length = std::to_string(bytes.size());
    bytes.resize(std::max<std::size_t>(bytes.size(), 104) / 92 * 92 + 12);
    const auto number = [&](std::size_t at, std::size_t size = 4) {
        std::int32_t value = 0;
        std::memcpy(&value, &bytes[at], size);
        return std::to_string(value);
    };
    std::vector<std::string> lines{length + "|" + &bytes[36] + "|" + number(88, 2) + "x" +
                                   number(90, 2) + "|" + number(92) + "|" + number(96) + "|" +
                                   number(100)};
    for (std::size_t at = 104; at < bytes.size(); at += 92) {
        lines.push_back(number(at) + "," + number(at + 4) + " " + number(at + 8) + " " +
                        number(at + 12) + " " + number(at + 16) + " " + &bytes[at + 20]);
    }
    return lines;
}

class Editing : public Run {
  protected:
    static constexpr QRect screen{0, 0, 640, 480};
    static constexpr QRect stage{25, 42, 590, 380};
    static constexpr QRect picker{35, 95, 570, 290};
    static constexpr const char* editor = "Fenky Dorbo Toon File Editor";
    static constexpr const char* pickersTitle = "Choose a Pose, 1 to 8";

    Editing() : Run(screen.size()) {}

    std::string activeTitle() const {
        const std::string ask = "xdotool getactivewindow getwindowname 2>&1";
        return ground.launch({"sh", "-c", ask}).readLine();
    }

    /// Waits until the window has the keyboard; opens it by a key, which may come too early.
    void waitForWindow(const std::string& title, const std::string& key = "") {
        std::string active;
        const auto comesUp = [&] { return (active = activeTitle()) == title; };
        const auto opened = [&] {
            return (key.empty() || ground.command({"xdotool", "key", key}) == 0) &&
                   waitFor(comesUp, 1);
        };
        if (!waitFor(opened)) {
            throw std::runtime_error(title + ", not " + active);
        }
    }

    void keys(std::vector<std::string> words) {
        words.insert(words.begin(), {"xdotool", "key"});
        ground.command(words);
    }

    void click(QPoint at) {
        const auto [x, y] = std::pair(std::to_string(at.x()), std::to_string(at.y()));
        ground.command({"xdotool", "mousemove", x, y, "click", "1"});
    }

    /// Whether nothing but the tile shows on the stage, or on a part of it.
    bool isEmpty(const std::string& tile, QRect part = stage) const {
        QImage empty(stage.size(), QImage::Format_RGB32);
        QPainter(&empty).fillRect(empty.rect(), QBrush(loadPicture(tile)));
        return ground.grab().copy(part) == empty.copy(part.translated(-stage.topLeft()));
    }

    void expectFile(const std::vector<std::string>& expected) {
        const auto file = ground.toons() / "mine.zkt";
        EXPECT_TRUE(waitFor([&] { return told(file) == expected; }))
            << testing::PrintToString(told(file));
    }

    /// From the setup, which has been started.
    void openFrameEditor() {
        ASSERT_TRUE(waitFor([&] {
            return ground.command({"xdotool", "search", "--name", "Rematch", "windowactivate"}) ==
                       0 &&
                   activeTitle() == "Fenky Dorbo's Rematch";
        }));
        waitForWindow(editor, "alt+e");
        const auto up = std::chrono::steady_clock::now();
        const QRect leftEdge(25, 142, 40, 180);
        ASSERT_TRUE(waitFor([&] { return isEmpty("bg01", leftEdge); }));
        click(stage.topLeft() + QPoint(60, 190));
        ASSERT_TRUE(waitFor([&] { return !isEmpty("bg01", leftEdge); })) << "he comes in";
        // While he walks there the moment passes at which he would begin his long hello.
        std::this_thread::sleep_until(up + std::chrono::milliseconds(1300));
        waitForWindow("File: [Untitled]", "ctrl+e"); // which does nothing while he says hello
    }
};

} // namespace ground
