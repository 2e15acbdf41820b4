#include "saver/show_cycle.h"

#include "stage/random_walk.h"
#include "tests/saver/saver_fixture.h"
#include "toon/settings.h"

#include <cstring>
#include <set>

using testing::UnorderedElementsAre;
using Names = std::vector<std::string>;

namespace {

class ShowChoice : public SaverTest {
  protected:
    /// What `draws` draws give.
    static std::set<std::string> drawn(int draws) {
        std::set<std::string> names;
        for (int i = 0; i < draws; ++i) {
            char name[NEXT_TOON_SIZE] = "";
            EXPECT_EQ(PickRandomToonFile(name), 1);
            names.insert(name);
        }
        return names;
    }
};

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
        {{"a.zkt"}, 1},
        {{"a.zkt", "B.ZKT", "c.Zkt"}, 3},
        {{"a.zkt", "directory.zkt/"}, 2},
        {{"a.txt", "zkt", "a.zkt.old", "a.zkt2", "directory/"}, 0},
        {{nameOf(longest, 'a'), nameOf(longest, 'b')}, 2},
        {{nameOf(longest + 1, 'a')}, 0},
        {{nameOf(longest + 1, 'a'), "b.zkt", nameOf(255, 'c'), "d.zkt", nameOf(200, 'e')}, 2},
    };

    for (const auto& one : cases) {
        setEntries(one.entries);
        EXPECT_EQ(CountToonFiles(), one.count) << testing::PrintToString(one.entries);
        EXPECT_EQ(ToonFileCount, one.count);
    }
}

TEST_F(ShowChoice, DrawsNoNameThatWouldBeCut) {
    setEntries({nameOf(longest + 1, 'a'), "b.zkt", nameOf(255, 'c'), nameOf(longest, 'd'),
                nameOf(longest + 1, 'e')});
    for (const LONG count : {2, 5}) { // 5: as if three had gone since the count
        ToonFileCount = count;
        EXPECT_THAT(drawn(60), UnorderedElementsAre("b.zkt", nameOf(longest, 'd'))) << count;
    }
    setEntries({nameOf(longest + 1, 'a'), nameOf(255, 'b')});
    char name[NEXT_TOON_SIZE] = "before";
    EXPECT_EQ(PickRandomToonFile(name), 0);
    EXPECT_STREQ(name, "before");
}

TEST_F(ShowChoice, DrawsEveryToonThatWasCounted) {
    setEntries({"a.zkt", "b.zkt", "c.zkt", "d.zkt"});
    CountToonFiles();
    EXPECT_EQ(drawn(100).size(), 4U);
    ToonFileCount = 1;
    EXPECT_THAT(drawn(20), UnorderedElementsAre("a.zkt")) << "made after the count";
}

TEST_F(ShowChoice, NeverPlaysTheSameTwiceInARow) {
    const struct {
        Names entries;
        bool repeats;
    } cases[] = {
        {{"a.zkt"}, true},
        {{"a.zkt", "b.zkt"}, false}, // so they take turns
        {{"a.zkt", "A.ZKT"}, false},
        {{"a.zkt", "b.zkt", "intro.zkt"}, false},
    };

    for (const auto& one : cases) {
        setEntries(one.entries);
        CountToonFiles();
        NextToonFile[0] = '\0';
        std::string before;
        for (int i = 0; i < 40; ++i) {
            ASSERT_EQ(PickToonFile(), 1);
            ASSERT_THAT(one.entries, testing::Contains(NextToonFile));
            EXPECT_EQ(before == NextToonFile, one.repeats && i > 0) << i;
            before = NextToonFile;
        }
    }
}

TEST_F(ShowChoice, RepeatsTheLastToonAfterAHundredDraws) {
    setEntries({"c.zkt"});
    ToonFileCount = 3;
    std::strcpy(NextToonFile, "c.zkt");
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

TEST_F(ShowChoice, KeepsTheNameWhereNothingIsFound) {
    const struct {
        Names entries;
        LONG count;
        DWORD paces;
    } cases[] = {{{}, 1, 0}, {{}, 3, 100}, {{"a.zkt"}, 0, 100}, {{"intro.zkt"}, 0, 0}};

    for (const auto& one : cases) {
        setEntries(one.entries);
        ToonFileCount = one.count;
        PacesWalked = one.paces;
        std::strcpy(NextToonFile, "before.zkt");
        EXPECT_EQ(PickToonFile(), 0);
        EXPECT_STREQ(NextToonFile, "before.zkt");
    }
}

TEST_F(ShowChoice, FindsTheIntroUntilHeHasWalked) {
    const struct {
        Names entries;
        DWORD paces;
        int found;
        const char* name;
    } cases[] = {
        {{"a.zkt", "intro.zkt"}, 0, 1, "intro.zkt"},
        {{"INTRO.ZKT", "a.zkt"}, 0, 1, "INTRO.ZKT"},
        {{"a.zkt", "intro.zkt2", "my intro.zkt"}, 0, 0, "before"},
        {{"a.zkt", "intro.zkt"}, 1, 0, "before"},
        {{"a.zkt", "intro.zkt"}, 0xFFFFFFFF, 0, "before"},
    };

    for (const auto& one : cases) {
        setEntries(one.entries);
        PacesWalked = one.paces;
        std::strcpy(NextToonFile, "before");
        EXPECT_EQ(PickIntroToon(), one.found) << one.name << ' ' << one.paces;
        EXPECT_STREQ(NextToonFile, one.name) << one.paces;
    }
}

TEST_F(ShowChoice, PrefersTheIntroUntilHeHasWalked) {
    setEntries({"a.zkt", "b.zkt", "Intro.zkt"});
    CountToonFiles();
    PacesWalked = 0;
    for (int i = 0; i < 10; ++i) {
        EXPECT_EQ(PickToonFile(), 1);
        EXPECT_STREQ(NextToonFile, "Intro.zkt");
    }
    PacesWalked = 1;
    PickToonFile();
    EXPECT_STRNE(NextToonFile, "Intro.zkt");
}

TEST_F(ShowChoice, NeverPicksTheSameBackgroundTwiceInARow) {
    WalkingStyle = 0;
    openStage();
    BackgroundCount = 0;
    PickBackground(stage);
    EXPECT_EQ(BackgroundCount, 10);
    for (const LONG count : {10, 2}) {
        BackgroundCount = count;
        BackgroundIndex = 0;
        std::set<LONG> picked;
        for (int i = 0; i < 200; ++i) {
            const LONG before = LastBackground;
            PickBackground(stage);
            ASSERT_NE(BackgroundIndex, before);
            ASSERT_EQ(BackgroundIndex, LastBackground);
            picked.insert(BackgroundIndex);
        }
        EXPECT_EQ(picked.size(), static_cast<std::size_t>(count));
        EXPECT_EQ(*picked.begin(), 1);
        EXPECT_EQ(*picked.rbegin(), count);
    }
}

TEST_F(ShowChoice, PicksNoBackgroundWhereNoneIsWantedOrNoOtherThere) {
    WalkingStyle = 0;
    openStage();

    const struct {
        LONG wanted;
        LONG count;
    } cases[] = {{0, 10}, {0, 0}, {1, 1}};

    for (const auto& one : cases) {
        Backgrounds = one.wanted;
        BackgroundCount = one.count;
        BackgroundIndex = 42;
        LastBackground = 7;
        PickBackground(stage);
        EXPECT_EQ(BackgroundIndex, 42);
        EXPECT_EQ(LastBackground, 7);
        EXPECT_EQ(BackgroundCount, one.count);
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
    } cases[] = {
        {{"a.zkt"}, 1, 0, 1, 1, "a.zkt", false},
        {{"a.zkt"}, 1, 1, 1, 1, "a.zkt", false},
        {{}, 1, 0, 0, 1, "", false}, // the fallback picks no background
        {{"a.zkt"}, 0, 1, 0, 1, "", true},
        {{"a.zkt"}, 0, 0, 0, 0, "", false},
        {{"a.zkt"}, 2, 1, 2, 1, "", true},
    };

    for (const auto& one : cases) {
        setEntries(one.entries);
        WalkingStyle = one.style;
        Backgrounds = one.backgrounds;
        std::strcpy(NextToonFile, "of-the-last-run.zkt");
        openStage();
        EXPECT_EQ(WalkingStyle, one.styleAfter) << one.style;
        EXPECT_EQ(Backgrounds, one.backgroundsAfter) << one.style;
        EXPECT_STREQ(NextToonFile, one.file) << one.style;
        EXPECT_EQ(BackgroundIndex != 0, one.picksBackground) << one.style;
        closeStage();
        EXPECT_EQ(savedSetting("Walking Style"), std::to_string(one.styleAfter));
        EXPECT_EQ(savedSetting("Backgrounds"), std::to_string(one.backgroundsAfter));
    }
}

TEST_F(ShowChoice, PicksABackgroundFromTheSecondWalkOnWhereNoToonWasFound) {
    openStage();
    EXPECT_EQ(BackgroundIndex, 0);
    ChooseNextShow(stage);
    EXPECT_NE(BackgroundIndex, 0);
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
        std::strcpy(Directory, (here + one.below).c_str());
        openStage();
        EXPECT_STREQ(NextToonFile, one.file);
        closeStage();
    }
}
