#include "cli/scene.h"

#include "editor/chrome.h"
#include "editor/command_ids.h"
#include "editor/editor_shell.h"
#include "editor/frame_fields.h"
#include "platform/harness.h"
#include "platform/kernel.h"
#include "stage/editor_host.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdlib>
#include <iterator>
#include <optional>
#include <sstream>
#include <stdexcept>

namespace {

using Words = std::vector<std::string>;
using Numbers = std::vector<int>;

/// What stands behind the moment: the action's name, how many numbers or words it takes, and what
/// it does with them.
struct Action {
    const char* name;
    std::size_t arguments;
    bool numbers;
    void (*act)(const Words& words, const Numbers& numbers);
};

constexpr std::int64_t longestScene = 24LL * 60 * 60 * 1000; // ms

void sendKey(int command) {
    PostMessageA(EditorMainWindow, WM_COMMAND, static_cast<WPARAM>(MAKELONG(command, 1)), 0);
}

void press(HWND button) {
    if (IsWindowEnabled(button) != FALSE) {
        PostMessageA(EditorMainWindow, WM_COMMAND, 0, static_cast<LPARAM>(button.number));
    }
}

void activate(WPARAM how) {
    PostMessageA(EditorMainWindow, WM_ACTIVATE, how, 0);
}

/// The dialog runs while the command is handled.
void chooseFile(int key, const std::optional<std::string>& name) {
    seam::answerFileDialogs([name](const std::string&) { return name; });
    sendKey(key);
}

void answer(const Words& /*words*/, const Numbers& numbers) {
    seam::answerBoxes([number = numbers[0]](const std::string&, const std::string&, UINT type) {
        return (type & MB_YESNOCANCEL) == MB_YESNOCANCEL ? number : IDOK;
    });
}

void sendItem(const Words& /*words*/, const Numbers& numbers) {
    PostMessageA(EditorDialog, WM_COMMAND, static_cast<WPARAM>(numbers[0]), 0);
}

void selectFrame(const Words& /*words*/, const Numbers& numbers) {
    SelectListedFrame(EditorDialog, numbers[0] - 1);
    PostMessageA(EditorDialog, WM_COMMAND, FRAME_LIST, 0);
}

void fillField(const Words& words, const Numbers& /*numbers*/) {
    SetDlgItemTextA(EditorDialog, std::atoi(words[0].c_str()), words[1].c_str());
}

/// A window that nobody sees is told of the picker's loop by a message that the loop takes.
LRESULT pickerUserProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (message != WM_KEYDOWN) {
        return DefWindowProcA(window, message, wParam, lParam);
    }
    SendMessageA(FindWindowA("PoseWndClass", nullptr), message, wParam, lParam);
    DestroyWindow(window);
    return 0;
}

void pickPose(const Words& /*words*/, const Numbers& numbers) {
    WNDCLASSA windowClass{};
    windowClass.lpfnWndProc = pickerUserProc;
    windowClass.hInstance = GetModuleHandleA(nullptr);
    windowClass.lpszClassName = "PickerUserClass";
    RegisterClassA(&windowClass); // refused from the second time on
    const HWND user = CreateWindowExA(0, windowClass.lpszClassName, "", WS_POPUP, 0, 0, 1, 1,
                                      EditorDialog, nullptr, windowClass.hInstance, nullptr);
    PostMessageA(EditorDialog, WM_COMMAND, POSE_BUTTON, 0);
    PostMessageA(user, WM_KEYDOWN, static_cast<WPARAM>('0' + numbers[0]), 0);
}

void click(const Words& /*words*/, const Numbers& at) {
    PostMessageA(EditorStage, WM_LBUTTONDOWN, 1, static_cast<LPARAM>(MAKELONG(at[0], at[1])));
}

void sendCommand(const Words& /*words*/, const Numbers& numbers) {
    sendKey(numbers[0]);
}

constexpr Action actions[] = {
    {"click", 2, true, click},
    {"play", 0, false, [](const Words&, const Numbers&) { press(PlayButton); }},
    {"walk", 0, false, [](const Words&, const Numbers&) { press(WalkButton); }},
    {"minimise", 0, false, [](const Words&, const Numbers&) { press(MinimizeButton); }},
    {"close", 0, false, [](const Words&, const Numbers&) { press(CloseButton); }},
    {"command", 1, true, sendCommand},
    {"open", 1, false, [](const Words& words, const Numbers&) { chooseFile(KEY_OPEN, words[0]); }},
    {"save", 1, false, [](const Words& words, const Numbers&) { chooseFile(KEY_SAVE, words[0]); }},
    {"cancel", 0, false, [](const Words&, const Numbers&) { chooseFile(KEY_OPEN, std::nullopt); }},
    {"answer", 1, true, answer},
    {"item", 1, true, sendItem},
    {"frame", 1, true, selectFrame},
    {"field", 2, false, fillField},
    {"pose", 1, true, pickPose},
    {"edit", 0, false, [](const Words&, const Numbers&) { sendKey(KEY_EDIT); }},
    {"activate", 0, false, [](const Words&, const Numbers&) { activate(WA_ACTIVE); }},
    {"deactivate", 0, false, [](const Words&, const Numbers&) { activate(WA_INACTIVE); }},
    {"iconify", 0, false,
     [](const Words&, const Numbers&) { seam::minimise(EditorMainWindow, true); }},
    {"restore", 0, false,
     [](const Words&, const Numbers&) { seam::minimise(EditorMainWindow, false); }},
    {"end", 0, false,
     [](const Words&, const Numbers&) { PostMessageA(EditorMainWindow, WM_CLOSE, 0, 0); }},
};

template <class Number>
Number numberOf(const std::string& text, Number lowest, Number highest) {
    Number number{};
    const char* end = text.data() + text.size();
    const auto [stopped, error] = std::from_chars(text.data(), end, number);
    if (error != std::errc() || stopped != end || number < lowest || number > highest) {
        throw std::runtime_error(text + " is no number that fits here");
    }
    return number;
}

SceneStep stepOf(const Words& line, std::int64_t earliest) {
    const std::int64_t moment = numberOf<std::int64_t>(line[0], 0, longestScene);
    if (moment < earliest) {
        throw std::runtime_error("the moment " + line[0] + " comes before that of the line above");
    }
    const std::string name = line.size() > 1 ? line[1] : "";
    const auto* action =
        std::ranges::find_if(actions, [&](const Action& one) { return name == one.name; });
    if (action == std::end(actions)) {
        throw std::runtime_error(name.empty() ? "there is no action"
                                              : name + " is no action of a scene");
    }
    const Words words(line.begin() + 2, line.end());
    if (words.size() != action->arguments) {
        throw std::runtime_error(name + " takes " + std::to_string(action->arguments) +
                                 " arguments, not " + std::to_string(words.size()));
    }
    Numbers numbers;
    for (const std::string& word : action->numbers ? words : Words{}) {
        numbers.push_back(numberOf(word, -0x8000, 0x7FFF)); // half a message's parameter
    }
    constexpr std::array unanswered{KEY_FILE, POPUP_ABOUT, ITEM_CONFIGURE, POSE_BUTTON};
    const bool sends = action->act == sendCommand || action->act == sendItem;
    if (sends && std::ranges::find(unanswered, numbers[0]) != unanswered.end()) {
        throw std::runtime_error("what command " + words[0] + " opens can't be answered");
    }
    return {moment, [action, words, numbers] { action->act(words, numbers); }};
}

} // namespace

std::vector<SceneStep> ReadScene(std::istream& in, const std::string& name) {
    std::vector<SceneStep> steps;
    std::string text;
    for (int number = 1; std::getline(in, text); ++number) {
        std::istringstream line(text);
        const Words words{std::istream_iterator<std::string>(line), {}};
        if (words.empty() || words[0][0] == '#') {
            continue;
        }
        try {
            steps.push_back(stepOf(words, steps.empty() ? 0 : steps.back().moment));
        } catch (const std::runtime_error& error) {
            throw std::runtime_error(name + ":" + std::to_string(number) + ": " + error.what());
        }
    }
    return steps;
}
