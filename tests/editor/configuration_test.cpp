// The configuration of a Toon: what the dialog shows, takes and drops.
#include "tests/editor/frame_fixture.h"

#include "editor/configuration.h"

namespace {

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

    static QWidget& part(int id) {
        return widgetOf(GetDlgItem(dialog(), id));
    }

    static std::string text(int id) {
        char found[100];
        GetDlgItemTextA(dialog(), id, found, sizeof found);
        return found;
    }

    static LRESULT tell(UINT message) {
        return SendDlgItemMessageA(dialog(), BACKGROUND_LIST, message, 0, 0);
    }

    /// Opens it, acts in it and leaves it by OK or Cancel.
    static void configure(const std::function<void()>& act, int button) {
        ToonSetDirty(EditorDialog, 0);
        record.clear();
        once([] { return dialog() != HWND{}; },
             [&act, button] {
                 act();
                 PostMessageA(dialog(), WM_COMMAND, static_cast<WPARAM>(button), 0);
             });
        command(ITEM_CONFIGURE);
        EXPECT_FALSE(dialog());
        EXPECT_EQ(count("rebuild_backdrop"), 1U);
        EXPECT_EQ(saveIsGrey(), button == IDCANCEL);
    }

    static std::string pair(LONG background, LONG speed) {
        return std::to_string(background) + ' ' + std::to_string(speed);
    }

    /// What the labels, the list and the bar show.
    static std::string shownThere() {
        return text(1024) + 'x' + text(1025) + ' ' + text(1029) + ' ' + text(1031) + " of " +
               std::to_string(tell(CB_GETCOUNT)) + ": " +
               pair(static_cast<LONG>(tell(CB_GETCURSEL)),
                    GetScrollPos(GetDlgItem(dialog(), SPEED_BAR), SB_CTL));
    }
};

TEST_F(Configuration, ShowsTheToonAndTakesItBackAsItIs) {
    const std::tuple<LONG, LONG, LONG, LONG, LONG> cases[] = {
        {3, 5, 2, 5, 3},
        {10, 3, 9, 3, 10},
        {0, 0, -1, 1, 0}, // none is selected
        {11, 6, -1, 5, 0},
        {INT32_MAX, INT32_MAX, -1, 5, 0},
        {INT32_MIN, INT32_MIN, -1, 1, 0},
    };
    std::strcpy(ToonDocHeader.magic, "Any title");
    for (const auto& [background, speed, listed, shownSpeed, back] : cases) {
        for (const int button : {IDCANCEL, IDOK}) {
            ToonDocHeader.background = BackgroundIndex = background;
            ToonDocHeader.speed = ToonSpeed = speed;
            std::string found;
            configure([&] { found = shownThere(); }, button);
            EXPECT_EQ(found, "1500x1400 2 1.2 of 10: " + pair(listed, shownSpeed));
            const std::string then =
                button == IDOK ? pair(back, shownSpeed) : pair(background, speed);
            EXPECT_EQ(pair(ToonDocHeader.background, ToonDocHeader.speed), then);
            EXPECT_EQ(pair(BackgroundIndex, ToonSpeed), then);
        }
    }
}

TEST_F(Configuration, ACaptionIsTypedWith49CharactersAndTakenWith48) {
    for (const int typed : {60, 0}) {
        configure(
            [typed] {
                QTest::keyClick(&part(CAPTION_FIELD), Qt::Key_A, Qt::ControlModifier);
                QTest::keyClick(&part(CAPTION_FIELD), Qt::Key_Delete);
                QTest::keyClicks(&part(CAPTION_FIELD), QString(typed, QLatin1Char('c')));
                EXPECT_EQ(text(CAPTION_FIELD).size(), typed == 0 ? 0U : 49U);
            },
            IDOK);
        EXPECT_EQ(CaptionText, std::string(typed == 0 ? 0 : 48, 'c'));
        EXPECT_STREQ(ToonDocHeader.caption, CaptionText);
    }
}

TEST_F(Configuration, ArrowsAndTroughMoveTheSpeedByOneAndTheThumbDoesNot) {
    const std::tuple<LONG, WORD, LONG> cases[] = {
        {3, SB_LINEUP, 2}, {3, SB_PAGEUP, 2}, {3, SB_LINEDOWN, 4},   {3, SB_PAGEDOWN, 4},
        {1, SB_LINEUP, 1}, {1, SB_PAGEUP, 1}, {5, SB_LINEDOWN, 5},   {5, SB_PAGEDOWN, 5},
        {3, 4, 3},         {3, 6, 3},         {3, SB_THUMBTRACK, 3}, {3, 8, 3},
    };
    for (const auto& [speed, code, then] : cases) {
        ToonDocHeader.speed = speed;
        configure([code = code] { SendMessageA(dialog(), WM_HSCROLL, code, 0); }, IDOK);
        EXPECT_EQ(ToonSpeed, then) << speed << " by " << code;
    }
}

TEST_F(Configuration, ATileIsChosenFromTheListAndShowsAtOnce) {
    configure([] { QTest::keyClick(&part(BACKGROUND_LIST), Qt::Key_End); }, IDOK);
    EXPECT_EQ(pair(BackgroundIndex, ToonSpeed), "10 5");
    EXPECT_EQ(events({"rebuild_backdrop"}).back(), "rebuild_backdrop index=10 tile=bg10");
}

TEST_F(Configuration, GoesWithTheEditorAndItsPicturesWithIt) {
    once([] { return dialog() != HWND{}; }, [] { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); });
    command(ITEM_CONFIGURE);
    EXPECT_FALSE(EditorMainWindow);
}

} // namespace
