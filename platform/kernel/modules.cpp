// Modules: the program file and those of the seam, which are never loaded from a directory.
#include "platform/kernel/modules.h"

#include "platform/kernel/counts.h"
#include "platform/kernel/text.h"

#include <string_view>

namespace {

constexpr HMODULE programFile{1};

// Constants at the start, so that a registration of any source file may come first.
constinit seam::ModuleRegistration* firstModule = nullptr;
constinit DWORD lastModule = programFile.number;

template <class Matches>
seam::ModuleRegistration* findModule(Matches matches) {
    for (seam::ModuleRegistration* module = firstModule; module != nullptr; module = module->next) {
        if (matches(*module)) {
            return module;
        }
    }
    return nullptr;
}

seam::ModuleRegistration* moduleNamed(const char* name) {
    return findModule([name](const seam::ModuleRegistration& module) {
        return name != nullptr && seam::sameButForCase(module.name, name);
    });
}

seam::ModuleRegistration* moduleOf(HMODULE handle) {
    return findModule(
        [handle](const seam::ModuleRegistration& module) { return module.handle == handle; });
}

bool inProcess(const seam::ModuleRegistration& module) {
    return module.resident || module.uses > 0;
}

} // namespace

namespace seam {

ModuleRegistration::ModuleRegistration(const char* moduleName, ModuleEntry moduleEntry,
                                       Kind kind) noexcept
    : name(moduleName), entry(moduleEntry), resident(kind == Kind::resident), handle(++lastModule),
      next(firstModule) {
    firstModule = this;
}

ModuleRegistration::~ModuleRegistration() {
    ModuleRegistration** link = &firstModule;
    while (*link != this) {
        link = &(*link)->next;
    }
    *link = next;
}

std::size_t loadedModules() {
    std::size_t count = 0;
    for (const ModuleRegistration* module = firstModule; module != nullptr; module = module->next) {
        count += module->uses;
    }
    return count;
}

} // namespace seam

HMODULE GetModuleHandleA(const char* name) {
    if (name == nullptr) {
        return programFile;
    }
    const seam::ModuleRegistration* module = moduleNamed(name);
    return module != nullptr && inProcess(*module) ? module->handle : HMODULE{};
}

HMODULE LoadLibraryA(const char* name) {
    seam::ModuleRegistration* module = moduleNamed(name);
    if (module == nullptr) {
        return nullptr;
    }
    ++module->uses;
    return module->handle;
}

BOOL FreeLibrary(HMODULE module) {
    seam::ModuleRegistration* found = moduleOf(module);
    if (found == nullptr || found->uses == 0) {
        return FALSE;
    }
    --found->uses;
    return TRUE;
}

FARPROC GetProcAddress(HMODULE module, const char* name) {
    const seam::ModuleRegistration* found = moduleOf(module);
    const bool has = found != nullptr && inProcess(*found) && name != nullptr &&
                     std::string_view(found->entry.name) == name;
    return has ? found->entry.address : nullptr;
}
