#include "cli/film_writer.h"

#include "cli/png_format.h"

#include <algorithm>

namespace {

constexpr std::int64_t longestDelay = 0xFFFF; // ms; the numerator of a delay has two bytes

class PngWriter : public FilmWriter {
  public:
    PngWriter(const std::string& path, const FilmPlan& plan)
        : file_(path), pixels_(plan.colours), animated_(plan.pictures > 1) {}

    void add(const FilmPicture& picture) override;
    void finish() override;

  private:
    Bytes animation() const;
    void begin(const seam::PixelView& picture);
    void putFrame(const FilmPicture& picture, const RECT& area, std::int64_t delay);
    Bytes control(const RECT& area, std::int64_t delay);
    void flush();

    OutFile file_;
    PngPixels pixels_;
    bool animated_;
    Packer packer_{Packer::Form::stream};
    Bytes rows_;
    Bytes out_;               // what goes into the file next
    long animationPlace_ = 0; // of the chunk that counts the frames
    std::uint32_t frames_ = 0;
    std::uint32_t sequence_ = 0; // numbers the chunks of the animation
};

void PngWriter::flush() {
    file_.write(out_.data(), out_.size());
    out_.clear();
}

/// The chunk that makes it an animation, with the frames counted up to now.
Bytes PngWriter::animation() const {
    Bytes chunk;
    if (animated_) {
        Bytes content;
        AppendNumber(content, frames_);
        AppendNumber(content, 0); // plays for ever
        AppendChunk(chunk, "acTL", content);
    }
    return chunk;
}

void PngWriter::begin(const seam::PixelView& picture) {
    constexpr long behindHeader = 33; // the signature and the first chunk always have this size
    animationPlace_ = behindHeader;
    out_ = pixels_.head(picture.width, picture.height, animation());
}

Bytes PngWriter::control(const RECT& area, std::int64_t delay) {
    constexpr std::uint32_t perSecond = 1000;
    Bytes content;
    AppendNumber(content, sequence_++);
    AppendNumber(content, static_cast<std::uint32_t>(area.right - area.left));
    AppendNumber(content, static_cast<std::uint32_t>(area.bottom - area.top));
    AppendNumber(content, static_cast<std::uint32_t>(area.left));
    AppendNumber(content, static_cast<std::uint32_t>(area.top));
    AppendShort(content, static_cast<std::uint32_t>(delay));
    AppendShort(content, perSecond);
    content.insert(content.end(), {0, 0}); // it stays, and covers what was there
    return content;
}

void PngWriter::putFrame(const FilmPicture& picture, const RECT& area, std::int64_t delay) {
    if (animated_) {
        AppendChunk(out_, "fcTL", control(area, delay));
    }
    Bytes content;
    if (frames_ > 0) {
        AppendNumber(content, sequence_++);
    }
    pixels_.rowsOf(picture.pixels, area, rows_);
    packer_.append(content, rows_);
    AppendChunk(out_, frames_ > 0 ? "fdAT" : "IDAT", content);
    flush();
    ++frames_;
}

void PngWriter::add(const FilmPicture& picture) {
    if (frames_ == 0) {
        begin(picture.pixels);
    }
    RECT area = picture.changed;
    std::int64_t left = picture.to - picture.from;
    do {
        const std::int64_t delay = std::min(left, longestDelay);
        putFrame(picture, area, delay);
        area = {0, 0, 1, 1}; // what goes on standing
        left -= delay;
    } while (left > 0 && animated_);
}

void PngWriter::finish() {
    AppendEnd(out_);
    flush();
    if (animated_) {
        file_.writeAt(animationPlace_, animation());
    }
    file_.commit();
}

} // namespace

std::unique_ptr<FilmWriter> MakePngWriter(const std::string& path, const FilmPlan& plan) {
    return std::make_unique<PngWriter>(path, plan);
}
