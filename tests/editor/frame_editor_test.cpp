// The frame editor: what its fields become, what its commands do to frames and file, how it closes.
#include "tests/editor/frame_fixture.h"

#include "stage/character.h"
#include "stage/player.h"

#include <QApplication>

namespace {

TEST_F(FrameEditorTest, NumbersAreHeldToTheirRanges) {
    // What is typed, and x, y and the pause on a stage of 750x700 and a screen of 800x800.
    const std::pair<const char*, const char*> cases[] = {
        {"0", "375,350,5"},      {"", "375,350,5"},       {"none", "375,350,5"},
        {" 7 x 9", "7,7,7"},     {"-3", "-3,-3,1"},       {"25", "25,25,20"},
        {"-150", "-150,-150,1"}, {"-151", "-150,-150,1"}, {"950", "950,950,20"},
        {"951", "950,950,20"},
    };
    edit("");
    for (const auto& [typed, kept] : cases) {
        for (const int id : {X_FIELD, Y_FIELD, PAUSE_FIELD}) {
            type(id, typed);
        }
        ToonDirty = 0;
        command(COMMIT);
        EXPECT_EQ(joined({frame(0).x, frame(0).y, frame(0).pause}), kept) << typed;
        EXPECT_EQ(shown(X_FIELD), typed) << "what was typed stays";
        EXPECT_EQ(ToonDirty, 1U) << typed;
    }
}

TEST_F(FrameEditorTest, ATextHolds69CharactersAndABreakIsOneCarriageReturn) {
    const std::string most(69, 'm');
    const std::pair<std::string, std::string> cases[] = {
        {"", ""},
        {"One\ntwo\n", "One\rtwo\r"},
        {most + "no more", most},
        {most.substr(1) + "\n!", most.substr(1) + "\r"},
    };
    edit("");
    for (const auto& [typed, text] : cases) {
        type(TEXT_FIELD, typed);
        EXPECT_EQ(ToonDirty, 0U) << "typing changes nothing";
        command(ITEM_SAVE_FRAME);
        EXPECT_EQ(frame(0).text, text);
        select(0);
        EXPECT_EQ(shown(TEXT_FIELD), text);
        ToonSetDirty(EditorDialog, 0);
    }
}

TEST_F(FrameEditorTest, AFrameIsShownAsItIsAndWhatIsNotCommittedIsGone) {
    putToon("odd.zkt", {{-7, 9, INT32_MAX, 0, 1, "a\rb", 0}, {}});
    edit("odd.zkt");
    EXPECT_EQ(fields(), "-7,9,0 a\rb Frame P&ose = -2147483648 winks");
    type(X_FIELD, "55");
    command(FRAME_LIST); // tells of something else than a choice
    EXPECT_EQ(shown(X_FIELD), "55");
    QTest::keyClick(&field(FRAME_LIST), Qt::Key_Down);
    pass(0);
    EXPECT_EQ(CurrentFrameIndex, 1);
    EXPECT_EQ(fields(), "0,0,0  Frame P&ose = 1");
    CurrentFrameIndex = 0; // as a show that has come to it
    command(FRAME_LIST);
    EXPECT_EQ(CurrentFrameIndex, 1);
    QTest::keyClick(&field(FRAME_LIST), Qt::Key_Up);
    pass(0);
    EXPECT_EQ(shown(X_FIELD), "-7");
    EXPECT_EQ(ToonDirty, 0U);
}

TEST_F(FrameEditorTest, AClickOnTheStageCommitsAndSetsThePlaceAsItIs) {
    edit("two.zkt");
    type(TEXT_FIELD, "Hi");
    click(0, 650);
    EXPECT_STREQ(frame(0).text, "Hi");
    EXPECT_EQ(joined({frame(0).x, frame(0).y}), "0,650");
    EXPECT_EQ(fields(), "0,650,2 Hi Frame P&ose = 2");
    EXPECT_FALSE(saveIsGrey());
    EXPECT_EQ(count("walk"), 2U) << "only his first one, in and off";
}

TEST_F(FrameEditorTest, KeysFindTheirFieldsFromTheStageToo) {
    const std::pair<int, int> fields[] = {{KEY_TO_LIST, FRAME_LIST},
                                          {KEY_TO_TEXT, TEXT_FIELD},
                                          {KEY_TO_X, X_FIELD},
                                          {KEY_TO_Y, Y_FIELD},
                                          {KEY_TO_PAUSE, PAUSE_FIELD}};
    edit("");
    for (const auto& [command, id] : fields) {
        SetFocus(FileButton);
        key(command);
        EXPECT_EQ(QApplication::focusWidget(), &field(id)) << id;
    }
    record.clear();
    for (const int nothing : {KEY_FILE, KEY_PLAY, KEY_CONTINUE, KEY_WALK}) {
        key(nothing);
    }
    EXPECT_EQ(count("play_button") + count("random_walk_refused"), 0U);
}

TEST_F(FrameEditorTest, EnterAndEscapeDoNothingInItsFieldsAndF10OpensTheFirstMenu) {
    edit("two.zkt");
    for (const int id : {FRAME_LIST, X_FIELD}) {
        for (const Qt::Key code : {Qt::Key_Return, Qt::Key_Escape}) {
            field(id).setFocus();
            QTest::keyClick(&field(id), code);
            pass(0);
            EXPECT_TRUE(EditorDialog) << id;
            EXPECT_EQ(ToonDirty, 0U) << id;
        }
    }
    QTest::keyClick(&field(X_FIELD), Qt::Key_F10);
    QWidget* const menu = QApplication::activePopupWidget();
    ASSERT_NE(menu, nullptr);
    QTest::keyClick(menu, Qt::Key_Return);
    pass(0);
    EXPECT_EQ(title(), "Untitled") << "New, its first item, is marked";
}

// ---- Frames -------------------------------------------------------------------------------------

TEST_F(FrameEditorTest, FramesComeAndGoInTheirPlaces) {
    // How many there are, which is selected, the command; all of them then, and which is selected.
    const std::tuple<LONG, LONG, int, const char*> cases[] = {
        {3, 0, ITEM_INSERT_FRAME, "0,1,2,3 at 0"}, {3, 1, ITEM_INSERT_FRAME, "1,0,2,3 at 1"},
        {3, 2, ITEM_INSERT_FRAME, "1,2,0,3 at 2"}, {3, 0, ITEM_DELETE_FRAME, "2,3 at 0"},
        {3, 1, ITEM_DELETE_FRAME, "1,3 at 1"},     {3, 2, ITEM_DELETE_FRAME, "1,2 at 1"},
        {1, 0, ITEM_DELETE_FRAME, "0 at 0"},       {3, 0, ITEM_NEW_FRAME, "1,2,3,0 at 3"},
        {1, 0, NEW_FRAME_BUTTON, "1,0 at 1"},
    };
    for (const auto& [frames, at, id, then] : cases) {
        editFrames(frames);
        select(at);
        command(id);
        const std::string x = joined({frame(CurrentFrameIndex).x});
        EXPECT_EQ(joined(places()) + " at " + joined({CurrentFrameIndex}), then) << id;
        EXPECT_EQ(fields(),
                  x + (x == "0" ? ",0,0  Frame P&ose = 1" : ",1,1 text Frame P&ose = 2 winks"));
        EXPECT_FALSE(saveIsGrey()) << then;
        expectInOrder(then);
    }
}

TEST_F(FrameEditorTest, AToonGrowsTo251Frames) {
    for (const int id : {ITEM_NEW_FRAME, ITEM_INSERT_FRAME}) {
        editFrames(250);
        command(id);
        ToonSetDirty(EditorDialog, 0);
        type(X_FIELD, "typed");
        EXPECT_TRUE(boxes.empty());
        command(id);
        EXPECT_EQ(FrameCount, 251);
        EXPECT_EQ(boxes.size(), 1U);
        EXPECT_EQ(shown(X_FIELD), "typed");
        EXPECT_TRUE(saveIsGrey());
        expectInOrder(std::to_string(id));
    }
}

TEST_F(FrameEditorTest, WhatChangesTheFramesEndsAShowAndLeavesPlayAsItIs) {
    const std::pair<int, const char*> cases[] = {
        {ITEM_NEW_FRAME, ""}, {ITEM_INSERT_FRAME, ""}, {ITEM_DELETE_FRAME, ""},
        {ITEM_NEW, ""},       {ITEM_OPEN, "one.zkt"},
    };
    for (const auto& [id, file] : cases) {
        reach("at frame");
        key(KEY_EDIT);
        fileGiven = file;
        EXPECT_FALSE(IsWindowEnabled(PlayButton));
        command(id);
        EXPECT_EQ(NextFrameIndex, 0) << id;
        EXPECT_EQ(IsWindowEnabled(PlayButton) != FALSE, fileGiven == "one.zkt") << id;
        EXPECT_TRUE(IsWindowEnabled(WalkButton)) << id;
        expectInOrder(file);
    }
    EXPECT_EQ(looks(), looksOf("idle"));
    press(PlayButton);
    runUntilEvent("timer_set timer=PAUSE");
    EXPECT_EQ(looks(), looksOf("pause")) << "it plays under the frame editor too";
    command(ITEM_INSERT_FRAME);
    EXPECT_EQ(looks(), looksOf("idle"));
    press(WalkButton);
    EXPECT_EQ(count("random_walk_refused"), 1U);
    EXPECT_TRUE(IsWindowEnabled(PlayButton));
    fileGiven = "none.zkt";
    answerGiven = IDNO;
    command(ITEM_OPEN);
    EXPECT_FALSE(IsWindowEnabled(PlayButton)) << "its one frame would hold a show for ever";
}

TEST_F(FrameEditorTest, ItsEndIsARestWhateverTheStageWasAt) {
    for (const EditorState& state : editorStates) {
        reach(state.name);
        OpenFrameEditor(EditorMainWindow, GetModuleHandleA(nullptr));
        EXPECT_NE(SetClassLongA(EditorStage, GCL_HCURSOR, 0), DWORD{IDC_ARROW.number});
        command(ITEM_EXIT);
        EXPECT_EQ(looks(), looksOf("idle")) << state.name;
        EXPECT_EQ(SetClassLongA(EditorStage, GCL_HCURSOR, 0), DWORD{IDC_ARROW.number});
    }
}

// ---- Files --------------------------------------------------------------------------------------

class Leaving : public FrameEditorTest {
  protected:
    /// A question mark for each box and a plus for each file dialog that came up; the name in the
    /// title and what stands in X, or "closed"; the frames in memory and in the file, by their
    /// places; a star if the Toon counts as changed.
    std::string outcome(const std::string& file) {
        std::string found = std::string(boxes.size(), '?') + std::string(unsigned(filesAsked), '+');
        if (EditorDialog) {
            expectInOrder(title());
            found += title() + ' ' + shown(X_FIELD);
        } else {
            found += "closed";
        }
        found += " of " + joined(places()) + ", file " + joined(placesInFile(file));
        return found + (ToonDirty != 0 ? " *" : "");
    }

    /// A user who has typed a place without committing it, and perhaps clicked on the wink box.
    void change(const std::string& toon, bool dirty) {
        putToons();
        std::filesystem::remove("new.zkt");
        edit(toon);
        type(X_FIELD, "111");
        if (dirty) {
            field(WINK_CHECK).setFocus();
            QTest::keyClick(&field(WINK_CHECK), Qt::Key_Space);
            pass(0);
        }
    }
};

TEST_F(Leaving, AsksAboutChangesAndDoesWhatIsAnsweredAndSavesWhatIsCommitted) {
    const std::string longest(251, 'l');
    // The Toon, the answer to the question, 0 where nothing has changed, the command, under which
    // name to save where that is asked, and the outcome.
    const std::tuple<const char*, int, int, std::string, std::string> cases[] = {
        {"two.zkt", 0, ITEM_EXIT, "", "closed of 200,300, file 200,300"},
        {"two.zkt", 0, ITEM_NEW, "", "Untitled 0 of 0, file 200,300"},
        {"two.zkt", 0, ITEM_OPEN, "", "+one 600 of 600, file 200,300"},
        {"two.zkt", IDYES, ITEM_EXIT, "", "?closed of 111,300, file 111,300"},
        {"two.zkt", IDYES, ITEM_NEW, "", "?Untitled 0 of 0, file 111,300"},
        {"two.zkt", IDYES, ITEM_OPEN, "", "?+one 600 of 600, file 111,300"},
        {"two.zkt", IDNO, ITEM_EXIT, "", "?closed of 200,300, file 200,300 *"},
        {"two.zkt", IDNO, ITEM_NEW, "", "?Untitled 0 of 0, file 200,300"},
        {"two.zkt", IDNO, ITEM_OPEN, "", "?+one 600 of 600, file 200,300"},
        {"two.zkt", IDCANCEL, ITEM_EXIT, "", "?two 111 of 200,300, file 200,300 *"},
        {"two.zkt", IDCANCEL, ITEM_NEW, "", "?two 111 of 200,300, file 200,300 *"},
        {"two.zkt", IDCANCEL, ITEM_OPEN, "", "?two 111 of 200,300, file 200,300 *"},
        {"", IDYES, ITEM_EXIT, "new.zkt", "?+closed of 111, file 111"},
        {"", IDYES, ITEM_OPEN, "new.zkt", "?++one 600 of 600, file 111"},
        {"", IDYES, ITEM_EXIT, "", "?+Untitled 111 of 0, file  *"},
        {"", IDYES, ITEM_NEW, "gone/new.zkt", "??+Untitled 111 of 111, file  *"},
        {"", IDNO, ITEM_EXIT, "", "?closed of 0, file  *"},
        {"two.zkt", 0, ITEM_SAVE, "x.zkt", "two 111 of 200,300, file 200,300"},
        {"two.zkt", IDYES, ITEM_SAVE, "x.zkt", "two 111 of 200,300, file 200,300"},
        {"two.zkt", 0, ITEM_SAVE_AS, "X.Y.ZKT", "+x.y 111 of 200,300, file 200,300"},
        {"two.zkt", IDYES, ITEM_SAVE_AS, "", "+two 111 of 200,300, file 200,300 *"},
        {"two.zkt", IDYES, ITEM_SAVE_AS, "gone/x", "?+x 111 of 200,300, file 200,300 *"},
        {"two.zkt", 0, ITEM_SAVE_AS, longest, "+" + longest + " 111 of 200,300, file 200,300"},
        {"", 0, ITEM_SAVE, "", "+Untitled 111 of 0, file "},
        {"", IDYES, ITEM_SAVE, "new.zkt", "+new 111 of 0, file 0"},
    };
    for (const auto& [toon, answered, id, name, then] : cases) {
        change(toon, answered != 0);
        answerGiven = answered;
        nameGiven = name;
        fileGiven = "one.zkt";
        command(id);
        EXPECT_EQ(outcome(*toon == '\0' ? "new.zkt" : toon), then)
            << id << ", " << toon << ", " << name << ", answer " << answered;
    }
}

TEST_F(Leaving, TheEditorsOwnEndAsksNothing) {
    change("two.zkt", true);
    key(POPUP_EXIT);
    EXPECT_FALSE(EditorMainWindow || EditorDialog);
    EXPECT_TRUE(boxes.empty());
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

TEST_F(Leaving, AnOpenThatFailsLeavesAnUntitledToonBehindTheFields) {
    for (const char* bad : {"none.zkt", "missing.zkt"}) {
        change("two.zkt", false);
        fileGiven = bad;
        command(ITEM_OPEN);
        EXPECT_EQ(outcome("two.zkt"), "?+Untitled 111 of 0, file 200,300") << bad;
        EXPECT_EQ(fields(), "111,300,2 One Frame P&ose = 2") << bad;
        command(COMMIT);
        EXPECT_EQ(joined({frame(0).x, frame(0).pose, frame(0).pause}), "111,1,2") << bad;
        command(ITEM_SAVE);
        EXPECT_EQ(filesAsked, 2) << "its name is asked for: " << bad;
    }
    EXPECT_EQ(std::filesystem::file_size("none.zkt"), 7U) << "nothing was written to it";
    change("two.zkt", false);
    fileGiven = "";
    command(ITEM_OPEN);
    EXPECT_EQ(shown(X_FIELD), "111") << "none was chosen";
}

TEST_F(Leaving, AFileThatCannotBeReadAgainLosesItsName) {
    for (const bool isThere : {false, true}) {
        change("two.zkt", true);
        const std::string file = "two.zkt";
        std::filesystem::remove(file);
        if (isThere) {
            std::ofstream(file) << "no Toon";
        }
        answerGiven = IDNO;
        command(ITEM_EXIT);
        EXPECT_FALSE(EditorDialog);
        EXPECT_EQ(boxes.size(), 2U) << "the question, and what is wrong";
        EXPECT_FALSE(IsWindowEnabled(PlayButton));
        key(KEY_EDIT);
        EXPECT_EQ(title(), "Untitled");
        command(COMMIT);
        command(ITEM_SAVE);
        EXPECT_EQ(filesAsked, 1);
        EXPECT_EQ(std::filesystem::exists(file), isThere);
        EXPECT_TRUE(!isThere || std::filesystem::file_size(file) == 7) << "nor written over";
    }
}

} // namespace
