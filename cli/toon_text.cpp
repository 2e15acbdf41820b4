#include "cli/toon_text.h"

#include "platform/codepage.h"
#include "toon/toon_document.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstring>
#include <span>

namespace {

enum class Kind { number, text };

/// A line of the text form and the field behind it.
struct Key {
    std::string_view name;
    Kind kind;
    std::size_t offset; // in the record
    std::size_t size;   // of the text field, or of each number
    std::size_t count;  // of numbers
    bool always;        // else printed only where it differs from what is made without the line
    LONG low;           // what the editor makes: a number's range, the length of a text
    LONG high;
};

constexpr std::array headerKeys{
    Key{"magic", Kind::text, offsetof(ToonHeader, magic), TOON_MAGIC_SIZE, 1, false, 0, 32},
    Key{"caption", Kind::text, offsetof(ToonHeader, caption), TOON_CAPTION_SIZE, 1, true, 0, 48},
    Key{"stage", Kind::number, offsetof(ToonHeader, windowSize), 2, 2, true, 0, 0xFFFF},
    Key{"speed", Kind::number, offsetof(ToonHeader, speed), 4, 1, true, 1, 5},
    Key{"background", Kind::number, offsetof(ToonHeader, background), 4, 1, true, 1, 10},
    Key{"count", Kind::number, offsetof(ToonHeader, frameCount), 4, 1, false, INT32_MIN, INT32_MAX},
};

constexpr std::array frameKeys{
    Key{"at", Kind::number, offsetof(ToonFrame, x), 4, 2, true, INT32_MIN, INT32_MAX},
    Key{"pose", Kind::number, offsetof(ToonFrame, pose), 4, 1, true, 0, 7},
    Key{"pause", Kind::number, offsetof(ToonFrame, pause), 4, 1, true, 1, 20},
    Key{"wink", Kind::number, offsetof(ToonFrame, wink), 4, 1, true, 0, 1},
    Key{"text", Kind::text, offsetof(ToonFrame, text), TOON_TEXT_SIZE, 1, true, 0, 69},
    Key{"reserved", Kind::number, offsetof(ToonFrame, reserved), 2, 1, false, 0, 0xFFFF},
};

constexpr std::size_t countKey = headerKeys.size() - 1;

ToonHeader NewHeader() {
    ToonHeader header{};
    std::memcpy(header.magic, ToonMagic, sizeof ToonMagic);
    header.version = TOON_VERSION;
    header.speed = TOON_DEFAULT_SPEED;
    header.background = TOON_DEFAULT_BACKGROUND;
    return header;
}

// ---- Texts and numbers
// ---------------------------------------------------------------------------

/// Whether a byte can't stand for itself in a text: control characters and the holes of the set.
bool isUnprintable(char byte) {
    constexpr std::string_view holes = "\x7F\x81\x8D\x8F\x90\x9D";
    return static_cast<unsigned char>(byte) < 0x20 || holes.find(byte) != std::string_view::npos;
}

/// The bytes in quotes, as UTF-8, with \r, \", \\ and \xNN for what can't stand as it is.
std::string Quoted(std::string_view bytes) {
    std::string result = "\"";
    for (const char byte : bytes) {
        if (byte == '\r') {
            result += "\\r";
        } else if (byte == '"' || byte == '\\') {
            result += {'\\', byte};
        } else if (isUnprintable(byte)) {
            constexpr std::string_view digits = "0123456789ABCDEF";
            const auto value = static_cast<unsigned char>(byte);
            result += {'\\', 'x', digits[value / 16U], digits[value % 16U]};
        } else {
            result += byte;
        }
    }
    return seam::utf8FromWindows1252(result + '"');
}

/// Takes the escape behind a backslash off the front of `rest`; none if there is no such escape.
std::optional<char> TakeEscape(std::string_view& rest) {
    constexpr std::size_t hexadecimal = 3; // x and two digits
    if (rest.starts_with('x')) {
        unsigned value = 0;
        const char* digits = rest.data() + 1;
        const char* end = rest.data() + std::min(rest.size(), hexadecimal);
        if (rest.size() < hexadecimal || std::from_chars(digits, end, value, 16).ptr != end) {
            return std::nullopt;
        }
        rest.remove_prefix(hexadecimal);
        return static_cast<char>(value);
    }
    if (rest.empty() || std::string_view("r\"\\").find(rest.front()) == std::string_view::npos) {
        return std::nullopt;
    }
    const char byte = rest.front() == 'r' ? '\r' : rest.front();
    rest.remove_prefix(1);
    return byte;
}

/// The bytes of a text in quotes; none, and what is wrong in `error`, if it isn't one.
std::optional<std::string> Unquoted(std::string_view word, std::string& error) {
    const std::optional<std::string> text = seam::windows1252FromUtf8(word);
    if (!text) {
        error = "a character that Windows-1252 hasn't got";
        return std::nullopt;
    }
    error = "a text stands in quotes";
    std::string_view rest = *text;
    if (!rest.starts_with('"')) {
        return std::nullopt;
    }
    rest.remove_prefix(1);
    std::string result;
    while (!rest.empty() && rest.front() != '"') {
        const char character = rest.front();
        rest.remove_prefix(1);
        const std::optional<char> byte = character == '\\' ? TakeEscape(rest) : character;
        if (!byte) {
            error = "only \\r, \\\", \\\\ and \\xNN stand for something else";
            return std::nullopt;
        }
        result += *byte;
    }
    if (rest.size() != 1) {
        return std::nullopt;
    }
    error.clear();
    return result;
}

LONG NumberAt(const char* field, std::size_t size) {
    if (size == sizeof(WORD)) {
        WORD value = 0;
        std::memcpy(&value, field, sizeof value);
        return value;
    }
    LONG value = 0;
    std::memcpy(&value, field, sizeof value);
    return value;
}

std::string_view TakeWord(std::string_view& line) {
    const std::size_t begin = std::min(line.find_first_not_of(" \t"), line.size());
    line.remove_prefix(begin);
    const std::string_view word = line.substr(0, line.find_first_of(" \t"));
    line.remove_prefix(word.size());
    return word;
}

std::string_view Trimmed(std::string_view line) {
    const std::size_t begin = std::min(line.find_first_not_of(" \t\r"), line.size());
    const std::size_t end = line.find_last_not_of(" \t\r");
    return line.substr(begin, end == std::string_view::npos ? 0 : end + 1 - begin);
}

// ---- To text
// -------------------------------------------------------------------------------------

std::string_view WithoutTrailingNuls(const char* field, std::size_t size) {
    std::string_view bytes(field, size);
    return bytes.substr(0, bytes.find_last_not_of('\0') + 1);
}

void PrintRecord(std::string& text, std::span<const Key> keys, const char* record,
                 const char* made) {
    for (const Key& key : keys) {
        const char* field = record + key.offset;
        const std::size_t bytes = key.size * key.count;
        if (!key.always && std::memcmp(field, made + key.offset, bytes) == 0) {
            continue;
        }
        text += key.name;
        if (key.kind == Kind::text) {
            text.append(" ").append(Quoted(WithoutTrailingNuls(field, key.size)));
        } else {
            for (std::size_t i = 0; i < key.count; ++i) {
                text.append(" ").append(std::to_string(NumberAt(field + i * key.size, key.size)));
            }
        }
        text += "\n";
    }
}

} // namespace

std::optional<std::string> ToonToText(std::string_view bytes) {
    ToonHeader header{};
    if (bytes.size() < sizeof header) {
        return std::nullopt;
    }
    std::memcpy(&header, bytes.data(), sizeof header);
    if (header.version != TOON_VERSION) {
        return std::nullopt;
    }
    bytes.remove_prefix(sizeof header);
    ToonHeader madeHeader = NewHeader();
    madeHeader.frameCount = static_cast<LONG>(bytes.size() / sizeof(ToonFrame));
    constexpr ToonFrame madeFrame{};

    std::string text;
    PrintRecord(text, headerKeys, reinterpret_cast<const char*>(&header),
                reinterpret_cast<const char*>(&madeHeader));
    for (; bytes.size() >= sizeof(ToonFrame); bytes.remove_prefix(sizeof(ToonFrame))) {
        text += "\nframe\n";
        PrintRecord(text, frameKeys, bytes.data(), reinterpret_cast<const char*>(&madeFrame));
    }
    if (!bytes.empty()) {
        text.append("\nrest ").append(Quoted(bytes)).append("\n");
    }
    return text;
}

// ---- From text
// -----------------------------------------------------------------------------------

namespace {

struct Reader {
    ToonFromText result;
    int line = 0;
    ToonHeader header = NewHeader();
    std::vector<ToonFrame> frames;
    std::optional<std::string> rest;
    DWORD headerSeen = 0; // a bit for each key of the record
    DWORD frameSeen = 0;
};

std::string InLine(const Reader& reader, const std::string& what) {
    return std::string("line ").append(std::to_string(reader.line)).append(": ").append(what);
}

void Fail(Reader& reader, const std::string& what) {
    reader.result.error = InLine(reader, what);
}

void WarnUnless(Reader& reader, bool usual, const std::string& what) {
    if (!usual) {
        reader.result.warnings.push_back(InLine(reader, what));
    }
}

void ReadText(Reader& reader, const Key& key, std::string_view word, char* field) {
    std::string error;
    const std::optional<std::string> bytes = Unquoted(word, error);
    if (!bytes) {
        Fail(reader, error);
        return;
    }
    if (bytes->size() > key.size) {
        Fail(reader,
             std::string(key.name) + " is longer than its " + std::to_string(key.size) + " bytes");
        return;
    }
    WarnUnless(reader, bytes->size() <= static_cast<std::size_t>(key.high),
               std::string(key.name) + " is longer than " + std::to_string(key.high) +
                   " characters");
    std::memset(field, 0, key.size);
    std::copy(bytes->begin(), bytes->end(), field);
}

void ReadNumbers(Reader& reader, const Key& key, std::string_view words, char* field) {
    for (std::size_t i = 0; i < key.count; ++i) {
        const std::string_view word = TakeWord(words);
        LONG value = 0;
        const auto [end, problem] = std::from_chars(word.data(), word.data() + word.size(), value);
        const bool fits = key.size == sizeof(LONG) || (value >= 0 && value <= 0xFFFF);
        if (word.empty() || problem != std::errc{} || end != word.data() + word.size() || !fits) {
            Fail(reader, std::string(key.name) + " takes " + std::to_string(key.count) +
                             (key.count == 1 ? " number" : " numbers"));
            return;
        }
        WarnUnless(reader, value >= key.low && value <= key.high,
                   std::string(key.name) + " is outside " + std::to_string(key.low) + " to " +
                       std::to_string(key.high));
        std::memcpy(field + i * key.size, &value, key.size);
    }
    if (!Trimmed(words).empty()) {
        Fail(reader, "too much behind " + std::string(key.name));
    }
}

/// Reads the value of a key into its field. False if the record has no such key.
bool ReadKey(Reader& reader, std::span<const Key> keys, DWORD& seen, char* record,
             std::string_view name, std::string_view value) {
    for (std::size_t i = 0; i < keys.size(); ++i) {
        const Key& key = keys[i];
        if (key.name != name) {
            continue;
        }
        if ((seen & 1U << i) != 0) {
            Fail(reader, std::string(name) + " stands twice");
        } else if (key.kind == Kind::text) {
            ReadText(reader, key, value, record + key.offset);
        } else {
            ReadNumbers(reader, key, value, record + key.offset);
        }
        seen |= 1U << i;
        return true;
    }
    return false;
}

void ReadLine(Reader& reader, std::string_view line) {
    std::string_view value = line;
    const std::string_view name = TakeWord(value);
    value = Trimmed(value);
    if (reader.rest) {
        Fail(reader, "nothing stands behind the rest");
    } else if (name == "rest") {
        std::string error;
        reader.rest = Unquoted(value, error);
        if (!reader.rest) {
            Fail(reader, error);
        }
    } else if (name == "frame" && value.empty()) {
        reader.frames.push_back({});
        reader.frameSeen = 0;
    } else if (reader.frames.empty()) {
        if (!ReadKey(reader, headerKeys, reader.headerSeen, reinterpret_cast<char*>(&reader.header),
                     name, value)) {
            Fail(reader, "before the first frame there is no " + std::string(name));
        }
    } else if (!ReadKey(reader, frameKeys, reader.frameSeen,
                        reinterpret_cast<char*>(&reader.frames.back()), name, value)) {
        Fail(reader, "a frame has no " + std::string(name));
    }
}

void Assemble(Reader& reader) {
    if ((reader.headerSeen & 1U << countKey) == 0) {
        reader.header.frameCount = static_cast<LONG>(reader.frames.size());
    }
    const std::size_t size = reader.frames.size() * sizeof(ToonFrame);
    WarnUnless(reader, !reader.frames.empty(), "a Toon without a frame doesn't load");
    WarnUnless(reader, reader.frames.size() <= static_cast<std::size_t>(TOON_FRAME_LIMIT),
               "the editor adds no frame to so many");
    std::string& bytes = reader.result.bytes;
    bytes.assign(reinterpret_cast<const char*>(&reader.header), sizeof reader.header);
    bytes.append(reinterpret_cast<const char*>(reader.frames.data()), size);
    bytes += reader.rest.value_or("");
}

} // namespace

ToonFromText TextToToon(std::string_view text) {
    constexpr std::string_view byteOrderMark = "\xEF\xBB\xBF";
    if (text.starts_with(byteOrderMark)) {
        text.remove_prefix(byteOrderMark.size());
    }
    Reader reader;
    while (!text.empty() && reader.result.error.empty()) {
        const std::size_t end = text.find('\n');
        const std::string_view line = Trimmed(text.substr(0, end));
        text.remove_prefix(end == std::string_view::npos ? text.size() : end + 1);
        ++reader.line;
        if (!line.empty() && line.front() != '#') {
            ReadLine(reader, line);
        }
    }
    if (reader.result.error.empty()) {
        Assemble(reader);
    }
    return std::move(reader.result);
}
