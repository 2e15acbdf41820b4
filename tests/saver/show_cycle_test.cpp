#include "saver/show_cycle.h"

#include "stage/random_walk.h"
#include "tests/saver/saver_fixture.h"
#include "toon/settings.h"

#include <set>

using testing::PrintToString;
using testing::UnorderedElementsAre;
using Names = std::vector<std::string>;

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
    const struct {
        Names entries;
        LONG count;
    } cases[] = {
        {{}, 0},
        {{"a.zkt", "B.ZKT", "c.Zkt", "directory.zkt/"}, 4},
        {{"a.txt", "zkt", "a.zkt.old", "a.zkt2", "directory/"}, 0},
        {{nameOf(longest + 1, 'a')}, 0},
        {{nameOf(longest + 1, 'a'), nameOf(longest, 'b'), nameOf(255, 'c'), "d.zkt"}, 2},
    };

    for (const auto& one : cases) {
        setEntries(one.entries);
        EXPECT_EQ(CountToonFiles(), one.count) << PrintToString(one.entries);
        EXPECT_EQ(ToonFileCount, one.count);
    }
}

TEST_F(ShowChoice, DrawsNoNameThatWouldBeCut) {
    setEntries({nameOf(longest + 1, 'a'), "b.zkt", nameOf(255, 'c'), nameOf(longest, 'd'),
                nameOf(longest + 1, 'e')});
    for (const LONG count : {2, 5}) { // 5: as if three had gone since the count
        ToonFileCount = count;
        std::set<std::string> drawn;
        for (int i = 0; i < 60; ++i) {
            char name[NEXT_TOON_SIZE] = "";
            EXPECT_EQ(PickRandomToonFile(name), 1);
            drawn.insert(name);
        }
        EXPECT_THAT(drawn, UnorderedElementsAre("b.zkt", nameOf(longest, 'd'))) << count;
    }
    setEntries({nameOf(longest + 1, 'a')});
    char name[NEXT_TOON_SIZE] = "before";
    EXPECT_EQ(PickRandomToonFile(name), 0);
    EXPECT_STREQ(name, "before");
}

TEST_F(ShowChoice, DrawsEveryToonAndNoneTwiceInARow) {
    for (const Names& entries :
         {Names{"a.zkt"}, Names{"a.zkt", "A.ZKT"}, Names{"a.zkt", "b.zkt", "c.zkt", "intro.zkt"}}) {
        setEntries(entries);
        CountToonFiles();
        NextToonFile[0] = '\0';
        std::set<std::string> drawn;
        for (int i = 0; i < 60; ++i) {
            const std::string before = NextToonFile;
            ASSERT_EQ(PickToonFile(), 1);
            EXPECT_EQ(before == NextToonFile, entries.size() == 1 && i > 0) << i;
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
    const struct {
        Names entries;
        LONG count;
        DWORD paces;
        int found;
        const char* name; // "intro.zkt" was the last one
    } cases[] = {
        {{"a.zkt", "intro.zkt"}, 2, 0, 1, "intro.zkt"},
        {{"a.zkt", "INTRO.ZKT"}, 2, 0, 1, "INTRO.ZKT"},
        {{"intro.zkt2", "my intro.zkt"}, 1, 0, 1, "my intro.zkt"},
        {{"a.zkt", "intro.zkt"}, 2, 1, 1, "a.zkt"},
        {{"a.zkt", "intro.zkt"}, 2, 0xFFFFFFFF, 1, "a.zkt"},
        {{"a.zkt", "intro.zkt"}, 0, 0, 0, "intro.zkt"}, // none was counted
        {{}, 1, 0, 0, "intro.zkt"},                     // gone since the count
        {{}, 3, 100, 0, "intro.zkt"},
    };

    for (const auto& one : cases) {
        setEntries(one.entries);
        ToonFileCount = one.count;
        PacesWalked = one.paces;
        CopyText(NextToonFile, "intro.zkt", sizeof NextToonFile);
        EXPECT_EQ(PickToonFile(), one.found) << PrintToString(one.entries) << one.paces;
        EXPECT_STREQ(NextToonFile, one.name) << PrintToString(one.entries) << one.paces;
    }
}

TEST_F(ShowChoice, NeverPicksTheSameBackgroundTwiceInARow) {
    openStage();
    for (const LONG count : {0, 2}) {
        BackgroundCount = count; // 0: not counted yet
        std::set<LONG> picked;
        for (int i = 0; i < 200; ++i) {
            const LONG before = LastBackground;
            PickBackground(stage);
            ASSERT_NE(BackgroundIndex, before);
            ASSERT_EQ(BackgroundIndex, LastBackground);
            picked.insert(BackgroundIndex);
        }
        EXPECT_EQ(BackgroundCount, count == 0 ? 10 : count);
        EXPECT_EQ(picked.size(), static_cast<std::size_t>(BackgroundCount));
        EXPECT_EQ(*picked.begin() + *picked.rbegin(), 1 + BackgroundCount);
    }
}

TEST_F(ShowChoice, PicksNoBackgroundWhereNoneIsWantedOrNoOtherThere) {
    openStage();
    for (const LONG wanted : {0, 1}) {
        Backgrounds = wanted;
        BackgroundCount = wanted == 0 ? 10 : 1;
        BackgroundIndex = 42;
        PickBackground(stage);
        EXPECT_EQ(BackgroundIndex, 42) << wanted;
    }
}

TEST_F(ShowChoice, MakesTheFirstChoiceAndSavesWhatItChanged) {
    const struct {
        Names entries;
        LONG style;
        LONG backgrounds;
        LONG styleAfter;
        LONG backgroundsAfter;
        const char* file;
        bool picksBackground;
        bool picksAtTheNext;
    } cases[] = {
        {{"a.zkt"}, 1, 0, 1, 1, "a.zkt", false, false},
        {{"a.zkt"}, 1, 1, 1, 1, "a.zkt", false, false},
        {{}, 1, 0, 0, 1, "", false, true}, // the fallback picks no background
        {{"a.zkt"}, 0, 1, 0, 1, "", true, true},
        {{"a.zkt"}, 0, 0, 0, 0, "", false, false},
        {{"a.zkt"}, 2, 1, 2, 1, "", true, true},
    };

    for (const auto& one : cases) {
        SCOPED_TRACE(PrintToString(one.entries) + PrintToString(one.style));
        setEntries(one.entries);
        WalkingStyle = one.style;
        Backgrounds = one.backgrounds;
        CopyText(NextToonFile, "of-the-last-run.zkt", sizeof NextToonFile);
        openStage();
        EXPECT_EQ(WalkingStyle, one.styleAfter);
        EXPECT_EQ(Backgrounds, one.backgroundsAfter);
        EXPECT_STREQ(NextToonFile, one.file);
        EXPECT_EQ(BackgroundIndex != 0, one.picksBackground);
        ChooseNextShow(stage);
        EXPECT_EQ(BackgroundIndex != 0, one.picksAtTheNext);
        closeStage();
        EXPECT_EQ(savedSetting("Walking Style"), std::to_string(one.styleAfter));
        EXPECT_EQ(savedSetting("Backgrounds"), std::to_string(one.backgroundsAfter));
    }
}

TEST_F(ShowChoice, LooksForToonsInTheDirectoryOfTheSettings) {
    const struct {
        const char* below;
        const char* file;
    } cases[] = {{"\\missing", "here.zkt"}, {"\\more", "there.zkt"}}; // the second one is entered

    setEntries({"here.zkt", "more/"});
    std::filesystem::copy_file("here.zkt", "more/there.zkt");
    const std::string here = Directory;
    for (const auto& one : cases) {
        CopyText(Directory, (here + one.below).c_str(), sizeof Directory);
        openStage();
        EXPECT_STREQ(NextToonFile, one.file);
        closeStage();
    }
}
