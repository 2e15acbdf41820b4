// How runs of the editor begin and end, and that none leaves anything to the next.
#include "tests/editor/editor_fixture.h"

#include "platform/kernel.h"
#include "platform/user/window.h"
#include "saver/setup_dialog.h"
#include "saver/toon_player.h"
#include "stage/backdrop.h"
#include "stage/random_walk.h"
#include "toon/settings.h"

namespace {

bool dialogStands() {
    bool found = false;
    seam::forEachWindow([&](const seam::Window& window) { found = found || window.dialog; });
    return found;
}

void postCommand(HWND window, int command) {
    PostMessageA(window, WM_COMMAND, static_cast<WPARAM>(command), 0);
}

void expectNothingLeft(const std::string& what) {
    MSG message{};
    EXPECT_EQ(EditorMainWindow, HWND{}) << what;
    EXPECT_EQ(EditorStage, HWND{}) << what;
    EXPECT_EQ(PeekMessageA(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE), FALSE) << what;
}

TEST_F(EditorTest, ARunEndsWithItsWindowHoweverThatGoes) {
    struct Way {
        HWND* window;
        UINT message;
        WPARAM wParam;
        bool behindAboutBox;
    };

    const Way ways[] = {
        {&EditorMainWindow, WM_COMMAND, POPUP_EXIT, false},
        {&EditorMainWindow, WM_CLOSE, 0, false},
        {&EditorStage, WM_CLOSE, 0, false},
        {&EditorMainWindow, WM_ENDSESSION, TRUE, false},
        {&EditorMainWindow, WM_CLOSE, 0, true},
    };
    for (const Way& way : ways) {
        once(editorStands, [&way] {
            if (way.behindAboutBox) {
                postCommand(EditorMainWindow, POPUP_ABOUT);
            }
            once(way.behindAboutBox ? dialogStands : editorStands,
                 [&way] { PostMessageA(*way.window, way.message, way.wParam, 0); });
        });
        EXPECT_EQ(RunEditor(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL), 0);
        expectNothingLeft(std::to_string(way.message));
    }
}

TEST_F(EditorTest, TheSetupsButtonClosesTheEditorAndOpensAnother) {
    constexpr int editButton = 1044;
    constexpr int ok = 1;
    static std::vector<HWND> editors;
    editors.clear();
    const HWND setup =
        CreateDialogParamA(GetModuleHandleA(nullptr), 2003, nullptr, SetupDialogProc, 0);
    CheckDlgButton(setup, 1040, 0);
    postCommand(setup, editButton);
    once(editorStands, [setup] {
        EXPECT_EQ(Statements, 0) << "saved, for the editor reads the file anew";
        editors.push_back(EditorMainWindow);
        postCommand(setup, editButton); // reaches the dialog in the first editor's loop
        once([] { return editorStands() && EditorMainWindow != editors[0]; },
             [setup] {
                 editors.push_back(EditorMainWindow);
                 postCommand(setup, ok);
             });
    });
    pass(0);
    ASSERT_EQ(editors.size(), 2U);
    EXPECT_NE(editors[0], editors[1]);
    EXPECT_TRUE(editors[1]);
    expectNothingLeft("both");
    DestroyWindow(setup);
}

TEST_F(EditorTest, AToonThatTheSetupPlaysClosesTheEditor) {
    constexpr int list = 1043;
    GetCurrentDirectoryA(sizeof Directory, Directory);
    SettingsSave();
    const HWND setup =
        CreateDialogParamA(GetModuleHandleA(nullptr), 2003, nullptr, SetupDialogProc, 0);
    const auto last = SendDlgItemMessageA(setup, list, LB_GETCOUNT, 0, 0) - 1; // two.zkt
    SendDlgItemMessageA(setup, list, LB_SETCURSEL, static_cast<WPARAM>(last), 0);
    once(editorStands, [setup] { postCommand(setup, MAKELONG(list, LBN_DBLCLK)); });
    once([] { return IsWindow(PlayerWindow) != FALSE; },
         [] {
             EXPECT_FALSE(EditorMainWindow);
             DestroyWindow(EditorMainWindow);
             PostMessageA(PlayerWindow, WM_KEYDOWN, ' ', 0);
         });
    RunEditor(GetModuleHandleA(nullptr), setup, SW_SHOWNORMAL);
    EXPECT_FALSE(IsWindow(PlayerWindow));
    expectNothingLeft("the player");
    DestroyWindow(setup);
    DeleteObject(BackdropBitmap); // the next stage's start would free it
    BackdropBitmap = nullptr;
}

TEST_F(EditorTest, AToonThatIsNamedIsOpenFromTheStart) {
    const std::tuple<std::string, std::string, LONG> cases[] = {
        {"two.zkt", "two.zkt", 2},
        {"none.zkt", "", 0},
    };
    for (const auto& [named, name, frames] : cases) {
        const std::function<void()> look = [&, &name = name, &frames = frames] {
            EXPECT_EQ(ToonFileName, name);
            EXPECT_EQ(FrameCount, frames);
            EXPECT_EQ(IsWindowEnabled(PlayButton), name.empty() ? FALSE : TRUE);
            EXPECT_EQ(BackgroundIndex, name.empty() ? 0 : 3);
        };
        once(editorStands, [&] {
            look();
            once([] { return OpeningDone != 0 && RandomWalkActive == 0; },
                 [&] {
                     look(); // also when he has said hello
                     PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0);
                 });
        });
        RunEditorWith(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL, named.c_str());
        expectNothingLeft(named.c_str());
    }
    EXPECT_EQ(boxes.size(), 1U) << "for the one that is none";
    EXPECT_EQ(filesAsked, 0);
}

TEST_F(EditorTest, ClosedInAnyStateItsStageBeginsClean) {
    for (const EditorState& state : editorStates) {
        reach(state.name);
        if (state.timers.contains("WALK")) {
            pass(700); // into the walk
        }
        press(CloseButton);
        expectNothingLeft(state.name);
        open();
        EXPECT_EQ(stateNow(), "idle") << state.name;
        EXPECT_EQ(SetClassLongA(EditorStage, GCL_HCURSOR, LONG{IDC_ARROW.number}),
                  IDC_ARROW.number);
        EXPECT_EQ(ToonFileName + std::to_string(FrameCount), "1");
        EXPECT_EQ(CurrentFrameIndex + BackgroundIndex, 0);
        EXPECT_STREQ(CaptionText, "Fenky Dorbo's Rematch");
        record.clear();
        pass(1200);
        EXPECT_THAT(events({"walk"}), testing::Contains(testing::HasSubstr("to=[275,350]")))
            << "no Toon is in memory to scale by";
        close();
    }
}

} // namespace
