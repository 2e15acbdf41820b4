// The setup dialog, and the player and the editor that it opens.
#include "saver/setup_dialog.h"

#include "editor/editor_shell.h"
#include "saver/saver_main.h"
#include "saver/toon_player.h"
#include "stage/editor_host.h"
#include "stage/stage.h"
#include "tests/saver/saver_fixture.h"

namespace fs = std::filesystem;
using testing::ElementsAre;

namespace {

constexpr WORD WALK = 1037;
constexpr WORD PLAYBACK = 1038;
constexpr WORD STATEMENTS = 1040;
constexpr WORD LIST = 1043;
constexpr WORD EDIT = 1044;
constexpr WORD COUNT = 1045;

class Setup : public SaverTest {
  protected:
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
    void post(WORD id, WORD code = 0) const {
        PostMessageA(dialog, WM_COMMAND, static_cast<WPARAM>(MAKELONG(id, code)), 0);
    }

    void command(WORD id) const {
        post(id);
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

    /// Selects the entry of that text, if it is there, and gives the click on it to the dialog.
    void postDoubleClick(const std::string& entry) const {
        const Names names = listed();
        const auto row = std::find(names.begin(), names.end(), entry) - names.begin();
        EXPECT_LT(row, std::ssize(names)) << entry;
        SendDlgItemMessageA(dialog, LIST, LB_SETCURSEL, static_cast<WPARAM>(row), 0);
        post(LIST, LBN_DBLCLK);
    }

    /// The same, until what it opens has gone. In the player a key is pressed at this event of the
    /// record.
    void openEntry(const std::string& entry, const std::string& until = "") {
        record.clear();
        if (!until.empty()) {
            once([until] { return count(until) != 0; },
                 [] { PostMessageA(PlayerWindow, WM_KEYDOWN, 0x1B, 0); });
        }
        postDoubleClick(entry);
        pass(0);
        EXPECT_FALSE(IsWindow(PlayerWindow));
    }

    std::string toonCount() const {
        char text[20];
        GetDlgItemTextA(dialog, COUNT, text, sizeof text);
        return text;
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
        {"c:\\", "[..]", EntryStep::refused, "c:\\"}, // what is left has no backslash
        {"\\tmp\\", "[..]", EntryStep::moved, "\\"},  // no drive: the root of the present one
        {"", "[..]", EntryStep::refused, ""},
        {"C:\\Games\\", "[-D-]", EntryStep::moved, "d:\\"},
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

TEST_F(Setup, EnablesOneGroupOrTheOtherAndSavesWhatOKTakesAndWhatCancelLeaves) {
    for (const WORD end : {WORD{IDOK}, WORD{IDCANCEL}}) {
        WalkingStyle = Statements = Backgrounds = 1;
        setEntries({"Sub/"});
        GetCurrentDirectoryA(sizeof Directory, Directory);
        open();
        openEntry("[Sub]");
        EXPECT_EQ(enabled(), "yyyynnyyyy");
        command(WALK);
        EXPECT_EQ(enabled(), "yyyyyynnnn");
        CheckDlgButton(dialog, STATEMENTS, 0);
        command(end);
        const std::string taken = end == IDOK ? "0" : "1";
        EXPECT_EQ(savedSetting("Walking Style") + savedSetting("Statements"), taken + taken);
        EXPECT_EQ(savedSetting("Backgrounds"), "1");
        EXPECT_TRUE(savedSetting("Directory").ends_with("\\toons\\sub\\"));
        DestroyWindow(dialog);
        fs::current_path("..");
    }
    WalkingStyle = 0;
    open();
    EXPECT_EQ(enabled(), "yyyyyynnnn");
    command(PLAYBACK);
    EXPECT_EQ(enabled(), "yyyynnyyyy");
}

TEST_F(Setup, ListsToonsDirectoriesAndDrivesAndWalksAmongThem) {
    setEntries(
        {"b.zkt", "A.ZKT", "c.txt", "d.zkt/", "Sub/", ".hidden/", ".h.zkt", "-x/", " y.zkt"});
    fs::create_directory("Sub/Deep");
    open();
    EXPECT_THAT(listed(), ElementsAre(" y.zkt", "[-c-]", "[-x]", "[..]", "[d.zkt]", "[Sub]",
                                      "A.ZKT", "b.zkt"));
    EXPECT_EQ(toonCount(), "5"); // whatever has the name of a Toon
    openEntry("[Sub]");
    EXPECT_THAT(listed(), ElementsAre("[-c-]", "[..]", "[Deep]"));
    EXPECT_EQ(toonCount(), "0");
    fs::remove("Deep");
    openEntry("[Deep]"); // gone: list and count stay, the text goes on
    EXPECT_EQ(listed().size(), 3U);
    EXPECT_TRUE(std::string(Directory).ends_with("\\sub\\deep\\"));
    command(IDCANCEL);
    EXPECT_TRUE(savedSetting("Directory").ends_with("\\sub\\deep\\"));
    openEntry("[..]");
    openEntry("[-c-]");
    EXPECT_STREQ(Directory, "c:\\");
    EXPECT_THAT(listed(), testing::Not(testing::Contains("[..]")));
}

TEST_F(Setup, PlaysAToonAndComesBackAtAnyMoment) {
    setEntries({"bad.zkt"});
    writeToon("one.zkt", {{0, 0, 0, 1, 0, "", 0}});
    const fs::path before = fs::current_path();
    open();
    for (const std::string moment :
         {"", "timer_set timer=SHOWSTART", "walk", "timer_set timer=PAUSE"}) {
        // Twice, as a space bar that is held leaves it in the queue: there is one player.
        post(LIST, LBN_DBLCLK);
        openEntry("one.zkt", moment);
        EXPECT_EQ(count("timer_set timer=SHOWSTART"), 1U) << moment;
        EXPECT_EQ(count("show_done"), moment.empty() ? 1U : 0U) << moment;
        EXPECT_EQ(fs::current_path(), before);
    }
    openEntry("bad.zkt", "message");
    command(WALK);
    EXPECT_EQ(enabled(), "yyyyyynnnn") << "the dialog still works";
}

TEST_F(Setup, PlayerIgnoresThePointerAndFollowsItsSize) {
    for (const UINT last : {WM_SYSKEYDOWN, WM_KEYDOWN, WM_LBUTTONDOWN}) {
        once([] { return IsWindow(PlayerWindow) != FALSE; },
             [last] {
                 MoveWindow(PlayerWindow, 5, 5, 300, 200, FALSE);
                 EXPECT_EQ(StageSize, MAKELONG(300, 200));
                 for (const UINT other : {WM_MOUSEMOVE, WM_RBUTTONDOWN, WM_MBUTTONDOWN, WM_KEYUP}) {
                     SendMessageA(PlayerWindow, other, 0x12, 0);
                     EXPECT_TRUE(IsWindow(PlayerWindow)) << other;
                 }
                 SendMessageA(PlayerWindow, last, 0x12, 0);
                 EXPECT_FALSE(IsWindow(PlayerWindow)) << last;
             });
        EXPECT_EQ(RunPlayer(GetModuleHandleA(nullptr), nullptr, ""), 0);
    }
}

TEST_F(Setup, ItsEditorIsClosedByAnotherOneByOkAndByAToonThatPlays) {
    writeToon("one.zkt", {{0, 0, 0, 1, 0, "", 0}});
    open();
    CheckDlgButton(dialog, STATEMENTS, 0);
    HWND first{};
    // What comes after the first command reaches the dialog in the editor's loop.
    once([] { return EditorStage != HWND{}; },
         [&] {
             EXPECT_EQ(Statements, 0) << "saved, for the editor reads the file anew";
             first = EditorMainWindow;
             post(EDIT);
         });
    once([&] { return first && EditorStage && EditorMainWindow != first; },
         [this] { postDoubleClick("one.zkt"); });
    once([] { return IsWindow(PlayerWindow) != FALSE; },
         [] {
             EXPECT_FALSE(EditorMainWindow);
             PostMessageA(PlayerWindow, WM_KEYDOWN, ' ', 0);
         });
    command(EDIT);
    EXPECT_FALSE(IsWindow(PlayerWindow));
    once([] { return EditorStage != HWND{}; }, [this] { post(IDOK); });
    command(EDIT);
    EXPECT_FALSE(EditorMainWindow || EditorStage);
}
