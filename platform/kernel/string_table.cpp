#include "platform/kernel/string_table.h"

#include "platform/kernel.h"
#include "platform/kernel/text.h"

#include <QtCore/QResource>

#include <algorithm>
#include <charconv>

namespace seam {

namespace {

std::string unescaped(std::string_view text) {
    std::string result;
    for (std::size_t at = 0; at < text.size(); ++at) {
        const std::string_view mark = text.substr(at, 2);
        if (mark == "\\r" || mark == "\\\\") {
            result += mark == "\\r" ? '\r' : '\\';
            ++at;
        } else {
            result += text[at];
        }
    }
    return result;
}

void addLine(StringTable& table, std::string_view line) {
    UINT id = 0;
    const char* end = line.data() + line.size();
    const auto [stop, error] = std::from_chars(line.data(), end, id);
    if (error == std::errc{} && stop != end && *stop == '\t') {
        table.emplace(id, unescaped({stop + 1, static_cast<std::size_t>(end - stop - 1)}));
    }
}

const StringTable& programTexts() {
    static const StringTable table = [] {
        const QResource resource(QStringLiteral(":/string/table"));
        const QByteArray lines = resource.uncompressedData();
        return parseStringTable({lines.constData(), static_cast<std::size_t>(lines.size())});
    }();
    return table;
}

} // namespace

StringTable parseStringTable(std::string_view lines) {
    StringTable table;
    while (!lines.empty()) {
        std::string_view line = lines.substr(0, lines.find('\n'));
        lines.remove_prefix(std::min(line.size() + 1, lines.size()));
        if (line.ends_with('\r')) {
            line.remove_suffix(1);
        }
        addLine(table, line);
    }
    return table;
}

} // namespace seam

int LoadStringA(HINSTANCE, UINT id, char* buffer, int size) {
    const seam::StringTable& texts = seam::programTexts();
    const auto found = texts.find(id);
    const std::string_view text = found != texts.end() ? found->second : std::string_view{};
    return static_cast<int>(
        seam::copyCut(text, buffer, static_cast<std::size_t>(std::max(size, 0))));
}
