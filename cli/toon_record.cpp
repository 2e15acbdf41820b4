#include "cli/toon_record.h"

#include <algorithm>
#include <cstring>
#include <span>

ToonHeader NewHeader() {
    ToonHeader header{};
    std::memcpy(header.magic, ToonMagic, sizeof ToonMagic);
    header.version = TOON_VERSION;
    header.speed = TOON_DEFAULT_SPEED;
    header.background = TOON_DEFAULT_BACKGROUND;
    return header;
}

ToonFrame NewFrame() {
    ToonFrame frame{};
    frame.pause = TOON_DEFAULT_PAUSE;
    return frame;
}

// ---- Fields -----------------------------------------------------------------------------------

const char* BytesOf(const ToonHeader& header) {
    return reinterpret_cast<const char*>(&header);
}

const char* BytesOf(const ToonFrame& frame) {
    return reinterpret_cast<const char*>(&frame);
}

char* BytesOf(ToonHeader& header) {
    return reinterpret_cast<char*>(&header);
}

char* BytesOf(ToonFrame& frame) {
    return reinterpret_cast<char*>(&frame);
}

std::string_view TextOf(const Field& field, const char* record) {
    const char* text = record + field.offset;
    return {text, strnlen(text, static_cast<std::size_t>(field.most))};
}

/// What people see is more by this than what stands in the file.
static std::int64_t ShownBy(const Field& field) {
    return field.kind == FieldKind::pose ? 1 : 0;
}

std::int64_t NumberOf(const Field& field, const char* record) {
    LONG value = 0;
    std::memcpy(&value, record + field.offset, sizeof value);
    return value + ShownBy(field);
}

bool SetNumber(const Field& field, char* record, std::int64_t shown) {
    const std::int64_t more = ShownBy(field);
    if (shown < INT32_MIN + more || shown > INT32_MAX + more) {
        return false;
    }
    const auto stored = static_cast<LONG>(shown - more);
    std::memcpy(record + field.offset, &stored, sizeof stored);
    return true;
}

LONG StageWidth(const ToonHeader& header) {
    return LOWORD(header.windowSize);
}

LONG StageHeight(const ToonHeader& header) {
    return HIWORD(header.windowSize);
}

// ---- Files ------------------------------------------------------------------------------------

std::string ToonFromBytes(std::string_view bytes, Toon& toon) {
    constexpr std::size_t size = sizeof(ToonHeader);
    if (bytes.size() < size) {
        return "it is no Toon: of the header's " + std::to_string(size) + " bytes it has " +
               std::to_string(bytes.size());
    }
    std::memcpy(&toon.header, bytes.data(), size);
    if (toon.header.version != TOON_VERSION) {
        return "it is no Toon of the version that loads: the bytes 32 to 35 aren't 01 00 02 00";
    }
    // Meant: a last record that lacks one byte counts, and what is missing stays zero.
    toon.frames.assign((bytes.size() - (size - 1)) / sizeof(ToonFrame), ToonFrame{});
    const std::size_t wanted = toon.frames.size() * sizeof(ToonFrame);
    if (wanted > 0) {
        std::memcpy(toon.frames.data(), bytes.data() + size, std::min(wanted, bytes.size() - size));
    }
    return "";
}

std::string ToonBytes(const Toon& toon) {
    ToonHeader header = toon.header;
    header.frameCount = static_cast<LONG>(toon.frames.size());
    std::string bytes(BytesOf(header), sizeof header);
    const auto* frames = reinterpret_cast<const char*>(toon.frames.data());
    return bytes.append(frames, toon.frames.size() * sizeof(ToonFrame));
}

// ---- What is odd ------------------------------------------------------------------------------

std::string Counted(std::int64_t number, std::string_view what) {
    std::string text = std::to_string(number) + " ";
    return text.append(what).append(number == 1 ? "" : "s");
}

std::string Where(std::size_t frame, std::string_view field) {
    std::string text = frame == 0 ? "" : "frame " + std::to_string(frame);
    if (frame != 0 && !field.empty()) {
        text += ", ";
    }
    text += field;
    return text.empty() ? text : text + ": ";
}

std::string Advice(std::string_view what, std::string_view right) {
    return std::string(what).append("; ").append(right).append(" would be right");
}

static void FindOddFields(std::vector<Finding>& found, std::size_t frame,
                          std::span<const Field> fields, const char* record) {
    for (const Field& field : fields) {
        if (field.kind == FieldKind::stage) {
            continue; // any size is a stage
        }
        if (field.kind == FieldKind::text) {
            const auto length = static_cast<std::int64_t>(TextOf(field, record).size());
            if (length > field.high) {
                found.push_back(
                    {frame, field.name,
                     Advice(std::to_string(length) + " characters are too many", field.right)});
            }
            continue;
        }
        const std::int64_t value = NumberOf(field, record);
        if (value < field.low || value > field.high) {
            std::string what = std::to_string(value) + " is no ";
            found.push_back({frame, field.name, Advice(what.append(field.noun), field.right)});
        }
    }
}

/// He is out of sight beyond this, in pixels past an edge of the stage. A side of 0 has no far
/// edge.
static void FindPlaceOutOfSight(std::vector<Finding>& found, std::size_t frame,
                                std::string_view field, LONG place, LONG side) {
    constexpr LONG beyond = 150;
    if (place >= -beyond && (side == 0 || place <= side + beyond)) {
        return;
    }
    const std::string range =
        side == 0 ? std::to_string(-beyond) + " or more"
                  : std::to_string(-beyond) + " to " + std::to_string(side + beyond);
    found.push_back({frame, field, Advice(std::to_string(place) + " is out of sight", range)});
}

std::vector<Finding> OddValues(const Toon& toon) {
    std::vector<Finding> found;
    FindOddFields(found, 0, headerFields, BytesOf(toon.header));
    for (std::size_t i = 0; i < toon.frames.size(); ++i) {
        const ToonFrame& frame = toon.frames[i];
        FindPlaceOutOfSight(found, i + 1, "x", frame.x, StageWidth(toon.header));
        FindPlaceOutOfSight(found, i + 1, "y", frame.y, StageHeight(toon.header));
        FindOddFields(found, i + 1, frameFields, BytesOf(frame));
    }
    constexpr auto most = static_cast<std::size_t>(TOON_FRAME_LIMIT);
    if (toon.frames.empty()) {
        found.push_back({0, "frames", Advice("a Toon without a frame doesn't load", "1 to 251")});
    } else if (toon.frames.size() > most) {
        const auto count = static_cast<std::int64_t>(toon.frames.size());
        found.push_back(
            {0, "frames",
             Advice(Counted(count, "frame") + " are more than the editor makes", "1 to 251")});
    }
    return found;
}
