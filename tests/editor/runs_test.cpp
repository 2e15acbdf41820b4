// How runs of the editor begin and end, and that none leaves anything to the next.
#include "tests/editor/editor_fixture.h"

#include "editor/button_states.h"
#include "platform/kernel.h"
#include "platform/user/window.h"
#include "saver/setup_dialog.h"
#include "stage/backdrop.h"
#include "stage/bubble.h"
#include "stage/face.h"
#include "stage/player.h"
#include "stage/random_walk.h"
#include "stage/walk.h"
#include "toon/toon_prompts.h"

namespace {

bool dialogStands() {
    bool found = false;
    seam::forEachWindow([&](const seam::Window& window) { found = found || window.dialog; });
    return found;
}

void postCommand(HWND window, int command) {
    PostMessageA(window, WM_COMMAND, static_cast<WPARAM>(command), 0);
}

int runEditor() {
    return RunEditor(GetModuleHandleA(nullptr), nullptr, SW_SHOWNORMAL);
}

void expectNothingLeft(const char* what) {
    MSG message{};
    EXPECT_EQ(EditorMainWindow, HWND{}) << what;
    EXPECT_EQ(EditorStage, HWND{}) << what;
    EXPECT_EQ(PeekMessageA(&message, nullptr, WM_QUIT, WM_QUIT, PM_REMOVE), FALSE) << what;
}

TEST_F(EditorTest, ARunEndsWithItsWindowHoweverThatGoes) {
    const std::pair<const char*, std::function<void()>> ways[] = {
        {"the button",
         [] {
             PostMessageA(EditorMainWindow, WM_COMMAND, 0, static_cast<LPARAM>(CloseButton.number));
         }},
        {"Exit", [] { postCommand(EditorMainWindow, POPUP_EXIT); }},
        {"the window manager", [] { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); }},
        {"the stage", [] { PostMessageA(EditorStage, WM_CLOSE, 0, 0); }},
        {"the setup", CloseEditorIfOpen},
        {"the session", [] { PostMessageA(EditorMainWindow, WM_ENDSESSION, TRUE, 0); }},
        {"behind the about box",
         [] {
             postCommand(EditorMainWindow, POPUP_ABOUT);
             once(dialogStands, [] { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); });
         }},
    };
    for (const auto& [name, close] : ways) {
        bool stood = false;
        once(editorStands, [&stood, &go = close] {
            stood = true;
            go();
        });
        EXPECT_EQ(runEditor(), 0) << name;
        EXPECT_TRUE(stood) << name;
        expectNothingLeft(name);
    }
}

TEST_F(EditorTest, TheSetupsButtonClosesTheEditorAndOpensAnother) {
    constexpr int editButton = 1044;
    constexpr int ok = 1;
    static std::vector<HWND> editors;
    editors.clear();
    const HWND setup =
        CreateDialogParamA(GetModuleHandleA(nullptr), 2003, nullptr, SetupDialogProc, 0);
    postCommand(setup, editButton);
    once(editorStands, [setup] {
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

TEST_F(EditorTest, ClosedInAnyStateItsStageBeginsClean) {
    for (const EditorState& state : editorStates) {
        reach(state.name);
        if (state.timers.contains("WALK")) {
            pass(700); // into the walk
        }
        close();
        expectNothingLeft(state.name);
        open();
        EXPECT_EQ(stateNow(), "idle") << state.name;
        const std::tuple<const char*, LONG, LONG> values[] = {
            {"WalkTimerRunning", WalkTimerRunning, 0},
            {"PendingPause", PendingPause, 0},
            {"PendingText", PendingText[0], 0},
            {"Talking", Talking, 0},
            {"BubbleHidden", BubbleHidden, 1},
            {"WalkingOut", WalkingOut, 0},
            {"OpeningDone", OpeningDone, 0},
            {"ButtonsSaved", ButtonsSaved, 0},
            {"CurrentFrameIndex", CurrentFrameIndex, 0},
            {"FrameCount", FrameCount, 1},
            {"ToonFileName", ToonFileName[0], 0},
            {"BackgroundIndex", BackgroundIndex, 0},
            {"cursor", SetClassLongA(EditorStage, GCL_HCURSOR, LONG{IDC_ARROW.number}),
             IDC_ARROW.number},
        };
        for (const auto& [name, is, shouldBe] : values) {
            EXPECT_EQ(is, shouldBe) << name << ", closed at " << state.name;
        }
        EXPECT_STREQ(CaptionText, "Fenky Dorbo's Rematch");
        record.clear();
        pass(1200);
        EXPECT_THAT(events({"walk"}), testing::Contains(testing::HasSubstr("to=[275,350]")))
            << "no Toon is in memory to scale by";
        close();
    }
}

} // namespace
