// A Toon as the program `toon` handles it: its records as they stand in a file, the names under
// which people meet their fields, and what in them the editor would not have made.
#pragma once

#include "toon/toon_document.h"

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

struct Toon {
    ToonHeader header;
    std::vector<ToonFrame> frames;
};

/// What the header of a new Toon holds.
ToonHeader NewHeader();

/// What a new frame holds: a pause of TOON_DEFAULT_PAUSE seconds, else zeros.
constexpr LONG TOON_DEFAULT_PAUSE = 5;
ToonFrame NewFrame();

// ---- Fields -----------------------------------------------------------------------------------

enum class FieldKind {
    text,
    stage, // two numbers of 16 bits
    number,
    pose, // a number that people count from 1
    wink, // a number of which 0 and 1 are false and true
};

struct Field {
    std::string_view name;
    FieldKind kind;
    std::size_t offset;     // in its record
    std::size_t size;       // in bytes
    bool required;          // else it may be missing in what people write
    std::int64_t low;       // what the editor makes, as people see it; of a text, its characters
    std::int64_t high;      // the same
    std::int64_t most;      // characters that a text has room for
    std::string_view noun;  // "9 is no pose"
    std::string_view right; // "1 to 8 would be right"
};

inline constexpr std::string_view anyNumber = "a whole number of 32 bits";

// Without the count of frames, which follows from the frames.
inline constexpr std::array headerFields{
    Field{"magic", FieldKind::text, offsetof(ToonHeader, magic), TOON_MAGIC_SIZE, false, 0, 32, 32,
          "magic", "a text of up to 32 characters"},
    Field{"caption", FieldKind::text, offsetof(ToonHeader, caption), TOON_CAPTION_SIZE, false, 0,
          48, 51, "caption", "a text of up to 48 characters"},
    Field{"stage", FieldKind::stage, offsetof(ToonHeader, windowSize), 4, false, 0, 0xFFFF, 0,
          "stage", "[width, height], 0 to 65535 each,"},
    Field{"speed", FieldKind::number, offsetof(ToonHeader, speed), 4, false, 1, 5, 0, "speed",
          "1 to 5"},
    Field{"background", FieldKind::number, offsetof(ToonHeader, background), 4, false, 1, 10, 0,
          "background", "1 to 10"},
};

inline constexpr std::array frameFields{
    Field{"x", FieldKind::number, offsetof(ToonFrame, x), 4, true, INT32_MIN, INT32_MAX, 0, "place",
          anyNumber},
    Field{"y", FieldKind::number, offsetof(ToonFrame, y), 4, true, INT32_MIN, INT32_MAX, 0, "place",
          anyNumber},
    Field{"pose", FieldKind::pose, offsetof(ToonFrame, pose), 4, true, 1, 8, 0, "pose", "1 to 8"},
    Field{"pause", FieldKind::number, offsetof(ToonFrame, pause), 4, false, 1, 20, 0, "pause",
          "1 to 20"},
    Field{"wink", FieldKind::wink, offsetof(ToonFrame, wink), 4, false, 0, 1, 0, "wink",
          "true or false"},
    Field{"text", FieldKind::text, offsetof(ToonFrame, text), TOON_TEXT_SIZE, false, 0, 69, 69,
          "text", "a text of up to 69 characters"},
};

/// The bytes of a record, for the fields in it.
const char* BytesOf(const ToonHeader& header);
const char* BytesOf(const ToonFrame& frame);
char* BytesOf(ToonHeader& header);
char* BytesOf(ToonFrame& frame);

/// A text up to its NUL, or to where the program cuts it.
std::string_view TextOf(const Field& field, const char* record);

/// A number as people see it. SetNumber gives false, and changes nothing, if the field can't hold
/// it.
std::int64_t NumberOf(const Field& field, const char* record);
bool SetNumber(const Field& field, char* record, std::int64_t shown);

LONG StageWidth(const ToonHeader& header);
LONG StageHeight(const ToonHeader& header);

// ---- Files ------------------------------------------------------------------------------------

/// Takes a file's bytes apart as a load does, its number of frames by its size. Gives why they are
/// no Toon, empty if they are one. A Toon without a frame is one here.
std::string ToonFromBytes(std::string_view bytes, Toon& toon);

/// The whole file, with the true count of frames in its header.
std::string ToonBytes(const Toon& toon);

// ---- What is odd ------------------------------------------------------------------------------

struct Finding {
    std::size_t frame;      // from 1; 0: the header or the file
    std::string_view field; // empty: no field of its own
    std::string what;
    bool fault = true; // else good to know, and nothing is wrong
};

/// "frame 3, pose: ", or as much of it as there is.
std::string Where(std::size_t frame, std::string_view field);

/// "what; right would be right"
std::string Advice(std::string_view what, std::string_view right);

/// Each value that the editor would not have made.
std::vector<Finding> OddValues(const Toon& toon);

/// "1 frame", "2 frames"
std::string Counted(std::int64_t number, std::string_view what);
