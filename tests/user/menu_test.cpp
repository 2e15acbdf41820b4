// Menus that open: what they show and choose, and what goes on behind them.
#include "platform/menus.h"
#include "tests/user/test_window.h"

#include <QMenu>
#include <QTest>

#include <stdexcept>

namespace {

using test::handlers;
using test::whenUp;

class Menus : public test::WindowTest {
  protected:
    void SetUp() override {
        WindowTest::SetUp();
        seam::useSystemClock(); // the toolkit's own loop runs behind a menu
        menu = CreatePopupMenu();
        AppendMenuA(menu, MF_STRING, 11, "&Open\tCtrl+O");
        AppendMenuA(menu, MF_SEPARATOR, 0, nullptr);
        AppendMenuA(menu, MF_STRING | MF_GRAYED, 12, "&Save");
        AppendMenuA(menu, MF_STRING, 13, "Caf\xE9 \x80");
        handlers[WM_COMMAND] = [](HWND, WPARAM, LPARAM) { return 0; };
    }

    void TearDown() override {
        DestroyMenu(menu);
        WindowTest::TearDown();
    }

    BOOL track() const {
        return TrackPopupMenu(menu, 0, 30, 40, 0, window, nullptr);
    }

    /// The ids that arrive at the window.
    static std::vector<WPARAM> chosen() {
        test::seen.clear();
        test::handleWaiting();
        std::vector<WPARAM> ids;
        for (const test::Seen& one : test::seen) {
            if (one.message == WM_COMMAND && one.lParam == 0) {
                ids.push_back(one.wParam);
            }
        }
        return ids;
    }

    HMENU menu;
};

TEST_F(Menus, TellTheWindowWhatTheKeysHaveChosen) {
    EXPECT_EQ(GetMenuItemCount(menu), 4);
    EXPECT_EQ(static_cast<UINT>(EnableMenuItem(menu, 12, MF_GRAYED)), MF_GRAYED);
    EXPECT_EQ(EnableMenuItem(menu, 99, MF_GRAYED), -1);

    const struct {
        std::vector<Qt::Key> keys;
        UINT save;
        std::vector<WPARAM> chosen;
    } cases[] = {{{Qt::Key_O}, MF_GRAYED, {11}},
                 {{Qt::Key_S, Qt::Key_Escape}, MF_GRAYED, {}},
                 {{Qt::Key_S}, MF_ENABLED, {12}},
                 {{Qt::Key_Up, Qt::Key_Return}, MF_GRAYED, {13}}};

    for (const auto& one : cases) {
        EnableMenuItem(menu, 12, one.save);
        whenUp<QMenu>([&](QMenu& open) {
            EXPECT_EQ(open.pos(), QPoint(30, 40));
            EXPECT_EQ(open.actions().at(3)->text(), QStringLiteral("Caf\u00E9 \u20AC"));
            EXPECT_FALSE(TrackPopupMenu(menu, 0, 0, 0, 0, window, nullptr)) << "one at a time";
            for (const Qt::Key key : one.keys) {
                QTest::keyClick(&open, key);
            }
        });
        EXPECT_TRUE(track());
        EXPECT_EQ(chosen(), one.chosen);
        EXPECT_TRUE(test::seenAmong({WM_ACTIVATE, WM_KILLFOCUS}).empty());
    }
}

TEST_F(Menus, GoWithTheirWindowWithTheirHandleWithAQuitAndWithAnException) {
    const HWND other = test::makeWindow();
    test::onTimer(window, [] { throw std::runtime_error("fault"); });
    EXPECT_THROW(track(), std::runtime_error);
    const std::function<void()> endings[] = {[&] { DestroyMenu(menu); }, [] { PostQuitMessage(5); },
                                             [&] { DestroyWindow(window); }};
    for (const auto& ending : endings) {
        menu = GetMenuItemCount(menu) < 0 ? CreatePopupMenu() : menu;
        AppendMenuA(menu, MF_STRING, 1, "Item");
        test::onTimer(other, ending);
        EXPECT_TRUE(track());
        EXPECT_EQ(QApplication::activePopupWidget(), nullptr);
        EXPECT_TRUE(chosen().empty());
    }
    EXPECT_FALSE(track()) << "the window has gone";
    DestroyWindow(other);
}

} // namespace
