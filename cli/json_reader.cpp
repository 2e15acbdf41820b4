#include "cli/json_text.h"
#include "cli/json_value.h"
#include "cli/toon_json.h"

#include <rapidjson/memorystream.h>
#include <rapidjson/reader.h>

#include <algorithm>
#include <optional>
#include <span>

namespace json = rapidjson;

namespace {

constexpr std::string_view framesName = "frames";
constexpr std::string_view toonForm = R"({"frames": [...]})";
constexpr std::string_view framesForm = "a list of frames";
constexpr std::string_view frameForm = R"({"x": 420, "y": 780, "pose": 1})";

/// What the parser tells step by step, in the order of the file.
class Reader {
  public:
    explicit Reader(std::string_view text) : stream(text.data(), text.size()), text_(text) {
        result.toon.header = NewHeader();
    }

    // The parser's names. False ends the reading.

    bool Null() {
        return take({JsonType::null, "null"});
    }

    bool Bool(bool value) {
        return take({JsonType::boolean, value ? "true" : "false"});
    }

    bool RawNumber(const char* text, json::SizeType length, bool) {
        return take({JsonType::number, {text, length}});
    }

    bool String(const char* text, json::SizeType length, bool) {
        return take({JsonType::text, {text, length}});
    }

    bool StartObject() {
        return take({JsonType::object, "{...}"});
    }

    bool StartArray() {
        return take({JsonType::list, "[...]"});
    }

    bool Key(const char* name, json::SizeType length, bool);
    bool EndObject(json::SizeType);
    bool EndArray(json::SizeType);

    // Numbers come as they are written.

    static bool Int(int) {
        return false;
    }

    static bool Uint(unsigned) {
        return false;
    }

    static bool Int64(std::int64_t) {
        return false;
    }

    static bool Uint64(std::uint64_t) {
        return false;
    }

    static bool Double(double) {
        return false;
    }

    /// Notes what is wrong in a line, in the field under way; gives false.
    bool failIn(int line, const std::string& what);
    int lineAt(std::size_t offset);

    /// Notes where the values stand that the editor would not have made.
    void warn();

    json::MemoryStream stream;
    ToonFromJson result;

  private:
    enum class Place { root, toon, stage, frames, frame };

    bool take(const JsonValue& value);
    bool takeInToon(const JsonValue& value);
    bool takeSide(const JsonValue& value);
    bool takeField(const JsonValue& value, char* record);
    bool takeFrame(const JsonValue& value);
    bool closeFrame();

    std::span<const Field> fields() const;
    int* lines();
    std::size_t frame() const;
    bool fail(const std::string& what);
    int lineOf(const Finding& finding) const;

    std::string_view text_;
    Place place_ = Place::root;
    const Field* field_ = nullptr; // whose value comes next
    std::string name_;             // its name, also that of the list of frames
    int sides_ = 0;                // of the stage, that have come
    int framesLine_ = 0;
    int recordLine_ = 1; // where the record under way begins
    // The line of each field, 0 for one that wasn't met.
    std::array<int, headerFields.size()> headerLines_{};
    std::vector<std::array<int, frameFields.size()>> frameLines_;
    std::size_t counted_ = 0; // up to here line breaks have been counted
    int line_ = 1;
};

int Reader::lineAt(std::size_t offset) {
    if (offset < counted_) {
        counted_ = 0;
        line_ = 1;
    }
    const std::string_view passed = text_.substr(counted_, offset - counted_);
    line_ += static_cast<int>(std::count(passed.begin(), passed.end(), '\n'));
    counted_ += passed.size();
    return line_;
}

/// The frame under way, counted from 1; 0 outside of them.
std::size_t Reader::frame() const {
    return place_ == Place::frame ? result.toon.frames.size() : 0;
}

/// "12: frame 3, pose: ..."
std::string InLine(int line, std::size_t frame, std::string_view field, const std::string& what) {
    return std::to_string(line).append(": ").append(Where(frame, field)).append(what);
}

bool Reader::failIn(int line, const std::string& what) {
    result.error = InLine(line, frame(), name_, what);
    return false;
}

bool Reader::fail(const std::string& what) {
    return failIn(lineAt(stream.Tell()), what);
}

std::span<const Field> Reader::fields() const {
    return place_ == Place::frame ? std::span<const Field>(frameFields) : headerFields;
}

/// Of the record under way, one for each of fields().
int* Reader::lines() {
    return place_ == Place::frame ? frameLines_.back().data() : headerLines_.data();
}

bool Reader::Key(const char* name, json::SizeType length, bool) {
    const std::string_view key(name, length);
    name_ = "";
    const auto known = fields();
    const auto found = std::find_if(known.begin(), known.end(),
                                    [&](const Field& field) { return field.name == key; });
    const bool ofFrames = place_ == Place::toon && key == framesName;
    if (found == known.end() && !ofFrames) {
        const std::string what = "no field is called " + JsonText(Shortened(key));
        return fail(Advice(what, place_ == Place::frame
                                     ? "x, y, pose, pause, wink or text"
                                     : "caption, stage, speed, background, magic or frames"));
    }
    name_ = key;
    field_ = ofFrames ? nullptr : &*found;
    int& line = ofFrames ? framesLine_ : lines()[found - known.begin()];
    if (line != 0) {
        return fail(Advice("it stands twice", "once"));
    }
    line = lineAt(stream.Tell());
    return true;
}

bool Reader::take(const JsonValue& value) {
    switch (place_) {
    case Place::root:
        if (value.type != JsonType::object) {
            return fail(Refusal(value, "Toon", toonForm));
        }
        recordLine_ = lineAt(stream.Tell());
        place_ = Place::toon;
        return true;
    case Place::toon:
        return takeInToon(value);
    case Place::stage:
        return takeSide(value);
    case Place::frames:
        return takeFrame(value);
    default:
        return takeField(value, BytesOf(result.toon.frames.back()));
    }
}

bool Reader::takeInToon(const JsonValue& value) {
    if (field_ != nullptr && field_->kind != FieldKind::stage) {
        return takeField(value, BytesOf(result.toon.header));
    }
    if (value.type != JsonType::list) {
        return fail(field_ != nullptr ? Refusal(value, field_->noun, field_->right)
                                      : Refusal(value, "list of frames", framesForm));
    }
    place_ = field_ != nullptr ? Place::stage : Place::frames;
    return true;
}

bool Reader::takeSide(const JsonValue& value) {
    const std::optional<std::int64_t> number = WholeNumber(value);
    if (!number || *number < field_->low || *number > field_->high) {
        return fail(Refusal(value, "side of a stage", field_->right));
    }
    DWORD& size = result.toon.header.windowSize;
    const auto side = static_cast<DWORD>(*number);
    size = sides_ == 0 ? side : LOWORD(size) | side << 16U;
    ++sides_;
    return sides_ <= 2 || fail(Advice("there are more than two numbers", field_->right));
}

bool Reader::takeFrame(const JsonValue& value) {
    if (value.type != JsonType::object) {
        name_ = "frame " + std::to_string(result.toon.frames.size() + 1);
        return fail(Refusal(value, "frame", frameForm));
    }
    recordLine_ = lineAt(stream.Tell());
    result.toon.frames.push_back(NewFrame());
    frameLines_.emplace_back();
    place_ = Place::frame;
    name_ = "";
    return true;
}

bool Reader::takeField(const JsonValue& value, char* record) {
    if (field_->kind == FieldKind::text) {
        if (value.type != JsonType::text) {
            return fail(Refusal(value, field_->noun, field_->right));
        }
        std::string error;
        const std::string bytes = BytesForText(*field_, value.text, error);
        if (!error.empty()) {
            return fail(error);
        }
        std::fill_n(record + field_->offset, field_->size, '\0');
        std::copy(bytes.begin(), bytes.end(), record + field_->offset);
        return true;
    }
    std::optional<std::int64_t> number = WholeNumber(value);
    if (field_->kind == FieldKind::wink && value.type == JsonType::boolean) {
        number = value.text == "true" ? 1 : 0;
    }
    return (number && SetNumber(*field_, record, *number)) ||
           fail(Refusal(value, field_->noun, field_->right));
}

/// At the end of a frame: whether all has come that it needs.
bool Reader::closeFrame() {
    for (std::size_t i = 0; i < frameFields.size(); ++i) {
        if (frameFields[i].required && lines()[i] == 0) {
            name_ = frameFields[i].name;
            return failIn(recordLine_, Advice("it is missing", frameFields[i].right));
        }
    }
    place_ = Place::frames;
    name_ = framesName;
    return true;
}

bool Reader::EndObject(json::SizeType) {
    if (place_ == Place::frame) {
        return closeFrame();
    }
    name_ = framesName;
    if (framesLine_ == 0) {
        return failIn(recordLine_, Advice("it is missing", framesForm));
    }
    name_ = "";
    return true;
}

bool Reader::EndArray(json::SizeType) {
    if (place_ == Place::stage && sides_ < 2) {
        return fail(Advice("there are less than two numbers", field_->right));
    }
    place_ = Place::toon;
    name_ = "";
    return true;
}

/// The line of a name among the fields of a record; `other` if it is none of them.
int LineOf(std::string_view name, std::span<const Field> fields, const int* lines, int other) {
    for (const Field& field : fields) {
        if (field.name == name) {
            return *lines;
        }
        ++lines;
    }
    return other;
}

int Reader::lineOf(const Finding& finding) const {
    return finding.frame == 0
               ? LineOf(finding.field, headerFields, headerLines_.data(), framesLine_)
               : LineOf(finding.field, frameFields, frameLines_[finding.frame - 1].data(), 0);
}

void Reader::warn() {
    for (const Finding& odd : OddValues(result.toon)) {
        result.warnings.push_back(InLine(lineOf(odd), odd.frame, odd.field, odd.what));
    }
}

/// What is wrong where the parser can't go on.
std::string Mistake(json::ParseErrorCode code) {
    switch (code) {
    case json::kParseErrorDocumentEmpty:
        return Advice("nothing stands in the file", toonForm);
    case json::kParseErrorDocumentRootNotSingular:
        return Advice("something stands behind the Toon", "nothing");
    case json::kParseErrorObjectMissName:
        return Advice("this is no name of a field", "a name in quotes");
    case json::kParseErrorObjectMissColon:
        return Advice("no colon stands behind the name", "a colon");
    case json::kParseErrorObjectMissCommaOrCurlyBracket:
        return Advice("the value doesn't end here", "a comma or a }");
    case json::kParseErrorArrayMissCommaOrSquareBracket:
        return Advice("the value doesn't end here", "a comma or a ]");
    case json::kParseErrorStringMissQuotationMark:
        return Advice("the text has no end", "a quote mark");
    case json::kParseErrorStringInvalidEncoding:
        return Advice("the text is no UTF-8", "a file saved as UTF-8");
    case json::kParseErrorStringUnicodeEscapeInvalidHex:
    case json::kParseErrorStringUnicodeSurrogateInvalid:
    case json::kParseErrorStringEscapeInvalid:
        return Advice("the text holds a backslash or a control character that means nothing",
                      R"(\n, \r, \", \\ or \u00E9)");
    case json::kParseErrorNumberTooBig:
    case json::kParseErrorNumberMissFraction:
    case json::kParseErrorNumberMissExponent:
        return Advice("this is no number", anyNumber);
    default:
        return Advice("this is no value", "a number, a text in quotes, true, false, [ or {");
    }
}

} // namespace

ToonFromJson JsonToToon(std::string_view text) {
    constexpr std::string_view byteOrderMark = "\xEF\xBB\xBF";
    if (text.starts_with(byteOrderMark)) {
        text.remove_prefix(byteOrderMark.size());
    }
    constexpr unsigned flags = json::kParseIterativeFlag | json::kParseValidateEncodingFlag |
                               json::kParseNumbersAsStringsFlag;
    Reader reader(text);
    json::Reader parser;
    const json::ParseResult parsed = parser.Parse<flags>(reader.stream, reader);
    const int line = reader.lineAt(parsed.IsError() ? parsed.Offset() : reader.stream.Tell());
    if (!parsed.IsError() && reader.stream.Tell() < text.size()) {
        // The parser takes a NUL for the end.
        reader.failIn(line, Mistake(json::kParseErrorDocumentRootNotSingular));
    } else if (parsed.IsError() && reader.result.error.empty()) {
        reader.failIn(line, Mistake(parsed.Code()));
    } else if (!parsed.IsError()) {
        reader.warn();
    }
    return std::move(reader.result);
}
