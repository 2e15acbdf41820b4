// The keys and the menu of the main window, pressed on the toolkit's own windows.
#include "tests/editor/editor_fixture.h"

#include <QApplication>
#include <QDialog>
#include <QMenu>
#include <QTest>
#include <QTimer>

namespace {

class Keys : public EditorTest {
  protected:
    static QMenu* openMenu() {
        return qobject_cast<QMenu*>(QApplication::activePopupWidget());
    }

    static bool dialogStands() {
        return qobject_cast<QDialog*>(QApplication::activeWindow()) != nullptr;
    }

    static bool hasKeyboard() {
        return editorStands() && QApplication::focusWindow() != nullptr;
    }

    static void typeOpen() {
        QTest::sendKeyEvent(QTest::Click, QApplication::focusWindow(), Qt::Key_O, '\0',
                            Qt::ControlModifier);
    }
};

TEST_F(Keys, ReachTheEditorWhereverTheFocusIsButNotBehindADialog) {
    once(hasKeyboard, typeOpen);
    once([] { return filesAsked == 1; },
         [] {
             SetFocus(FileButton);
             typeOpen();
         });
    once([] { return filesAsked == 2; },
         [] {
             PostMessageA(EditorMainWindow, WM_COMMAND, POPUP_ABOUT, 0);
             once(dialogStands, [] {
                 typeOpen();
                 QTimer::singleShot(50, [] { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); });
             });
         });
    RunEditor(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL);
    EXPECT_EQ(filesAsked, 2);
}

TEST_F(Keys, TheMenuStandsAboveTheFileButtonAndGreysWhatCantBeChosen) {
    for (const bool toonIsOpen : {false, true}) {
        openAtRest();
        if (toonIsOpen) {
            openToon("two.zkt");
        }
        std::string shown;
        once([] { return openMenu() != nullptr; },
             [&] {
                 for (const QAction* item : openMenu()->actions()) {
                     shown += item->isSeparator() ? "-" : item->isEnabled() ? "o" : ".";
                 }
                 EXPECT_EQ(openMenu()->x(), 14 + 11);
                 EXPECT_GE(783 - 44 - openMenu()->y(), 6 * 12);
                 openMenu()->setActiveAction(openMenu()->actions().first());
                 QTest::keyClick(openMenu(), Qt::Key_Return);
             });
        const int before = filesAsked;
        toonIsOpen ? key(KEY_FILE) : press(FileButton);
        EXPECT_EQ(shown, toonIsOpen ? "ooo-oo" : "oo.-oo");
        EXPECT_EQ(filesAsked, before + 1);
        close();
    }
}

} // namespace
