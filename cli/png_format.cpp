#include "cli/png_format.h"

#include <cstring>
#include <new>

void AppendNumber(Bytes& bytes, std::uint32_t number) {
    AppendShort(bytes, number >> 16U);
    AppendShort(bytes, number);
}

void AppendShort(Bytes& bytes, std::uint32_t number) {
    bytes.push_back(static_cast<std::uint8_t>(number >> 8U));
    bytes.push_back(static_cast<std::uint8_t>(number));
}

void AppendChunk(Bytes& bytes, const char* name, const Bytes& content) {
    AppendNumber(bytes, static_cast<std::uint32_t>(content.size()));
    const std::size_t checked = bytes.size();
    bytes.insert(bytes.end(), name, name + 4);
    bytes.insert(bytes.end(), content.begin(), content.end());
    const uLong sum = crc32_z(0, bytes.data() + checked, bytes.size() - checked);
    AppendNumber(bytes, static_cast<std::uint32_t>(sum));
}

void AppendEnd(Bytes& bytes) {
    AppendChunk(bytes, "IEND", {});
}

static void appendParts(Bytes& bytes, DWORD colour) {
    for (const unsigned shift : {16U, 8U, 0U}) {
        bytes.push_back(static_cast<std::uint8_t>(colour >> shift));
    }
}

Bytes PngPixels::head(int width, int height, const Bytes& animation) const {
    constexpr std::uint8_t bits = 8;
    constexpr std::uint8_t byPalette = 3;
    constexpr std::uint8_t byParts = 2;
    Bytes bytes = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    Bytes header;
    AppendNumber(header, static_cast<std::uint32_t>(width));
    AppendNumber(header, static_cast<std::uint32_t>(height));
    header.insert(header.end(), {bits, colours_.tooMany() ? byParts : byPalette, 0, 0, 0});
    AppendChunk(bytes, "IHDR", header);
    bytes.insert(bytes.end(), animation.begin(), animation.end());
    if (!colours_.tooMany()) {
        Bytes palette;
        for (const DWORD colour : colours_.list()) {
            appendParts(palette, colour);
        }
        AppendChunk(bytes, "PLTE", palette);
    }
    return bytes;
}

void PngPixels::rowsOf(const seam::PixelView& picture, const RECT& area, Bytes& rows) const {
    const auto width = static_cast<std::size_t>(area.right - area.left);
    const std::size_t perRow = 1 + width * (colours_.tooMany() ? 3 : 1);
    const auto height = static_cast<std::size_t>(area.bottom - area.top);
    rows.resize(perRow * height);
    std::uint8_t* to = rows.data();
    for (LONG y = area.top; y < area.bottom; ++y) {
        const auto row = static_cast<std::ptrdiff_t>(y) * picture.stride;
        const DWORD* from = picture.bits + row + area.left;
        *to++ = 0; // the row stands unfiltered: neighbours in flat colours tell nothing new
        if (!colours_.tooMany()) {
            colours_.numbersOf(from, width, to);
            to += width;
            continue;
        }
        for (std::size_t x = 0; x < width; ++x) {
            *to++ = static_cast<std::uint8_t>(from[x] >> 16U);
            *to++ = static_cast<std::uint8_t>(from[x] >> 8U);
            *to++ = static_cast<std::uint8_t>(from[x]);
        }
    }
}

Packer::Packer(Form form) : form_(form) {
    constexpr int level = 6;
    constexpr int memory = 8;
    constexpr int window = 15;
    const int bits = form == Form::stream ? window : -window;
    if (deflateInit2(&stream_, level, Z_DEFLATED, bits, memory, Z_DEFAULT_STRATEGY) != Z_OK) {
        throw std::bad_alloc();
    }
}

Packer::~Packer() {
    deflateEnd(&stream_);
}

void Packer::append(Bytes& packed, const Bytes& bytes) {
    constexpr std::size_t ofFlush = 16; // more than a part's end takes
    deflateReset(&stream_);
    const std::size_t before = packed.size();
    packed.resize(before + deflateBound(&stream_, bytes.size()) + ofFlush);
    stream_.next_in = bytes.data();
    stream_.avail_in = static_cast<uInt>(bytes.size());
    stream_.next_out = packed.data() + before;
    stream_.avail_out = static_cast<uInt>(packed.size() - before);
    deflate(&stream_, form_ == Form::stream ? Z_FINISH : Z_FULL_FLUSH);
    packed.resize(packed.size() - stream_.avail_out);
}
