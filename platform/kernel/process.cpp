// The program file, its command line and the modules it loads.

#include "platform/kernel.h"

#include <algorithm>
#include <string>

namespace {

constexpr HMODULE programFile{1};

std::string commandLine; // written by SetCommandLineArguments alone

} // namespace

HMODULE GetModuleHandleA(const char* name) {
    return name == nullptr ? programFile : HMODULE{};
}

const char* GetCommandLineA() {
    return commandLine.c_str();
}

void SetCommandLineArguments(int count, const char* const* arguments) {
    std::string name = count > 0 ? arguments[0] : "";
    // A quote in the program's name would end the name for whoever reads the line.
    name.erase(std::remove(name.begin(), name.end(), '"'), name.end());
    commandLine = '"' + name + '"';
    for (int at = 1; at < count; ++at) {
        commandLine.append(" ").append(arguments[at]);
    }
}

// The seam has no module of its own, and none is ever loaded from a directory.

HMODULE LoadLibraryA(const char*) {
    return nullptr;
}

BOOL FreeLibrary(HMODULE) {
    return FALSE;
}

FARPROC GetProcAddress(HMODULE, const char*) {
    return nullptr;
}
