// Settings and password on a disk that fails, and under a process that is killed.
#include "platform/user/password_store.h"
#include "tests/faults/each_fault.h"
#include "tests/kernel/scratch_directory.h"
#include "toon/settings.h"
#include "toon/toon_document.h"

#include <gmock/gmock.h>

#include <sys/wait.h>

namespace {

using seam::Fault;
using seam::Operation;
using namespace std::string_literals;

constexpr const char* settings = "dorbo/Dorbo95.ini";
constexpr const char* password = "dorbo/password";
constexpr const char* registry = "dorbo/registry.ini";
const std::string asking = "[Control Panel\\Desktop]\r\nScreenSaveUsePassword=";

class FileFaults : public ConfigDirectory {
  protected:
    static void SetUpTestSuite() {
        // Made once: a hash takes its time.
        class Maker : public ConfigDirectory {
            void TestBody() override {}

          public:
            void make() const {
                ASSERT_TRUE(seam::changePassword("old"));
                oldHash = textOf(password);
            }
        };

        Maker().make();
    }

    void putOld() const {
        std::filesystem::remove_all("dorbo");
        make(settings, text("1", "100", "c:\\old\\"));
        make(password, oldHash);
        make(registry, asking + "1\r\n");
    }

    static std::string text(const std::string& choice, const std::string& paces,
                            const std::string& directory) {
        return "; mine\r\n[Fenky Dorbo Screen Saver]\r\nWalking Style=" + choice +
               "\r\nStatements=" + choice + "\r\nBackgrounds=" + choice +
               "\r\nPaces Walked=" + paces + "\r\nDirectory=" + directory + "\r\n";
    }

    static void saveNew() {
        WalkingStyle = Statements = Backgrounds = 0;
        PacesWalked = 70'000;
        CopyText(Directory, "c:\\new\\", DIRECTORY_SIZE);
        SettingsSave();
    }

    /// That the file is whole, and how many of its five keys are old.
    int oldKeys() const {
        std::string now = textOf(settings);
        EXPECT_THAT(now,
                    testing::MatchesRegex(
                        "; mine\r\n\\[Fenky Dorbo Screen Saver\\]\r\nWalking Style=[01]\r\n"
                        "Statements=[01]\r\nBackgrounds=[01]\r\nPaces Walked=(100|70000|80000)\r\n"
                        "Directory=c:\\\\(old|new)\\\\\r\n"));
        int old = 0;
        for (const char* value : {"Style=1", "ments=1", "grounds=1", "=100\r", "old"}) {
            old += now.find(value) != std::string::npos ? 1 : 0;
        }
        return old;
    }

    /// Which password holds: old, new, or none.
    std::string passwordNow() const {
        const seam::StoredPassword stored = seam::readPassword();
        EXPECT_NE(stored.state, seam::PasswordState::broken) << stored.reason;
        if (stored.state == seam::PasswordState::none) {
            return "none";
        }
        return textOf(password) == oldHash ? "old" : "new";
    }

    bool asks() const {
        const std::string now = textOf(registry);
        EXPECT_THAT(now, testing::MatchesRegex("\\[Control Panel\\\\Desktop\\]\r\n"
                                               "ScreenSaveUsePassword=[01]\r\n"));
        return now.find("=1") != std::string::npos;
    }

    /// Files beside those that belong there.
    static std::ptrdiff_t strays() {
        const std::filesystem::directory_iterator all("dorbo");
        return std::count_if(begin(all), end(all), [](const auto& entry) {
            const std::string name = entry.path().filename();
            return name != "Dorbo95.ini" && name != "password" && name != "registry.ini";
        });
    }

    static inline std::string oldHash;
};

TEST_F(FileFaults, ASettingThatCannotBeWrittenStaysAsItWas) {
    for (const Operation operation : {Operation::open, Operation::read, Operation::write,
                                      Operation::rename, Operation::change}) {
        eachFault(operation, {Fault::error, Fault::lessened, Fault::cut, Fault::onwards},
                  [this](const ChosenFault& fault) {
                      putOld();
                      fault.begin();
                      saveNew();
                      seam::endFaults();
                      const int most = fault.fault == Fault::onwards    ? 5
                                       : fault.fault == Fault::lessened ? 0
                                                                        : 1;
                      EXPECT_LE(oldKeys(), fault.at == 0 ? 0 : most);
                      EXPECT_EQ(strays(), 0);
                      return "";
                  });
    }
}

TEST_F(FileFaults, ASettingThatCannotBeReadStaysAsItIsInAFileOfAnySpelling) {
    for (const char* name : {"dorbo/Dorbo95.ini", "dorbo/DORBO95.INI"}) {
        for (const Operation operation : {Operation::open, Operation::read}) {
            eachFault(operation, {Fault::error, Fault::cut, Fault::onwards},
                      [this, name](const ChosenFault& fault) {
                          putOld();
                          std::filesystem::rename(settings, name);
                          const std::string before = textOf(name);
                          fault.begin();
                          SettingsLoad();
                          seam::endFaults();
                          SettingsSave();
                          EXPECT_EQ(textOf(name), before);
                          EXPECT_TRUE(name == std::string(settings) ||
                                      !std::filesystem::exists(settings));
                          return "";
                      });
        }
    }
    SettingsLoad(); // which may be saved again
}

TEST_F(FileFaults, AFileOfAnotherSpellingIsTheOneThatIsMeantOrNone) {
    const Outcomes outcomes =
        eachFault(Operation::open, {Fault::error}, [this](const ChosenFault& fault) {
            make("Mine.zkt", "old");
            fault.begin();
            OFSTRUCT found{};
            const HFILE file = OpenFile("mine.zkt", &found, OF_CREATE);
            seam::endFaults();
            EXPECT_FALSE(std::filesystem::exists("mine.zkt"));
            EXPECT_EQ(textOf("Mine.zkt"), file == HFILE_ERROR ? "old" : "");
            return file == HFILE_ERROR || _lclose(file) != 0 ? "refused" : "cut";
        });
    EXPECT_EQ(outcomes, (Outcomes{"cut", "refused"}));
}

TEST_F(FileFaults, APasswordIsChangedOrStaysAndTheCallerIsTold) {
    const struct {
        const char* before;
        const char* given;
        const char* after;
    } changes[] = {{"old", "new", "new"}, {"old", "", "none"}, {"none", "new", "new"}};

    const auto change = [this](const char* before, const char* given) {
        return [this, given, before](const ChosenFault& fault) {
            putOld();
            if (before == "none"s) {
                std::filesystem::remove(password);
                make(registry, asking + "0\r\n");
            }
            fault.begin();
            const bool changed = seam::changePassword(given);
            seam::endFaults();
            const std::string now = passwordNow();
            EXPECT_TRUE(fault.at > 0 || now != "new" ||
                        seam::isPassword(seam::readPassword(), "new"));
            EXPECT_EQ(asks(), now != "none");
            EXPECT_EQ(strays(), 0);
            return (changed ? "changed to " : "still ") + now;
        };
    };
    for (const auto& [before, given, after] : changes) {
        for (const Operation operation : {Operation::open, Operation::read, Operation::write,
                                          Operation::rename, Operation::change}) {
            const Outcomes outcomes =
                eachFault(operation, {Fault::error, Fault::cut}, change(before, given));
            EXPECT_EQ(outcomes, (Outcomes{"changed to "s + after, "still "s + before}))
                << before << " " << given << " " << static_cast<int>(operation);
        }
    }
}

TEST_F(FileFaults, AKillAtAnyMomentLeavesEachKeyOldOrNew) {
    std::size_t moments = 0;
    for (const auto& [operation, fault] :
         {std::pair(Operation::any, Fault::killed), {Operation::write, Fault::halfKilled}}) {
        int status = SIGKILL;
        for (std::size_t at = 1; WIFSIGNALED(status) && !HasFailure(); ++at) {
            SCOPED_TRACE(testing::Message() << at);
            putOld();
            const pid_t child = fork();
            if (child == 0) {
                seam::makeFault(operation, at, fault);
                saveNew();
                PacesWalked = 80'000;
                SettingsSave();
                const bool changed = seam::changePassword("new") && seam::changePassword("");
                _exit(changed ? 0 : 1);
            }
            waitpid(child, &status, 0);
            moments += WIFSIGNALED(status) ? 1 : 0;
            EXPECT_EQ(status, WIFSIGNALED(status) ? SIGKILL : 0);
            const int old = oldKeys();
            const std::string now = passwordNow();
            EXPECT_TRUE(old == 0 || now == "old") << "in the order of the writing";
            EXPECT_TRUE(asks() || now == "none") << "it is asked for as long as it stands";
            EXPECT_LE(strays(), 1);
        }
    }
    EXPECT_GE(moments, 100U);
}

} // namespace
