// Dialogs from templates: what their controls tell of the user, and take from the program.
#include "platform/dialogs.h"
#include "platform/user/dialog_template.h"
#include "tests/user/test_window.h"

#include <QAbstractButton>
#include <QAccessible>
#include <QApplication>
#include <QComboBox>
#include <QDialog>
#include <QLineEdit>
#include <QListView>
#include <QPlainTextEdit>
#include <QScrollBar>
#include <QShortcutEvent>
#include <QTest>
#include <QTimer>

namespace {

constexpr int itemHeight = 17;

using Command = std::pair<int, WORD>; // the control and what it tells

std::vector<Command> commands;
std::vector<WORD> scrolls;
std::vector<DRAWITEMSTRUCT> drawn;

LRESULT dialogProc(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam) {
    const auto word = static_cast<DWORD>(wParam);
    switch (message) {
    case WM_INITDIALOG:
        return 1;
    case WM_COMMAND:
        commands.emplace_back(LOWORD(word), HIWORD(word));
        if (LOWORD(word) == IDOK || LOWORD(word) == IDCANCEL) {
            EndDialog(dialog, 40 + LOWORD(word));
        }
        return 1;
    case WM_HSCROLL:
        scrolls.push_back(LOWORD(word));
        return 0;
    case WM_MEASUREITEM:
        reinterpret_cast<MEASUREITEMSTRUCT*>(lParam)->itemHeight = itemHeight;
        return 0;
    case WM_DRAWITEM: {
        const auto& item = *reinterpret_cast<const DRAWITEMSTRUCT*>(lParam);
        drawn.push_back(item);
        FillRect(item.hDC, &item.rcItem, HBRUSH{GetStockObject(BLACK_BRUSH)});
        return 0;
    }
    default:
        return 0;
    }
}

class Dialogs : public test::WindowTest {
  protected:
    void SetUp() override {
        WindowTest::SetUp();
        dialog = CreateDialogParamA(nullptr, "controls", window, dialogProc, 0);
        ShowWindow(dialog, SW_SHOWNORMAL);
        test::handleWaiting();
        widget = qobject_cast<QDialog*>(QApplication::activeWindow());
        ASSERT_NE(widget, nullptr);
        commands.clear();
        scrolls.clear();
        drawn.clear();
    }

    void TearDown() override {
        DestroyWindow(dialog);
        WindowTest::TearDown();
    }

    template <class Widget>
    Widget& child() const {
        return *widget->findChild<Widget*>(QString(), Qt::FindDirectChildrenOnly);
    }

    QAbstractButton& button(const char* text) const {
        for (auto* one : widget->findChildren<QAbstractButton*>()) {
            if (one->text() == QLatin1String(text)) {
                return *one;
            }
        }
        throw std::runtime_error(text);
    }

    void type(QWidget& where, const QString& text) const {
        for (const QChar letter : text) {
            const bool enter = letter == QLatin1Char('\n');
            QKeyEvent event(QEvent::KeyPress, enter ? Qt::Key_Return : Qt::Key_A, Qt::NoModifier,
                            enter ? QStringLiteral("\r") : QString(letter));
            QCoreApplication::sendEvent(&where, &event);
        }
        test::handleWaiting();
    }

    std::string text(int id) const {
        char buffer[200];
        GetDlgItemTextA(dialog, id, buffer, sizeof buffer);
        return static_cast<const char*>(buffer);
    }

    HWND dialog;
    QDialog* widget;
};

} // namespace

TEST(DialogTemplates, AreReadOrRefusedAsAWhole) {
    const auto read = seam::parseDialogTemplate(
        "# remark\ndialog \"a \\\"b\\\"\" 4 8 90 153 popup\n"
        "font 8 \"MS Sans Serif\"\nmenu \"&File\"\nitem 104 \"&New\\tCtrl+N\"\n"
        "separator\n"
        "-1 static \"x\\ry\" 1 1 30 45 group center\n");
    ASSERT_TRUE(read);
    EXPECT_EQ(read->title, "a \"b\"");
    EXPECT_EQ(read->place.width, 135);
    EXPECT_EQ(read->place.height, 249);
    EXPECT_EQ(read->fontHeight, 11);
    ASSERT_EQ(read->menus.size(), 1U);
    ASSERT_EQ(read->menus[0].items.size(), 2U);
    EXPECT_EQ(read->menus[0].items[0].text, "&New\tCtrl+N");
    ASSERT_EQ(read->controls.size(), 1U);
    EXPECT_EQ(read->controls[0].text, "x\ry");
    EXPECT_EQ(read->controls[0].place.left, 2); // a half is rounded up
    EXPECT_EQ(read->controls[0].style, WS_CHILD | WS_VISIBLE | WS_GROUP | SS_CENTER);

    for (const char* wrong :
         {"dialog \"a 0 0 1 1", "dialog \"a\" 0 0 1", "1 button \"\" 0 0 1 x",
          "1 button \"\" 0 0 1 1 shiny", "font big \"a\"", "menu 1", "item 1 \"a\""}) {
        EXPECT_FALSE(seam::parseDialogTemplate(wrong)) << wrong;
    }
}

TEST_F(Dialogs, TellOfWhatTheUserDoesAndNotOfWhatTheProgramDoes) {
    CheckDlgButton(dialog, 15, 1);
    CheckDlgButton(dialog, 17, 1);
    SendDlgItemMessageA(dialog, 12, CB_ADDSTRING, 0, reinterpret_cast<LPARAM>("one"));
    SendDlgItemMessageA(dialog, 12, CB_SETCURSEL, 0, 0);
    SendDlgItemMessageA(dialog, 18, LB_ADDSTRING, 0, reinterpret_cast<LPARAM>("x"));
    SendDlgItemMessageA(dialog, 18, LB_SETCURSEL, 0, 0);
    SetDlgItemTextA(dialog, 10, "text");
    test::handleWaiting();
    EXPECT_TRUE(commands.empty());

    button("&Right").click();
    button("&Tick").click();
    type(child<QListView>(), QStringLiteral(" "));
    Q_EMIT child<QComboBox>().activated(0);
    test::handleWaiting();
    EXPECT_EQ(IsDlgButtonChecked(dialog, 15), 0U); // of a group only one
    EXPECT_EQ(IsDlgButtonChecked(dialog, 16), 1U);
    EXPECT_EQ(IsDlgButtonChecked(dialog, 17), 0U);
    test::press(&child<QListView>(), Qt::Key_Space);
    test::handleWaiting();
    EXPECT_EQ(commands,
              (std::vector<Command>{
                  {16, BN_CLICKED}, {17, BN_CLICKED}, {12, CBN_SELCHANGE}, {18, LBN_DBLCLK}}));

    commands.clear();
    QWidget* const rows = child<QListView>().viewport();
    QTest::mouseClick(rows, Qt::LeftButton, {}, {9, 9});
    QTest::mouseDClick(rows, Qt::LeftButton, {}, {9, 9});
    test::handleWaiting();
    EXPECT_EQ(commands, (std::vector<Command>{{18, LBN_SELCHANGE}, {18, LBN_DBLCLK}}));

    commands.clear();
    QShortcutEvent letter(QKeySequence(QStringLiteral("Alt+T")), 0);
    QCoreApplication::sendEvent(&button("&Tick"), &letter);
    test::handleWaiting();
    EXPECT_EQ(commands, (std::vector<Command>{{17, BN_CLICKED}})) << "at once";
}

TEST_F(Dialogs, HoldWhatIsTypedToItsLimitAndGiveItAsBytes) {
    SendDlgItemMessageA(dialog, 10, EM_LIMITTEXT, 4, 0);
    type(child<QLineEdit>(), QStringLiteral("\u20ACa\u4E00bcd"));
    EXPECT_EQ(text(10), "\x80"
                        "a?b");
    EXPECT_EQ(child<QLineEdit>().text(), QStringLiteral("\u20ACa?b")) << "what is kept shows";
    child<QLineEdit>().setSelection(0, 3);
    child<QLineEdit>().insert(QStringLiteral("\U0001F600")); // one character, though two units
    EXPECT_EQ(child<QLineEdit>().text(), QStringLiteral("?b"));
    EXPECT_EQ(child<QLineEdit>().cursorPosition(), 1);
    SetDlgItemTextA(dialog, 10, "longer"); // the program may
    EXPECT_EQ(text(10), "longer");
    SendDlgItemMessageA(dialog, 11, EM_LIMITTEXT, 5, 0);
    type(child<QPlainTextEdit>(), QStringLiteral("ab\ncdef"));
    EXPECT_EQ(text(11), "ab\rcd");
    auto& lines = child<QPlainTextEdit>();
    lines.selectAll();
    lines.insertPlainText(QStringLiteral("\U0001F600x\U0001F600\U0001F600yz"));
    EXPECT_EQ(text(11), "?x??y") << "as much as there is room for";
    SetDlgItemTextA(dialog, 11, "\xC3\xA9\xA0\r\r"); // a hard blank, and no UTF-8
    EXPECT_EQ(lines.toPlainText(), QStringLiteral("\u00C3\u00A9 \n\n"));
    EXPECT_EQ(text(11), "\xC3\xA9\xA0\r\r");
}

TEST_F(Dialogs, LeaveTheDrawingOfItemsAndTheThumbToTheProgram) {
    SendDlgItemMessageA(dialog, 13, CB_INSERTSTRING, 0, 71);
    SendDlgItemMessageA(dialog, 13, CB_INSERTSTRING, 0, 72);
    SendDlgItemMessageA(dialog, 13, CB_SETCURSEL, 1, 0);
    auto& box = *widget->findChildren<QComboBox*>().at(1);
    const QImage picture = box.grab().toImage();
    ASSERT_FALSE(drawn.empty());
    EXPECT_EQ(drawn.back().itemData, 71U);
    EXPECT_EQ(drawn.back().rcItem.bottom, itemHeight);
    EXPECT_EQ(picture.pixelColor(10, picture.height() / 2), QColor(Qt::black));

    const HWND bar = GetDlgItem(dialog, 14);
    SetScrollRange(bar, SB_CTL, 1, 5, FALSE);
    SetScrollPos(bar, SB_CTL, 9, TRUE);
    test::press(&child<QScrollBar>(), Qt::Key_Left);
    child<QScrollBar>().triggerAction(QAbstractSlider::SliderPageStepSub);
    test::handleWaiting();
    EXPECT_EQ(GetScrollPos(bar, SB_CTL), 5) << "where the program has put it";
    EXPECT_EQ(scrolls, (std::vector<WORD>{SB_LINEUP, SB_PAGEUP}));
}

TEST_F(Dialogs, KeepTheirKeysAndTheOrderOfTheirTabs) {
    EXPECT_EQ(widget->focusWidget(), &child<QLineEdit>());
    button("&Left").setFocus();
    button("&Left").click();
    test::press(&button("&Left"), Qt::Key_Right); // the arrows go from one to the other
    EXPECT_EQ(IsDlgButtonChecked(dialog, 16), 1U);
    child<QLineEdit>().setFocus();
    std::vector<QString> reached;
    for (int i = 0; i < 11; ++i) {
        QKeyEvent tab(QEvent::KeyPress, Qt::Key_Tab, Qt::NoModifier);
        QCoreApplication::sendEvent(widget->focusWidget(), &tab);
        if (const auto* one = qobject_cast<QAbstractButton*>(widget->focusWidget())) {
            reached.push_back(one->text());
        }
    }
    // The radio buttons are no tab stops.
    const std::vector<QString> expected{QStringLiteral("&Tick"), QString(), QStringLiteral("&OK"),
                                        QStringLiteral("&Cancel")};
    EXPECT_EQ(reached, expected);
    test::press(widget->focusWidget(), Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_EQ(widget->focusWidget(), &child<QLineEdit>()) << "once round, and one back";

    child<QLineEdit>().setFocus();
    test::handleWaiting();
    commands.clear();
    test::press(&child<QLineEdit>(), Qt::Key_Return);
    test::press(&child<QLineEdit>(), Qt::Key_Escape);
    test::handleWaiting();
    widget->close();
    test::handleWaiting();
    EXPECT_EQ(commands, (std::vector<Command>{{IDOK, 0}, {IDCANCEL, 0}, {IDCANCEL, 0}}));
    EXPECT_TRUE(IsWindow(dialog)); // it goes when the program says so
}

TEST_F(Dialogs, TellWhoCannotSeeWhatTheyAre) {
    const auto nameOf = [](QWidget& one) {
        return QAccessible::queryAccessibleInterface(&one)->text(QAccessible::Name);
    };
    EXPECT_EQ(nameOf(button("&Tick")), QStringLiteral("Tick"));
    EXPECT_EQ(nameOf(child<QListView>()), QStringLiteral("Names"));
    SendDlgItemMessageA(dialog, 13, CB_ADDSTRING, 0, 71);
    SendDlgItemMessageA(dialog, 13, CB_ADDSTRING, 0, 72);
    SendDlgItemMessageA(dialog, 13, CB_SETCURSEL, 1, 0);
    EXPECT_EQ(nameOf(*widget->findChildren<QComboBox*>().at(1)), QStringLiteral("2"))
        << "a picture, by its number";
    EXPECT_EQ(QAccessible::queryAccessibleInterface(&button("&Left"))->role(),
              QAccessible::RadioButton);
}

TEST_F(Dialogs, RunUntilTheyAreEndedWhileTheirOwnerTakesNoInput) {
    EXPECT_EQ(DialogBoxParamA(nullptr, "missing", window, dialogProc, 0), -1);
    BOOL ownerTakesInput = TRUE;
    QTimer::singleShot(0, [&] {
        ownerTakesInput = IsWindowEnabled(window);
        PostQuitMessage(7); // meant for a loop round this one
        for (QWidget* one : QApplication::topLevelWidgets()) {
            if (one != widget && one->windowTitle() == widget->windowTitle()) {
                test::press(one, Qt::Key_Escape);
            }
        }
    });
    EXPECT_EQ(DialogBoxParamA(nullptr, "CONTROLS", window, dialogProc, 0), 42);
    EXPECT_FALSE(ownerTakesInput);
    EXPECT_TRUE(IsWindowEnabled(window));
    EXPECT_EQ(test::runLoop(), 7U);
}

TEST_F(Dialogs, ShutTheWindowsInTheirOwnerToo) {
    test::makeWindow(10, 10, WS_CHILD | WS_VISIBLE, window);
    QWindow* child = nullptr;
    for (QWindow* one : QGuiApplication::allWindows()) {
        child = one->parent() != nullptr ? one : child;
    }
    for (const BOOL enabled : {FALSE, TRUE}) {
        EnableWindow(window, enabled);
        test::seen.clear();
        test::press(child, Qt::Key_A);
        test::handleWaiting();
        EXPECT_EQ(test::seenAmong({WM_KEYDOWN}).size(), enabled != FALSE ? 1U : 0U);
        // An underlined letter must not be looked for where the key itself won't arrive.
        QKeyEvent before(QEvent::ShortcutOverride, Qt::Key_O, Qt::AltModifier);
        EnableWindow(dialog, enabled);
        QCoreApplication::sendEvent(widget->windowHandle(), &before);
        EXPECT_EQ(before.isAccepted(), enabled == FALSE);
    }
}

TEST_F(Dialogs, GoWithTheirOwnerWhichMayGoWithAnother) {
    const HWND other = test::makeWindow(10, 10, WS_POPUP, window);
    test::handlers[WM_DESTROY] = [&](HWND dying, WPARAM, LPARAM) {
        return dying == other ? DestroyWindow(window) : 0;
    };
    PostMessageA(other, WM_CLOSE, 0, 0);
    EXPECT_EQ(DialogBoxParamA(nullptr, "controls", window, dialogProc, 0), -1);
    EXPECT_FALSE(IsWindow(window));
    EXPECT_FALSE(IsWindow(dialog));
}
