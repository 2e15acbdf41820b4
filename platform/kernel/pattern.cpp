#include "platform/kernel/pattern.h"

#include "platform/kernel/text.h"

namespace seam {

bool isPattern(std::string_view text) {
    return text.find_first_of("*?") != std::string_view::npos;
}

bool matchesPattern(std::string_view name, std::string_view pattern) {
    if (pattern == "*.*") {
        return true;
    }
    // Where the last star stands and where the run that it stands for ends: on a mismatch that
    // run grows by one byte, which is all the going back that is ever needed.
    std::size_t star = std::string_view::npos;
    std::size_t runEnd = 0;
    std::size_t at = 0;
    std::size_t mark = 0;
    while (at < name.size()) {
        if (mark < pattern.size() && pattern[mark] == '*') {
            star = mark++;
            runEnd = at;
        } else if (mark < pattern.size() &&
                   (pattern[mark] == '?' ||
                    sameButForCase(name.substr(at, 1), pattern.substr(mark, 1)))) {
            ++at;
            ++mark;
        } else if (star != std::string_view::npos) {
            mark = star + 1;
            at = ++runEnd;
        } else {
            return false;
        }
    }
    return pattern.find_first_not_of("*?", mark) == std::string_view::npos;
}

} // namespace seam
