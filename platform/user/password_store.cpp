#include "platform/user/password_store.h"

#include "platform/kernel/config_directory.h"
#include "platform/kernel/faults.h"
#include "platform/kernel/registry.h"
#include "platform/kernel/text.h"
#include "platform/kernel/transfer.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <regex>
#include <sodium.h>
#include <system_error>

namespace seam {

namespace {

constexpr mode_t userAlone = 0600;

/// Whether the text is a hash as crypto_pwhash_str makes them, and takes a bearable time and
/// memory to check.
bool isHash(const std::string& text) {
    static const std::regex form(R"(\$argon2id\$v=19\$m=(\d{1,7}),t=(\d{1,2}),p=1)"
                                 R"(\$[A-Za-z0-9+/]{22}\$[A-Za-z0-9+/]{43})");
    constexpr unsigned long leastKilobytes = 8; // below it there is no such hash
    constexpr unsigned long mostKilobytes = 256 * 1024;
    constexpr unsigned long mostRounds = 4;
    std::smatch parts;
    if (!std::regex_match(text, parts, form)) {
        return false;
    }
    const unsigned long kilobytes = std::stoul(parts[1]);
    const unsigned long rounds = std::stoul(parts[2]);
    return kilobytes >= leastKilobytes && kilobytes <= mostKilobytes && rounds >= 1 &&
           rounds <= mostRounds &&
           crypto_pwhash_str_needs_rehash(text.c_str(), crypto_pwhash_OPSLIMIT_INTERACTIVE,
                                          crypto_pwhash_MEMLIMIT_INTERACTIVE) >= 0;
}

/// A change of a directory's names lasts only once the directory has been written.
void syncDirectory() {
    const Descriptor directory = openDescriptor(configDirectory(), O_RDONLY | O_DIRECTORY);
    if (directory && !faultDue(Operation::change)) {
        fsync(directory.number());
    }
}

/// The replaced file's mode is what the new one gets, so the old one has to be for the user alone
/// first.
bool keepHash(const std::string& hash) {
    const std::string path = passwordFile();
    struct stat status = {};
    const bool there = stat(path.c_str(), &status) == 0;
    if ((there && (!S_ISREG(status.st_mode) || faultDue(Operation::change) ||
                   chmod(path.c_str(), userAlone) != 0)) ||
        !makeConfigDirectory() || !replaceFile(path, hash + "\n")) {
        return false;
    }
    syncDirectory();
    return true;
}

bool dropHash() {
    const bool refused = faultDue(Operation::change);
    if ((refused || unlink(passwordFile().c_str()) != 0) && errno != ENOENT) {
        return false;
    }
    syncDirectory();
    return true;
}

bool keepOrDrop(const std::string& hash) {
    return hash.empty() ? dropHash() : keepHash(hash);
}

/// The password's hash, empty if it can't be worked out.
std::string hashOf(std::string_view password) {
    constexpr std::size_t usedStack = 64 << 10;
    char hash[crypto_pwhash_STRBYTES] = "";
    const bool made =
        sodium_init() >= 0 && crypto_pwhash_str(hash, password.data(), password.size(),
                                                crypto_pwhash_OPSLIMIT_INTERACTIVE,
                                                crypto_pwhash_MEMLIMIT_INTERACTIVE) == 0;
    sodium_stackzero(usedStack);
    return made ? hash : "";
}

} // namespace

std::string passwordFile() {
    return configDirectory() + "/password";
}

StoredPassword readPassword() {
    constexpr std::size_t largestFile = 1024;
    const WholeFile file = readWholeFile(passwordFile(), largestFile);
    if (file.error == ENOENT) {
        return {};
    }
    if (file.error != 0 && file.error != EFBIG) {
        return {PasswordState::broken,
                {},
                "the file that holds the password can't be read (" +
                    (file.error == EINVAL ? "it is no regular file"
                                          : std::generic_category().message(file.error)) +
                    ")"};
    }
    const std::string hash(trimmed(file.text));
    if (sodium_init() < 0 || !isHash(hash)) {
        return {PasswordState::broken, {}, "the file that holds the password is damaged"};
    }
    return {PasswordState::set, hash, {}};
}

bool isPassword(const StoredPassword& stored, std::string_view password) {
    constexpr std::size_t usedStack = 64 << 10;
    const bool right =
        stored.state == PasswordState::set &&
        crypto_pwhash_str_verify(stored.hash.c_str(), password.data(), password.size()) == 0;
    sodium_stackzero(usedStack);
    return right;
}

bool changePassword(std::string_view password) {
    const StoredPassword before = readPassword();
    if (before.state == PasswordState::broken) {
        return false;
    }
    const std::string hash = password.empty() ? "" : hashOf(password);
    // The hash first, both ways: whatever ends the process between the two, nobody is shut out.
    if ((hash.empty() && !password.empty()) || !keepOrDrop(hash)) {
        return false;
    }
    if (setRegistryNumber("Control Panel\\Desktop", "ScreenSaveUsePassword",
                          hash.empty() ? 0 : 1)) {
        return true;
    }
    keepOrDrop(before.hash);
    return false;
}

} // namespace seam
