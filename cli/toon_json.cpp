#include "cli/toon_json.h"

#include "cli/json_text.h"

#include "platform/codepage.h"

namespace {

std::string ValueText(const Field& field, const char* record) {
    if (field.kind == FieldKind::text) {
        return JsonText(seam::utf8FromWindows1252(WithBreaksSwapped(TextOf(field, record))));
    }
    const std::int64_t number = NumberOf(field, record);
    if (field.kind == FieldKind::wink && (number == 0 || number == 1)) {
        return number == 1 ? "true" : "false";
    }
    return std::to_string(number);
}

void AddField(std::string& text, const char* indent, std::string_view name,
              std::string_view value) {
    text.append(indent).append("\"").append(name).append("\": ").append(value).append(",\n");
}

std::string StageText(const ToonHeader& header) {
    return "[" + std::to_string(StageWidth(header)) + ", " + std::to_string(StageHeight(header)) +
           "]";
}

void AddFrame(std::string& text, const ToonFrame& frame) {
    text += "    {\n";
    for (const Field& field : frameFields) {
        AddField(text, "      ", field.name, ValueText(field, BytesOf(frame)));
    }
    text.erase(text.size() - 2, 1); // no comma behind the last one
    text += "    },\n";
}

} // namespace

std::string ToonToJson(const Toon& toon) {
    std::string text = "{\n";
    for (const Field& field : headerFields) {
        const char* record = BytesOf(toon.header);
        if (field.kind == FieldKind::stage) {
            AddField(text, "  ", field.name, StageText(toon.header));
        } else if (field.name != "magic" || TextOf(field, record) != ToonMagic) {
            AddField(text, "  ", field.name, ValueText(field, record));
        }
    }
    if (toon.frames.empty()) {
        return text + "  \"frames\": []\n}\n";
    }
    text += "  \"frames\": [\n";
    for (const ToonFrame& frame : toon.frames) {
        AddFrame(text, frame);
    }
    text.erase(text.size() - 2, 1);
    return text + "  ]\n}\n";
}
