// The dialogs behind the frame editor: a Toon's configuration and the pose picker. What they show
// and take.
#include "tests/editor/frame_fixture.h"

#include "editor/configuration.h"
#include "editor/pose_picker.h"
#include "platform/user/queue.h"

namespace {

// ---- The configuration --------------------------------------------------------------------------

constexpr int CAPTION_FIELD = 1023;
constexpr int SPEED_BAR = 1030;
constexpr int BACKGROUND_LIST = 1035;

class Configuration : public FrameEditorTest {
  protected:
    void SetUp() override {
        FrameEditorTest::SetUp();
        edit("two.zkt");
    }

    static HWND dialog() {
        return FindWindowA("dialog", ToonDocHeader.magic);
    }

    static std::string text(int id) {
        return textOf(dialog(), id);
    }

    /// Opens it, acts in it and leaves it by OK or Cancel. Gives tile and speed, which are then in
    /// force and the Toon's.
    static std::string configure(const std::function<void()>& act, int button) {
        ToonSetDirty(EditorDialog, 0);
        record.clear();
        once(dialogStands, [&act, button] {
            act();
            PostMessageA(dialog(), WM_COMMAND, static_cast<WPARAM>(button), 0);
        });
        command(ITEM_CONFIGURE);
        EXPECT_FALSE(dialogStands());
        EXPECT_EQ(saveIsGrey(), button == IDCANCEL);
        const std::string rebuilt = "rebuild_backdrop index=" + std::to_string(BackgroundIndex);
        EXPECT_EQ(count(rebuilt), 1U);
        EXPECT_EQ(joined({ToonDocHeader.background, ToonDocHeader.speed}),
                  joined({BackgroundIndex, ToonSpeed}));
        return joined({BackgroundIndex, ToonSpeed});
    }
};

TEST_F(Configuration, ShowsTheToonAndTakesItBackAsItIs) {
    // Tile, counted from 1, and speed of the Toon; those shown, counted from 0, and taken back.
    const std::tuple<LONG, LONG, const char*, const char*> cases[] = {
        {3, 5, "2,5", "3,5"},
        {0, 0, "-1,1", "0,1"}, // none is selected
        {INT32_MAX, INT32_MAX, "-1,5", "0,5"},
    };
    std::string found;
    const auto look = [&found] {
        EXPECT_EQ(text(1024) + 'x' + text(1025) + ' ' + text(1029) + ' ' + text(1031),
                  "1500x1400 2 1.2");
        const LRESULT tile = SendDlgItemMessageA(dialog(), BACKGROUND_LIST, CB_GETCURSEL, 0, 0);
        found = joined(
            {static_cast<LONG>(tile), GetScrollPos(GetDlgItem(dialog(), SPEED_BAR), SB_CTL)});
    };
    for (const auto& [background, speed, shown, back] : cases) {
        for (const int button : {IDCANCEL, IDOK}) {
            ToonDocHeader.background = BackgroundIndex = background;
            ToonDocHeader.speed = ToonSpeed = speed;
            EXPECT_EQ(configure(look, button), button == IDOK ? back : joined({background, speed}));
            EXPECT_EQ(found, shown);
        }
    }
}

TEST_F(Configuration, TakesACaptionOf48CharactersAndATile) {
    const auto act = [] {
        QWidget& caption = widgetOf(GetDlgItem(dialog(), CAPTION_FIELD));
        QTest::keyClick(&caption, Qt::Key_A, Qt::ControlModifier);
        QTest::keyClicks(&caption, QString(60, QLatin1Char('c')));
        EXPECT_EQ(text(CAPTION_FIELD), std::string(49, 'c'));
        QTest::keyClick(&widgetOf(GetDlgItem(dialog(), BACKGROUND_LIST)), Qt::Key_End);
    };
    EXPECT_EQ(configure(act, IDOK), "10,5");
    EXPECT_EQ(CaptionText, std::string(48, 'c'));
    EXPECT_STREQ(ToonDocHeader.caption, CaptionText);
}

TEST_F(Configuration, ArrowsAndTroughMoveTheSpeedByOneAndTheThumbDoesNot) {
    const std::tuple<LONG, WORD, const char*> cases[] = {
        {3, SB_LINEUP, "3,2"}, {3, SB_PAGEUP, "3,2"},     {3, SB_LINEDOWN, "3,4"},
        {1, SB_LINEUP, "3,1"}, {3, SB_PAGEDOWN, "3,4"},   {5, SB_LINEDOWN, "3,5"},
        {3, 4, "3,3"},         {3, SB_THUMBTRACK, "3,3"},
    };
    for (const auto& [speed, code, then] : cases) {
        ToonDocHeader.speed = speed;
        const auto act = [code = code] { SendMessageA(dialog(), WM_HSCROLL, code, 0); };
        EXPECT_EQ(configure(act, IDOK), then) << speed << " by " << code;
    }
}

TEST_F(Configuration, ACommandThatWaitedWhenItCameUpIsDropped) {
    for (const int second : {ITEM_NEW_FRAME, ITEM_EXIT}) {
        once([] { return dialogStands() && !seam::messagesWait(); },
             [] { PostMessageA(modalDialog(), WM_COMMAND, IDCANCEL, 0); });
        PostMessageA(EditorDialog, WM_COMMAND, ITEM_CONFIGURE, 0);
        command(second);
        EXPECT_TRUE(EditorDialog);
        EXPECT_EQ(FrameCount, 2);
    }
}

// ---- The picker ---------------------------------------------------------------------------------

class Picker : public FrameEditorTest {
  protected:
    static HWND picker() {
        return FindWindowA("PoseWndClass", nullptr);
    }

    static bool pickerStands() {
        return picker() != HWND{};
    }

    /// The numbers of the cells that are drawn as pressed, from 1.
    static std::string sunkenCells() {
        constexpr DWORD shadow = 0x808080;
        const seam::Picture picture = seam::windowPicture(picker());
        std::string sunken;
        for (int i = 0; i < 8; ++i) {
            const int left = 5 + i % 4 * 140;
            const int top = i < 4 ? 5 : 146;
            const auto at = static_cast<std::size_t>((top + 60) * picture.width + left);
            sunken += picture.pixels.at(at) == shadow ? std::to_string(i + 1) : "";
        }
        return sunken;
    }

    /// Opens it by the button with a pose, which is then drawn as pressed, and acts. Gives the pose
    /// that the button shows at the end; the Toon has changed whatever came of it.
    std::string pick(LONG current, const std::function<void()>& act) {
        edit("two.zkt");
        EditPose = current;
        once(pickerStands, [current, &act] {
            RECT place{};
            GetWindowRect(picker(), &place);
            EXPECT_EQ(joined({place.left, place.top, place.right, place.bottom}),
                      "115,255,685,545");
            EXPECT_EQ(sunkenCells(), std::to_string(std::clamp(current, 0, 7) + 1));
            act();
        });
        command(POSE_BUTTON);
        EXPECT_FALSE(pickerStands());
        expectInOrder("picked");
        EXPECT_EQ(ToonDirty, 1U);
        return std::to_string(EditPose + 1);
    }
};

TEST_F(Picker, APressChoosesAndAReleaseAnywhereCloses) {
    const std::tuple<int, int, const char*> cases[] = {
        {5, 5, "1"},     {143, 5, "1"}, // beside all cells: the first pose
        {145, 5, "2"},   {282, 142, "2"}, {562, 5, "4"},   {5, 145, "1"},
        {145, 146, "6"}, {145, 284, "1"}, {562, 283, "8"},
    };
    for (const auto& [x, y, chosen] : cases) {
        const std::string taken = pick(6, [x = x, y = y] {
            QWindow* window = toolkitWindowOf(picker());
            QTest::mousePress(window, Qt::LeftButton, {}, {x + 1, y + 1}); // behind its border
            QTest::mouseRelease(window, Qt::LeftButton, {}, {300, 200});
        });
        EXPECT_EQ(taken, chosen) << x << ' ' << y;
    }
}

TEST_F(Picker, TheDigitsOneToEightChooseAndOtherKeysDoNothing) {
    for (const char* keys : {"1", "2", "3", "4", "5", "6", "7", "09A\x1B\r8"}) {
        const std::string taken = pick(2, [keys] {
            EXPECT_EQ(RunPosePicker(GetModuleHandleA(nullptr), EditorDialog, 5), 5)
                << "there is one at a time";
            for (const char* key = keys; *key != '\0'; ++key) {
                EXPECT_TRUE(pickerStands()) << keys;
                SendMessageA(picker(), WM_KEYDOWN, static_cast<WPARAM>(*key), 0);
            }
        });
        EXPECT_EQ(taken, std::string(1, std::string(keys).back()));
    }
}

TEST_F(Picker, ClosedWithoutAChoiceItGivesTheNearestOfItsPoses) {
    for (const auto& [before, then] : {std::pair(2, "3"), {-4, "1"}, {99, "8"}}) {
        EXPECT_EQ(pick(before, [] { PostMessageA(picker(), WM_CLOSE, 0, 0); }), then);
    }
}

TEST_F(Picker, AndTheConfigurationGoWithTheirOwnersAndLeaveNoQuitBehind) {
    const auto eitherStands = [] { return pickerStands() || dialogStands(); };
    const std::pair<int, HWND*> cases[] = {{POSE_BUTTON, &EditorDialog},
                                           {POSE_BUTTON, &EditorMainWindow},
                                           {ITEM_CONFIGURE, &EditorMainWindow}};
    for (const auto& [opens, owner] : cases) {
        edit("two.zkt");
        once(eitherStands, [owner = owner] { PostMessageA(*owner, WM_CLOSE, 0, 0); });
        command(opens);
        EXPECT_FALSE(eitherStands() || EditorDialog);
        MSG message{};
        EXPECT_FALSE(PeekMessageA(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE));
    }
}

} // namespace
