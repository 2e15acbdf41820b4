// What ends the saver and what doesn't, and the password in between.
#include "platform/kernel/modules.h"
#include "saver/saver_main.h"
#include "stage/stage.h"
#include "tests/saver/saver_fixture.h"

#include <stdexcept>

#include <sys/wait.h>
#include <unistd.h>

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

class Guard : public SaverTest {
  protected:
    void SetUp() override {
        SaverTest::SetUp();
        codes.clear();
        asked = 0;
        verdict = FALSE;
        meanwhile = nullptr;
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

    static void setRegistry(const std::string& text) {
        std::ofstream(std::string(std::getenv("XDG_CONFIG_HOME")) + "/dorbo/registry.ini") << text;
    }

    static constexpr const char* wanted = "[Control Panel\\Desktop]\r\nScreenSaveUsePassword=1\r\n";

    seam::DeviceRegistration device{"\\\\.\\REBOOT", noteCode};
};

TEST_F(Guard, EndsOnInputAndOnTheLossOfActivation) {
    // The message, and whether it ends the saver and a preview.
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
        {WM_SYSCOMMAND, SC_NEXTWINDOW, false, false},
        {WM_SYSCOMMAND, SC_CLOSE, true, true},
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
        {{{302, 201}}, false},
        {{{302, 202}}, true},
        {{{300, 203}, {300, 200}, {299, 198}}, false},
        {{{299, 200}, {298, 200}, {298, 199}, {297, 199}}, true},
    };
    for (const auto& [places, ends] : cases) {
        for (const DWORD mode : {PREVIEW_NONE, PREVIEW_WALK}) {
            SetCursorPos(300, 200);
            open(mode);
            bool ended = false;
            for (const POINT& place : places) {
                SetCursorPos(place.x, place.y);
                ended = endsOn(WM_MOUSEMOVE);
            }
            EXPECT_EQ(ended, ends && mode == PREVIEW_NONE) << places.back().x;
        }
    }
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
        SetCursorPos(340, 240);
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

    meanwhile = nullptr;
    SetCursorPos(341, 242); // counted from where it was when refused
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
    const std::pair<std::string, Codes> cases[] = {
        {"", {}},
        {"[Control Panel\\Desktop]\r\nScreenSaveUsePassword=0\r\n", {}},
        {wanted, {1, 2}},
        {"[Other]\r\nScreenSaveUsePassword=1\r\n", {}},
    };
    open(); // makes the directory of the settings
    for (const auto& [registry, told] : cases) {
        codes.clear();
        setRegistry(registry);
        LoadPasswordModule();
        EXPECT_EQ(VerifyPassword != nullptr, !told.empty()) << registry;
        UnloadPasswordModule();
        EXPECT_EQ(VerifyPassword, nullptr);
        EXPECT_EQ(codes, told) << registry;
    }
    setRegistry(wanted);
    codes.clear();
    const seam::ModuleRegistration without("PASSWORD.CPL", {"Other", nullptr},
                                           seam::ModuleRegistration::Kind::loadable);
    LoadPasswordModule();
    EXPECT_EQ(VerifyPassword, nullptr) << "a module that lacks the entry";
    EXPECT_EQ(without.uses, 0U);
    EXPECT_TRUE(codes.empty());
}

TEST_F(Guard, EachPasswordSetIsFollowedByOneDropped) {
    setEntries({"a.zkt"}); // which doesn't load
    open();                // leaves settings that play it
    closeStage();
    setRegistry(wanted);
    ForgetEarlierStages();
    for (const bool fault : {false, true}) {
        seam::answerBoxes([fault](const std::string&, const std::string&, UINT) {
            if (fault) {
                throw std::runtime_error("a fault in the show, as the test wants it");
            }
            PostMessageA(SaverWindow, WM_KEYDOWN, 'A', 0);
            return IDOK;
        });
        const pid_t child = fork(); // a process sets up the saver's class once
        if (child == 0) {
            // A display's name of its own: it finds no saver of another test's.
            setenv("QT_QPA_PLATFORM", std::to_string(getpid()).c_str(), 1);
            const int code = SaverMain(GetModuleHandleA(nullptr), "S");
            _exit(code == (fault ? -1 : 0) && codes == Codes{1, 2} ? 0 : 1);
        }
        int status = -1;
        waitpid(child, &status, 0);
        EXPECT_EQ(status, 0) << fault;
    }
}

} // namespace
