// The dialogs that ask for the password and change it, by the keys that are typed into them.
#include "platform/user/password_dialog.h"
#include "tests/kernel/scratch_directory.h"
#include "tests/user/test_window.h"

#include <QAccessible>
#include <QApplication>
#include <QElapsedTimer>
#include <QKeyEvent>
#include <QLabel>
#include <QPushButton>
#include <QTimer>

#include <algorithm>

namespace {

using namespace std::chrono_literals;
using seam::isPassword;
using seam::PasswordDialog;
using seam::PasswordField;
using seam::PasswordState;
using seam::readPassword;

PasswordDialog* dialogUp() {
    return dynamic_cast<PasswordDialog*>(QApplication::activeModalWidget());
}

void press(QWidget* widget, int key, const QString& text = {},
           Qt::KeyboardModifiers modifiers = Qt::NoModifier, bool held = false) {
    QKeyEvent event(QEvent::KeyPress, key, modifiers, text, held);
    QCoreApplication::sendEvent(widget, &event);
}

/// Types into whatever has the focus: "\t", "\n", "\b" and "\x1B" (Escape) are those keys.
void type(const QString& text) {
    const std::map<char32_t, int> keys = {{U'\t', Qt::Key_Tab},
                                          {U'\n', Qt::Key_Return},
                                          {U'\b', Qt::Key_Backspace},
                                          {U'\x1B', Qt::Key_Escape}};
    for (const char32_t code : text.toUcs4()) {
        if (dialogUp() != nullptr) {
            const auto key = keys.find(code);
            press(dialogUp()->focusWidget(), key == keys.end() ? 0 : key->second,
                  QString::fromUcs4(&code, 1));
        }
    }
}

bool okIsOn() {
    const auto buttons = dialogUp()->findChildren<QPushButton*>();
    return std::any_of(buttons.begin(), buttons.end(), [](const QPushButton* button) {
        return button->isVisible() && button->isEnabled() && button->text() == QLatin1String("OK");
    });
}

/// All that the dialog says.
QString words() {
    QString said;
    for (const auto* label : dialogUp()->findChildren<QLabel*>()) {
        said += label->text() + QLatin1Char('\n');
    }
    return said;
}

/// The first one, if any.
PasswordField* field() {
    for (QWidget* widget : dialogUp()->findChildren<QWidget*>()) {
        if (auto* found = dynamic_cast<PasswordField*>(widget)) {
            return found;
        }
    }
    return nullptr;
}

/// One thing done with the dialog after another: each as soon as OK can be pressed, or at once.
struct Step {
    std::function<void()> action;
    bool whenOk = true;
};

Step typed(const QString& keys) {
    return {[keys] { type(keys); }};
}

class PasswordDialogs : public ConfigDirectory {
  protected:
    void SetUp() override {
        test::handlers.clear();
        window_ = test::makeWindow();
        test::handleWaiting();
        seam::passwordPatience() = {.untilGone = 10s, .firstDelay = 1ms, .longestDelay = 20ms};
    }

    void TearDown() override {
        seam::forgetWrongPasswords();
        seam::passwordPatience() = {};
        DestroyWindow(window_);
        test::handleWaiting();
        ConfigDirectory::TearDown();
    }

    template <class Entry, class... Arguments>
    static auto call(const char* library, const char* name, const std::vector<Step>& steps,
                     Arguments... arguments) {
        const HMODULE module = LoadLibraryA(library);
        walk(steps);
        const auto result = reinterpret_cast<Entry>(GetProcAddress(module, name))(arguments...);
        FreeLibrary(module);
        return result;
    }

    BOOL verify(const std::vector<Step>& steps) {
        return call<BOOL (*)(HWND)>("PASSWORD.CPL", "VerifyScreenSavePwd", steps, window_);
    }

    DWORD change(const std::vector<Step>& steps, HWND owner, const char* provider = "SCRSAVE") {
        return call<DWORD (*)(const char*, HWND, DWORD, void*)>(
            "MPR.DLL", "PwdChangePasswordA", steps, provider, owner, 0U, nullptr);
    }

    HWND window_;

  private:
    static void walk(const std::vector<Step>& steps) {
        if (steps.empty()) {
            return;
        }
        QTimer::singleShot(0, [steps] {
            if (dialogUp() == nullptr || !dialogUp()->isVisible() ||
                (steps.front().whenOk && !okIsOn())) {
                walk(steps);
                return;
            }
            walk({steps.begin() + 1, steps.end()});
            steps.front().action();
        });
    }
};

TEST_F(PasswordDialogs, LetWhoeverKnowsThePasswordPass) {
    EXPECT_EQ(verify({}), TRUE) << "there is none";
    ASSERT_TRUE(seam::changePassword("s\xC3\xA9\xF0\x9F\x98\x80 2"));
    const std::tuple<QString, BOOL> cases[] = {
        {QStringLiteral("sé😀 2\n"), TRUE},       {QStringLiteral("\x1B"), FALSE},
        {QStringLiteral("sé😀 2\x1B"), FALSE},    {QStringLiteral("sé😀 3\b2\n"), TRUE},
        {QStringLiteral("\n\n\nsé😀 2\n"), TRUE}, // without a password OK does nothing
        {QStringLiteral("sé😀 2\t\t\n"), FALSE},  // Cancel
        {QStringLiteral("sé😀 2\t\t\t\n"), TRUE}, // round to the field again
    };
    for (const auto& [keys, passes] : cases) {
        EXPECT_EQ(verify({typed(keys)}), passes) << keys.toStdString();
    }
    const Step remove{[] {
        EXPECT_TRUE(seam::changePassword(""));
        type(QStringLiteral("any\n"));
    }};
    EXPECT_EQ(verify({remove}), TRUE) << "it has been removed meanwhile";
}

TEST_F(PasswordDialogs, TakeNoKeysThatAreHeldDownAndNoCommands) {
    ASSERT_TRUE(seam::changePassword("wood"));
    const auto tell = [](QEvent::Type kind, int key, const QString& text, quint32 place) {
        QKeyEvent event(kind, key, Qt::NoModifier, place, 0, 0, text);
        event.setTimestamp(5000); // all in one millisecond
        QCoreApplication::sendEvent(dialogUp()->focusWidget(), &event);
    };
    const auto held = [&] {
        for (const int key : {Qt::Key_Escape, Qt::Key_Return, Qt::Key_A}) {
            press(dialogUp()->focusWidget(), key, QStringLiteral("a"), Qt::NoModifier, true);
            // The same as a display may tell it: up and down again at once.
            tell(QEvent::KeyRelease, key, QStringLiteral("a"), 38);
            tell(QEvent::KeyPress, key, QStringLiteral("a"), 38);
        }
        press(dialogUp()->focusWidget(), Qt::Key_V, QStringLiteral("v"), Qt::ControlModifier);
        press(dialogUp()->focusWidget(), Qt::Key_A, QStringLiteral("a"), Qt::AltModifier);
        type(QStringLiteral("wrong"));
        press(dialogUp()->focusWidget(), Qt::Key_U, QStringLiteral("\x15"), Qt::ControlModifier);
        for (const QChar letter : QStringLiteral("wood")) { // goes down here: may come so fast
            tell(QEvent::KeyPress, Qt::Key_O, letter, 32);
            tell(QEvent::KeyRelease, Qt::Key_O, letter, 32);
        }
        type(QStringLiteral("\n"));
    };
    EXPECT_EQ(verify({{held}}), TRUE);
}

TEST_F(PasswordDialogs, HoldOkBackForLongerAfterEachWrongOne) {
    ASSERT_TRUE(seam::changePassword("word"));
    seam::useManualClock(0);
    seam::passwordPatience() = {.untilGone = 60s, .firstDelay = 10s, .longestDelay = 35s};
    const auto wrong = [](const char* told) {
        return Step{[told] {
            type(QStringLiteral("wrong\n"));
            EXPECT_TRUE(words().contains(QLatin1String(told))) << words().toStdString();
            EXPECT_FALSE(okIsOn());
            type(QStringLiteral("word\n"));
            EXPECT_NE(dialogUp(), nullptr) << "Enter is no way round it";
            type(QStringLiteral("\x1B"));
        }};
    };
    const Step held{[] {
                        EXPECT_FALSE(okIsOn());
                        type(QStringLiteral("\x1B"));
                    },
                    false};
    const std::pair<const char*, DWORD> cases[] = {
        {"in 10 s", 10'000}, {"in 20 s", 20'000}, {"in 35 s", 35'000}, {"in 35 s", 35'000}};
    for (const auto& [told, delay] : cases) {
        EXPECT_EQ(verify({wrong(told)}), FALSE);
        Sleep(delay - 1);
        EXPECT_EQ(verify({held}), FALSE) << "the delay goes on in the next dialog";
        Sleep(1);
    }
    EXPECT_EQ(verify({typed(QStringLiteral("word\n"))}), TRUE);
    EXPECT_EQ(verify({wrong("in 10 s")}), FALSE) << "starts anew";
    seam::useSystemClock();
}

TEST_F(PasswordDialogs, GoByThemselvesWhenNoKeyComes) {
    ASSERT_TRUE(seam::changePassword("word"));
    seam::passwordPatience().untilGone = 200ms;
    QElapsedTimer clock;
    clock.start();
    const Step keyLater{[] { QTimer::singleShot(100ms, [] { type(QStringLiteral("w")); }); }};
    EXPECT_EQ(verify({keyLater}), FALSE);
    EXPECT_GE(clock.elapsed(), 299) << "the time counts from the last key";
}

TEST_F(PasswordDialogs, SayWhyNobodyCanBeLetIn) {
    make("dorbo/password", "garbage");
    const Step look{[&] {
                        EXPECT_TRUE(words().contains(QLatin1String("damaged")));
                        const auto path = (root_ / "dorbo/password").string();
                        EXPECT_TRUE(words().contains(QString::fromStdString(path)));
                        EXPECT_EQ(field(), nullptr);
                        EXPECT_FALSE(okIsOn());
                        type(QStringLiteral("\n"));
                    },
                    false};
    EXPECT_EQ(verify({look}), FALSE);
    EXPECT_EQ(change({look}, window_), 13U);
    EXPECT_EQ(textOf("dorbo/password"), "garbage");
}

TEST_F(PasswordDialogs, ChangeThePassword) {
    const std::tuple<const char*, QString, const char*, DWORD> cases[] = {
        {"", QStringLiteral("new\tnew\n"), "new", 0},
        {"", QStringLiteral("new\tnew\x1B"), "", 1223},
        {"", QStringLiteral("\n"), "", 0},
        {"old", QStringLiteral("old\tnew\tnew\n"), "new", 0},
        {"old", QStringLiteral("old\n"), "", 0}, // removes it
        {"old", QStringLiteral("\tnew\tnew\n\x1B"), "old", 1223},
        {"old", QStringLiteral("old\tnew\tno\nnew\tnew\n"), "new", 0},
        {"old", QStringLiteral("old\tnew\tnew\t\t\n"), "old", 1223}, // Cancel
    };
    for (const auto& [before, keys, after, result] : cases) {
        ASSERT_TRUE(seam::changePassword(before));
        EXPECT_EQ(change({typed(keys)}, window_), result) << keys.toStdString();
        if (*after == '\0') {
            EXPECT_EQ(readPassword().state, PasswordState::none) << keys.toStdString();
        } else {
            EXPECT_TRUE(isPassword(readPassword(), after)) << keys.toStdString();
        }
    }
}

TEST_F(PasswordDialogs, SayWhatKeepsThePasswordFromBeingChanged) {
    ASSERT_TRUE(seam::changePassword("old"));
    std::filesystem::remove("dorbo/registry.ini");
    std::filesystem::create_directory("dorbo/registry.ini");
    const Step differ{[] {
        type(QStringLiteral("old\tnew\tno\n"));
        EXPECT_TRUE(words().contains(QLatin1String("differ")));
    }};
    const Step wrong{[] {
        field()->setFocus();
        type(QStringLiteral("x\tnew\tnew\n"));
        EXPECT_TRUE(words().contains(QLatin1String("Wrong")));
    }};
    const Step unwritten{[] {
        type(QStringLiteral("old\n"));
        EXPECT_TRUE(words().contains(QLatin1String("can't be written")));
        type(QStringLiteral("\x1B"));
    }};
    EXPECT_EQ(change({differ, wrong, unwritten}, window_), 1223U);
    EXPECT_TRUE(isPassword(readPassword(), "old"));
    EXPECT_EQ(change({}, window_, "OTHER"), 1204U);
}

TEST_F(PasswordDialogs, KeepWhatIsTypedToTheFieldsAndNeedNoOwner) {
    const Step look{[] {
        QAccessibleInterface* heard = QAccessible::queryAccessibleInterface(field());
        ASSERT_NE(heard, nullptr);
        EXPECT_EQ(heard->role(), QAccessible::EditableText);
        EXPECT_TRUE(heard->state().passwordEdit);
        EXPECT_EQ(heard->text(QAccessible::Name), QStringLiteral("New password:"));
        type(QStringLiteral("new"));
        EXPECT_EQ(field()->secret().bytes(), "new");
        EXPECT_EQ(heard->text(QAccessible::Value), QString());
        type(QStringLiteral("\tother\n"));
        ASSERT_NE(dialogUp(), nullptr) << "they differ";
        EXPECT_EQ(field()->secret().memory(), std::string(seam::Secret::capacity, '\0'));
        type(QStringLiteral("new\tnew\n"));
    }};
    EXPECT_EQ(change({look}, nullptr), 0U);
    EXPECT_TRUE(isPassword(readPassword(), "new"));
}

} // namespace
