// Which show comes next.
#include "saver/show_cycle.h"

#include "tests/saver/saver_fixture.h"

#include <set>

using testing::PrintToString;

namespace {

class ShowChoice : public SaverTest {
  protected:
    /// What many draws give; each has to give one.
    template <class Draw>
    static std::set<std::string> drawn(const Draw& draw) {
        std::set<std::string> names;
        for (int i = 0; i < 60; ++i) {
            names.insert(draw());
        }
        return names;
    }
};

} // namespace

TEST_F(ShowChoice, CountsWhateverHasTheNameOfAToonButNoneThatWouldBeCut) {
    const auto nameOf = [](std::size_t bytes, char letter) {
        return std::string(bytes - 4, letter) + ".zkt";
    };
    const std::string longest = nameOf(NEXT_TOON_SIZE - 1, 'd');
    const std::string tooLong = nameOf(NEXT_TOON_SIZE, 'a');
    setEntries({tooLong, "B.ZKT", nameOf(255, 'c'), longest, "e.zkt/", "f.zkt.old", "zkt", "g/"});
    EXPECT_EQ(CountToonFiles(), 3);
    ToonFileCount = 5; // as if two had gone since the count
    const auto draw = [] {
        char name[NEXT_TOON_SIZE] = "";
        EXPECT_EQ(PickRandomToonFile(name), 1);
        return std::string(name);
    };
    EXPECT_EQ(drawn(draw), (std::set<std::string>{"B.ZKT", longest, "e.zkt"}));
    setEntries({tooLong});
    EXPECT_EQ(CountToonFiles(), 0);
}

TEST_F(ShowChoice, DrawsEveryToonAndNoneTwiceInARow) {
    for (const Names& entries :
         {Names{"a.zkt"}, Names{"a.zkt", "A.ZKT"}, Names{"a.zkt", "b.zkt", "intro.zkt"}}) {
        setEntries(entries);
        CountToonFiles();
        const auto draw = [&entries] {
            const std::string before = NextToonFile;
            EXPECT_EQ(PickToonFile(), 1);
            EXPECT_TRUE(before != NextToonFile || entries.size() == 1);
            return std::string(NextToonFile);
        };
        EXPECT_EQ(drawn(draw), std::set<std::string>(entries.begin(), entries.end()));
    }
    setEntries({NextToonFile});
    EXPECT_EQ(PickToonFile(), 1) << "the others have gone since the count";
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
        EXPECT_EQ(picked.size(), count == 0 ? 10U : 2U);
    }
    for (const auto& [wanted, there] : {std::pair<LONG, LONG>(1, 1), {0, 10}}) {
        BackgroundIndex = 42;
        Backgrounds = wanted;
        BackgroundCount = there;
        PickBackground(stage);
        EXPECT_EQ(BackgroundIndex, 42);
    }
}

TEST_F(ShowChoice, MakesTheFirstChoiceAndSavesWhatItChanged) {
    // Style and backgrounds before; in text those after, the file, and how many of the first two
    // choices have picked a background.
    const std::tuple<Names, LONG, LONG, const char*> cases[] = {
        {{"a.zkt"}, 1, 0, "1 1 a.zkt 0"},
        {{}, 1, 0, "0 1  1"}, // the fallback picks none
        {{"a.zkt"}, 0, 1, "0 1  2"},
    };
    for (const auto& [entries, style, backgrounds, then] : cases) {
        setEntries(entries);
        WalkingStyle = style;
        Backgrounds = backgrounds;
        CopyText(NextToonFile, "of-the-last-run.zkt", sizeof NextToonFile);
        openStage();
        int picked = BackgroundIndex != 0 ? 1 : 0;
        ChooseNextShow(stage);
        picked += BackgroundIndex != 0 ? 1 : 0;
        closeStage();
        EXPECT_EQ(savedSetting("Walking Style") + ' ' + savedSetting("Backgrounds") + ' ' +
                      NextToonFile + ' ' + std::to_string(picked),
                  then);
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
