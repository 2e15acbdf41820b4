// The setup dialog, and the player that it opens.
#include "saver/setup_dialog.h"

#include "saver/saver_main.h"
#include "saver/toon_player.h"
#include "stage/stage.h"
#include "tests/saver/saver_fixture.h"
#include "toon/settings.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QListView>
#include <QMouseEvent>
#include <QTimer>

#include <filesystem>
#include <malloc.h>

namespace fs = std::filesystem;
using testing::ElementsAre;
using Names = std::vector<std::string>;

namespace {

/// The event of the record at which a key is pressed in the player.
std::string pressKeyAt;

class Setup : public SaverTest {
  protected:
    void SetUp() override {
        SaverTest::SetUp();
        TraceSink = [](const char* line) {
            record.emplace_back(line);
            if (!pressKeyAt.empty() && record.back().find(pressKeyAt) != std::string::npos) {
                QTimer::singleShot(0, [] { PostMessageA(PlayerWindow, WM_KEYDOWN, 0x1B, 0); });
            }
        };
    }

    void open() {
        SettingsSave();
        dialog = CreateDialogParamA(GetModuleHandleA(nullptr), SETUP_DIALOG, nullptr,
                                    SetupDialogProc, 0);
        ASSERT_TRUE(dialog);
        pass(0);
    }

    void TearDown() override {
        pressKeyAt = "";
        DestroyWindow(dialog);
        SaverTest::TearDown();
    }

    static QWidget& widget() {
        for (QWidget* one : QApplication::topLevelWidgets()) {
            if (qobject_cast<QDialog*>(one) != nullptr && one->isVisible()) {
                return *one;
            }
        }
        throw std::runtime_error("no dialog");
    }

    static void sendMouse(QWidget& where, QEvent::Type type, QPoint at) {
        const bool up = type == QEvent::MouseButtonRelease;
        QMouseEvent event(type, at, where.mapToGlobal(at), Qt::LeftButton,
                          up ? Qt::NoButton : Qt::LeftButton, Qt::NoModifier);
        QCoreApplication::sendEvent(&where, &event);
    }

    static void click(const char* text) {
        for (auto* one : widget().findChildren<QAbstractButton*>()) {
            if (one->text().startsWith(QLatin1String(text))) {
                sendMouse(*one, QEvent::MouseButtonPress, QPoint(6, 6));
                sendMouse(*one, QEvent::MouseButtonRelease, QPoint(6, 6));
            }
        }
        pass(0);
    }

    Names listed() const {
        Names names;
        const auto count = SendDlgItemMessageA(dialog, 1043, LB_GETCOUNT, 0, 0);
        for (LRESULT row = 0; row < count; ++row) {
            char name[300];
            SendDlgItemMessageA(dialog, 1043, LB_GETTEXT, static_cast<WPARAM>(row),
                                reinterpret_cast<LPARAM>(name));
            names.emplace_back(static_cast<const char*>(name));
        }
        return names;
    }

    /// Double-clicks the entry of that text.
    void openEntry(const std::string& entry) {
        const Names names = listed();
        const auto found = std::find(names.begin(), names.end(), entry);
        ASSERT_NE(found, names.end()) << entry;
        auto& list = *widget().findChild<QListView*>();
        const QModelIndex index = list.model()->index(static_cast<int>(found - names.begin()), 0);
        list.scrollTo(index);
        const QPoint at = list.visualRect(index).center();
        for (const QEvent::Type type : {QEvent::MouseButtonPress, QEvent::MouseButtonRelease,
                                        QEvent::MouseButtonDblClick, QEvent::MouseButtonRelease}) {
            sendMouse(*list.viewport(), type, at);
        }
        pass(0);
    }

    std::string count() const {
        char text[20];
        GetDlgItemTextA(dialog, 1045, text, sizeof text);
        return static_cast<const char*>(text);
    }

    /// Which of these controls can be used, as one text of y and n.
    std::string enabled() const {
        std::string result;
        for (const int id : {1, 2, 1037, 1038, 1040, 1041, 1043, 1044, 1045, 1046}) {
            result += IsWindowEnabled(GetDlgItem(dialog, id)) != FALSE ? 'y' : 'n';
        }
        return result;
    }

    HWND dialog;
};

} // namespace

TEST(SetupSteps, ChangeTheDirectoryAsTheEntrySays) {
    const std::string deep = "c:\\" + std::string(119, 'd') + "\\";

    const struct {
        std::string directory;
        const char* entry;
        EntryStep step;
        std::string after;
    } cases[] = {
        {"c:\\games\\toons\\", "[..]", EntryStep::moved, "c:\\games\\"},
        {"c:\\games\\", "[..]", EntryStep::moved, "c:\\"},
        {"c:\\", "[..]", EntryStep::refused, "c:\\"}, // what is left has no backslash
        {"\\tmp\\", "[..]", EntryStep::moved, "\\"},  // no drive: the root of the present one
        {"\\", "[..]", EntryStep::refused, "\\"},
        {"toons\\", "[..]", EntryStep::refused, "toons\\"},
        {"", "[..]", EntryStep::refused, ""},
        {"C:\\Games\\", "[-D-]", EntryStep::moved, "d:\\"},
        {"C:\\", "[-]", EntryStep::moved, "]:\\"}, // a directory named by a minus
        {"C:\\Games\\", "[Toons]", EntryStep::moved, "c:\\games\\toons\\"},
        {"C:\\", "[a]b]", EntryStep::moved, "c:\\a]b\\"},
        {"C:\\", "[a].zkt", EntryStep::moved, "c:\\a\\"},
        {"C:\\", "[\xC3\x89T\xC3\x89]", EntryStep::moved, "c:\\\xC3\x89t\xC3\x89\\"},
        {"C:\\", "[a.zkt", EntryStep::file, "C:\\"},
        {"C:\\", "]a.zkt", EntryStep::file, "C:\\"},
        {"C:\\Games\\", "[]", EntryStep::refused, "C:\\Games\\"},
        {deep, "[ab]", EntryStep::moved, deep + "ab\\"},
        {deep, "[abc]", EntryStep::moved, deep + "abc\\"},
        {deep, "[abcd]", EntryStep::refused, deep},
    };

    for (const auto& one : cases) {
        char directory[DIRECTORY_SIZE];
        CopyText(directory, one.directory.c_str(), sizeof directory);
        EXPECT_EQ(StepDirectory(directory, one.entry), one.step) << one.directory << one.entry;
        EXPECT_EQ(std::string(static_cast<const char*>(directory)), one.after) << one.entry;
    }
}

TEST_F(Setup, EnablesOneGroupOrTheOther) {
    for (const LONG style : {1, 0, 7}) {
        WalkingStyle = style;
        open();
        EXPECT_EQ(enabled(), style == 0 ? "yyyyyynnnn" : "yyyynnyyyy");
        click("&Walk");
        EXPECT_EQ(enabled(), "yyyyyynnnn");
        click("&Playback");
        EXPECT_EQ(enabled(), "yyyynnyyyy");
        EXPECT_EQ(WalkingStyle, style) << "only OK takes it";
        DestroyWindow(dialog);
    }
}

TEST_F(Setup, SavesWhatOKTakesAndWhatCancelLeaves) {
    for (const char* end : {"&OK", "&Cancel"}) {
        WalkingStyle = Statements = Backgrounds = 1;
        setEntries({"Sub/"});
        GetCurrentDirectoryA(sizeof Directory, Directory);
        open();
        openEntry("[Sub]");
        click("&Walk");
        click("&Allow");
        click(end);
        const bool taken = *(end + 1) == 'O';
        EXPECT_EQ(savedSetting("Walking Style"), taken ? "0" : "1") << end;
        EXPECT_EQ(savedSetting("Statements"), taken ? "0" : "1") << end;
        EXPECT_EQ(savedSetting("Backgrounds"), "1") << end;
        EXPECT_TRUE(savedSetting("Directory").ends_with("\\toons\\sub\\")) << end;
        DestroyWindow(dialog);
        fs::current_path("..");
    }
}

TEST_F(Setup, ListsToonsDirectoriesAndDrivesAndWalksAmongThem) {
    setEntries(
        {"b.zkt", "A.ZKT", "c.txt", "d.zkt/", "Sub/", ".hidden/", ".h.zkt", "-x/", " y.zkt"});
    fs::create_directory("Sub/Deep");
    open();
    EXPECT_THAT(listed(), ElementsAre(" y.zkt", "[-c-]", "[-x]", "[..]", "[d.zkt]", "[Sub]",
                                      "A.ZKT", "b.zkt"));
    EXPECT_EQ(count(), "5"); // whatever has the name of a Toon
    openEntry("[Sub]");
    EXPECT_THAT(listed(), ElementsAre("[-c-]", "[..]", "[Deep]"));
    EXPECT_EQ(count(), "0");
    fs::remove("Deep");
    openEntry("[Deep]"); // gone: list and count stay, the text goes on
    EXPECT_THAT(listed(), ElementsAre("[-c-]", "[..]", "[Deep]"));
    EXPECT_TRUE(std::string(static_cast<const char*>(Directory)).ends_with("\\sub\\deep\\"));
    openEntry("[..]");
    openEntry("[-c-]");
    EXPECT_STREQ(static_cast<const char*>(Directory), "c:\\");
    const Names root = listed();
    EXPECT_EQ(std::count(root.begin(), root.end(), "[..]"), 0);
}

TEST_F(Setup, BearsADirectoryThatCannotBeEntered) {
    CopyText(Directory, "c:\\no such place\\", sizeof Directory);
    open();
    EXPECT_EQ(count(), "00");
    EXPECT_TRUE(listed().empty());
    SetupOpenEntry(dialog, {}); // nothing is selected
    click("&Cancel");
    EXPECT_EQ(savedSetting("Directory"), "c:\\no such place\\");
}

TEST_F(Setup, PlaysAToonAndComesBackAgainAndAgain) {
    setEntries({"bad.zkt"});
    ToonFrame frame{};
    frame.pause = 1;
    putToon("one.zkt", "One", {frame});
    open();
    const fs::path before = fs::current_path();
    seam::HandleCounts counts{};
    // Never, before it starts, in mid-walk, in a pause.
    const char* const moments[] = {"never", "timer_set timer=SHOWSTART", " walk ",
                                   "timer_set timer=PAUSE"};
    for (int round = 0; round < 12; ++round) {
        record.clear();
        pressKeyAt = moments[round % 4];
        openEntry("one.zkt");
        pressKeyAt = "";
        EXPECT_FALSE(IsWindow(PlayerWindow));
        EXPECT_EQ(RecordedStage::count("show_done"), round % 4 == 0 ? 1U : 0U) << round;
        EXPECT_EQ(fs::current_path(), before);
        counts = round == 0 ? seam::liveHandles() : counts;
        EXPECT_EQ(seam::liveHandles(), counts) << round;
    }
    pressKeyAt = "message text";
    openEntry("bad.zkt");
    pressKeyAt = "";
    EXPECT_FALSE(IsWindow(PlayerWindow));
    click("&Walk");
    EXPECT_EQ(enabled(), "yyyyyynnnn") << "the dialog still works";
}

TEST_F(Setup, AHundredOpeningsAndPlaysLeaveNothingBehind) {
    constexpr std::size_t slack = 65536; // bytes, for lists of the toolkit's that find their size
    putToon("one.zkt", "", {ToonFrame{}});
    std::size_t heap = 0;
    for (int round = 0; round < 110; ++round) {
        heap = round == 10 ? mallinfo2().uordblks : heap;
        open();
        pressKeyAt = "timer_set timer=SHOWSTART";
        openEntry("one.zkt");
        click("&Cancel");
        DestroyWindow(dialog);
        record.clear();
    }
    EXPECT_LE(mallinfo2().uordblks, heap + slack);
}

TEST_F(Setup, ADoubleClickThatComesLateOpensNoSecondPlayer) {
    ToonFrame frame{};
    frame.pause = 1;
    putToon("one.zkt", "One", {frame});
    open();
    pressKeyAt = "timer_set timer=PAUSE";
    // What the second and third press of a held space bar leave in the queue.
    for (int i = 0; i < 2; ++i) {
        PostMessageA(dialog, WM_COMMAND, static_cast<WPARAM>(MAKELONG(1043, LBN_DBLCLK)), 0);
    }
    record.clear();
    openEntry("one.zkt");
    pressKeyAt = "";
    EXPECT_FALSE(IsWindow(PlayerWindow));
    EXPECT_EQ(RecordedStage::count("timer_set timer=SHOWSTART"), 1U);
}

TEST_F(Setup, PlayerIgnoresThePointerAndFollowsItsSize) {
    open();
    std::vector<bool> alive;
    DWORD stageSize = 0;
    QTimer::singleShot(0, [&] {
        for (const UINT message : {WM_MOUSEMOVE, WM_RBUTTONDOWN, WM_MBUTTONDOWN, WM_KEYUP}) {
            SendMessageA(PlayerWindow, message, 0, 0);
            alive.push_back(IsWindow(PlayerWindow) != FALSE);
        }
        MoveWindow(PlayerWindow, 5, 5, 300, 200, FALSE);
        stageSize = StageSize;
        SendMessageA(PlayerWindow, WM_SYSKEYDOWN, 0x12, 0);
        alive.push_back(IsWindow(PlayerWindow) != FALSE);
    });
    EXPECT_EQ(RunPlayer(GetModuleHandleA(nullptr), nullptr, ""), 0);
    EXPECT_THAT(alive, ElementsAre(true, true, true, true, false));
    EXPECT_EQ(stageSize, MAKELONG(300, 200)) << "the stage follows its window";
}
