// The dialogs that ask for the password and change it, by the keys that are typed into them.
#include "platform/user/password_dialog.h"
#include "tests/user/password_ground.h"
#include "tests/user/test_window.h"

#include <QAccessible>
#include <QApplication>
#include <QElapsedTimer>
#include <QKeyEvent>
#include <QLabel>
#include <QPushButton>
#include <QTimer>

#include <gtest/gtest.h>

#include <algorithm>
#include <optional>

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
    const std::map<char16_t, int> keys = {{u'\t', Qt::Key_Tab},
                                          {u'\n', Qt::Key_Return},
                                          {u'\b', Qt::Key_Backspace},
                                          {u'\x1B', Qt::Key_Escape}};
    for (qsizetype at = 0; at < text.size(); ++at) {
        const qsizetype units = text.at(at).isHighSurrogate() ? 2 : 1;
        const auto key = keys.find(text.at(at).unicode());
        if (dialogUp() == nullptr) {
            return;
        }
        press(dialogUp()->focusWidget(), key == keys.end() ? 0 : key->second, text.mid(at, units));
        at += units - 1;
    }
}

bool okIsOn() {
    const auto buttons = dialogUp()->findChildren<QPushButton*>();
    return std::any_of(buttons.begin(), buttons.end(), [](const QPushButton* button) {
        return button->isVisible() && button->isEnabled() && button->text() == QLatin1String("OK");
    });
}

/// All that the dialog says.
QString wordsOf(const QWidget& dialog) {
    QString words;
    for (const auto* label : dialog.findChildren<QLabel*>()) {
        words += label->text() + QLatin1Char('\n');
    }
    return words;
}

std::vector<PasswordField*> fields() {
    std::vector<PasswordField*> found;
    for (QWidget* widget : dialogUp()->findChildren<QWidget*>()) {
        if (auto* field = dynamic_cast<PasswordField*>(widget)) {
            found.push_back(field);
        }
    }
    return found;
}

/// One thing done with the dialog after another: each as soon as OK can be pressed, or at once.
struct Step {
    std::function<void()> action;
    bool whenOk = true;
};

class PasswordDialogs : public test::PasswordGround {
  protected:
    PasswordDialogs() {
        test::handlers.clear();
        window_ = test::makeWindow();
        test::handleWaiting();
        seam::passwordPatience() = {.untilGone = 10s, .firstDelay = 1ms, .longestDelay = 20ms};
        for (const char* name : {"PASSWORD.CPL", "MPR.DLL"}) {
            modules_.push_back(LoadLibraryA(name));
        }
    }

    ~PasswordDialogs() override {
        seam::forgetWrongPasswords();
        seam::passwordPatience() = {};
        for (const HMODULE module : modules_) {
            FreeLibrary(module);
        }
        DestroyWindow(window_);
        MSG message{};
        while (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE)) {
        }
    }

    BOOL verify(std::vector<Step> steps) {
        auto* entry =
            reinterpret_cast<BOOL (*)(HWND)>(GetProcAddress(modules_[0], "VerifyScreenSavePwd"));
        walk(std::move(steps));
        return entry(window_);
    }

    BOOL verify(const QString& keys) {
        return verify({{[keys] { type(keys); }}});
    }

    DWORD change(std::vector<Step> steps, HWND owner, const char* provider = "SCRSAVE") {
        auto* entry = reinterpret_cast<DWORD (*)(const char*, HWND, DWORD, void*)>(
            GetProcAddress(modules_[1], "PwdChangePasswordA"));
        walk(std::move(steps));
        return entry(provider, owner, 0, nullptr);
    }

    DWORD change(const QString& keys) {
        return change({{[keys] { type(keys); }}}, window_);
    }

    HWND window_;

  private:
    static void walk(std::vector<Step> steps) {
        if (steps.empty()) {
            return;
        }
        QTimer::singleShot(0, [steps = std::move(steps)]() mutable {
            if (dialogUp() != nullptr && dialogUp()->isVisible() &&
                (okIsOn() || !steps.front().whenOk)) {
                const Step step = steps.front();
                steps.erase(steps.begin());
                walk(steps);
                step.action();
            } else {
                walk(std::move(steps));
            }
        });
    }

    std::vector<HMODULE> modules_;
};

TEST_F(PasswordDialogs, LetWhoeverKnowsThePasswordPass) {
    EXPECT_EQ(verify(std::vector<Step>{}), TRUE) << "there is none";
    ASSERT_TRUE(seam::changePassword("s\xC3\xA9\xF0\x9F\x98\x80 2"));

    const struct {
        QString keys;
        BOOL passes;
    } cases[] = {
        {QStringLiteral("sé😀 2\n"), TRUE},
        {QStringLiteral("\x1B"), FALSE},
        {QStringLiteral("sé😀 2\x1B"), FALSE},
        {QStringLiteral("sé😀é\b 2\n"), TRUE},
        {QStringLiteral("sé😀 3\b2\n"), TRUE},
        {QStringLiteral("\n\n\nsé😀 2\n"), TRUE}, // without a password OK does nothing
        {QStringLiteral("sé😀 2\t\t\n"), FALSE},  // Cancel
        {QStringLiteral("sé😀 2\t\t\t\n"), TRUE}, // round to the field again
    };

    for (const auto& c : cases) {
        EXPECT_EQ(verify(c.keys), c.passes) << c.keys.toStdString();
    }
}

TEST_F(PasswordDialogs, LetPassWhenThePasswordHasBeenRemovedMeanwhile) {
    ASSERT_TRUE(seam::changePassword("word"));
    const Step remove{[] {
        EXPECT_TRUE(seam::changePassword(""));
        type(QStringLiteral("any\n"));
    }};
    EXPECT_EQ(verify({remove}), TRUE);
}

TEST_F(PasswordDialogs, TakeNoKeysThatAreHeldDownAndNoCommands) {
    ASSERT_TRUE(seam::changePassword("wood"));
    const auto held = [] {
        for (const int key : {Qt::Key_Escape, Qt::Key_Return, Qt::Key_A}) {
            press(dialogUp()->focusWidget(), key, QStringLiteral("a"), Qt::NoModifier, true);
            // The same as a display may tell it: up and down again in one millisecond.
            for (const QEvent::Type type : {QEvent::KeyRelease, QEvent::KeyPress}) {
                QKeyEvent event(type, key, Qt::NoModifier, 38, 0, 0, QStringLiteral("a"));
                event.setTimestamp(5000);
                QCoreApplication::sendEvent(dialogUp()->focusWidget(), &event);
            }
        }
        press(dialogUp()->focusWidget(), Qt::Key_V, QStringLiteral("v"), Qt::ControlModifier);
        press(dialogUp()->focusWidget(), Qt::Key_A, QStringLiteral("a"), Qt::AltModifier);
        type(QStringLiteral("wrong"));
        press(dialogUp()->focusWidget(), Qt::Key_U, QStringLiteral("\x15"), Qt::ControlModifier);
        // A key that has gone down here is taken however fast it comes again.
        for (const char16_t letter : {u'w', u'o', u'o', u'd'}) {
            for (const QEvent::Type kind : {QEvent::KeyPress, QEvent::KeyRelease}) {
                QKeyEvent event(kind, Qt::Key_O, Qt::NoModifier, 32, 0, 0, QString(letter));
                event.setTimestamp(6000);
                QCoreApplication::sendEvent(dialogUp()->focusWidget(), &event);
            }
        }
        type(QStringLiteral("\n"));
    };
    EXPECT_EQ(verify({{held}}), TRUE);
}

TEST_F(PasswordDialogs, LeaveNothingOfThePasswordInTheField) {
    ASSERT_TRUE(seam::changePassword("word"));
    const auto look = [] {
        const PasswordField* field = fields().front();
        type(QStringLiteral("secret"));
        EXPECT_EQ(field->secret().bytes(), "secret");
        type(QStringLiteral("\n"));
        EXPECT_EQ(field->secret().memory(), std::string(seam::Secret::capacity, '\0'));
        type(QStringLiteral("\x1B"));
    };
    EXPECT_EQ(verify({{look}}), FALSE);
}

TEST_F(PasswordDialogs, HoldOkBackForLongerAfterEachWrongOne) {
    ASSERT_TRUE(seam::changePassword("word"));
    seam::passwordPatience() = {.untilGone = 60s, .firstDelay = 300ms, .longestDelay = 900ms};
    QElapsedTimer sinceWrong;
    std::vector<qint64> delays;
    const Step wrong{[&] {
        if (sinceWrong.isValid()) {
            delays.push_back(sinceWrong.elapsed());
        }
        type(QStringLiteral("wrong\n"));
        sinceWrong.start();
        EXPECT_TRUE(wordsOf(*dialogUp()).contains(QLatin1String("Wrong")));
        EXPECT_FALSE(okIsOn());
        type(QStringLiteral("word\n"));
        EXPECT_NE(dialogUp(), nullptr) << "Enter is no way round it";
        press(dialogUp()->focusWidget(), Qt::Key_U, {}, Qt::ControlModifier);
    }};
    const Step cancel{[] { type(QStringLiteral("\x1B")); }, false};
    EXPECT_EQ(verify({wrong, wrong, wrong, wrong, cancel}), FALSE);

    const Step right{[&] {
        delays.push_back(sinceWrong.elapsed());
        type(QStringLiteral("word\n"));
    }};
    EXPECT_EQ(verify({right}), TRUE) << "the delay goes on in the next dialog";
    ASSERT_EQ(delays.size(), 4U);
    const qint64 whole[] = {300, 600, 900, 900};
    for (std::size_t i = 0; i < delays.size(); ++i) {
        EXPECT_GE(delays[i], whole[i] * 3 / 4) << i; // it began before we looked at the clock
    }

    seam::passwordPatience().firstDelay = 10s;
    seam::passwordPatience().longestDelay = 3600s;
    const Step wrongOnce{[] {
        type(QStringLiteral("wrong\n"));
        EXPECT_TRUE(wordsOf(*dialogUp()).contains(QLatin1String("in 10 s"))) << "starts anew";
        type(QStringLiteral("\x1B"));
    }};
    EXPECT_EQ(verify({wrongOnce}), FALSE);
}

TEST_F(PasswordDialogs, GoByThemselvesWhenNoKeyComes) {
    ASSERT_TRUE(seam::changePassword("word"));
    seam::passwordPatience().untilGone = 200ms;
    QElapsedTimer clock;
    clock.start();
    int ticks = 0;
    test::handlers[WM_TIMER] = [&](HWND, WPARAM, LPARAM) {
        ++ticks;
        return LRESULT{0};
    };
    SetTimer(window_, 1, 10, nullptr);
    const Step keyLater{[] { QTimer::singleShot(100ms, [] { type(QStringLiteral("w")); }); }};
    EXPECT_EQ(verify({keyLater}), FALSE);
    EXPECT_GE(clock.elapsed(), 299) << "the time counts from the last key";
    EXPECT_GE(ticks, 2) << "the show goes on behind it";
}

TEST_F(PasswordDialogs, GoWithTheirOwnerAndWithTheProgram) {
    ASSERT_TRUE(seam::changePassword("word"));
    EXPECT_EQ(verify({{[] { PostQuitMessage(5); }}}), FALSE);
    MSG message{};
    EXPECT_TRUE(PeekMessageA(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE));
    EXPECT_EQ(message.wParam, 5U);
    EXPECT_EQ(verify({{[this] { DestroyWindow(window_); }}}), FALSE);
    window_ = test::makeWindow();
}

TEST_F(PasswordDialogs, SayWhyNobodyCanBeLetIn) {
    write("password", "garbage");
    QString words;
    const Step look{[&] {
                        words += wordsOf(*dialogUp());
                        EXPECT_TRUE(fields().empty());
                        EXPECT_FALSE(okIsOn());
                        type(QStringLiteral("\n"));
                    },
                    false};
    EXPECT_EQ(verify({look}), FALSE);
    EXPECT_EQ(change({look}, window_), 13U);
    EXPECT_EQ(words.count(QLatin1String("damaged")), 2) << words.toStdString();
    EXPECT_EQ(words.count(QString::fromStdString(path("password"))), 2);
    EXPECT_EQ(textOf("password"), "garbage");
}

TEST_F(PasswordDialogs, ChangeThePassword) {
    const struct {
        const char* before;
        QString keys;
        const char* after;
        DWORD result;
    } cases[] = {
        {"", QStringLiteral("new\tnew\n"), "new", 0},
        {"", QStringLiteral("new\tnow\nNew\tNew\n"), "New", 0},
        {"", QStringLiteral("new\tnew\x1B"), "", 1223},
        {"", QStringLiteral("\n"), "", 0},
        {"old", QStringLiteral("old\tnew\tnew\n"), "new", 0},
        {"old", QStringLiteral("old\n"), "", 0}, // removes it
        {"old", QStringLiteral("wrong\tnew\tnew\n\x1B"), "old", 1223},
        {"old", QStringLiteral("\tnew\tnew\n\x1B"), "old", 1223},
        {"old", QStringLiteral("old\tnew\tno\nnew\tnew\n"), "new", 0},
        {"old", QStringLiteral("old\tnew\tnew\t\t\n"), "old", 1223}, // Cancel
    };

    for (const auto& c : cases) {
        ASSERT_TRUE(seam::changePassword(c.before));
        EXPECT_EQ(change(c.keys), c.result) << c.keys.toStdString();
        if (*c.after == '\0') {
            EXPECT_EQ(readPassword().state, PasswordState::none) << c.keys.toStdString();
        } else {
            EXPECT_TRUE(isPassword(readPassword(), c.after)) << c.keys.toStdString();
        }
        EXPECT_EQ(saverAsks(), *c.after != '\0') << c.keys.toStdString();
    }
}

TEST_F(PasswordDialogs, SayWhatKeepsThePasswordFromBeingChanged) {
    ASSERT_TRUE(seam::changePassword("old"));
    std::filesystem::remove(path("registry.ini"));
    std::filesystem::create_directories(path("registry.ini"));
    const Step differ{[] {
        type(QStringLiteral("old\tnew\tno\n"));
        EXPECT_TRUE(wordsOf(*dialogUp()).contains(QLatin1String("differ")));
    }};
    const Step wrong{[] {
        fields().front()->setFocus();
        type(QStringLiteral("x\tnew\tnew\n"));
        EXPECT_TRUE(wordsOf(*dialogUp()).contains(QLatin1String("Wrong")));
    }};
    const Step unwritten{[] {
        type(QStringLiteral("old\n"));
        EXPECT_TRUE(wordsOf(*dialogUp()).contains(QLatin1String("can't be written")));
        type(QStringLiteral("\x1B"));
    }};
    EXPECT_EQ(change({differ, wrong, unwritten}, window_), 1223U);
    EXPECT_TRUE(isPassword(readPassword(), "old"));
    EXPECT_EQ(change({}, window_, "OTHER"), 1204U);
}

TEST_F(PasswordDialogs, NeedNoOwner) {
    EXPECT_EQ(change({{[] { type(QStringLiteral("new\tnew\n")); }}}, nullptr), 0U);
    EXPECT_TRUE(isPassword(readPassword(), "new"));
}

TEST_F(PasswordDialogs, TellScreenReadersWhatTheFieldsAre) {
    const Step look{[] {
        QAccessibleInterface* field = QAccessible::queryAccessibleInterface(fields().front());
        ASSERT_NE(field, nullptr);
        EXPECT_EQ(field->role(), QAccessible::EditableText);
        EXPECT_TRUE(field->state().passwordEdit);
        EXPECT_EQ(field->text(QAccessible::Name), QStringLiteral("New password:"));
        type(QStringLiteral("new"));
        EXPECT_EQ(field->text(QAccessible::Value), QString());
        type(QStringLiteral("\x1B"));
    }};
    EXPECT_EQ(change({look}, window_), 1223U);
}

} // namespace
