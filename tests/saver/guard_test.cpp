// What ends the saver and what doesn't, and the password in between.
#include "platform/kernel/modules.h"
#include "saver/saver_main.h"
#include "stage/stage.h"
#include "tests/saver/saver_fixture.h"

#include <stdexcept>

using testing::ElementsAre;

namespace {

using Codes = std::vector<DWORD>;

Codes codes; // what the device has been told
int asked;   // how often the password has been asked for
BOOL verdict;
std::function<void()> meanwhile; // what goes on while it is asked for

BOOL verify(HWND /*window*/) {
    ++asked;
    if (meanwhile) {
        meanwhile();
    }
    return verdict;
}

bool noteCode(DWORD code) {
    codes.push_back(code);
    return true;
}

std::vector<std::pair<HWND, HIMC>> associations;

HIMC associate(HWND window, HIMC context) {
    associations.emplace_back(window, context);
    return HIMC{5};
}

POINT cursor() {
    POINT at{};
    GetCursorPos(&at);
    return at;
}

class Guard : public SaverTest {
  protected:
    void SetUp() override {
        SaverTest::SetUp();
        codes.clear();
        asked = 0;
        verdict = FALSE;
        meanwhile = nullptr;
        associations.clear();
        SetCursorPos(300, 200);
    }

    void TearDown() override {
        seam::answerBoxes(nullptr);
        UnloadPasswordModule();
        VerifyPassword = nullptr;
        SaverTest::TearDown();
    }

    /// A fresh saver window, or a preview.
    void open(DWORD mode = PREVIEW_NONE) {
        closeStage();
        ForgetEarlierStages();
        PreviewMode = mode;
        openStage();
        pass(0);
    }

    /// Whether the window has gone once the message has been handled, and what that brought about.
    bool endsOn(UINT message, WPARAM wParam = 0) {
        SendMessageA(stage, message, wParam, 0);
        pass(0);
        return !IsWindow(stage);
    }

    static void moveMouse(int x, int y) {
        SetCursorPos(cursor().x + x, cursor().y + y);
    }

    static void setRegistry(const std::string& text) {
        std::ofstream(std::string(std::getenv("XDG_CONFIG_HOME")) + "/dorbo/registry.ini") << text;
    }

    static void wantPassword() {
        setRegistry("[Control Panel\\Desktop]\r\nScreenSaveUsePassword=1\r\n");
    }

    seam::DeviceRegistration device{"\\\\.\\REBOOT", noteCode};
};

TEST_F(Guard, EndsOnInputAndOnTheLossOfActivation) {
    const std::tuple<UINT, WPARAM, bool, bool> cases[] = {
        {WM_KEYDOWN, 'A', true, false},
        {WM_SYSKEYDOWN, 0x79, true, false},
        {WM_LBUTTONDOWN, 1, true, false},
        {WM_RBUTTONDOWN, 2, true, false},
        {WM_MBUTTONDOWN, 16, true, false},
        {WM_ACTIVATEAPP, 0, true, false},
        {WM_ACTIVATEAPP, 1, false, false},
        {WM_KEYUP, 'A', false, false},
        {WM_MOUSEMOVE, 0, false, false}, // an event without travel
        {WM_HELP, 0, false, false},
        {WM_SYSCOMMAND, SC_NEXTWINDOW, false, false},
        {WM_SYSCOMMAND, SC_CLOSE, true, true},
        {WM_CLOSE, 0, true, true},
        {WM_ENDSESSION, 1, true, true},
    };
    for (const auto& [message, wParam, endsSaver, endsPreview] : cases) {
        open();
        EXPECT_EQ(endsOn(message, wParam), endsSaver) << message;
        for (const DWORD mode : {PREVIEW_WALK, PREVIEW_WHOLE}) {
            open(mode);
            EXPECT_EQ(endsOn(message, wParam), endsPreview) << message << ", " << mode;
        }
    }
}

TEST_F(Guard, FourPixelsOfTravelEndIt) {
    const std::pair<std::vector<POINT>, bool> cases[] = {
        {{{2, 1}}, false},
        {{{2, 2}}, true},
        {{{-4, 0}}, true},
        {{{0, 3}, {0, -3}, {-1, -2}}, false},
        {{{1, 0}, {1, 0}, {0, 1}, {1, 0}}, true},
    };
    for (const auto& [moves, ends] : cases) {
        open();
        bool ended = false;
        for (const POINT& move : moves) {
            moveMouse(move.x, move.y);
            ended = endsOn(WM_MOUSEMOVE);
        }
        EXPECT_EQ(ended, ends) << moves.front().x << ' ' << moves.front().y;
    }
    open(PREVIEW_WALK);
    moveMouse(50, 50);
    EXPECT_FALSE(endsOn(WM_MOUSEMOVE)) << "a preview";
}

TEST_F(Guard, HelpOnAPreviewGoesToItsParent) {
    const HWND parent = createWindow("GuardParentClass", DefWindowProcA, {99, 99});
    PreviewMode = PREVIEW_WALK;
    openStage(90, 90, parent);
    for (const UINT help : {WM_HELP, WM_CONTEXTMENU}) {
        EXPECT_EQ(SendMessageA(stage, help, 0, 0), 1);
        MSG heard{};
        EXPECT_TRUE(PeekMessageA(&heard, parent, help, help, PM_REMOVE));
        EXPECT_EQ(heard.wParam, parent.number);
    }
    closeStage();
    DestroyWindow(parent);
}

TEST_F(Guard, TheTitleStays) {
    open();
    EXPECT_EQ(SendMessageA(stage, WM_SETTEXT, 0, reinterpret_cast<LPARAM>("Other")), 0);
    EXPECT_FALSE(FindWindowA("SaverTestClass", "Other"));
}

TEST_F(Guard, ARefusedPasswordLeavesItRunning) {
    open();
    VerifyPassword = verify;
    meanwhile = [this] {
        EXPECT_EQ(SaverVerifying, 1U);
        moveMouse(40, 40);
        // As the loop of the password's dialog would, and what piles up behind it.
        SendMessageA(stage, WM_KEYDOWN, 'A', 0);
        SendMessageA(stage, WM_MOUSEMOVE, 0, 0);
        PostMessageA(stage, WM_LBUTTONDOWN, 1, 0);
        PostMessageA(stage, WM_ACTIVATEAPP, 0, 0);
        PostMessageA(stage, WM_CLOSE, 0, 0);
    };
    for (int i = 0; i < 3; ++i) {
        PostMessageA(stage, WM_KEYDOWN, 'A', 0);
    }
    pass(0);
    EXPECT_EQ(asked, 1) << "keys that were held down ask no second time";
    ASSERT_TRUE(IsWindow(stage));
    EXPECT_EQ(SaverVerifying + SaverClosing, 0U);
    EXPECT_EQ(MouseStartPos.x, cursor().x);
    EXPECT_EQ(MouseStartPos.y, cursor().y);

    meanwhile = nullptr;
    moveMouse(1, 2);
    EXPECT_FALSE(endsOn(WM_MOUSEMOVE));
    EXPECT_EQ(asked, 1);
    verdict = 7;
    EXPECT_TRUE(endsOn(WM_KEYDOWN, 'A'));
    EXPECT_EQ(asked, 2);
    EXPECT_EQ(SaverClosing, 7U);
}

TEST_F(Guard, TheShowGoesOnBehindThePassword) {
    writeToon("a.zkt", {{300, 200, 0, 5, 0, "", 0}});
    open();
    VerifyPassword = verify;
    ASSERT_TRUE(runUntilEvent("draw"));
    const auto drawn = [this] {
        const std::size_t before = count("draw");
        SendMessageA(stage, WM_TIMER, TIMER_WALK, 0);
        return count("draw") - before;
    };
    std::size_t behind = 0;
    meanwhile = [&] { behind = drawn(); };
    EXPECT_EQ(VerifyBeforeClose(stage), 0U);
    EXPECT_EQ(behind, 1U);
    verdict = TRUE;
    EXPECT_NE(VerifyBeforeClose(stage), 0U);
    EXPECT_EQ(drawn(), 0U) << "nothing moves any more";
}

TEST_F(Guard, ASignalEndsItWithoutThePassword) {
    open();
    VerifyPassword = verify;
    EXPECT_TRUE(endsOn(WM_ENDSESSION, 1));
    open();
    meanwhile = [this] { SendMessageA(stage, WM_ENDSESSION, 1, 0); };
    EXPECT_TRUE(endsOn(WM_CLOSE));
    EXPECT_EQ(asked, 1);
    EXPECT_EQ(savedSetting("Paces Walked"), "100");
}

TEST_F(Guard, ThePasswordAppliesWhereTheRegistryAndTheModuleSaySo) {
    const std::string desktop = "[Control Panel\\Desktop]\r\n";
    const std::pair<std::string, bool> cases[] = {
        {"", false},
        {desktop, false},
        {desktop + "ScreenSaveUsePassword=0\r\n", false},
        {desktop + "ScreenSaveUsePassword=1\r\n", true},
        {"[Other]\r\nScreenSaveUsePassword=1\r\n", false},
    };
    open(); // makes the directory of the settings
    for (const auto& [registry, applies] : cases) {
        SCOPED_TRACE(registry);
        codes.clear();
        setRegistry(registry);
        LoadPasswordModule();
        EXPECT_EQ(VerifyPassword != nullptr, applies);
        UnloadPasswordModule();
        EXPECT_EQ(VerifyPassword, nullptr);
        EXPECT_EQ(codes, applies ? (Codes{1, 2}) : Codes{});
    }
    wantPassword();
    codes.clear();
    const seam::ModuleRegistration without("PASSWORD.CPL", {"Other", nullptr},
                                           seam::ModuleRegistration::Kind::loadable);
    LoadPasswordModule();
    EXPECT_EQ(VerifyPassword, nullptr) << "a module that lacks the entry";
    EXPECT_EQ(without.uses, 0U);
    EXPECT_TRUE(codes.empty());
}

TEST_F(Guard, TheInputMethodIsTakenOffAndGivenBack) {
    const seam::ModuleRegistration module(
        "IMM32.DLL", {"ImmAssociateContext", reinterpret_cast<FARPROC>(associate)},
        seam::ModuleRegistration::Kind::resident);
    open();
    const HWND window = stage;
    EXPECT_THAT(associations, ElementsAre(std::pair(window, HIMC{})));
    EXPECT_TRUE(endsOn(WM_CLOSE));
    EXPECT_THAT(associations, ElementsAre(std::pair(window, HIMC{}), std::pair(window, HIMC{5})));
}

TEST_F(Guard, EachPasswordSetIsFollowedByOneDropped) {
    setEntries({"a.zkt"}); // which doesn't load
    open();                // leaves settings that play it
    closeStage();
    wantPassword();
    for (const bool fault : {false, true}) {
        codes.clear();
        ForgetEarlierStages();
        seam::answerBoxes([fault](const std::string&, const std::string&, UINT) {
            if (fault) {
                throw std::runtime_error("a fault in the show, as the test wants it");
            }
            PostMessageA(SaverWindow, WM_KEYDOWN, 'A', 0);
            return IDOK;
        });
        EXPECT_EQ(SaverMain(GetModuleHandleA(nullptr), "S"), fault ? -1 : 0);
        EXPECT_EQ(codes, (Codes{1, 2}));
    }
    stage = SaverWindow;
}

} // namespace
