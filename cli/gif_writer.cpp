#include "cli/film_writer.h"

#include "cli/out_file.h"

#include <gif_lib.h>

#include <algorithm>
#include <bit>
#include <exception>
#include <new>
#include <stdexcept>
#include <utility>

namespace {

/// What is handed to the library by a pointer that it gives back.
struct Palette {
    explicit Palette(const std::vector<DWORD>& colours)
        : map(GifMakeMapObject(sizeFor(colours.size()), nullptr)) {
        if (map == nullptr) {
            throw std::bad_alloc();
        }
        for (std::size_t i = 0; i < colours.size(); ++i) {
            map->Colors[i] = {static_cast<GifByteType>(colours[i] >> 16U),
                              static_cast<GifByteType>(colours[i] >> 8U),
                              static_cast<GifByteType>(colours[i])};
        }
    }

    Palette(const Palette&) = delete;
    Palette& operator=(const Palette&) = delete;

    ~Palette() {
        GifFreeMapObject(map);
    }

    /// The sizes that a file can have: powers of two.
    static int sizeFor(std::size_t colours) {
        return static_cast<int>(std::bit_ceil(std::max<std::size_t>(colours, 2)));
    }

    ColorMapObject* map;
};

/// The clock of a GIF.
std::int64_t hundredths(std::int64_t milliseconds) {
    return (milliseconds + 5) / 10;
}

class GifWriter : public FilmWriter {
  public:
    GifWriter(const std::string& path, const FilmPlan& plan)
        : path_(path), file_(path), colours_(plan.colours) {}

    ~GifWriter() override {
        closeGif();
    }

    void add(const FilmPicture& picture) override;
    void finish() override;

  private:
    static int writeBytes(GifFileType* gif, const GifByteType* bytes, int count);
    void begin(const FilmPicture& picture);
    void check(int done);
    void closeGif();
    void putImage(const FilmPicture& picture, const RECT& area, std::int64_t delay);
    void putDelay(std::int64_t delay);
    void putNumbered(const FilmPicture& picture, const RECT& area, const Colours& colours,
                     bool ownPalette);
    void putReduced(const FilmPicture& picture, const RECT& area);
    void putRows(const RECT& area, ColorMapObject* map);

    std::string path_;
    OutFile file_;
    const Colours& colours_; // of the whole film
    GifFileType* gif_ = nullptr;
    std::exception_ptr failure_; // of the file, kept while the library is at work
    RECT leftOut_{};             // of pictures that stood for too short a time
    std::vector<GifByteType> numbers_;
};

int GifWriter::writeBytes(GifFileType* gif, const GifByteType* bytes, int count) {
    auto* self = static_cast<GifWriter*>(gif->UserData);
    try {
        if (!self->failure_) {
            self->file_.write(bytes, static_cast<std::size_t>(count));
            return count;
        }
    } catch (...) {
        self->failure_ = std::current_exception();
    }
    return 0;
}

void GifWriter::check(int done) {
    if (failure_) {
        std::rethrow_exception(failure_);
    }
    if (done == GIF_ERROR) {
        throw std::runtime_error(path_ + ": the film can't be put into a GIF");
    }
}

/// The library closes its record whether or not it can write what is left.
void GifWriter::closeGif() {
    if (gif_ != nullptr) {
        int error = 0;
        EGifCloseFile(std::exchange(gif_, nullptr), &error);
    }
}

void GifWriter::begin(const FilmPicture& picture) {
    int error = 0;
    gif_ = EGifOpen(this, writeBytes, &error);
    if (gif_ == nullptr) {
        throw std::bad_alloc();
    }
    EGifSetGifVersion(gif_, true);
    constexpr int colourBits = 8;
    if (colours_.tooMany()) {
        check(EGifPutScreenDesc(gif_, picture.pixels.width, picture.pixels.height, colourBits, 0,
                                nullptr));
    } else {
        const Palette palette(colours_.list());
        check(EGifPutScreenDesc(gif_, picture.pixels.width, picture.pixels.height, colourBits, 0,
                                palette.map));
    }
    const GifByteType forEver[] = {1, 0, 0};
    check(EGifPutExtensionLeader(gif_, APPLICATION_EXT_FUNC_CODE));
    check(EGifPutExtensionBlock(gif_, 11, "NETSCAPE2.0"));
    check(EGifPutExtensionBlock(gif_, sizeof forEver, forEver));
    check(EGifPutExtensionTrailer(gif_));
}

void GifWriter::putDelay(std::int64_t delay) {
    GraphicsControlBlock control{};
    control.DisposalMode = DISPOSE_DO_NOT;
    control.DelayTime = static_cast<int>(delay);
    control.TransparentColor = NO_TRANSPARENT_COLOR;
    GifByteType bytes[4];
    const std::size_t count = EGifGCBToExtension(&control, bytes);
    check(EGifPutExtension(gif_, GRAPHICS_EXT_FUNC_CODE, static_cast<int>(count), bytes));
}

/// Writes numbers_ as an image; with a map of its own, or null for that of the film.
void GifWriter::putRows(const RECT& area, ColorMapObject* map) {
    const int width = area.right - area.left;
    const int height = area.bottom - area.top;
    check(EGifPutImageDesc(gif_, area.left, area.top, width, height, false, map));
    for (int y = 0; y < height; ++y) {
        check(EGifPutLine(gif_, numbers_.data() + static_cast<std::ptrdiff_t>(y) * width, width));
    }
}

void GifWriter::putNumbered(const FilmPicture& picture, const RECT& area, const Colours& colours,
                            bool ownPalette) {
    const auto width = static_cast<std::size_t>(area.right - area.left);
    std::uint8_t* numbers = numbers_.data();
    for (LONG y = area.top; y < area.bottom; ++y, numbers += width) {
        const auto row = static_cast<std::ptrdiff_t>(y) * picture.pixels.stride;
        colours.numbersOf(picture.pixels.bits + row + area.left, width, numbers);
    }
    if (ownPalette) {
        const Palette palette(colours.list());
        putRows(area, palette.map);
    } else {
        putRows(area, nullptr);
    }
}

/// More colours than a palette holds: the library picks the nearest ones.
void GifWriter::putReduced(const FilmPicture& picture, const RECT& area) {
    std::vector<GifByteType> parts[3];
    for (unsigned part = 0; part < 3; ++part) {
        for (LONG y = area.top; y < area.bottom; ++y) {
            for (LONG x = area.left; x < area.right; ++x) {
                const DWORD pixel =
                    picture.pixels.bits[static_cast<std::ptrdiff_t>(y) * picture.pixels.stride + x];
                parts[part].push_back(static_cast<GifByteType>(pixel >> (16U - 8U * part)));
            }
        }
    }
    const std::vector<DWORD> unset(Colours::most);
    const Palette palette(unset);
    int size = Colours::most;
    check(GifQuantizeBuffer(static_cast<unsigned>(area.right - area.left),
                            static_cast<unsigned>(area.bottom - area.top), &size, parts[0].data(),
                            parts[1].data(), parts[2].data(), numbers_.data(),
                            palette.map->Colors));
    putRows(area, palette.map);
}

void GifWriter::putImage(const FilmPicture& picture, const RECT& area, std::int64_t delay) {
    putDelay(delay);
    numbers_.resize(static_cast<std::size_t>(area.right - area.left) *
                    static_cast<std::size_t>(area.bottom - area.top));
    if (!colours_.tooMany()) {
        putNumbered(picture, area, colours_, false);
        return;
    }
    Colours own;
    if (own.add(picture.pixels, area)) {
        putNumbered(picture, area, own, true);
    } else {
        putReduced(picture, area);
    }
}

RECT unionOf(const RECT& a, const RECT& b) {
    return a.right == 0 ? b
                        : RECT{std::min(a.left, b.left), std::min(a.top, b.top),
                               std::max(a.right, b.right), std::max(a.bottom, b.bottom)};
}

void GifWriter::add(const FilmPicture& picture) {
    constexpr std::int64_t longest = 0xFFFF; // a delay has two bytes
    if (gif_ == nullptr) {
        begin(picture);
    }
    RECT area = unionOf(leftOut_, picture.changed);
    std::int64_t left = hundredths(picture.to) - hundredths(picture.from);
    if (left == 0 && picture.to != picture.from) {
        leftOut_ = area;
        return;
    }
    leftOut_ = {};
    do {
        const std::int64_t delay = std::min(left, longest);
        putImage(picture, area, delay);
        area = {0, 0, 1, 1}; // what goes on standing
        left -= delay;
    } while (left > 0);
}

void GifWriter::finish() {
    int error = 0;
    const int closed = EGifCloseFile(std::exchange(gif_, nullptr), &error);
    check(closed);
    file_.commit();
}

} // namespace

std::unique_ptr<FilmWriter> MakeGifWriter(const std::string& path, const FilmPlan& plan) {
    return std::make_unique<GifWriter>(path, plan);
}
