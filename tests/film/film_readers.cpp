#include "tests/film/film_readers.h"

#include <arpa/inet.h>
#include <gif_lib.h>
#include <png.h>
#include <zlib.h>

#include <algorithm>
#include <fstream>
#include <iterator>
#include <stdexcept>

namespace test {

namespace {

using Text = std::string;

void demand(bool holds, const char* what) {
    if (!holds) {
        throw std::runtime_error(what);
    }
}

/// The canvas on which a film's rectangles are put one over the other.
class Canvas {
  public:
    Canvas(Film& film, int width, int height)
        : film_(film), pixels_(static_cast<std::size_t>(width) * static_cast<std::size_t>(height)) {
        film_.width = width;
        film_.height = height;
    }

    void put(int left, int top, int width, int height, const std::vector<DWORD>& pixels) {
        demand(left >= 0 && top >= 0 && left + width <= film_.width && top + height <= film_.height,
               "a rectangle leaves the picture");
        for (int y = 0; y < height; ++y) {
            std::copy_n(pixels.begin() + static_cast<std::ptrdiff_t>(y) * width, width,
                        pixels_.begin() + static_cast<std::ptrdiff_t>(top + y) * film_.width +
                            left);
        }
        film_.drawn += static_cast<std::int64_t>(width) * height;
    }

    void stand(std::int64_t milliseconds) {
        if (film_.pictures.empty() || film_.pictures.back().pixels != pixels_) {
            film_.pictures.push_back({moment_, moment_, pixels_});
        }
        moment_ += milliseconds;
        film_.pictures.back().to = moment_;
    }

  private:
    Film& film_;
    std::vector<DWORD> pixels_;
    std::int64_t moment_ = 0;
};

Text contentOf(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    demand(file.good(), "the file can't be read");
    return {std::istreambuf_iterator<char>(file), {}};
}

std::uint32_t number(const Text& bytes, std::size_t at, std::size_t count = 4) {
    std::uint32_t value = 0;
    for (const char byte : bytes.substr(at, count)) {
        value = value << 8U | static_cast<unsigned char>(byte);
    }
    return value;
}

Text numberAsText(std::uint32_t value) {
    const std::uint32_t turned = htonl(value);
    return {reinterpret_cast<const char*>(&turned), sizeof turned};
}

std::uint32_t sumOf(const Text& bytes) {
    return static_cast<std::uint32_t>(
        crc32_z(0, reinterpret_cast<const Bytef*>(bytes.data()), bytes.size()));
}

Text chunk(const Text& name, const Text& content) {
    return numberAsText(static_cast<std::uint32_t>(content.size())) + name + content +
           numberAsText(sumOf(name + content));
}

const Text signature("\x89PNG\r\n\x1A\n");

/// The pixels of a plain picture.
std::vector<DWORD> decode(const Text& png) {
    png_image image{};
    image.version = PNG_IMAGE_VERSION;
    demand(png_image_begin_read_from_memory(&image, png.data(), png.size()) != 0, image.message);
    image.format = PNG_FORMAT_BGRA;
    std::vector<DWORD> pixels(PNG_IMAGE_SIZE(image) / 4);
    demand(png_image_finish_read(&image, nullptr, pixels.data(), 0, nullptr) != 0 &&
               image.warning_or_error == 0,
           image.message);
    for (DWORD& pixel : pixels) {
        demand(pixel >> 24U == 0xFF, "a pixel is transparent");
        pixel &= 0xFFFFFFU;
    }
    return pixels;
}

/// The chunks of a file, held to their sums.
std::vector<std::pair<Text, Text>> chunksOf(const Text& png) {
    std::vector<std::pair<Text, Text>> chunks;
    demand(png.rfind(signature, 0) == 0, "no signature");
    for (std::size_t at = signature.size(); at < png.size();) {
        const std::size_t size = number(png, at);
        const Text whole = png.substr(at + 4, 4 + size);
        demand(sumOf(whole) == number(png, at + 8 + size), "a check sum is wrong");
        chunks.emplace_back(whole.substr(0, 4), whole.substr(4));
        at += 12 + size;
    }
    demand(!chunks.empty() && chunks.back().first == "IEND", "the end is missing");
    return chunks;
}

/// One frame of an animation as it comes together from chunks.
struct Frame {
    Text control;
    Text data;
};

void put(Canvas& canvas, const Frame& frame, const Text& header, const Text& palette) {
    const Text size = frame.control.substr(4, 8);
    const auto part = [&](std::size_t at) { return static_cast<int>(number(frame.control, at)); };
    canvas.put(part(12), part(16), part(4), part(8),
               decode(signature + chunk("IHDR", size + header.substr(8)) +
                      (palette.empty() ? "" : chunk("PLTE", palette)) + chunk("IDAT", frame.data) +
                      chunk("IEND", "")));
    demand(number(frame.control, 22, 2) == 1000, "a delay isn't in milliseconds");
    demand(number(frame.control, 24, 2) == 0, "a frame goes, or is blended");
    canvas.stand(number(frame.control, 20, 2));
}

} // namespace

Film readPng(const std::filesystem::path& path) {
    Film film;
    const Text file = contentOf(path);
    Text header;
    Text palette;
    std::vector<Frame> frames;
    std::uint32_t counted = 0;
    std::uint32_t sequence = 0;
    for (const auto& [name, content] : chunksOf(file)) {
        if (name == "IHDR") {
            header = content;
        } else if (name == "PLTE") {
            palette = content;
        } else if (name == "acTL") {
            counted = number(content, 0);
            film.forEver = number(content, 4) == 0;
        } else if (name == "fcTL") {
            demand(number(content, 0) == sequence++, "the chunks are misnumbered");
            frames.push_back({content, ""});
        } else if (name == "fdAT") {
            demand(number(content, 0) == sequence++, "the chunks are misnumbered");
            frames.back().data += content.substr(4);
        } else if (name == "IDAT" && !frames.empty()) {
            frames.back().data += content;
        }
    }
    Canvas canvas(film, static_cast<int>(number(header, 0)), static_cast<int>(number(header, 4)));
    demand(frames.size() == counted, "the frames are miscounted");
    for (const Frame& frame : frames) {
        put(canvas, frame, header, palette);
    }
    if (frames.empty() || decode(file) != film.pictures.front().pixels) { // what others show
        demand(frames.empty(), "the first frame isn't the plain picture");
        canvas.put(0, 0, film.width, film.height, decode(file));
        canvas.stand(0);
    }
    return film;
}

Film readGif(const std::filesystem::path& path) {
    Film film;
    int error = 0;
    GifFileType* gif = DGifOpenFileName(path.c_str(), &error);
    demand(gif != nullptr && DGifSlurp(gif) == GIF_OK, "no whole GIF");
    Canvas canvas(film, gif->SWidth, gif->SHeight);
    for (int i = 0; i < gif->ImageCount; ++i) {
        const SavedImage& image = gif->SavedImages[i];
        const GifImageDesc& place = image.ImageDesc;
        const ColorMapObject* map = place.ColorMap != nullptr ? place.ColorMap : gif->SColorMap;
        demand(map != nullptr, "an image has no palette");
        std::vector<DWORD> pixels;
        for (int at = 0; at < place.Width * place.Height; ++at) {
            demand(image.RasterBits[at] < map->ColorCount, "a colour is outside the palette");
            const GifColorType& colour = map->Colors[image.RasterBits[at]];
            pixels.push_back(static_cast<DWORD>(colour.Red) << 16U |
                             static_cast<DWORD>(colour.Green) << 8U | colour.Blue);
        }
        canvas.put(place.Left, place.Top, place.Width, place.Height, pixels);
        GraphicsControlBlock control{};
        demand(DGifSavedExtensionToGCB(gif, i, &control) == GIF_OK, "an image has no delay");
        demand(control.TransparentColor == NO_TRANSPARENT_COLOR &&
                   control.DisposalMode == DISPOSE_DO_NOT,
               "an image goes, or is transparent");
        canvas.stand(10LL * control.DelayTime);
    }
    if (gif->ImageCount > 0 && gif->SavedImages[0].ExtensionBlockCount > 1) {
        const ExtensionBlock* blocks = gif->SavedImages[0].ExtensionBlocks;
        film.forEver = blocks[0].Function == APPLICATION_EXT_FUNC_CODE &&
                       Text(reinterpret_cast<char*>(blocks[1].Bytes), 3) == Text("\1\0\0", 3);
    }
    DGifCloseFile(gif, &error);
    return film;
}

Film readDirectory(const std::filesystem::path& directory) {
    Film film;
    std::ifstream times(directory / "times.txt");
    Text name;
    std::int64_t from = 0;
    std::int64_t stands = 0;
    std::size_t named = 1; // the list itself
    for (std::int64_t end = 0; times >> name >> from >> stands; end = from + stands) {
        const Film picture = readPng(directory / name);
        demand(from == end, "a picture doesn't come when the one before goes");
        film.width = picture.width;
        film.height = picture.height;
        film.pictures.push_back({from, from + stands, picture.pictures.front().pixels});
        ++named;
    }
    const auto count = std::distance(std::filesystem::directory_iterator(directory), {});
    demand(static_cast<std::size_t>(count) == named, "there are files that the list doesn't name");
    return film;
}

} // namespace test
