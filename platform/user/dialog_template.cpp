#include "platform/user/dialog_template.h"

#include "platform/dialogs.h"

#include <algorithm>
#include <charconv>

namespace seam {

namespace {

constexpr int baseWidth = 6;
constexpr int baseHeight = 13;
constexpr int pixelsOfAnInch = 96;
constexpr int pointsOfAnInch = 72;

struct StyleWord {
    std::string_view word;
    DWORD style;
};

constexpr StyleWord styleWords[] = {
    {"popup", WS_POPUP},
    {"visible", WS_VISIBLE},
    {"caption", WS_CAPTION},
    {"sysmenu", WS_SYSMENU},
    {"modalframe", 0}, // all frames are the window manager's
    {"border", WS_BORDER},
    {"vscroll", WS_VSCROLL},
    {"group", WS_GROUP},
    {"tabstop", WS_TABSTOP},
    {"default", BS_DEFPUSHBUTTON},
    {"checkbox", BS_AUTOCHECKBOX},
    {"radio", BS_AUTORADIOBUTTON},
    {"center", SS_CENTER},
    {"right", SS_RIGHT},
    {"icon", SS_ICON},
    {"blackframe", SS_BLACKFRAME},
    {"grayframe", SS_GRAYFRAME},
    {"multiline", ES_MULTILINE},
    {"wantreturn", ES_WANTRETURN},
    {"dropdownlist", CBS_DROPDOWNLIST},
    {"ownerdrawvariable", CBS_OWNERDRAWVARIABLE},
    {"ownerdraw", BS_OWNERDRAW},
    {"notify", LBS_NOTIFY},
    {"sort", LBS_SORT},
    {"nointegralheight", LBS_NOINTEGRALHEIGHT},
};

/// One line, taken apart from its start; once something is wrong, it stays wrong.
class Line {
  public:
    Line(std::string_view text, int percent) : rest_(text), percent_(percent) {
        skipBlanks();
    }

    bool good() const {
        return good_;
    }

    bool atEnd() const {
        return rest_.empty() || rest_.front() == '#';
    }

    std::string_view word() {
        const std::string_view found = rest_.substr(0, rest_.find_first_of(" \t"));
        rest_.remove_prefix(found.size());
        skipBlanks();
        return found;
    }

    int number() {
        const std::string_view digits = word();
        int value = 0;
        const auto [end, error] =
            std::from_chars(digits.data(), digits.data() + digits.size(), value);
        good_ = good_ && error == std::errc() && end == digits.data() + digits.size();
        return value;
    }

    std::string text() {
        std::string found;
        good_ = good_ && rest_.starts_with('"');
        std::size_t at = 1;
        for (; at < rest_.size() && rest_[at] != '"'; ++at) {
            const bool escape = rest_[at] == '\\' && at + 1 < rest_.size();
            at += escape ? 1 : 0;
            found += escape ? unescaped(rest_[at]) : rest_[at];
        }
        good_ = good_ && at < rest_.size();
        rest_.remove_prefix(std::min(at + 1, rest_.size()));
        skipBlanks();
        return found;
    }

    Place place() {
        const int left = number();
        const int top = number();
        const int width = number();
        const int height = number();
        return {across(left), down(top), across(width), down(height)};
    }

    /// Reads styles to the end of the line, and the spoken name among them.
    DWORD styles(std::string& spokenName) {
        DWORD style = 0;
        while (good_ && !atEnd()) {
            const std::string_view name = word();
            if (name == "named") {
                spokenName = text();
                continue;
            }
            const auto* found =
                std::find_if(std::begin(styleWords), std::end(styleWords),
                             [name](const StyleWord& entry) { return entry.word == name; });
            good_ = found != std::end(styleWords);
            style |= good_ ? found->style : 0;
        }
        return style;
    }

  private:
    static char unescaped(char letter) {
        if (letter == 'r') {
            return '\r';
        }
        return letter == 't' ? '\t' : letter;
    }

    int across(int units) const {
        return (units * baseWidth * percent_ + 200) / 400;
    }

    int down(int units) const {
        return (units * baseHeight * percent_ + 400) / 800;
    }

    void skipBlanks() {
        rest_.remove_prefix(std::min(rest_.find_first_not_of(" \t"), rest_.size()));
    }

    std::string_view rest_;
    int percent_;
    bool good_ = true;
};

void readHead(Line& line, DialogTemplate& dialog) {
    std::string unused;
    dialog.title = line.text();
    dialog.place = line.place();
    dialog.style = line.styles(unused);
}

void readControl(Line& line, DialogTemplate& dialog) {
    ControlTemplate control;
    control.id = line.number();
    control.kind = line.word();
    control.text = line.text();
    control.place = line.place();
    control.style = line.styles(control.spokenName) | WS_CHILD | WS_VISIBLE;
    dialog.controls.push_back(std::move(control));
}

int fontPixels(int points, int percent) {
    constexpr int whole = pointsOfAnInch * 100;
    return (points * pixelsOfAnInch * percent + whole / 2) / whole;
}

bool readLine(std::string_view text, int percent, DialogTemplate& dialog) {
    Line line(text, percent);
    if (line.atEnd()) {
        return true;
    }
    Line start = line;
    const std::string_view first = start.word();
    if (first == "dialog") {
        readHead(start, dialog);
    } else if (first == "font") {
        dialog.fontHeight = fontPixels(start.number(), percent);
        start.text();
    } else if (first == "menu") {
        dialog.menus.push_back({start.text(), {}});
    } else if (!dialog.menus.empty() && (first == "item" || first == "separator")) {
        const bool isItem = first == "item";
        const int id = isItem ? start.number() : 0;
        dialog.menus.back().items.push_back({id, isItem ? start.text() : std::string()});
    } else {
        readControl(line, dialog);
        return line.good();
    }
    return start.good() && start.atEnd();
}

} // namespace

std::optional<DialogTemplate> parseDialogTemplate(std::string_view text, int percent) {
    DialogTemplate dialog;
    while (!text.empty()) {
        const std::string_view line = text.substr(0, text.find('\n'));
        if (!readLine(line, percent, dialog)) {
            return std::nullopt;
        }
        text.remove_prefix(std::min(line.size() + 1, text.size()));
    }
    return dialog;
}

} // namespace seam
