#include "resources/art/png_file.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <iterator>
#include <string>

namespace art {

namespace {

using Bytes = std::vector<std::uint8_t>;

void appendNumber(Bytes& bytes, std::uint32_t number) {
    for (int shift = 24; shift >= 0; shift -= 8) {
        bytes.push_back(static_cast<std::uint8_t>(number >> static_cast<unsigned>(shift)));
    }
}

std::uint32_t crc(const std::uint8_t* from, std::size_t size) {
    std::uint32_t sum = 0xFFFFFFFFU;
    for (std::size_t i = 0; i < size; ++i) {
        sum ^= from[i];
        for (int bit = 0; bit < 8; ++bit) {
            sum = (sum & 1U) != 0 ? (sum >> 1U) ^ 0xEDB88320U : sum >> 1U;
        }
    }
    return ~sum;
}

std::uint32_t adler(const Bytes& bytes) {
    constexpr std::uint32_t Prime = 65521;
    std::uint32_t a = 1;
    std::uint32_t b = 0;
    for (const std::uint8_t byte : bytes) {
        a = (a + byte) % Prime;
        b = (b + a) % Prime;
    }
    return b << 16U | a;
}

void appendChunk(Bytes& bytes, const std::string& name, const Bytes& content) {
    appendNumber(bytes, static_cast<std::uint32_t>(content.size()));
    const std::size_t checked = bytes.size();
    bytes.insert(bytes.end(), name.begin(), name.end());
    bytes.insert(bytes.end(), content.begin(), content.end());
    appendNumber(bytes, crc(bytes.data() + checked, bytes.size() - checked));
}

// Bits from the lowest of each byte on.
class BitWriter {
  public:
    explicit BitWriter(Bytes& bytes) : bytes_(bytes) {}

    void number(std::uint32_t value, unsigned bits) {
        for (unsigned i = 0; i < bits; ++i) {
            held_ |= (value >> i & 1U) << count_;
            if (++count_ == 8) {
                finish();
            }
        }
    }

    // A code begins with its highest bit.
    void code(std::uint32_t value, unsigned bits) {
        for (unsigned i = bits; i > 0; --i) {
            number(value >> (i - 1), 1);
        }
    }

    void finish() {
        if (count_ > 0) {
            bytes_.push_back(static_cast<std::uint8_t>(held_));
        }
        held_ = 0;
        count_ = 0;
    }

  private:
    Bytes& bytes_;
    std::uint32_t held_ = 0;
    unsigned count_ = 0;
};

// Codes of the fixed table: a byte, the end (256), or the class of a length (257 and up).
void writeSymbol(BitWriter& bits, std::uint32_t symbol) {
    if (symbol < 144) {
        bits.code(0x30 + symbol, 8);
    } else if (symbol < 256) {
        bits.code(0x190 + symbol - 144, 9);
    } else if (symbol < 280) {
        bits.code(symbol - 256, 7);
    } else {
        bits.code(0xC0 + symbol - 280, 8);
    }
}

// The class of a number and what is left of it: classes begin at `first` and grow twice as large
// after each `step` of them, beginning with the one that is numbered 2 * step.
struct Class {
    std::uint32_t number = 0;
    std::uint32_t rest = 0;
    unsigned bits = 0;
};

Class classOf(std::uint32_t value, std::uint32_t first, std::uint32_t step) {
    Class found;
    std::uint32_t start = first;
    for (;;) {
        found.bits = found.number < 2 * step ? 0 : found.number / step - 1;
        if (value < start + (1U << found.bits)) {
            found.rest = value - start;
            return found;
        }
        start += 1U << found.bits;
        ++found.number;
    }
}

constexpr std::size_t LongestCopy = 257; // 258 has a class of its own, which isn't worth a case
constexpr std::size_t ShortestCopy = 4;

void writeCopy(BitWriter& bits, std::size_t length, std::size_t distance) {
    const Class lengths = classOf(static_cast<std::uint32_t>(length), 3, 4);
    writeSymbol(bits, 257 + lengths.number);
    bits.number(lengths.rest, lengths.bits);
    const Class distances = classOf(static_cast<std::uint32_t>(distance), 1, 2);
    bits.code(distances.number, 5);
    bits.number(distances.rest, distances.bits);
}

std::size_t lengthOfCopy(const Bytes& bytes, std::size_t at, std::size_t distance) {
    std::size_t length = 0;
    while (distance <= at && length < LongestCopy && at + length < bytes.size() &&
           bytes[at + length] == bytes[at + length - distance]) {
        ++length;
    }
    return length;
}

// Packed by copies of the pixel before, the pixel above and their neighbours only: drawings are
// made of flat areas and of chessboards.
Bytes packed(const Bytes& bytes, std::size_t row) {
    const std::array<std::size_t, 5> distances = {4, 8, row, row - 4, row + 4};
    Bytes result = {0x78, 0x01};
    BitWriter bits(result);
    bits.number(3, 3); // the one and last block, in the fixed codes
    for (std::size_t at = 0; at < bytes.size();) {
        std::size_t best = 0;
        std::size_t distance = 0;
        for (const std::size_t tried : distances) {
            const std::size_t length = lengthOfCopy(bytes, at, tried);
            distance = length > best ? tried : distance;
            best = std::max(best, length);
        }
        if (best < ShortestCopy) {
            writeSymbol(bits, bytes[at++]);
        } else {
            writeCopy(bits, best, distance);
            at += best;
        }
    }
    writeSymbol(bits, 256);
    bits.finish();
    appendNumber(result, adler(bytes));
    return result;
}

} // namespace

Bytes pngBytes(const Image& image) {
    Bytes rows;
    for (int y = 0; y < image.height; ++y) {
        rows.push_back(0); // the row stands as it is
        for (int x = 0; x < image.width; ++x) {
            const Rgba& pixel = image.at(x, y);
            rows.insert(rows.end(), {pixel.red, pixel.green, pixel.blue, pixel.alpha});
        }
    }
    Bytes header;
    appendNumber(header, static_cast<std::uint32_t>(image.width));
    appendNumber(header, static_cast<std::uint32_t>(image.height));
    header.insert(header.end(), {8, 6, 0, 0, 0});

    Bytes bytes = {0x89, 'P', 'N', 'G', '\r', '\n', 0x1A, '\n'};
    appendChunk(bytes, "IHDR", header);
    appendChunk(bytes, "IDAT", packed(rows, static_cast<std::size_t>(image.width) * 4 + 1));
    appendChunk(bytes, "IEND", {});
    return bytes;
}

} // namespace art
