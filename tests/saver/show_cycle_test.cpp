#include "saver/show_cycle.h"

#include "tests/saver/saver_fixture.h"

#include <set>

using testing::PrintToString;
using testing::UnorderedElementsAre;

namespace {

class ShowChoice : public SaverTest {};

/// A Toon's name of so many bytes.
std::string nameOf(std::size_t bytes, char letter) {
    const std::string extension = ".zkt";
    return std::string(bytes - extension.size(), letter) + extension;
}

constexpr std::size_t longest = NEXT_TOON_SIZE - 1;

} // namespace

TEST_F(ShowChoice, CountsWhateverHasTheNameOfAToon) {
    const std::pair<Names, LONG> cases[] = {
        {{}, 0},
        {{"a.zkt", "B.ZKT", "c.Zkt", "directory.zkt/"}, 4},
        {{"a.txt", "zkt", "a.zkt.old", "a.zkt2", "directory/"}, 0},
        {{nameOf(longest + 1, 'a')}, 0},
        {{nameOf(longest + 1, 'a'), nameOf(longest, 'b'), nameOf(255, 'c'), "d.zkt"}, 2},
    };
    for (const auto& [entries, count] : cases) {
        setEntries(entries);
        EXPECT_EQ(CountToonFiles(), count) << PrintToString(entries);
        EXPECT_EQ(ToonFileCount, count);
    }
}

TEST_F(ShowChoice, DrawsNoNameThatWouldBeCut) {
    setEntries({nameOf(longest + 1, 'a'), "b.zkt", nameOf(255, 'c'), nameOf(longest, 'd'),
                nameOf(longest + 1, 'e')});
    ToonFileCount = 5; // as if three had gone since the count
    std::set<std::string> drawn;
    for (int i = 0; i < 60; ++i) {
        char name[NEXT_TOON_SIZE] = "";
        EXPECT_EQ(PickRandomToonFile(name), 1);
        drawn.insert(name);
    }
    EXPECT_THAT(drawn, UnorderedElementsAre("b.zkt", nameOf(longest, 'd')));
}

TEST_F(ShowChoice, DrawsEveryToonAndNoneTwiceInARow) {
    for (const Names& entries :
         {Names{"a.zkt"}, Names{"a.zkt", "A.ZKT"}, Names{"a.zkt", "b.zkt", "intro.zkt"}}) {
        setEntries(entries);
        CountToonFiles();
        std::set<std::string> drawn;
        for (int i = 0; i < 60; ++i) {
            const std::string before = NextToonFile;
            ASSERT_EQ(PickToonFile(), 1);
            EXPECT_TRUE(before != NextToonFile || entries.size() == 1) << i;
            drawn.insert(NextToonFile);
        }
        EXPECT_EQ(drawn, std::set<std::string>(entries.begin(), entries.end()));
    }
}

TEST_F(ShowChoice, RepeatsTheLastToonAfterAHundredDraws) {
    setEntries({"c.zkt"});
    ToonFileCount = 3;
    CopyText(NextToonFile, "c.zkt", sizeof NextToonFile);
    SeedRandom(7);
    EXPECT_EQ(PickToonFile(), 1);
    EXPECT_STREQ(NextToonFile, "c.zkt");
    const LONG next = RandomInt(0, RANDOM_HIGHEST);
    SeedRandom(7);
    for (int i = 0; i < 100; ++i) {
        RandomInt(1, 3);
    }
    EXPECT_EQ(RandomInt(0, RANDOM_HIGHEST), next);
}

TEST_F(ShowChoice, PrefersTheIntroUntilHeHasWalked) {
    const std::tuple<Names, LONG, DWORD, int, const char*> cases[] = {
        {{"a.zkt", "intro.zkt"}, 2, 0, 1, "intro.zkt"},
        {{"intro.zkt2", "my intro.zkt"}, 1, 0, 1, "my intro.zkt"},
        {{"a.zkt", "intro.zkt"}, 2, 1, 1, "a.zkt"},
        {{"a.zkt", "intro.zkt"}, 0, 0, 0, "intro.zkt"}, // none was counted
        {{}, 1, 0, 0, "intro.zkt"},                     // gone since the count
    };

    for (const auto& [entries, count, paces, found, name] : cases) {
        setEntries(entries);
        ToonFileCount = count;
        PacesWalked = paces;
        CopyText(NextToonFile, "intro.zkt", sizeof NextToonFile);
        EXPECT_EQ(PickToonFile(), found) << PrintToString(entries) << paces;
        EXPECT_STREQ(NextToonFile, name) << PrintToString(entries) << paces;
    }
}

TEST_F(ShowChoice, PicksAnotherBackgroundWhereOneIsWantedAndThere) {
    openStage();
    for (const LONG count : {0, 2}) { // 0: not counted yet
        BackgroundCount = count;
        std::set<LONG> picked;
        for (int i = 0; i < 200; ++i) {
            const LONG before = LastBackground;
            PickBackground(stage);
            ASSERT_NE(BackgroundIndex, before);
            picked.insert(BackgroundIndex);
        }
        EXPECT_EQ(BackgroundCount, count == 0 ? 10 : count);
        EXPECT_EQ(picked.size(), static_cast<std::size_t>(BackgroundCount));
    }
    BackgroundIndex = 42;
    BackgroundCount = 1;
    PickBackground(stage);
    Backgrounds = 0;
    BackgroundCount = 10;
    PickBackground(stage);
    EXPECT_EQ(BackgroundIndex, 42);
}

TEST_F(ShowChoice, MakesTheFirstChoiceAndSavesWhatItChanged) {
    // Style and backgrounds before, in text those after; whether the choices pick a background.
    const std::tuple<Names, LONG, LONG, const char*, const char*, bool, bool> cases[] = {
        {{"a.zkt"}, 1, 0, "1 1", "a.zkt", false, false},
        {{}, 1, 0, "0 1", "", false, true}, // the fallback picks no background
        {{"a.zkt"}, 0, 1, "0 1", "", true, true},
    };
    for (const auto& [entries, style, backgrounds, saved, file, picksFirst, picksNext] : cases) {
        SCOPED_TRACE(PrintToString(entries) + PrintToString(style));
        setEntries(entries);
        WalkingStyle = style;
        Backgrounds = backgrounds;
        CopyText(NextToonFile, "of-the-last-run.zkt", sizeof NextToonFile);
        openStage();
        EXPECT_STREQ(NextToonFile, file);
        EXPECT_EQ(BackgroundIndex != 0, picksFirst);
        ChooseNextShow(stage);
        EXPECT_EQ(BackgroundIndex != 0, picksNext);
        closeStage();
        EXPECT_EQ(savedSetting("Walking Style") + ' ' + savedSetting("Backgrounds"), saved);
    }
}

TEST_F(ShowChoice, LooksForToonsInTheDirectoryOfTheSettings) {
    setEntries({"here.zkt", "more/"});
    std::filesystem::copy_file("here.zkt", "more/there.zkt");
    const std::string here = Directory;
    for (const auto& [below, file] :
         {std::pair("\\missing", "here.zkt"), {"\\more", "there.zkt"}}) {
        CopyText(Directory, (here + below).c_str(), sizeof Directory);
        openStage();
        EXPECT_STREQ(NextToonFile, file);
        closeStage();
    }
}
