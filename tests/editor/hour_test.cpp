// An hour with a user who does whatever comes to his mind.
#include "tests/editor/editor_fixture.h"

#include <QApplication>
#include <QMenu>
#include <QTest>
#include <QTimer>

#include <random>

namespace {

class Hour : public EditorTest {
  protected:
    /// A menu that has opened: opens, edits or plays, or lets it go.
    void chooseFromMenu() {
        if (auto* menu = qobject_cast<QMenu*>(QApplication::activePopupWidget())) {
            menu->setActiveAction(menu->actions().at(pick({0, 1, 2})));
            QTest::keyClick(menu, pick({Qt::Key_Return, Qt::Key_Escape}));
        }
    }

    void actAtRandom() {
        fileGiven = pick<std::string>({"", "two.zkt", "one.zkt", "still.zkt", "none.zkt", "x.zkt"});
        const int place = pick({0, 100, 250, 400, 749});
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
    QObject::connect(&user, &QTimer::timeout, [this] { chooseFromMenu(); });
    user.start(0);
    open();
    std::set<std::string> seen;
    std::set<std::string> names;
    for (const EditorState& state : editorStates) {
        names.insert(state.name);
    }
    while (seam::clockNow() < hour) {
        pass(pick({0, 10, 400, 1500, 3000, 5000}));
        record.clear();
        actAtRandom();
        const std::string state = stateNow();
        seen.insert(state);
        ASSERT_TRUE(names.contains(state)) << state << " at " << seam::clockNow();
    }
    EXPECT_EQ(seen, names);
}

} // namespace
