// The saver's password as it is kept: an Argon2id hash in the file "password" of the config
// directory, for the user alone (mode 0600).
#pragma once

#include <string>
#include <string_view>

namespace seam {

enum class PasswordState {
    none,   // there is no file: everybody may pass
    set,    // there is a hash
    broken, // there is a file, and no hash can be read from it: nobody may pass
};

struct StoredPassword {
    PasswordState state = PasswordState::none;
    std::string hash{};   // where one is set
    std::string reason{}; // where it is broken: what is wrong, behind a "because"
};

/// What is kept now. A hash that would take more than 256 MiB or 4 rounds to check counts as
/// broken.
StoredPassword readPassword();

/// Whether this is the password. Takes a tenth of a second and 64 MiB.
bool isPassword(const StoredPassword& stored, std::string_view password);

/// Keeps a new password, or none if it is empty, and has the saver ask for it or not: sets
/// ScreenSaveUsePassword of the registry. False, and all as it was, if that can't be written.
bool changePassword(std::string_view password);

/// Where the hash lies: a path of the file system.
std::string passwordFile();

} // namespace seam
