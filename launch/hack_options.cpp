#include "launch/hack_options.h"

#include <cstdlib>

/// The id of a window in decimal, hexadecimal (0x...) or octal (0...); 0 if the text is none.
static DWORD ReadWindowId(const std::string& text) {
    constexpr unsigned long largest = 0x1FFFFFFF; // the X server gives out no others
    if (text.empty() || text.front() < '0' || text.front() > '9') {
        return 0; // strtoul takes blanks and signs too
    }
    char* end = nullptr;
    const unsigned long id = std::strtoul(text.c_str(), &end, 0);
    return *end == '\0' && id <= largest ? static_cast<DWORD>(id) : 0;
}

static HackRequest Wrong(const std::string& complaint) {
    return {HackTarget::WRONG, 0, complaint};
}

static HackRequest FromVariable(const char* variable) {
    const DWORD window = variable != nullptr ? ReadWindowId(variable) : 0;
    if (window != 0) {
        return {HackTarget::WINDOW, window, ""};
    }
    return {
        HackTarget::NOWHERE, 0,
        variable == nullptr
            ? "no window to show anything in: neither XSCREENSAVER_WINDOW nor an option names one"
            : "XSCREENSAVER_WINDOW is no window: \"" + std::string(variable) + "\""};
}

static HackRequest FromWindowId(const std::string& text) {
    const DWORD window = ReadWindowId(text);
    return window != 0 ? HackRequest{HackTarget::WINDOW, window, ""}
                       : Wrong("--window-id takes a window, not \"" + text + "\"");
}

HackRequest ReadHackArguments(const std::vector<std::string>& arguments, const char* variable) {
    HackRequest request = FromVariable(variable);
    for (std::size_t i = 0; i < arguments.size(); ++i) {
        const std::string& word = arguments[i];
        const std::string option = word.rfind("--", 0) == 0 ? word.substr(1) : word;
        if (option == "-root") {
            request = variable != nullptr ? FromVariable(variable)
                                          : HackRequest{HackTarget::DESKTOP, 0, ""};
        } else if (option == "-window-id" && i + 1 < arguments.size()) {
            request = FromWindowId(arguments[++i]);
        } else if (option == "-help" || option == "-h") {
            return {HackTarget::HELP, 0, ""};
        } else {
            return Wrong(option == "-window-id" ? "which window is behind --window-id?"
                                                : "there is no option " + word);
        }
        if (request.target == HackTarget::WRONG) {
            return request;
        }
    }
    return request;
}
