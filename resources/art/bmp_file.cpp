#include "resources/art/bmp_file.h"

#include <fstream>

namespace art {

namespace {

constexpr std::size_t FileHeaderSize = 14;
constexpr std::size_t InfoHeaderSize = 40;

void put(std::vector<std::uint8_t>& bytes, std::uint32_t value, int size) {
    for (int i = 0; i < size; ++i) {
        bytes.push_back(static_cast<std::uint8_t>(value >> (8 * i)));
    }
}

void putHeaders(std::vector<std::uint8_t>& bytes, const Picture& picture, BmpForm form,
                std::size_t pixelStart, std::size_t pixelSize) {
    bytes.push_back('B');
    bytes.push_back('M');
    put(bytes, static_cast<std::uint32_t>(pixelStart + pixelSize), 4);
    put(bytes, 0, 4);
    put(bytes, static_cast<std::uint32_t>(pixelStart), 4);
    put(bytes, InfoHeaderSize, 4);
    put(bytes, static_cast<std::uint32_t>(picture.width), 4);
    put(bytes, static_cast<std::uint32_t>(picture.height), 4);
    put(bytes, 1, 2);
    put(bytes, static_cast<std::uint32_t>(form.bitsPerPixel), 2);
    put(bytes, 0, 4);
    put(bytes, static_cast<std::uint32_t>(pixelSize), 4);
    put(bytes, 0, 4);
    put(bytes, 0, 4);
    put(bytes, form.coloursUsed, 4);
    put(bytes, 0, 4);
}

void putColours(std::vector<std::uint8_t>& bytes, std::span<const Rgb> colours, std::size_t count) {
    for (std::size_t i = 0; i < count; ++i) {
        const Rgb colour = i < colours.size() ? colours[i] : Rgb{};
        bytes.insert(bytes.end(), {colour.blue, colour.green, colour.red, 0});
    }
}

void putRow(std::vector<std::uint8_t>& bytes, const Picture& picture, int y, int bitsPerPixel,
            std::size_t rowSize) {
    const std::size_t end = bytes.size() + rowSize;
    for (int x = 0; x < picture.width; x += 8 / bitsPerPixel) {
        const int high = picture.at(x, y);
        bytes.push_back(
            static_cast<std::uint8_t>(bitsPerPixel == 8 ? high : high * 16 + picture.at(x + 1, y)));
    }
    bytes.resize(end, 0);
}

} // namespace

std::vector<std::uint8_t> bmpBytes(const Picture& picture, std::span<const Rgb> colours,
                                   BmpForm form) {
    const std::size_t count = std::size_t{1} << form.bitsPerPixel;
    const auto bits = static_cast<std::size_t>(picture.width * form.bitsPerPixel);
    const std::size_t rowSize = (bits + 31) / 32 * 4;
    const std::size_t pixelSize = rowSize * static_cast<std::size_t>(picture.height);
    std::vector<std::uint8_t> bytes;
    putHeaders(bytes, picture, form, FileHeaderSize + InfoHeaderSize + count * 4, pixelSize);
    putColours(bytes, colours, count);
    for (int y = picture.height - 1; y >= 0; --y) {
        putRow(bytes, picture, y, form.bitsPerPixel, rowSize);
    }
    return bytes;
}

bool writeFile(const std::string& path, std::span<const std::uint8_t> bytes) {
    std::ofstream file(path, std::ios::binary | std::ios::trunc);
    for (const std::uint8_t byte : bytes) {
        file.put(static_cast<char>(byte));
    }
    file.close();
    return !file.fail();
}

} // namespace art
