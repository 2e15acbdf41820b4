// Devices of the seam, and what is done with them by handle.
#include "platform/handle_table.h"
#include "platform/kernel/counts.h"
#include "platform/kernel/modules.h"
#include "platform/kernel/text.h"

#include <string>

namespace {

constinit seam::DeviceRegistration* firstDevice = nullptr;

/// By name: the device itself may go while it is open.
struct OpenDevice {
    std::string name;
};

seam::HandleTable<OpenDevice> openDevices(seam::HandleKind::device);

const seam::DeviceRegistration* deviceNamed(const std::string& name) {
    for (const auto* device = firstDevice; device != nullptr; device = device->next) {
        if (seam::sameButForCase(device->name, name)) {
            return device;
        }
    }
    return nullptr;
}

} // namespace

namespace seam {

DeviceRegistration::DeviceRegistration(const char* deviceName, DeviceControl deviceControl) noexcept
    : name(deviceName), control(deviceControl), next(firstDevice) {
    firstDevice = this;
}

DeviceRegistration::~DeviceRegistration() {
    DeviceRegistration** link = &firstDevice;
    while (*link != this) {
        link = &(*link)->next;
    }
    *link = next;
}

std::size_t liveDevices() {
    return openDevices.live();
}

} // namespace seam

HANDLE CreateFileA(const char* name, DWORD /*access*/, DWORD /*share*/, void* /*security*/,
                   DWORD disposition, DWORD /*flags*/, HANDLE /*model*/) {
    if (name == nullptr || disposition != OPEN_EXISTING || deviceNamed(name) == nullptr) {
        return INVALID_HANDLE_VALUE;
    }
    const DWORD handle = openDevices.add(std::make_unique<OpenDevice>(OpenDevice{name}));
    return handle != 0 ? HANDLE{handle} : INVALID_HANDLE_VALUE;
}

BOOL DeviceIoControl(HANDLE device, DWORD code, void* /*input*/, DWORD /*inputBytes*/,
                     void* /*output*/, DWORD /*outputBytes*/, DWORD* returned,
                     void* /*overlapped*/) {
    if (returned != nullptr) {
        *returned = 0;
    }
    const OpenDevice* open = openDevices.find(device.number);
    const seam::DeviceRegistration* found = open != nullptr ? deviceNamed(open->name) : nullptr;
    return found != nullptr && found->control(code) ? TRUE : FALSE;
}

BOOL CloseHandle(HANDLE device) {
    return openDevices.take(device.number) ? TRUE : FALSE;
}
