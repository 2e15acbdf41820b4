// An hour with a user who does whatever comes to his mind.
#include "tests/editor/frame_fixture.h"

#include <QApplication>
#include <QMenu>
#include <QTest>
#include <QTimer>

#include <random>

namespace {

class Hour : public FrameEditorTest {
  protected:
    /// A menu that has opened: opens, edits or plays, or lets it go.
    void chooseFromMenu() {
        if (auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget())) {
            menu->setActiveAction(menu->actions().at(pick({0, 1, 2})));
            QTest::keyClick(menu, pick({Qt::Key_Return, Qt::Key_Escape}));
        }
    }

    /// A dialog or a picker that has opened: chooses in it, or lets it go.
    void answerDialogs() {
        if (const HWND picker = FindWindowA("PoseWndClass", nullptr)) {
            PostMessageA(picker, pick({WM_KEYDOWN, WM_KEYDOWN, WM_LBUTTONUP, WM_CLOSE}),
                         pick<WPARAM>({'1', '5', '8', '9'}), 0);
        }
        const HWND settings = FindWindowA("dialog", ToonDocHeader.magic);
        if (settings && settings != EditorDialog) {
            PostMessageA(settings, WM_HSCROLL, pick<WPARAM>({SB_LINEUP, SB_LINEDOWN, SB_PAGEDOWN}),
                         0);
            PostMessageA(settings, WM_COMMAND, pick<WPARAM>({IDOK, IDCANCEL}), 0);
        }
    }

    void editAtRandom() {
        constexpr int begin = 104;
        answerGiven = pick({IDYES, IDNO, IDCANCEL});
        nameGiven = pick<std::string>({"", "new.zkt", "no/where.zkt"});
        switch (pick({0, 1, 2, 3, 3, 3, 3, 3})) {
        case 0:
            type(pick({X_FIELD, Y_FIELD, PAUSE_FIELD}), pick<std::string>({"", "0", "250", "-9"}));
            break;
        case 1:
            stepInList(pick({Qt::Key_Down, Qt::Key_Up, Qt::Key_End}));
            break;
        case 2:
            command(begin);
            if (ToonDirty == 0 && ToonFileName[0] == '\0') {
                playIsAlive(false);
            }
            break;
        default:
            command(pick(
                {105, 106, 108, 109, 110, 110, 111, 112, 113, 114, 1012, 1015, 1016, 1021, 1046}));
            break;
        }
    }

    void actAtRandom() {
        fileGiven = pick<std::string>({"", "two.zkt", "one.zkt", "still.zkt", "none.zkt", "x.zkt"});
        const int place = pick({0, 100, 250, 400, 749});
        if (EditorDialog && pick({true, true, false})) {
            editAtRandom();
            return;
        }
        switch (pick({0, 1, 2, 3, 4})) {
        case 0:
            click(place, pick({100, 300, 500}));
            break;
        case 1:
            press(pick({FileButton, PlayButton, PlayButton, WalkButton, MinimizeButton}));
            break;
        case 2:
            key(pick({KEY_FILE, KEY_PLAY, KEY_CONTINUE, KEY_STOP, KEY_OPEN, KEY_OPEN, KEY_EDIT,
                      KEY_WALK}));
            break;
        case 3:
            SendMessageA(EditorMainWindow, WM_ACTIVATE,
                         pick({WA_INACTIVE, WA_ACTIVE, WA_CLICKACTIVE}), 0);
            break;
        default:
            seam::minimise(EditorMainWindow, pick({true, false, false}));
            break;
        }
    }

    template <class Value>
    Value pick(std::initializer_list<Value> values) {
        return values.begin()[random_() % values.size()];
    }

  private:
    std::mt19937 random_{7};
};

TEST_F(Hour, IsAlwaysInOneOfTheStatesAndPassesThroughEach) {
    constexpr std::int64_t hour = 60 * 60 * 1000;
    QTimer user;
    QObject::connect(&user, &QTimer::timeout, [this] {
        chooseFromMenu();
        answerDialogs();
    });
    user.start(0);
    open();
    std::set<std::string> seen;
    int edits = 0;
    std::set<std::string> names;
    for (const EditorState& state : editorStates) {
        names.insert(state.name);
    }
    while (seam::clockNow() < hour) {
        pass(pick({0, 10, 400, 1500, 3000, 5000}));
        record.clear();
        const HWND before = EditorDialog;
        actAtRandom();
        if (EditorDialog != before && (EditorDialog || ToonFileName[0] != '\0')) {
            playIsAlive(!EditorDialog);
        }
        if (EditorDialog && ToonFileName[0] == '\0') {
            playIsAlive(false);
        }
        if (EditorDialog) {
            expectInOrder(std::to_string(seam::clockNow()));
            edits += EditorDialog != before ? 1 : 0;
        }
        const std::string state = stateNow();
        seen.insert(state);
        ASSERT_TRUE(names.contains(state)) << state << " at " << seam::clockNow();
        ASSERT_FALSE(HasFailure());
    }
    EXPECT_GT(edits, 10);
    EXPECT_EQ(seen, names);
}

} // namespace
