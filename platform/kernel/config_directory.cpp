#include "platform/kernel/config_directory.h"

#include "platform/kernel/faults.h"
#include "platform/kernel/paths.h"

#include <sys/stat.h>

#include <cstdlib>

namespace seam {

std::string configDirectory() {
    const char* chosen = std::getenv("XDG_CONFIG_HOME");
    const bool absolute = chosen != nullptr && *chosen == '/';
    return (absolute ? std::string(chosen) : homeDirectory() + "/.config") + "/dorbo";
}

bool makeConfigDirectory() {
    constexpr mode_t userAlone = 0700;
    const std::string path = configDirectory();
    for (std::size_t slash = path.find('/', 1); slash != std::string::npos;
         slash = path.find('/', slash + 1)) {
        mkdir(path.substr(0, slash).c_str(), userAlone);
    }
    if (!faultDue(Operation::change)) {
        mkdir(path.c_str(), userAlone);
    }
    struct stat status = {};
    return stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

} // namespace seam
