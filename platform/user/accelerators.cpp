#include "platform/user/accelerators.h"

#include "platform/handle_table.h"
#include "platform/kernel.h"
#include "platform/kernel/text.h"
#include "platform/user/queue.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QApplication>
#include <QKeyEvent>
#include <QWidget>
#include <QWindow>

#include <algorithm>
#include <charconv>
#include <memory>

namespace seam {

namespace {

struct AcceleratorTable {
    std::string name; // in lower case
    std::vector<Accelerator> keys;

    const Accelerator* find(const KeyStroke& key) const {
        const auto found = std::find_if(keys.begin(), keys.end(),
                                        [&key](const Accelerator& one) { return one.key == key; });
        return found == keys.end() ? nullptr : &*found;
    }
};

/// Each table once; they stay, for nothing ever gives one back.
HandleTable<AcceleratorTable> tables(HandleKind::accelerators);

/// What the loop of a depth has said of its keys.
struct Depth {
    HACCEL table;
    bool translated = true; // its last message has been through TranslateAcceleratorA
};

std::vector<Depth> depths(1);

std::vector<std::string_view> wordsOf(std::string_view line) {
    std::vector<std::string_view> words;
    line = line.substr(0, line.find('#'));
    while (!(line = trimmed(line)).empty()) {
        words.push_back(line.substr(0, line.find_first_of(" \t")));
        line.remove_prefix(words.back().size());
    }
    return words;
}

std::optional<Accelerator> readAccelerator(const std::vector<std::string_view>& words) {
    if (words.size() != 3 || (words[0] != "alt" && words[0] != "ctrl") || words[1].size() != 1) {
        return std::nullopt;
    }
    const char key = words[1].front();
    const std::string_view number = words[2];
    WORD command = 0;
    const auto [end, error] =
        std::from_chars(number.data(), number.data() + number.size(), command);
    const bool isKey = (key >= 'A' && key <= 'Z') || (key >= '0' && key <= '9');
    if (!isKey || error != std::errc() || end != number.data() + number.size()) {
        return std::nullopt;
    }
    return Accelerator{{static_cast<WPARAM>(key), words[0] == "alt" ? altHeld : ctrlHeld}, command};
}

std::optional<std::vector<Accelerator>> loadTable(HINSTANCE instance, const char* name) {
    const HRSRC found = FindResourceA(instance, name, RT_ACCELERATOR);
    const HGLOBAL block = found ? LoadResource(instance, found) : HGLOBAL{};
    const auto* text = static_cast<const char*>(LockResource(block));
    if (text == nullptr) {
        return std::nullopt;
    }
    auto keys = parseAccelerators({text, SizeofResource(instance, found)});
    FreeResource(block);
    return keys;
}

HACCEL tableNamed(const std::string& name) {
    HACCEL handle;
    tables.forEach([&](DWORD number, const AcceleratorTable& table) {
        handle = table.name == name ? HACCEL{number} : handle;
    });
    return handle;
}

/// Whether the press is for the loop that the toolkit hands it to.
bool isForTheLoop(const QKeyEvent& event) {
    const AcceleratorTable* table = tables.find(depths.back().table.number);
    return table != nullptr && table->find(keyStroke(event)) != nullptr &&
           !toolkitLoopIsInnermost() && QApplication::activePopupWidget() == nullptr;
}

/// The top-level window of ours that has the key, whichever of the toolkit's objects it reaches.
HWND windowOf(QObject& object) {
    const auto* widget = qobject_cast<QWidget*>(&object);
    const QWindow* native =
        widget != nullptr ? widget->window()->windowHandle() : qobject_cast<QWindow*>(&object);
    HWND found;
    forEachWindow([&](const Window& window) {
        if (!found && native != nullptr && toolkitWindow(window) == native) {
            found = topLevelOf(window.handle);
        }
    });
    return found;
}

/// Takes the keys of the loop's table before the toolkit looks for underlined letters.
class KeyTaker : public QObject {
  protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() != QEvent::ShortcutOverride && event->type() != QEvent::KeyPress) {
            return false;
        }
        const auto& key = static_cast<const QKeyEvent&>(*event);
        const HWND window = isForTheLoop(key) ? windowOf(*watched) : HWND{};
        if (!window) {
            return false;
        }
        event->accept();
        if (event->type() == QEvent::KeyPress) {
            queueKey(keyTarget(window), key, true);
        }
        return true;
    }
};

void takeKeys() {
    static KeyTaker* taker = nullptr;
    if (taker == nullptr && toolkit()) {
        taker = new KeyTaker; // kept, like the application object, until the process ends
        qApp->installEventFilter(taker);
    }
}

} // namespace

std::optional<std::vector<Accelerator>> parseAccelerators(std::string_view text) {
    std::vector<Accelerator> keys;
    while (!text.empty()) {
        const std::string_view line = text.substr(0, text.find('\n'));
        text.remove_prefix(std::min(line.size() + 1, text.size()));
        const std::vector<std::string_view> words = wordsOf(line);
        if (words.empty()) {
            continue;
        }
        const auto key = readAccelerator(words);
        if (!key) {
            return std::nullopt;
        }
        keys.push_back(*key);
    }
    return keys;
}

InnerDepth::InnerDepth() {
    depths.emplace_back();
}

InnerDepth::~InnerDepth() {
    depths.pop_back();
}

void loopAsksForMessage() {
    Depth& depth = depths.back();
    if (!depth.translated) {
        depth.table = {};
    }
    depth.translated = false;
}

} // namespace seam

using namespace seam;

HACCEL LoadAcceleratorsA(HINSTANCE instance, const char* name) {
    const std::string wanted = lowered(name == nullptr ? "" : name);
    HACCEL table = tableNamed(wanted);
    if (!table) {
        auto keys = loadTable(instance, wanted.c_str());
        if (!keys) {
            return {};
        }
        table =
            HACCEL{tables.add(std::make_unique<AcceleratorTable>(AcceleratorTable{wanted, *keys}))};
    }
    depths.back() = {table, true};
    takeKeys();
    return table;
}

int TranslateAcceleratorA(HWND window, HACCEL table, const MSG* message) {
    const AcceleratorTable* found = tables.find(table.number);
    if (found == nullptr || message == nullptr) {
        return 0;
    }
    depths.back() = {table, true};
    const bool press = message->message == WM_KEYDOWN || message->message == WM_SYSKEYDOWN;
    const Accelerator* key = press ? found->find(keyStroke(*message)) : nullptr;
    if (key == nullptr || findWindow(window) == nullptr) {
        return 0;
    }
    const InnerDepth inner;
    SendMessageA(window, WM_COMMAND, MAKELONG(key->command, 1), 0);
    return 1;
}
