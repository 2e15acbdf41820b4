// Runs of the program `toon` that show something: what they show, and where they look for it.
#include "tests/program/run.h"

#include <sys/stat.h>

namespace {

using ground::Run;

class ToonRun : public Run {
  protected:
    ground::Process toon(const std::string& command, const std::string& file) const {
        return ground.launch({DORBO_TOON, command, file});
    }

    /// Waits until the screen shows this tile at a place that nobody walks over.
    void waitForTile(const std::string& name, QPoint place) const {
        const QImage tile = ground::loadPicture(name);
        const QRect part(place, tile.size());
        const auto shown = [&] {
            return ground.grab().copy(part) == tile.convertToFormat(QImage::Format_RGB32);
        };
        ASSERT_TRUE(ground::waitFor(shown)) << name;
    }
};

TEST_F(ToonRun, PlayShowsAReadOnlyFileOfAnyNameAndLeavesTheToonsAtHome) {
    addToon("waiter.zkt");
    const auto folder = ground.toons() / "an odd\\place";
    const auto file = folder / (std::string(200, 'x') + "é (1).dat");
    std::filesystem::create_directory(folder);
    std::filesystem::rename(ground.toons() / "waiter.zkt", file);
    chmod(file.c_str(), S_IRUSR);
    auto player = toon("play", file);
    waitForTile("bg02", {0, 0});
    ground.press("space");
    EXPECT_EQ(player.exitCode(), 0);
    EXPECT_TRUE(ground::waitFor([&] { return ground.grab() == bare; }));
    EXPECT_TRUE(setting("Directory").ends_with("\\data\\dorbo\\toons\\"))
        << "at the very first run";
}

TEST_F(ToonRun, EditOpensTheToonOfAFileThatStandsElsewhere) {
    addToon("secret.zkt");
    std::filesystem::rename(ground.toons() / "secret.zkt", ground.toons() / "Grüße.zkt");
    {
        auto empty = ground.launch({DORBO_TOON, "edit"});
        waitForTile("bg01", {25, 42});
    }
    auto editor = toon("edit", "./Grüße.zkt");
    waitForTile("bg10", {25, 42});
}

TEST_F(ToonRun, WhatCannotBeShownIsTold) {
    std::ofstream(ground.toons() / "bad.zkt") << "too short";
    addToon("waiter.zkt");
    chmod((ground.toons() / "waiter.zkt").c_str(), S_IRUSR);

    const struct {
        const char* command;
        const char* file;
        int code;
    } cases[] = {{"play", "bad.zkt", 1},
                 {"edit", "bad.zkt", 1},
                 {"edit", "waiter.zkt", 1},
                 {"play", "--", 2}};

    for (const auto& one : cases) {
        const std::string words = std::string(DORBO_TOON) + " " + one.command + " " + one.file;
        auto told = ground.launch({"sh", "-c", "exec env -u DISPLAY " + words + " 2>&1"});
        EXPECT_EQ(told.readLine().find(std::string("toon ") + one.command + ": "), 0U) << words;
        EXPECT_EQ(told.exitCode(), one.code) << words;
    }
    auto shown = toon("play", "bad.zkt"); // with a display and no terminal
    ground.typeInto("Dorbo", "");
    EXPECT_EQ(shown.exitCode(), 1);
}

} // namespace
