// The password as it is kept on disk and in memory.
#include "platform/user/password_store.h"
#include "platform/user/secret.h"
#include "tests/kernel/scratch_directory.h"

#include <sys/prctl.h>

#include <set>

namespace {

using seam::PasswordState;
using Names = std::set<std::string>;

constexpr const char* file = "dorbo/password";
constexpr const char* registry = "dorbo/registry.ini";
const std::string asks = "[Control Panel\\Desktop]\r\nScreenSaveUsePassword=1\r\n";

class PasswordStore : public ConfigDirectory {
  protected:
    /// What lies in the config directory.
    static Names names() {
        Names found;
        for (const auto& entry : std::filesystem::directory_iterator("dorbo")) {
            found.insert(entry.path().filename());
        }
        return found;
    }
};

TEST_F(PasswordStore, KeepsWhatIsSetAndNothingElse) {
    EXPECT_EQ(seam::readPassword().state, PasswordState::none);
    EXPECT_FALSE(seam::isPassword(seam::readPassword(), ""));
    const std::string password = "se\xC3\xA9" + std::string(100, 'a');
    ASSERT_TRUE(seam::changePassword(password));
    const seam::StoredPassword stored = seam::readPassword();
    ASSERT_EQ(stored.state, PasswordState::set) << stored.reason;
    EXPECT_TRUE(seam::isPassword(stored, password));
    for (const std::string& wrong : {std::string(), password + 'a', password.substr(1)}) {
        EXPECT_FALSE(seam::isPassword(stored, wrong));
    }
    EXPECT_EQ(textOf(file).find("aaa"), std::string::npos);
    EXPECT_EQ(textOf(registry), asks);

    ASSERT_TRUE(seam::changePassword("other"));
    EXPECT_NE(seam::readPassword().hash, stored.hash);
    EXPECT_TRUE(seam::isPassword(seam::readPassword(), "other"));
    EXPECT_EQ(names(), (Names{"password", "registry.ini"}));

    ASSERT_TRUE(seam::changePassword(""));
    EXPECT_EQ(seam::readPassword().state, PasswordState::none);
    EXPECT_TRUE(textOf(registry).ends_with("=0\r\n"));
    EXPECT_TRUE(seam::changePassword("")) << "there is none to remove";
    EXPECT_EQ(names(), Names{"registry.ini"});
}

TEST_F(PasswordStore, IsForTheUserAlone) {
    ASSERT_TRUE(seam::changePassword("first"));
    EXPECT_EQ(modeOf(file), 0600U);
    for (const unsigned before : {0644U, 0400U}) {
        setMode(file, before);
        ASSERT_TRUE(seam::changePassword("second"));
        EXPECT_EQ(modeOf(file), 0600U);
    }
}

TEST_F(PasswordStore, LetsNobodyInByAFileThatIsNoHash) {
    ASSERT_TRUE(seam::changePassword("word"));
    const std::string good = textOf(file);
    const auto with = [&good](const std::string& part, const std::string& other) {
        std::string text = good;
        return text.replace(text.find(part), part.size(), other);
    };
    const std::tuple<const char*, std::string> cases[] = {
        {"empty", ""},
        {"the password itself", "word"},
        {"cut", good.substr(0, 60)},
        {"a NUL", good.substr(0, 20) + '\0' + good.substr(21)},
        {"large", good + std::string(2000, ' ')},
        {"over 256 MiB", with("m=65536", "m=262145")},
        {"no memory", with("m=65536", "m=7")},
        {"wraps", with("m=65536", "m=4295032832")},
        {"a day", with("t=2", "t=99")},
        {"no round", with("t=2", "t=0")},
        {"many threads", with("p=1", "p=9")},
        {"bits too many", good.substr(0, good.size() - 2) + "/\n"},
    };
    for (const auto& [what, text] : cases) {
        make(file, text);
        const seam::StoredPassword stored = seam::readPassword();
        EXPECT_EQ(stored.state, PasswordState::broken) << what;
        EXPECT_NE(stored.reason, "") << what;
        EXPECT_FALSE(seam::isPassword(stored, "word")) << what;
        EXPECT_FALSE(seam::changePassword("new")) << what;
        EXPECT_EQ(textOf(file), text) << what;
    }
    make(file, good.substr(0, good.size() - 1) + "\r\n\n");
    EXPECT_TRUE(seam::isPassword(seam::readPassword(), "word")) << "line ends don't count";
}

TEST_F(PasswordStore, StaysAsItWasWhereItsFilesCantBeWritten) {
    std::filesystem::create_directories(file);
    EXPECT_EQ(seam::readPassword().state, PasswordState::broken);
    EXPECT_FALSE(seam::changePassword("new"));
    EXPECT_EQ(names(), Names{"password"});
    std::filesystem::remove(file);
    std::filesystem::create_directories(registry);
    EXPECT_FALSE(seam::changePassword("new"));
    EXPECT_EQ(names(), Names{"registry.ini"});
    std::filesystem::remove(registry);
    ASSERT_TRUE(seam::changePassword("old"));
    std::filesystem::remove(registry);
    std::filesystem::create_directories(registry);
    for (const char* password : {"new", ""}) {
        EXPECT_FALSE(seam::changePassword(password));
        EXPECT_TRUE(seam::isPassword(seam::readPassword(), "old")) << password;
    }
}

TEST(Secret, TakesWholeCharactersAndWipesWhatIsTakenOut) {
    const std::string nothing(seam::Secret::capacity, '\0');
    seam::Secret secret;
    for (const char* character : {"a", "\xC3\xA9", "\xF0\x9F\x98\x80"}) {
        EXPECT_TRUE(secret.append(character));
    }
    EXPECT_EQ(secret.characters(), 3U);
    secret.removeLast();
    EXPECT_EQ(secret.bytes(), "a\xC3\xA9");
    secret.removeLast();
    EXPECT_EQ(secret.bytes(), "a");
    EXPECT_EQ(secret.memory(), "a" + nothing.substr(1));
    secret.clear();
    secret.removeLast();
    EXPECT_EQ(secret.memory(), nothing);

    for (std::size_t i = 0; i < seam::Secret::capacity - 1; ++i) {
        ASSERT_TRUE(secret.append("x"));
    }
    EXPECT_FALSE(secret.append("\xC3\xA9")) << "half of a character is none";
    EXPECT_TRUE(secret.append("x"));
    EXPECT_FALSE(secret.append("x"));
}

TEST(Secret, LeavesNoDumpsMeanwhile) {
    ASSERT_EQ(prctl(PR_GET_DUMPABLE), 1);
    {
        const seam::NoDumps outer;
        const seam::NoDumps inner;
        EXPECT_EQ(prctl(PR_GET_DUMPABLE), 0);
    }
    EXPECT_EQ(prctl(PR_GET_DUMPABLE), 1);
}

} // namespace
