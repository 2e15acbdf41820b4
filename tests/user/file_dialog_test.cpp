// The dialogs for choosing a file, answered by keys in the user's place.
#include "platform/common_dialogs.h"
#include "tests/kernel/scratch_directory.h"
#include "tests/user/test_window.h"

#include <QComboBox>
#include <QFileDialog>
#include <QLineEdit>
#include <QListView>
#include <QMessageBox>
#include <QTest>

#include <array>

namespace {

using test::whenUp;

class FileDialogs : public ScratchDirectory {
  protected:
    void SetUp() override {
        test::handlers.clear();
        window = test::makeWindow();
        test::handleWaiting();
        make("one.zkt");
        make("two.txt");
        make("inner/three.zkt");
        asked.lStructSize = 76;
        asked.hwndOwner = window;
        asked.lpstrFilter = "Toons (*.zkt)\0*.zkt\0All files\0*.*\0";
        asked.nFilterIndex = 1;
        asked.lpstrFile = path.data();
        asked.nMaxFile = static_cast<DWORD>(path.size());
        asked.lpstrInitialDir = "";
        asked.lpstrTitle = "Open a Toon";
    }

    void TearDown() override {
        DestroyWindow(window);
        EXPECT_EQ(std::filesystem::current_path(), root_);
        ScratchDirectory::TearDown();
    }

    static QLineEdit& nameField(const QFileDialog& dialog) {
        return *dialog.findChild<QLineEdit*>(QStringLiteral("fileNameEdit"));
    }

    static void enter(const QFileDialog& dialog, const QString& name) {
        nameField(dialog).selectAll();
        for (const QChar character : name) {
            QKeyEvent press(QEvent::KeyPress, 0, Qt::NoModifier, QString(character));
            QCoreApplication::sendEvent(&nameField(dialog), &press);
        }
        QTest::keyClick(&nameField(dialog), Qt::Key_Return);
    }

    void put(const std::string& text) {
        path.fill('x');
        path[text.copy(path.data(), path.size() - 1)] = '\0';
    }

    std::string result() const {
        return path.data();
    }

    HWND window;
    std::array<char, 256> path{};
    OPENFILENAME asked{};
};

TEST_F(FileDialogs, GiveTheTypedPathInThePlatformsForm) {
    const struct {
        BOOL (*choose)(OPENFILENAME*);
        const char* file;
        const char* initial;
        QString typed;
        const char* shown;
        std::string chosen;
    } cases[] = {
        {GetOpenFileNameA, "", "", QStringLiteral("missing"), "", "missing"},
        {GetSaveFileNameA, "", "inner", QStringLiteral("../caf\u00E9"), "", "caf\xC3\xA9"},
        {GetOpenFileNameA, "", "none", QStringLiteral("inner/a \"b\""), "", "inner\\a \"b\""},
        {GetSaveFileNameA, "INNER\\three.zkt", "", QStringLiteral("x"), "three.zkt", "inner\\x"},
        // Nobody asks whether to write over a file:
        {GetSaveFileNameA, "", "", QStringLiteral("one.zkt"), "", "one.zkt"},
    };

    for (const auto& one : cases) {
        put(one.file);
        const std::string initial = *one.initial == '\0' ? "" : whole(one.initial);
        asked.lpstrInitialDir = initial.c_str();
        whenUp<QFileDialog>([&](QFileDialog& dialog) {
            EXPECT_EQ(dialog.windowTitle(), QStringLiteral("Open a Toon"));
            EXPECT_EQ(nameField(dialog).text(), QLatin1String(one.shown));
            enter(dialog, one.typed);
        });
        EXPECT_TRUE(one.choose(&asked));
        EXPECT_EQ(result(), whole(one.chosen));
    }
}

TEST_F(FileDialogs, LeaveThePathAloneWhenCancelledOrWithoutTheirOwner) {
    const std::function<void(QFileDialog&)> endings[] = {
        [](QFileDialog& dialog) { QTest::keyClick(&nameField(dialog), Qt::Key_Escape); },
        [&](QFileDialog&) { test::onTimer(window, [&] { DestroyWindow(window); }); }};
    for (const auto& ending : endings) {
        put("old.zkt");
        asked.nFilterIndex = 2;
        whenUp<QFileDialog>([&](QFileDialog& dialog) {
            QTest::keyClicks(&nameField(dialog), QStringLiteral("new.zkt"));
            ending(dialog);
        });
        EXPECT_FALSE(GetSaveFileNameA(&asked));
        EXPECT_EQ(result(), "old.zkt");
        EXPECT_EQ(asked.nFilterIndex, 2U);
    }
}

TEST_F(FileDialogs, RefuseWhatTheCallerCannotHoldAndGoOn) {
    const std::string fits(path.size() - 1 - whole("x").size() + 1, 'y');
    const std::pair<QString, const char*> cases[] = {
        {QString::fromStdString(fits + "y"), "The path is too long."},
        {QStringLiteral("C:\\one.zkt"), "The path can't be used."}};
    for (const auto& one : cases) {
        int refusals = 0;
        whenUp<QFileDialog>([&](QFileDialog& dialog) {
            whenUp<QMessageBox>([&](QMessageBox& box) {
                ++refusals;
                EXPECT_EQ(box.text(), QLatin1String(one.second));
                QTest::keyClick(&box, Qt::Key_Return);
            });
            enter(dialog, one.first);
            EXPECT_TRUE(dialog.isVisible());
            enter(dialog, QString::fromStdString(fits));
        });
        EXPECT_TRUE(GetOpenFileNameA(&asked));
        EXPECT_EQ(result(), whole(fits));
        EXPECT_EQ(refusals, 1);
    }
}

TEST_F(FileDialogs, ListWhatTheFilterLetsThroughAndGoIntoATypedDirectory) {
    make("plain");
    const auto waitForRows = [](const QFileDialog& dialog, int rows) {
        const auto& list = *dialog.findChild<QListView*>(QStringLiteral("listView"));
        return QTest::qWaitFor([&] { return list.model()->rowCount(list.rootIndex()) == rows; });
    };
    whenUp<QFileDialog>([&](QFileDialog& dialog) {
        auto& filters = *dialog.findChild<QComboBox*>(QStringLiteral("fileTypeCombo"));
        EXPECT_EQ(filters.currentText(), QStringLiteral("All files"));
        EXPECT_TRUE(waitForRows(dialog, 4));
        QTest::keyClick(&filters, Qt::Key_Up);
        EXPECT_EQ(filters.currentText(), QStringLiteral("Toons (*.zkt)"));
        EXPECT_TRUE(waitForRows(dialog, 2)) << "a directory and a Toon";
        enter(dialog, QStringLiteral("inner"));
        EXPECT_TRUE(dialog.isVisible());
        EXPECT_EQ(nameField(dialog).text(), QString());
        EXPECT_EQ(dialog.directory().path().toStdString(), (root_ / "inner").string());
        enter(dialog, QStringLiteral("three.zkt"));
    });
    asked.nFilterIndex = 2;
    EXPECT_TRUE(GetOpenFileNameA(&asked));
    EXPECT_EQ(result(), whole("inner\\three.zkt"));
    EXPECT_EQ(asked.nFilterIndex, 1U);
}

} // namespace
