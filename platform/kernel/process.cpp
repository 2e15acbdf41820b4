// The command line.

#include "platform/kernel.h"

#include <algorithm>
#include <string>

namespace {

std::string commandLine; // written by SetCommandLineArguments alone

} // namespace

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
