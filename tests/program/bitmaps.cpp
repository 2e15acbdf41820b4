#include "tests/program/bitmaps.h"

#include <cstring>
#include <fstream>
#include <iterator>
#include <stdexcept>

namespace ground {

namespace {

std::uint32_t number(const std::vector<unsigned char>& bytes, std::size_t offset) {
    std::uint32_t value = 0;
    std::memcpy(&value, bytes.data() + offset, sizeof value);
    return value;
}

} // namespace

Picture loadPicture(const std::string& name) {
    std::ifstream file(std::string(DORBO_SOURCE_DIR "/resources/bitmaps/") + name + ".bmp",
                       std::ios::binary);
    const std::vector<unsigned char> bytes{std::istreambuf_iterator<char>(file), {}};
    if (bytes.size() < 54) {
        throw std::runtime_error("no picture " + name);
    }
    constexpr std::size_t fileHeader = 14;
    constexpr std::size_t colours = fileHeader + 40;
    Picture picture{
        name, static_cast<int>(number(bytes, 18)), static_cast<int>(number(bytes, 22)), {}};
    const int bits = bytes[28];
    const std::size_t start = number(bytes, 10);
    const auto row = static_cast<std::size_t>((picture.width * bits + 31) / 32 * 4);
    for (int y = picture.height - 1; y >= 0; --y) {
        for (int x = 0; x < picture.width; ++x) {
            const auto at =
                start + static_cast<std::size_t>(y) * row + static_cast<std::size_t>(x * bits / 8);
            const unsigned index =
                bits == 8 ? bytes[at] : (x % 2 == 0 ? bytes[at] >> 4 : bytes[at] & 15U);
            picture.pixels.push_back(number(bytes, colours + index * 4) & 0xFFFFFFU);
        }
    }
    return picture;
}

std::vector<Picture> characterPictures() {
    std::vector<Picture> pictures;
    for (const char* name : {"fdltn1", "fdltn2", "fdrtn1", "fdrtn2"}) {
        pictures.push_back(loadPicture(name));
    }
    for (int i = 1; i <= 8; ++i) {
        for (const char* name : {"fdl2r", "fdr2l", "pose0"}) {
            pictures.push_back(loadPicture(name + std::to_string(i)));
        }
    }
    return pictures;
}

} // namespace ground
