// The configuration of a Toon: what the dialog shows, takes and drops.
#include "tests/editor/frame_fixture.h"

#include "editor/configuration.h"

#include <QScrollBar>
#include <QStyle>
#include <QStyleOptionSlider>

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

    static void answerWith(int button) {
        QTest::mouseClick(&part(button), Qt::LeftButton);
    }

    /// Opens it, acts in it and leaves it by OK or Cancel.
    static void configure(const std::function<void()>& act, int button) {
        ToonSetDirty(EditorDialog, 0);
        record.clear();
        once([] { return dialog() != HWND{}; },
             [&act, button] {
                 act();
                 QTimer::singleShot(0, [button] { answerWith(button); });
             });
        command(ITEM_CONFIGURE);
        EXPECT_FALSE(dialog());
        EXPECT_EQ(count("rebuild_backdrop"), 1U);
        EXPECT_EQ(saveIsGrey(), button == IDCANCEL);
    }

    static std::string settings() {
        return std::to_string(ToonDocHeader.background) + ' ' +
               std::to_string(ToonDocHeader.speed) + ' ' + ToonDocHeader.caption;
    }

    static std::string inForce() {
        return std::to_string(BackgroundIndex) + ' ' + std::to_string(ToonSpeed) + ' ' +
               CaptionText;
    }
};

TEST_F(Configuration, ShowsTheToonAndTakesItBackAsItIs) {
    struct Case {
        LONG background, speed, listed, shown, back; // -1: none is selected
    };

    const Case cases[] = {
        {3, 5, 2, 5, 3},
        {1, 1, 0, 1, 1},
        {10, 3, 9, 3, 10},
        {0, 0, -1, 1, 0},
        {11, 6, -1, 5, 0},
        {-7, -1, -1, 1, 0},
        {INT32_MAX, INT32_MAX, -1, 5, 0},
        {INT32_MIN, INT32_MIN, -1, 1, 0},
    };
    std::strcpy(ToonDocHeader.magic, "Any title");
    for (const auto& [background, speed, listed, shownSpeed, back] : cases) {
        for (const int button : {IDCANCEL, IDOK}) {
            ToonDocHeader.background = BackgroundIndex = background;
            ToonDocHeader.speed = ToonSpeed = speed;
            const std::string before = settings();
            configure(
                [&, listed = listed, shownSpeed = shownSpeed] {
                    EXPECT_EQ(tell(CB_GETCURSEL), listed) << before;
                    EXPECT_EQ(tell(CB_GETCOUNT), 10);
                    EXPECT_EQ(GetScrollPos(GetDlgItem(dialog(), SPEED_BAR), SB_CTL), shownSpeed);
                    EXPECT_EQ(text(1024) + 'x' + text(1025) + ' ' + text(1029) + ' ' + text(1031),
                              "1500x1400 2 1.2");
                },
                button);
            const bool taken = button == IDOK;
            EXPECT_EQ(settings(),
                      taken ? std::to_string(back) + ' ' + std::to_string(shownSpeed) + ' '
                            : before);
            EXPECT_EQ(inForce(), settings());
        }
    }
}

TEST_F(Configuration, ACaptionIsTypedWith49CharactersAndTakenWith48) {
    for (const std::size_t typed : {0U, 1U, 48U, 49U, 60U}) {
        configure(
            [typed] {
                QTest::keyClick(&part(CAPTION_FIELD), Qt::Key_A, Qt::ControlModifier);
                QTest::keyClick(&part(CAPTION_FIELD), Qt::Key_Delete);
                QTest::keyClicks(&part(CAPTION_FIELD),
                                 QString(static_cast<int>(typed), QLatin1Char('c')));
                EXPECT_EQ(text(CAPTION_FIELD).size(), std::min<std::size_t>(typed, 49));
            },
            IDOK);
        EXPECT_EQ(CaptionText, std::string(std::min<std::size_t>(typed, 48), 'c'));
        EXPECT_STREQ(ToonDocHeader.caption, CaptionText);
    }
}

TEST_F(Configuration, ArrowsAndTroughMoveTheSpeedByOneAndTheThumbDoesNot) {
    struct Case {
        LONG speed;
        WORD code;
        LONG then;
    };

    const Case cases[] = {
        {3, SB_LINEUP, 2}, {3, SB_PAGEUP, 2},     {3, SB_LINEDOWN, 4}, {3, SB_PAGEDOWN, 4},
        {1, SB_LINEUP, 1}, {1, SB_PAGEUP, 1},     {5, SB_LINEDOWN, 5}, {5, SB_PAGEDOWN, 5},
        {3, 4, 3},         {3, SB_THUMBTRACK, 3}, {3, 6, 3},           {3, 8, 3},
    };
    for (const auto& [speed, code, then] : cases) {
        ToonDocHeader.speed = speed;
        configure([code = code] { SendMessageA(dialog(), WM_HSCROLL, code, 0); }, IDOK);
        EXPECT_EQ(ToonSpeed, then) << speed << " by " << code;
    }
    const std::tuple<QStyle::SubControl, int, LONG> places[] = {
        {QStyle::SC_ScrollBarSubLine, 0, 2}, {QStyle::SC_ScrollBarAddLine, 0, 4},
        {QStyle::SC_ScrollBarSubPage, 0, 2}, {QStyle::SC_ScrollBarAddPage, 0, 4},
        {QStyle::SC_ScrollBarSlider, 60, 3},
    };
    for (const auto& [where, drag, then] : places) {
        ToonDocHeader.speed = 3;
        configure(
            [where = where, drag = drag] {
                auto& bar = static_cast<QScrollBar&>(part(SPEED_BAR));
                QStyleOptionSlider option;
                option.initFrom(&bar);
                option.subControls = QStyle::SC_All;
                option.orientation = Qt::Horizontal;
                option.minimum = bar.minimum();
                option.maximum = bar.maximum();
                option.sliderPosition = option.sliderValue = bar.value();
                option.pageStep = bar.pageStep();
                option.state |= QStyle::State_Horizontal;
                const QPoint at = bar.style()
                                      ->subControlRect(QStyle::CC_ScrollBar, &option, where, &bar)
                                      .center();
                QTest::mousePress(&bar, Qt::LeftButton, {}, at);
                QTest::mouseMove(&bar, at + QPoint(drag, 0));
                QTest::mouseRelease(&bar, Qt::LeftButton, {}, at + QPoint(drag, 0));
            },
            IDOK);
        EXPECT_EQ(ToonSpeed, then) << "a press on part " << where;
    }
}

TEST_F(Configuration, ATileIsChosenFromTheListAndShowsAtOnce) {
    configure(
        [] {
            auto& list = static_cast<QComboBox&>(part(BACKGROUND_LIST));
            QTest::keyClick(&list, Qt::Key_End);
        },
        IDOK);
    EXPECT_EQ(inForce(), "10 5 ");
    EXPECT_EQ(events({"rebuild_backdrop"}).back(), "rebuild_backdrop index=10 tile=bg10");
}

TEST_F(Configuration, GoesWithTheEditorAndItsPicturesWithIt) {
    once([] { return dialog() != HWND{}; }, [] { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); });
    command(ITEM_CONFIGURE);
    EXPECT_FALSE(EditorMainWindow);
}

} // namespace
