// From what is drawn on a stage to the pictures of a film.
#pragma once

#include "platform/harness.h"

#include <cstdint>
#include <functional>
#include <vector>

struct FilmPicture {
    std::int64_t from; // the moments in ms at which it comes and goes; the second is the later one
    std::int64_t to;
    RECT changed;           // the smallest rectangle round what differs from the picture before
    seam::PixelView pixels; // the whole picture, 0x00rrggbb
};

/// Gathers what is drawn at one moment into one picture. What was drawn over at the same moment,
/// and what looks as before, makes none.
class Reel {
  public:
    /// `sink` gets each picture when it is known how long it stands; the pixels are good until
    /// the next picture, or the end of the reel. The first picture has changed everywhere.
    explicit Reel(std::function<void(const FilmPicture&)> sink);

    /// These bounds of the stage have been drawn. Moments never go back.
    void draw(std::int64_t moment, const RECT& drawn, const seam::PixelView& stage);

    /// The film ends; the last picture is handed over, if there is any.
    void end(std::int64_t moment);

  private:
    using Pixels = std::vector<DWORD>;

    void begin(const seam::PixelView& stage);
    void gather();
    void handOver(std::int64_t to);
    bool rowDiffers(LONG y, LONG left, LONG right) const;
    void crop();

    std::function<void(const FilmPicture&)> sink_;
    int width_ = 0;
    int height_ = 0;
    Pixels drawn_;            // the stage as it is now
    Pixels picture_;          // the picture that stands, not handed over yet
    RECT area_{};             // where the two may differ
    std::int64_t moment_ = 0; // of the last drawing
    std::int64_t from_ = 0;   // when the picture came
    RECT changed_{};          // where it differs from the one before
};
