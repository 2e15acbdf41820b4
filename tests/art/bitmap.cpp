#include "tests/art/bitmap.h"

#include "resources/art/poses.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <utility>

Bytes readFile(const std::string& name) {
    std::ifstream file(DORBO_SOURCE_DIR "/resources/" + name, std::ios::binary);
    return Bytes(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

Bytes readBitmap(const std::string& name) {
    return readFile("bitmaps/" + name + ".bmp");
}

std::uint32_t number(const Bytes& bytes, std::size_t at) {
    return bytes.at(at) + bytes.at(at + 1) * 256U + bytes.at(at + 2) * 65536U;
}

Bitmap load(const std::string& name) {
    const Bytes bytes = readBitmap(name);
    Bitmap bitmap{name,
                  static_cast<int>(number(bytes, 18)),
                  static_cast<int>(number(bytes, 22)),
                  bytes.at(28),
                  {},
                  {}};
    const std::size_t start = number(bytes, 10);
    for (std::size_t at = 54; at < start; at += 4) {
        bitmap.colours.push_back(number(bytes, at));
    }
    const auto width = static_cast<std::uint32_t>(bitmap.width);
    const std::uint32_t row = (width * bitmap.bits + 31) / 32 * 4;
    for (int y = bitmap.height - 1; y >= 0; --y) {
        for (std::uint32_t bit = 0; bit < width * bitmap.bits; bit += bitmap.bits) {
            const int byte = bytes.at(start + static_cast<std::uint32_t>(y) * row + bit / 8);
            const int nibble = bit % 8 == 0 ? byte / 16 : byte % 16;
            const int index = bitmap.bits == 8 ? byte : nibble;
            bitmap.pixels.push_back(bitmap.colours.at(static_cast<std::size_t>(index)));
        }
    }
    return bitmap;
}

std::vector<Bitmap> series(const std::string& stem, int count) {
    std::vector<Bitmap> bitmaps;
    for (int i = 1; i <= count; ++i) {
        bitmaps.push_back(load(stem + std::to_string(i)));
    }
    return bitmaps;
}

std::vector<Bitmap> figures() {
    std::vector<Bitmap> all = series("pose0", art::PoseCount);
    for (const auto& [stem, count] :
         {std::pair{"fdl2r", 8}, {"fdr2l", 8}, {"fdltn", 2}, {"fdrtn", 2}}) {
        std::ranges::move(series(stem, count), std::back_inserter(all));
    }
    return all;
}

std::size_t smallestHole(const Bitmap& bitmap) {
    std::vector<std::uint32_t> left = bitmap.pixels;
    std::size_t smallest = left.size();
    for (int start = 0; start < std::ssize(left); ++start) {
        std::vector<int> area = {start};
        std::size_t found = 0;
        bool open = false;
        while (!area.empty()) {
            const int at = area.back();
            area.pop_back();
            if (std::exchange(left[static_cast<std::size_t>(at)], White) == Black) {
                const bool edges[] = {at % bitmap.width == 0, (at + 1) % bitmap.width == 0,
                                      at < bitmap.width, at + bitmap.width >= std::ssize(left)};
                const int steps[] = {-1, 1, -bitmap.width, bitmap.width};
                for (std::size_t i = 0; i < std::size(steps); ++i) {
                    open = open || edges[i];
                    area.push_back(edges[i] ? at : at + steps[i]);
                }
                ++found;
            }
        }
        smallest = found == 0 || open ? smallest : std::min(smallest, found);
    }
    return smallest;
}
