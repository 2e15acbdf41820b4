#include "platform/user/sleep_lock.h"

#include "platform/kernel/descriptor.h"

#include <QtGlobal>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

namespace seam {

namespace {

constexpr const char* variable = "XSS_SLEEP_LOCK_FD";

Descriptor held;

} // namespace

void takeSleepLock() {
    bool isNumber = false;
    const int number = qEnvironmentVariableIntValue(variable, &isNumber);
    qunsetenv(variable);
    struct stat status = {};
    if (isNumber && number > STDERR_FILENO && fstat(number, &status) == 0 &&
        S_ISFIFO(status.st_mode)) {
        fcntl(number, F_SETFD, FD_CLOEXEC); // what we start has nothing to do with it
        held = Descriptor(number);
    }
}

bool sleepLockIsHeld() {
    return static_cast<bool>(held);
}

void releaseSleepLock() {
    held = Descriptor();
}

} // namespace seam
