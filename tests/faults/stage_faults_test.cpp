// A whole show and a setup in which one thing after the other fails.
#include "saver/saver_main.h"
#include "saver/setup_dialog.h"
#include "stage/stage.h"
#include "tests/faults/each_fault.h"
#include "tests/saver/saver_fixture.h"

namespace {

using seam::Fault;
using seam::Operation;

const std::vector<ToonFrame> frames{{20, 60, 1, 1, 1, "One, two", 0}, {160, 60, 2, 1, 0, "", 0}};

class StageFaults : public SaverTest {
  protected:
    void SetUp() override {
        SaverTest::SetUp();
        seam::answerBoxes([](const std::string& text, const std::string&, UINT) {
            told += told.empty() ? text : " and " + text;
            return IDOK;
        });
        std::filesystem::create_directories("sub");
        start_ = std::filesystem::current_path();
    }

    void TearDown() override {
        SaverTest::TearDown();
        seam::answerBoxes(nullptr);
    }

    /// The settings of before, in memory and in the file; nothing failing.
    void prepare() {
        std::filesystem::current_path(start_);
        ForgetEarlierStages();
        SettingsLoad(); // what an earlier fault kept from being read may be written again
        WalkingStyle = Statements = Backgrounds = 1;
        PacesWalked = 100;
        GetCurrentDirectoryA(sizeof Directory, Directory);
        EnsureTrailingBackslash(Directory);
        SettingsSave();
        told.clear();
        record.clear();
        handles_ = seam::liveHandles();
    }

    /// That nothing is left behind and the settings are whole, each of them one of those given.
    void expectOrder(const std::string& styles, const std::string& paces) {
        seam::endFaults();
        DeleteObject(BackdropBitmap); // the next stage's start would free it
        BackdropBitmap = nullptr;
        EXPECT_EQ(seam::liveHandles(), handles_);
        const std::filesystem::path home = start_.parent_path() / "home/dorbo";
        EXPECT_EQ(std::distance(std::filesystem::directory_iterator(home), {}), 1);
        std::ifstream file(home / "Dorbo95.ini", std::ios::binary);
        const std::string text(std::istreambuf_iterator<char>(file), {});
        EXPECT_THAT(text,
                    testing::MatchesRegex("\\[Fenky Dorbo Screen Saver\\]\r\n"
                                          "Walking Style=" +
                                          styles +
                                          "\r\n"
                                          "Statements=1\r\nBackgrounds=1\r\n"
                                          "Paces Walked=" +
                                          paces +
                                          "\r\n"
                                          "Directory=[Cc]:\\\\.*\\\\toons\\\\(sub\\\\)?\r\n"));
    }

    /// One show, up to its end or to where nothing more comes; what has come of it.
    std::string show(const ChosenFault& fault) {
        constexpr std::int64_t longest = 120'000; // ms
        prepare();
        fault.begin();
        const std::int64_t begin = seam::clockNow();
        stage = createWindow("FaultStage", stageProc, {640, 480}); // its backdrop is a mosaic
        EXPECT_TRUE(stage);
        for (auto due = seam::nextDeadline(); due && IsWindow(stage) && *due < begin + longest;
             due = seam::nextDeadline()) {
            seam::runUntil(*due);
        }
        const bool ended = IsWindow(stage) == FALSE;
        DestroyWindow(stage);
        pass(0);
        expectOrder("[01]", "1[0-9][0-9]");
        const bool about = count("choice file=one.zkt") == 0;
        const std::string what = !ended ? "stalled" : about ? "walked about" : "played";
        return told.empty() ? what : what + ": " + told;
    }

    static LRESULT stageProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
        if (message == TM_SHOWDONE && RandomWalkActive == 0) {
            DestroyWindow(window);
            return 0;
        }
        return SaverGuardProc(window, message, wParam, lParam);
    }

    /// The setup is opened, another directory entered, walks about chosen, and OK pressed.
    std::string setUp(const ChosenFault& fault) {
        constexpr int walks = 1037;
        constexpr int list = 1043;
        prepare();
        fault.begin();
        const HWND dialog = CreateDialogParamA(GetModuleHandleA(nullptr), SETUP_DIALOG, nullptr,
                                               SetupDialogProc, 0);
        SendDlgItemMessageA(dialog, list, LB_SETCURSEL, 2, 0); // [sub]
        for (const DWORD command : {DWORD{MAKELONG(list, LBN_DBLCLK)}, DWORD{walks}, DWORD{IDOK}}) {
            PostMessageA(dialog, WM_COMMAND, command, 0);
            pass(0);
        }
        DestroyWindow(dialog);
        expectOrder("[01]", "100");
        const std::string what = dialog ? "done" : "not opened";
        return told.empty() ? what : what + ": " + told;
    }

    static inline std::string told;

  private:
    seam::HandleCounts handles_;
    std::filesystem::path start_;
};

TEST_F(StageFaults, AShowGoesOnOrTellsWhyNotOrStandsStill) {
    writeToon("one.zkt", frames);
    const std::pair<Operation, Outcomes> cases[] = {
        {Operation::picture, {"played"}},
        {Operation::block, {"played", "stalled: Not enough memory."}},
        {Operation::open, {"played", "walked about", "stalled: Error opening file"}},
        {Operation::read, {"played", "stalled", "stalled: Error reading one.zkt."}},
        {Operation::write, {"played"}},
        {Operation::rename, {"played"}},
        {Operation::change, {"played"}},
    };
    for (const auto& [operation, outcomes] : cases) {
        EXPECT_EQ(eachFault(operation, {Fault::error, Fault::cut, Fault::onwards},
                            [this](const ChosenFault& fault) { return show(fault); }),
                  outcomes)
            << static_cast<int>(operation);
    }
}

TEST_F(StageFaults, ASetupSaysNothing) {
    for (const Operation operation : {Operation::block, Operation::open, Operation::read,
                                      Operation::write, Operation::rename, Operation::change}) {
        const Outcomes outcomes =
            eachFault(operation, {Fault::error, Fault::cut, Fault::onwards},
                      [this](const ChosenFault& fault) { return setUp(fault); });
        EXPECT_THAT(outcomes, testing::IsSubsetOf({"done", "not opened"}));
    }
}

} // namespace
