// The device that is told when a password stands between the user and the desktop.
#include "platform/kernel/modules.h"
#include "platform/user/grabs.h"

namespace {

constexpr DWORD passwordSet = 1;
constexpr DWORD passwordDropped = 2;

bool control(DWORD code) {
    if (code != passwordSet && code != passwordDropped) {
        return false;
    }
    seam::holdInput(code == passwordSet);
    return true;
}

const seam::DeviceRegistration reboot("\\\\.\\REBOOT", control);

} // namespace
