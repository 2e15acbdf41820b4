// The frame editor: what its fields become, what its commands do to frames and file, how it closes.
#include "tests/editor/frame_fixture.h"

#include "stage/character.h"
#include "stage/player.h"

namespace {

TEST_F(FrameEditorTest, NumbersAreHeldToTheirRanges) {
    struct Case {
        const char* typed;
        LONG x, y, pause; // on a stage of 750x700 and a screen of 800x800
    };

    const Case cases[] = {
        {"0", 375, 350, 5},      {"", 375, 350, 5},
        {"none", 375, 350, 5},   {"-", 375, 350, 5},
        {" 7 x 9", 7, 7, 7},     {"-3", -3, -3, 1},
        {"25", 25, 25, 20},      {"20", 20, 20, 20},
        {"-150", -150, -150, 1}, {"-151", -150, -150, 1},
        {"950", 950, 950, 20},   {"951", 950, 950, 20},
        {"+1", 1, 1, 1},         {"99999999999", 375, 350, 5},
    };
    edit("");
    for (const auto& [typed, x, y, pause] : cases) {
        for (const int id : {X_FIELD, Y_FIELD, PAUSE_FIELD}) {
            type(id, typed);
        }
        ToonDirty = 0;
        command(COMMIT);
        const ToonFrame now = frame(0);
        EXPECT_EQ(joined({now.x, now.y, now.pause}), joined({x, y, pause})) << typed;
        EXPECT_EQ(shown(X_FIELD), typed) << "what was typed stays";
        EXPECT_EQ(ToonDirty, 1U) << typed;
    }
}

TEST_F(FrameEditorTest, ATextHolds69CharactersAndABreakIsOneCarriageReturn) {
    const std::string most(69, 'm');
    const std::pair<std::string, std::string> cases[] = {
        {"", ""},
        {"One\ntwo\n", "One\rtwo\r"},
        {most, most},
        {most + "no more", most},
        {most.substr(1) + "\n!", most.substr(1) + "\r"},
    };
    edit("");
    for (const auto& [typed, text] : cases) {
        type(TEXT_FIELD, typed);
        EXPECT_EQ(ToonDirty, 0U) << "typing changes nothing";
        command(114); // Frame, Save
        EXPECT_EQ(frame(0).text, text);
        select(0);
        EXPECT_EQ(shown(TEXT_FIELD), text);
        ToonSetDirty(EditorDialog, 0);
    }
}

TEST_F(FrameEditorTest, AFrameIsShownAsItIsAndWhatIsNotCommittedIsGone) {
    putToon("odd.zkt", {{-7, 9, INT32_MAX, 0, 5, "a\rb", 0}, {}});
    edit("odd.zkt");
    EXPECT_EQ(shown(X_FIELD) + shown(Y_FIELD) + shown(PAUSE_FIELD), "-790");
    EXPECT_EQ(shown(TEXT_FIELD), "a\rb");
    EXPECT_EQ(IsDlgButtonChecked(EditorDialog, WINK_CHECK), 1U);
    EXPECT_EQ(shown(POSE_BUTTON), "Frame P&ose = -2147483648");
    type(X_FIELD, "55");
    stepInList(Qt::Key_Down);
    EXPECT_EQ(CurrentFrameIndex, 1);
    EXPECT_EQ(shown(X_FIELD) + shown(TEXT_FIELD) + shown(POSE_BUTTON), "0Frame P&ose = 1");
    stepInList(Qt::Key_Up);
    EXPECT_EQ(shown(X_FIELD), "-7");
    EXPECT_EQ(ToonDirty, 0U);
    CurrentFrameIndex = 1; // as a show that has come to it
    command(FRAME_LIST);
    EXPECT_EQ(CurrentFrameIndex, 0);
    SendDlgItemMessageA(EditorDialog, FRAME_LIST, CB_SETCURSEL, static_cast<WPARAM>(-1), 0);
    for (const int id : {COMMIT, FRAME_LIST, ITEM_INSERT_FRAME, ITEM_DELETE_FRAME}) {
        command(id);
        EXPECT_EQ(CurrentFrameIndex, 0) << id;
        EXPECT_EQ(joined(places()), "-7,0") << id;
        EXPECT_EQ(ToonDirty, 0U) << id;
    }
}

TEST_F(FrameEditorTest, AClickOnTheStageCommitsAndSetsThePlaceAsItIs) {
    edit("two.zkt");
    type(TEXT_FIELD, "Hi");
    click(0, 650);
    EXPECT_STREQ(frame(0).text, "Hi");
    EXPECT_EQ(joined({frame(0).x, frame(0).y}), "0,650");
    EXPECT_EQ(shown(X_FIELD) + ' ' + shown(Y_FIELD), "0 650");
    EXPECT_FALSE(saveIsGrey());
    command(COMMIT);
    EXPECT_EQ(frame(0).x, 375) << "a place of 0 is the middle";
    CharacterSprite.drawX = 300;
    CharacterSprite.drawY = 300;
    const int edges[] = {299, 300, 300 + CharacterSprite.cx - 1, 300 + CharacterSprite.cx};
    for (const int x : edges) {
        command(COMMIT);
        click(x, 350);
        EXPECT_EQ(frame(0).x == x, x == edges[0] || x == edges[3]) << x << ", on him or beside";
    }
    EXPECT_EQ(count("walk"), 2U) << "only his first one, in and off";
}

// ---- Frames
// -------------------------------------------------------------------------------------

TEST_F(FrameEditorTest, FramesComeAndGoInTheirPlaces) {
    struct Case {
        LONG frames;
        LONG at;
        int id;
        LONG then; // the one that is shown afterwards
        const char* all;
    };

    const Case cases[] = {
        {3, 0, ITEM_INSERT_FRAME, 0, "0,1,2,3"}, {3, 1, ITEM_INSERT_FRAME, 1, "1,0,2,3"},
        {3, 2, ITEM_INSERT_FRAME, 2, "1,2,0,3"}, {1, 0, ITEM_INSERT_FRAME, 0, "0,1"},
        {3, 0, ITEM_DELETE_FRAME, 0, "2,3"},     {3, 1, ITEM_DELETE_FRAME, 1, "1,3"},
        {3, 2, ITEM_DELETE_FRAME, 1, "1,2"},     {1, 0, ITEM_DELETE_FRAME, 0, "0"},
        {3, 0, ITEM_NEW_FRAME, 3, "1,2,3,0"},    {1, 0, 1015, 1, "1,0"},
    };
    for (const auto& [frames, at, id, then, all] : cases) {
        editFrames(frames);
        select(at);
        command(id);
        const std::string when = std::to_string(id) + " at " + std::to_string(at) + ": " + all;
        EXPECT_EQ(joined(places()), all) << when;
        EXPECT_EQ(selected(), then) << when;
        EXPECT_EQ(CurrentFrameIndex, then) << when;
        EXPECT_EQ(shown(X_FIELD), std::to_string(frame(then).x)) << when;
        EXPECT_EQ(shown(TEXT_FIELD), frame(then).text) << when;
        EXPECT_EQ(EditPose, frame(then).pose) << when;
        EXPECT_FALSE(saveIsGrey()) << when;
        expectInOrder(when);
    }
}

TEST_F(FrameEditorTest, AToonGrowsTo251Frames) {
    for (const int id : {ITEM_NEW_FRAME, ITEM_INSERT_FRAME}) {
        for (const LONG frames : {250, 251, 300}) {
            editFrames(frames);
            select(249);
            type(X_FIELD, "typed");
            command(id);
            const std::string when = std::to_string(id) + " with " + std::to_string(frames);
            const bool refused = frames > 250;
            EXPECT_EQ(FrameCount, refused ? frames : 251) << when;
            EXPECT_EQ(boxes.size(), refused ? 1U : 0U) << when;
            EXPECT_EQ(shown(X_FIELD), refused ? "typed" : "0") << when;
            EXPECT_EQ(saveIsGrey(), refused) << when;
            expectInOrder(when);
        }
    }
    command(ITEM_DELETE_FRAME);
    EXPECT_EQ(FrameCount, 299);
    EXPECT_EQ(frame(249).x, 251);
    EXPECT_EQ(frame(298).x, 300);
    expectInOrder("299");
}

TEST_F(FrameEditorTest, WhatChangesTheFramesEndsAShowAndLeavesPlayAsItIs) {
    constexpr int open = 105;
    constexpr int begin = 104;
    const std::tuple<int, const char*, bool> cases[] = {
        {ITEM_NEW_FRAME, "", false}, {ITEM_INSERT_FRAME, "", false}, {ITEM_DELETE_FRAME, "", false},
        {begin, "", false},          {open, "one.zkt", true},        {open, "none.zkt", false},
    };
    for (const auto& [id, file, plays] : cases) {
        for (const char* state : {"held", "at frame"}) {
            reach(state);
            key(KEY_EDIT);
            fileGiven = file;
            EXPECT_FALSE(IsWindowEnabled(PlayButton));
            command(id);
            EXPECT_EQ(NextFrameIndex, 0) << id << ' ' << state;
            EXPECT_EQ(IsWindowEnabled(PlayButton) != FALSE, plays) << id << ' ' << state;
            EXPECT_NE(IsWindowEnabled(WalkButton), FALSE) << id << ' ' << state;
            if (plays) {
                EXPECT_EQ(stateNow(), "idle");
                press(PlayButton);
                runUntilEvent("timer_set timer=PAUSE");
                EXPECT_EQ(stateNow(), "pause") << "it plays under the frame editor too";
                command(ITEM_INSERT_FRAME);
                EXPECT_EQ(stateNow(), "idle");
            }
            expectInOrder(state);
        }
    }
    edit("two.zkt");
    press(WalkButton);
    EXPECT_EQ(count("random_walk_refused"), 1U);
}

TEST_F(FrameEditorTest, ItsEndIsARestWhateverTheStageWasAt) {
    for (const EditorState& state : editorStates) {
        reach(state.name);
        OpenFrameEditor(EditorMainWindow, GetModuleHandleA(nullptr));
        EXPECT_NE(SetClassLongA(EditorStage, GCL_HCURSOR, 0), DWORD{IDC_ARROW.number});
        command(ITEM_EXIT);
        EXPECT_EQ(stateNow(), "idle") << state.name;
        EXPECT_EQ(SetClassLongA(EditorStage, GCL_HCURSOR, 0), DWORD{IDC_ARROW.number});
    }
    reach("held");
    openToon(""); // forgets the name
    key(KEY_EDIT);
    EXPECT_EQ(joined(places()), "0");
    command(ITEM_EXIT);
    EXPECT_FALSE(IsWindowEnabled(PlayButton)) << "no Toon is open";
}

// ---- Files
// --------------------------------------------------------------------------------------

class Leaving : public FrameEditorTest {
  protected:
    /// "title memory file dirty", behind a question mark for each time that was asked.
    std::string outcome(const std::string& file) {
        if (EditorDialog) {
            expectInOrder(title());
        }
        const std::string stored = joined(placesInFile(file));
        return std::string(boxes.size(), '?') + title() + ' ' + joined(places()) + " / " +
               (stored.empty() ? "-" : stored) + (ToonDirty != 0 ? " dirty" : " clean");
    }

    /// A user who has typed a place without committing it, and perhaps clicked on the wink box.
    void change(const std::string& toon, bool dirty) {
        putToons();
        std::filesystem::remove(toons() / "new.zkt");
        edit(toon);
        type(X_FIELD, "111");
        if (dirty) {
            field(WINK_CHECK).setFocus();
            QTest::keyClick(&field(WINK_CHECK), Qt::Key_Space);
            pass(0);
        }
    }
};

TEST_F(Leaving, AsksAboutChangesAndDoesWhatIsAnswered) {
    struct Case {
        const char* toon;
        const char* name; // under which to save, for one that has none
        int answered;     // 0: nothing has changed
        const char* exit; // and what New and Open lead to
        const char* begin;
        const char* open;
    };

    const Case cases[] = {
        {"two.zkt", "", 0, "closed 200,300 / 200,300 clean", "File: [Untitled] 0 / 200,300 clean",
         "File: [one] 600 / 200,300 clean"},
        {"two.zkt", "", IDYES, "?closed 111,300 / 111,300 clean",
         "?File: [Untitled] 0 / 111,300 clean", "?File: [one] 600 / 111,300 clean"},
        {"two.zkt", "", IDNO, "?closed 200,300 / 200,300 dirty",
         "?File: [Untitled] 0 / 200,300 clean", "?File: [one] 600 / 200,300 clean"},
        {"two.zkt", "", IDCANCEL, "?File: [two] 200,300 / 200,300 dirty",
         "?File: [two] 200,300 / 200,300 dirty", "?File: [two] 200,300 / 200,300 dirty"},
        {"", "", 0, "closed 0 / - clean", "File: [Untitled] 0 / - clean",
         "File: [one] 600 / - clean"},
        {"", "new.zkt", IDYES, "?closed 111 / 111 clean", "?File: [Untitled] 0 / 111 clean",
         "?File: [one] 600 / 111 clean"},
        {"", "", IDYES, "?File: [Untitled] 0 / - dirty", "?File: [Untitled] 0 / - dirty",
         "?File: [Untitled] 0 / - dirty"},
        {"", "gone/new.zkt", IDYES, "??File: [Untitled] 111 / - dirty",
         "??File: [Untitled] 111 / - dirty", "??File: [Untitled] 111 / - dirty"},
        {"", "", IDNO, "?closed 0 / - dirty", "?File: [Untitled] 0 / - clean",
         "?File: [one] 600 / - clean"},
        {"", "", IDCANCEL, "?File: [Untitled] 0 / - dirty", "?File: [Untitled] 0 / - dirty",
         "?File: [Untitled] 0 / - dirty"},
    };
    for (const auto& [toon, name, answered, exit, begin, open] : cases) {
        for (const auto& [id, then] :
             {std::pair<int, const char*>(ITEM_EXIT, exit), {104, begin}, {105, open}}) {
            change(toon, answered != 0);
            answerGiven = answered;
            nameGiven = name;
            fileGiven = "one.zkt";
            command(id);
            EXPECT_EQ(outcome(*toon == '\0' ? "new.zkt" : toon), then)
                << id << ", " << toon << ", " << name << ", answer " << answered;
        }
    }
}

TEST_F(Leaving, TheEditorsOwnEndAsksNothing) {
    change("two.zkt", true);
    key(5004);
    EXPECT_FALSE(EditorMainWindow);
    EXPECT_FALSE(EditorDialog);
    EXPECT_THAT(boxes, testing::IsEmpty());
    EXPECT_EQ(joined(placesInFile("two.zkt")), "200,300");
}

TEST_F(Leaving, WithoutSavingTakesAddedFramesBackAndTheNextOpeningShowsOneThatThereIs) {
    edit("two.zkt");
    command(ITEM_NEW_FRAME);
    command(ITEM_NEW_FRAME);
    answerGiven = IDNO;
    command(ITEM_EXIT);
    EXPECT_EQ(joined(places()), "200,300");
    key(KEY_EDIT);
    EXPECT_TRUE(saveIsGrey());
    EXPECT_EQ(shown(X_FIELD), "300");
    expectInOrder("opened again");
}

TEST_F(Leaving, SavingWritesWhatIsCommittedAndNothingElse) {
    constexpr int save = 113;
    constexpr int saveAs = 106;

    struct Case {
        const char* toon;
        bool dirty;
        int id;
        const char* name;
        int asked;
        const char* then;
    };

    const Case cases[] = {
        {"two.zkt", false, save, "x.zkt", 0, "File: [two] 200,300 / 200,300 clean"},
        {"two.zkt", true, save, "x.zkt", 0, "File: [two] 200,300 / 200,300 clean"},
        {"two.zkt", false, saveAs, "X.Y.ZKT", 1, "File: [x.y] 200,300 / 200,300 clean"},
        {"two.zkt", true, saveAs, "", 1, "File: [two] 200,300 / 200,300 dirty"},
        {"two.zkt", true, saveAs, "gone/x", 1, "?File: [x] 200,300 / 200,300 dirty"},
        {"", false, save, "", 1, "File: [Untitled] 0 / - clean"},
        {"", false, save, "new.zkt", 1, "File: [new] 0 / 0 clean"},
        {"", true, save, "new.zkt", 1, "File: [new] 0 / 0 clean"},
    };
    for (const auto& [toon, dirty, id, name, asked, then] : cases) {
        change(toon, dirty);
        nameGiven = name;
        command(id);
        EXPECT_EQ(outcome(*toon == '\0' ? "new.zkt" : toon), then) << id << ' ' << name;
        EXPECT_EQ(filesAsked, asked) << id << ' ' << name;
        EXPECT_EQ(shown(X_FIELD), "111") << "the fields stay";
    }
    change("two.zkt", true);
    nameGiven = std::string(251, 'l') + ".zkt";
    command(saveAs);
    EXPECT_EQ(title(), "File: [" + std::string(251, 'l') + "]");
}

TEST_F(Leaving, AnOpenThatFailsLeavesAnUntitledToonBehindTheFields) {
    for (const char* bad : {"none.zkt", "missing.zkt"}) {
        change("two.zkt", false);
        fileGiven = bad;
        command(105);
        EXPECT_EQ(outcome("two.zkt"), "?File: [Untitled] 0 / 200,300 clean") << bad;
        EXPECT_EQ(shown(X_FIELD) + shown(TEXT_FIELD), "111One") << bad;
        command(COMMIT);
        EXPECT_EQ(joined({frame(0).x, frame(0).pose, frame(0).pause}), "111,1,2") << bad;
        nameGiven = "";
        command(113);
        EXPECT_EQ(filesAsked, 2) << "its name is asked for: " << bad;
    }
    std::ifstream in(toons() / "none.zkt");
    std::string text;
    EXPECT_TRUE(std::getline(in, text) && text == "no Toon");
    change("two.zkt", false);
    fileGiven = "";
    command(105);
    EXPECT_EQ(shown(X_FIELD), "111") << "none was chosen";
}

TEST_F(Leaving, AFileThatCannotBeReadAgainLosesItsName) {
    const std::pair<const char*, std::function<void(const std::filesystem::path&)>> fates[] = {
        {"gone", [](const auto& file) { std::filesystem::remove(file); }},
        {"another's", [](const auto& file) { std::ofstream(file) << "no Toon"; }},
    };
    for (const auto& [fate, befall] : fates) {
        change("two.zkt", true);
        befall(toons() / "two.zkt");
        answerGiven = IDNO;
        command(ITEM_EXIT);
        EXPECT_FALSE(EditorDialog) << fate;
        EXPECT_EQ(boxes.size(), 2U) << fate << ": the question, and what is wrong";
        EXPECT_FALSE(IsWindowEnabled(PlayButton)) << fate;
        key(KEY_EDIT);
        EXPECT_EQ(title(), "File: [Untitled]") << fate;
        command(COMMIT);
        nameGiven = "";
        command(ITEM_SAVE);
        EXPECT_EQ(filesAsked, 1) << fate;
        std::string text;
        EXPECT_EQ(std::getline(std::ifstream(toons() / "two.zkt"), text).fail(), *fate == 'g');
        EXPECT_EQ(text, *fate == 'g' ? "" : "no Toon");
    }
}

} // namespace
