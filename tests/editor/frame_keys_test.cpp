// The keys while the frame editor is open, pressed on the toolkit's own windows, and what fifty
// openings of the dialogs leave behind.
#include "tests/editor/frame_fixture.h"

#include "platform/user/queue.h"
#include "platform/user/window.h"

#include <QAbstractItemView>
#include <QApplication>
#include <QWheelEvent>

#include <malloc.h>

namespace {

/// The control that has the focus, by its number; 0 for none of the frame editor's.
int focused() {
    int found = 0;
    seam::forEachWindow([&](const seam::Window& window) {
        const bool has = window.control && window.parent == EditorDialog &&
                         &seam::widgetOf(window) == QApplication::focusWidget();
        found = has ? window.id : found;
    });
    return found;
}

bool configurationStands() {
    return FindWindowA("dialog", ToonMagic) != HWND{};
}

HWND picker() {
    return FindWindowA("PoseWndClass", nullptr);
}

class FrameKeys : public FrameEditorTest {
  protected:
    using Step = std::function<bool()>; // false: not yet

    static void inTurn(std::vector<Step> steps) {
        if (!steps.empty()) {
            if (steps.front()()) {
                steps.erase(steps.begin());
            }
            QTimer::singleShot(10, [steps] { inTurn(steps); });
        }
    }

    /// Runs the editor in its own loop with the frame editor over a Toon, and does the steps.
    static void run(std::vector<Step> steps) {
        steps.insert(steps.begin(), [] {
            fileGiven = "two.zkt";
            PostMessageA(EditorMainWindow, WM_COMMAND, KEY_OPEN, 0);
            PostMessageA(EditorMainWindow, WM_COMMAND, KEY_EDIT, 0);
            return true;
        });
        steps.emplace_back([] { return PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0) != FALSE; });
        once(editorStands, [steps] { inTurn(steps); });
        RunEditor(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL);
    }

    static std::string effect() {
        if (!EditorDialog) {
            return "closes";
        }
        if (configurationStands()) {
            PostMessageA(FindWindowA("dialog", ToonMagic), WM_COMMAND, IDCANCEL, 0);
            return "configures";
        }
        return QApplication::activePopupWidget() != nullptr ? "menu"
               : filesAsked != 0                            ? "asks"
               : count("play_button") != 0                  ? "plays"
               : count("random_walk_refused")               ? "walks"
               : focused() != WINK_CHECK                    ? "to " + std::to_string(focused())
                                                            : "";
    }
};

TEST_F(FrameKeys, AreTheFrameEditorsWhereverTheFocusIs) {
    const std::tuple<Qt::Key, Qt::KeyboardModifier, const char*> cases[] = {
        {Qt::Key_C, Qt::AltModifier, ""},
        {Qt::Key_E, Qt::ControlModifier, "closes"},
        {Qt::Key_E, Qt::AltModifier, "to 1016"},
        {Qt::Key_F, Qt::AltModifier, ""},
        {Qt::Key_G, Qt::ControlModifier, "configures"},
        {Qt::Key_O, Qt::ControlModifier, "asks"},
        {Qt::Key_P, Qt::AltModifier, ""},
        {Qt::Key_S, Qt::ControlModifier, "asks"},
        {Qt::Key_S, Qt::AltModifier, "to 1020"},
        {Qt::Key_T, Qt::AltModifier, "to 1017"},
        {Qt::Key_W, Qt::AltModifier, ""},
        {Qt::Key_X, Qt::AltModifier, "to 1018"},
        {Qt::Key_Y, Qt::AltModifier, "to 1019"},
    };
    for (const auto& [code, held, expected] : cases) {
        for (const bool inside : {true, false}) {
            std::string found;
            const auto focus = [inside] {
                if (!EditorDialog) {
                    return false; // the Toon is still being opened
                }
                ToonFileName[0] = '\0'; // for Save to ask for one
                CopyText(ToonDocHeader.magic, ToonMagic, sizeof ToonMagic);
                fileGiven = "";
                filesAsked = 0;
                SetFocus(inside ? GetDlgItem(EditorDialog, WINK_CHECK) : FileButton);
                return focused() == (inside ? int{WINK_CHECK} : 0);
            };
            const auto press = [code = code, held = held] {
                record.clear();
                QTest::sendKeyEvent(QTest::Click, QApplication::focusWindow(), code, '\0', held);
                return true;
            };
            const auto look = [&found] {
                found = effect();
                return true;
            };
            run({focus, press, [] { return true; }, look});
            const std::string stays = inside ? "" : "to 0";
            EXPECT_EQ(found, *expected == '\0' ? stays : expected)
                << code << " with the focus " << (inside ? "inside" : "outside");
        }
    }
}

TEST_F(FrameKeys, EnterAndEscapeDoNothingInItsFields) {
    edit("two.zkt");
    for (const int id : {FRAME_LIST, X_FIELD, Y_FIELD, PAUSE_FIELD, WINK_CHECK}) {
        for (const Qt::Key code : {Qt::Key_Return, Qt::Key_Enter, Qt::Key_Escape}) {
            field(id).setFocus();
            QTest::keyClick(&field(id), code);
            pass(0);
            EXPECT_TRUE(EditorDialog) << id;
            EXPECT_EQ(ToonDirty, 0U) << id;
        }
    }
}

TEST_F(FrameKeys, AndTheWheelWalkThroughTheListOfFrames) {
    const std::pair<Qt::Key, LONG> cases[] = {
        {Qt::Key_Down, 7}, {Qt::Key_PageDown, 7}, {Qt::Key_Up, 5}, {Qt::Key_PageUp, 5},
        {Qt::Key_Home, 0}, {Qt::Key_End, 29},     {Qt::Key_2, 19}, // the next one that begins so
    };
    editFrames(30);
    for (const auto& [code, then] : cases) {
        select(6);
        stepInList(code);
        EXPECT_EQ(CurrentFrameIndex, then) << code;
        EXPECT_EQ(shown(X_FIELD), std::to_string(then + 1)) << code;
    }
    select(6);
    QWheelEvent notch({}, {}, {}, {0, -120}, Qt::NoButton, Qt::NoModifier, Qt::NoScrollPhase,
                      false);
    QCoreApplication::sendEvent(&field(FRAME_LIST), &notch);
    pass(0);
    EXPECT_EQ(CurrentFrameIndex, 7);
    auto& list = static_cast<QComboBox&>(field(FRAME_LIST));
    stepInList(Qt::Key_F4);
    ASSERT_TRUE(list.view()->isVisible());
    QTest::keyClick(list.view(), Qt::Key_Down);
    QTest::keyClick(list.view(), Qt::Key_Escape);
    pass(0);
    EXPECT_FALSE(list.view()->isVisible());
    EXPECT_EQ(CurrentFrameIndex, 7) << "it closes without a choice";
}

TEST_F(FrameKeys, F10OpensTheFirstMenuWithItsFirstItemMarked) {
    edit("two.zkt");
    QTest::keyClick(&field(X_FIELD), Qt::Key_F10);
    QWidget* const menu = QApplication::activePopupWidget();
    ASSERT_NE(menu, nullptr);
    QTest::keyClick(menu, Qt::Key_Return);
    pass(0);
    EXPECT_EQ(title(), "File: [Untitled]") << "New";
}

TEST_F(FrameKeys, OfTwoCommandsAtOnceADialogOfTheFirstDropsTheSecond) {
    struct Case {
        int first, second;
        const char* outcome; // frames, dialogs that came up, questions
    };

    const Case cases[] = {
        {ITEM_NEW_FRAME, ITEM_NEW_FRAME, "4 0 0"}, {ITEM_DELETE_FRAME, ITEM_NEW_FRAME, "2 0 0"},
        {ITEM_CONFIGURE, ITEM_CONFIGURE, "2 1 0"}, {ITEM_CONFIGURE, ITEM_NEW_FRAME, "2 1 0"},
        {ITEM_CONFIGURE, ITEM_EXIT, "2 1 0"},      {ITEM_NEW_FRAME, ITEM_CONFIGURE, "3 1 0"},
        {POSE_BUTTON, POSE_BUTTON, "2 1 0"},       {ITEM_EXIT, ITEM_EXIT, "closed 0 1"},
        {ITEM_EXIT, ITEM_CONFIGURE, "closed 0 1"},
    };
    std::set<DWORD> stood;
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, [&stood] {
        if (seam::messagesWait()) {
            return; // the second command first
        }
        seam::forEachWindow([&stood](const seam::Window& window) {
            if (window.handle == picker() || (window.dialog && window.handle != EditorDialog)) {
                stood.insert(window.handle.number);
                SendMessageA(window.handle, window.dialog ? WM_COMMAND : WM_CLOSE, IDCANCEL, 0);
            }
        });
    });
    for (const auto& [first, second, outcome] : cases) {
        edit("two.zkt");
        ToonSetDirty(EditorDialog, first == ITEM_EXIT ? 1 : 0);
        answerGiven = IDNO;
        stood.clear();
        timer.start(5);
        PostMessageA(EditorDialog, WM_COMMAND, static_cast<WPARAM>(first), 0);
        command(second);
        timer.stop();
        const std::string frames = EditorDialog ? std::to_string(FrameCount) : "closed";
        EXPECT_EQ(frames + ' ' + std::to_string(stood.size()) + ' ' + std::to_string(boxes.size()),
                  outcome)
            << first << ", " << second;
    }
}

TEST_F(FrameKeys, FiftyOpeningsLeaveNothingBehind) {
    constexpr std::size_t rounds = 50;
    constexpr std::size_t noArrow = 2000; // bytes a round, as the toolkit's heap settles
    constexpr std::size_t warmUp = 30;
    openAtRest();
    seam::HandleCounts handles{};
    std::size_t heap = 0;
    for (std::size_t i = 0; i < warmUp + rounds; ++i) {
        handles = i == warmUp ? seam::liveHandles() : handles;
        heap = i == warmUp ? mallinfo2().uordblks : heap;
        key(KEY_EDIT);
        once([] { return picker() != HWND{}; }, [] { SendMessageA(picker(), WM_KEYDOWN, '4', 0); });
        command(POSE_BUTTON);
        once(configurationStands,
             [] { PostMessageA(FindWindowA("dialog", ToonMagic), WM_COMMAND, IDOK, 0); });
        command(ITEM_CONFIGURE);
        answerGiven = IDNO;
        key(KEY_EDIT);
        EXPECT_FALSE(EditorDialog);
        record.clear();
        boxes.clear();
    }
    EXPECT_EQ(seam::liveHandles(), handles);
    EXPECT_LT(mallinfo2().uordblks, heap + rounds * noArrow);
}

} // namespace
