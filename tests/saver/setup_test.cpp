// The setup dialog, and the player that it opens.
#include "saver/setup_dialog.h"

#include "saver/saver_main.h"
#include "saver/toon_player.h"
#include "stage/stage.h"
#include "tests/saver/saver_fixture.h"

#include <QTimer>

#include <malloc.h>

namespace fs = std::filesystem;
using testing::ElementsAre;

namespace {

constexpr WORD WALK = 1037;
constexpr WORD PLAYBACK = 1038;
constexpr WORD STATEMENTS = 1040;
constexpr WORD LIST = 1043;
constexpr WORD COUNT = 1045;

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

    void TearDown() override {
        DestroyWindow(dialog);
        SaverTest::TearDown();
    }

    void open() {
        SettingsSave();
        dialog = CreateDialogParamA(GetModuleHandleA(nullptr), SETUP_DIALOG, nullptr,
                                    SetupDialogProc, 0);
        ASSERT_TRUE(dialog);
        pass(0);
    }

    /// As a control tells of what the user does with it.
    void command(WORD id, WORD code = 0) const {
        PostMessageA(dialog, WM_COMMAND, static_cast<WPARAM>(MAKELONG(id, code)), 0);
        pass(0);
    }

    Names listed() const {
        Names names(static_cast<std::size_t>(SendDlgItemMessageA(dialog, LIST, LB_GETCOUNT, 0, 0)));
        for (WPARAM row = 0; row < names.size(); ++row) {
            char name[300];
            SendDlgItemMessageA(dialog, LIST, LB_GETTEXT, row, reinterpret_cast<LPARAM>(name));
            names[row] = static_cast<const char*>(name);
        }
        return names;
    }

    /// Double-clicks the entry of that text. In the player, if it opens, a key is pressed at this
    /// event of the record.
    void openEntry(const std::string& entry, const std::string& until = "") {
        const Names names = listed();
        const auto row = std::find(names.begin(), names.end(), entry) - names.begin();
        ASSERT_LT(row, std::ssize(names)) << entry;
        SendDlgItemMessageA(dialog, LIST, LB_SETCURSEL, static_cast<WPARAM>(row), 0);
        record.clear();
        pressKeyAt = until;
        command(LIST, LBN_DBLCLK);
        pressKeyAt = "";
        EXPECT_FALSE(IsWindow(PlayerWindow));
    }

    std::string count() const {
        char text[20];
        GetDlgItemTextA(dialog, COUNT, text, sizeof text);
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

    const std::tuple<std::string, const char*, EntryStep, std::string> cases[] = {
        {"c:\\games\\toons\\", "[..]", EntryStep::moved, "c:\\games\\"},
        {"c:\\games\\", "[..]", EntryStep::moved, "c:\\"},
        {"c:\\", "[..]", EntryStep::refused, "c:\\"}, // what is left has no backslash
        {"\\tmp\\", "[..]", EntryStep::moved, "\\"},  // no drive: the root of the present one
        {"toons\\", "[..]", EntryStep::refused, "toons\\"},
        {"", "[..]", EntryStep::refused, ""},
        {"C:\\Games\\", "[-D-]", EntryStep::moved, "d:\\"},
        {"C:\\", "[-]", EntryStep::moved, "]:\\"}, // a directory named by a minus
        {"C:\\", "[a]b].zkt", EntryStep::moved, "c:\\a]b\\"},
        {"C:\\", "[\xC3\x89T\xC3\x89]", EntryStep::moved, "c:\\\xC3\x89t\xC3\x89\\"},
        {"C:\\", "[a.zkt", EntryStep::file, "C:\\"},
        {"C:\\Games\\", "[]", EntryStep::refused, "C:\\Games\\"},
        {deep, "[abc]", EntryStep::moved, deep + "abc\\"},
        {deep, "[abcd]", EntryStep::refused, deep},
    };

    for (const auto& [before, entry, step, after] : cases) {
        char directory[DIRECTORY_SIZE];
        CopyText(directory, before.c_str(), sizeof directory);
        EXPECT_EQ(StepDirectory(directory, entry), step) << before << entry;
        EXPECT_EQ(directory, after) << entry;
    }
}

TEST_F(Setup, EnablesOneGroupOrTheOther) {
    for (const LONG style : {1, 0, 7}) {
        WalkingStyle = style;
        open();
        EXPECT_EQ(enabled(), style == 0 ? "yyyyyynnnn" : "yyyynnyyyy");
        command(WALK);
        EXPECT_EQ(enabled(), "yyyyyynnnn");
        command(PLAYBACK);
        EXPECT_EQ(enabled(), "yyyynnyyyy");
        EXPECT_EQ(WalkingStyle, style) << "only OK takes it";
        DestroyWindow(dialog);
    }
}

TEST_F(Setup, SavesWhatOKTakesAndWhatCancelLeaves) {
    for (const WORD end : {WORD{IDOK}, WORD{IDCANCEL}}) {
        WalkingStyle = Statements = Backgrounds = 1;
        setEntries({"Sub/"});
        GetCurrentDirectoryA(sizeof Directory, Directory);
        open();
        openEntry("[Sub]");
        command(WALK);
        CheckDlgButton(dialog, STATEMENTS, 0);
        command(end);
        const char* taken = end == IDOK ? "0" : "1";
        EXPECT_EQ(savedSetting("Walking Style"), taken);
        EXPECT_EQ(savedSetting("Statements"), taken);
        EXPECT_EQ(savedSetting("Backgrounds"), "1");
        EXPECT_TRUE(savedSetting("Directory").ends_with("\\toons\\sub\\"));
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
    EXPECT_EQ(listed().size(), 3U);
    EXPECT_TRUE(std::string(Directory).ends_with("\\sub\\deep\\"));
    openEntry("[..]");
    openEntry("[-c-]");
    EXPECT_STREQ(Directory, "c:\\");
    EXPECT_THAT(listed(), testing::Not(testing::Contains("[..]")));
}

TEST_F(Setup, BearsADirectoryThatCannotBeEntered) {
    CopyText(Directory, "c:\\no such place\\", sizeof Directory);
    open();
    EXPECT_EQ(count(), "00");
    EXPECT_TRUE(listed().empty());
    SetupOpenEntry(dialog, {}); // nothing is selected
    command(IDCANCEL);
    EXPECT_EQ(savedSetting("Directory"), "c:\\no such place\\");
}

TEST_F(Setup, PlaysAToonAndComesBackAHundredTimesWithNothingLeftBehind) {
    constexpr std::size_t slack = 65536; // bytes, for lists of the toolkit's that find their size
    setEntries({"bad.zkt"});
    writeToon("one.zkt", {{0, 0, 0, 1, 0, "", 0}});
    const fs::path before = fs::current_path();
    // Never, before it starts, in mid-walk, in a pause.
    const char* const moments[] = {"never", "timer_set timer=SHOWSTART", " walk ",
                                   "timer_set timer=PAUSE"};
    seam::HandleCounts handles{};
    std::size_t heap = 0;
    for (int round = 0; round < 112; ++round) {
        open();
        openEntry("one.zkt", moments[round % 4]);
        EXPECT_EQ(RecordedStage::count("show_done"), round % 4 == 0 ? 1U : 0U) << round;
        EXPECT_EQ(fs::current_path(), before);
        command(IDCANCEL);
        DestroyWindow(dialog);
        if (round == 11) {
            handles = seam::liveHandles();
            heap = mallinfo2().uordblks;
        }
    }
    EXPECT_EQ(seam::liveHandles(), handles);
    EXPECT_LE(mallinfo2().uordblks, heap + slack);
    open();
    openEntry("bad.zkt", "message text");
    command(WALK);
    EXPECT_EQ(enabled(), "yyyyyynnnn") << "the dialog still works";
}

TEST_F(Setup, ADoubleClickThatComesLateOpensNoSecondPlayer) {
    writeToon("one.zkt", {{0, 0, 0, 1, 0, "", 0}});
    open();
    // As a space bar that is held leaves in the queue.
    PostMessageA(dialog, WM_COMMAND, static_cast<WPARAM>(MAKELONG(LIST, LBN_DBLCLK)), 0);
    openEntry("one.zkt", "timer_set timer=PAUSE");
    EXPECT_EQ(RecordedStage::count("timer_set timer=SHOWSTART"), 1U);
}

TEST_F(Setup, PlayerIgnoresThePointerAndFollowsItsSize) {
    open();
    for (const UINT last : {WM_SYSKEYDOWN, WM_KEYDOWN, WM_LBUTTONDOWN}) {
        std::string alive;
        DWORD stageSize = 0;
        QTimer::singleShot(0, [&] {
            MoveWindow(PlayerWindow, 5, 5, 300, 200, FALSE);
            stageSize = StageSize;
            for (const UINT message :
                 {WM_MOUSEMOVE, WM_RBUTTONDOWN, WM_MBUTTONDOWN, WM_KEYUP, last}) {
                SendMessageA(PlayerWindow, message, 0x12, 0);
                alive += IsWindow(PlayerWindow) != FALSE ? 'y' : 'n';
            }
        });
        EXPECT_EQ(RunPlayer(GetModuleHandleA(nullptr), nullptr, ""), 0);
        EXPECT_EQ(alive, "yyyyn") << last;
        EXPECT_EQ(stageSize, MAKELONG(300, 200));
    }
}
