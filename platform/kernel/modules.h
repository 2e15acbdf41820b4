// What the seam has to offer by name: modules with their entries, and devices. Whoever offers one
// defines a registration beside it; it is found for as long as the registration lives.
#pragma once

#include "platform/kernel.h"

#include <cstddef>

namespace seam {

struct ModuleEntry {
    const char* name;
    FARPROC address;
};

/// A module of the seam. A resident one is in the process from its start; any other is from a
/// LoadLibraryA to the matching FreeLibrary.
class ModuleRegistration {
  public:
    enum class Kind { loadable, resident };

    ModuleRegistration(const char* name, ModuleEntry entry, Kind kind) noexcept;
    ~ModuleRegistration();
    ModuleRegistration(const ModuleRegistration&) = delete;
    ModuleRegistration& operator=(const ModuleRegistration&) = delete;

    const char* name;
    ModuleEntry entry;
    bool resident;
    HMODULE handle;
    std::size_t uses = 0; // loads that nobody has freed
    ModuleRegistration* next;
};

/// Takes a control code; whether it was one.
using DeviceControl = bool (*)(DWORD code);

/// A device. Of two with one name the younger is found, as in a test that stands in for a real one.
class DeviceRegistration {
  public:
    DeviceRegistration(const char* name, DeviceControl control) noexcept;
    ~DeviceRegistration();
    DeviceRegistration(const DeviceRegistration&) = delete;
    DeviceRegistration& operator=(const DeviceRegistration&) = delete;

    const char* name;
    DeviceControl control;
    DeviceRegistration* next;
};

} // namespace seam
