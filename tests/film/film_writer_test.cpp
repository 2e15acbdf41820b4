// What the writers make of pictures, read back.
#include "cli/film_writer.h"
#include "tests/film/film_readers.h"
#include "tests/kernel/scratch_directory.h"

#include <random>

namespace {

using test::Film;
using test::Shown;

constexpr int width = 70;
constexpr int height = 50;
using Pixels = std::vector<DWORD>;

/// A picture in which each pixel of an area has one of so many colours.
Pixels noise(Pixels pixels, const RECT& area, DWORD colours, DWORD shift = 0) {
    std::minstd_rand random(colours);
    for (LONG y = area.top; y < area.bottom; ++y) {
        for (LONG x = area.left; x < area.right; ++x) {
            const DWORD colour = static_cast<DWORD>(random() >> 4U) % colours;
            pixels[static_cast<std::size_t>(y * width + x)] = (colour * 5077 + shift) & 0xFFFFFFU;
        }
    }
    return pixels;
}

const Pixels black(static_cast<std::size_t>(width) * height);
constexpr RECT all{0, 0, width, height};
constexpr RECT some{10, 31, 40, 45};
constexpr RECT corner{69, 49, 70, 50};

/// Hands a film's pictures to `sink` as if each had been drawn anew.
void project(const std::vector<Shown>& film, const std::function<void(const FilmPicture&)>& sink) {
    Reel reel(sink);
    for (const Shown& shown : film) {
        Pixels pixels = shown.pixels;
        reel.draw(shown.from, all, {pixels.data(), width, height, width});
    }
    reel.end(film.back().to);
}

using MakeWriter = std::unique_ptr<FilmWriter> (*)(const std::string&, const FilmPlan&);
using ReadFilm = Film (*)(const std::filesystem::path&);

class Writers : public ScratchDirectory {
  protected:
    static Film writeAndRead(MakeWriter make, ReadFilm read, const std::string& name,
                             const std::vector<Shown>& film) {
        FilmPlan plan;
        project(film, [&](const FilmPicture& picture) {
            ++plan.pictures;
            plan.colours.add(picture.pixels, picture.changed);
        });
        const auto writer = make(name, plan);
        project(film, [&](const FilmPicture& picture) { writer->add(picture); });
        writer->finish();
        return read(name);
    }
};

const std::vector<Shown> fewColours = {{0, 40, noise(black, all, 100)},
                                       {40, 50, noise(black, some, 100)},
                                       {50, 2000, noise(black, corner, 7, 9)}};
const std::vector<Shown> manyColours = {{0, 40, noise(black, all, 256)},
                                        {40, 50, noise(black, some, 256, 77)},
                                        {50, 2000, noise(black, all, 200, 1)}};
const std::vector<Shown> longPictures = {
    {0, 66'000, black}, {66'000, 66'010, noise(black, some, 9)}, {66'010, 2'000'000, black}};

TEST_F(Writers, KeepEachPictureAndItsMoments) {
    for (const auto& film : {fewColours, manyColours, longPictures}) {
        for (const auto& [made, name] :
             {std::pair(writeAndRead(MakeGifWriter, test::readGif, "f.gif", film), "GIF"),
              std::pair(writeAndRead(MakePngWriter, test::readPng, "f.png", film), "PNG")}) {
            EXPECT_TRUE(made.pictures == film) << name;
            EXPECT_TRUE(made.forEver) << name;
        }
        EXPECT_TRUE(writeAndRead(MakeDirectoryWriter, test::readDirectory, "f", film).pictures ==
                    film);
    }
}

TEST_F(Writers, HoldWhatHasChangedAndNoMore) {
    const std::vector<Shown> film = {
        {0, 10, black}, {10, 20, noise(black, {12, 31, 13, 44}, 5, 1)}, {20, 1000, black}};
    constexpr std::int64_t needed = width * height + 13 + 13;
    EXPECT_EQ(writeAndRead(MakeGifWriter, test::readGif, "f.gif", film).drawn, needed);
    EXPECT_EQ(writeAndRead(MakePngWriter, test::readPng, "f.png", film).drawn, needed);
}

TEST_F(Writers, CountHundredthsInAGifWithoutDrift) {
    std::vector<Shown> film; // a picture each 33 ms, and one for 4
    for (std::int64_t at = 0; at < 990; at += 33) {
        film.push_back({at, at + 33, noise(black, corner, 1, static_cast<DWORD>(at + 1))});
    }
    film.push_back({990, 994, noise(black, some, 2)});
    film.push_back({994, 2003, noise(black, all, 3)});
    const Film made = writeAndRead(MakeGifWriter, test::readGif, "f.gif", film);
    film.erase(film.end() - 2); // 990 and 994 are the same hundredth
    ASSERT_EQ(made.pictures.size(), film.size());
    for (std::size_t i = 0; i < film.size(); ++i) {
        EXPECT_TRUE(made.pictures[i].pixels == film[i].pixels) << i;
        EXPECT_EQ(made.pictures[i].from, (film[i].from + 5) / 10 * 10) << i;
    }
    EXPECT_EQ(made.pictures.back().to, 2000);
}

TEST_F(Writers, ComeCloseWhereAGifHasTooFewColours) {
    Pixels blends;
    for (DWORD i = 0; i < width * height; ++i) {
        blends.push_back(i % width * 3 << 16U | i / width * 5 << 8U); // 3500 of them
    }
    const std::vector<Shown> film = {{0, 1000, blends}, {1000, 2000, black}};
    const Film made = writeAndRead(MakeGifWriter, test::readGif, "f.gif", film);
    ASSERT_EQ(made.pictures.size(), 2U);
    for (std::size_t i = 0; i < blends.size(); ++i) {
        for (const unsigned shift : {16U, 8U, 0U}) {
            ASSERT_NEAR(made.pictures[0].pixels[i] >> shift & 0xFFU, blends[i] >> shift & 0xFFU, 39)
                << i;
        }
    }
    EXPECT_TRUE(made.pictures[1].pixels == black);
    EXPECT_TRUE(writeAndRead(MakePngWriter, test::readPng, "f.png", film).pictures == film);
}

TEST_F(Writers, LeaveNothingWhereTheyAreNotLedToTheirEndAndReplaceNothing) {
    make("old.gif", "old");
    make("old.png", "old");
    make("old/0001.png", "old");
    make("old/mine.png", "mine");
    make("old/times.txt", "0001.png 0 10\n0002.png 10 10\n");
    const std::pair<MakeWriter, std::string> cases[] = {
        {MakeGifWriter, "old.gif"}, {MakeGifWriter, "new.gif"},   {MakePngWriter, "old.png"},
        {MakePngWriter, "new.png"}, {MakeDirectoryWriter, "old"}, {MakeDirectoryWriter, "new"}};
    for (const auto& [makeWriter, name] : cases) {
        for (const bool full : {false, true}) {
            const FilmPlan plan;
            std::string told;
            try {
                const FullDisk disk(full ? 60 : RLIM_INFINITY);
                const auto writer = makeWriter(name, plan);
                project(fewColours, [&](const FilmPicture& picture) { writer->add(picture); });
                if (full) {
                    writer->finish();
                }
            } catch (const std::runtime_error& error) {
                told = error.what();
            }
            EXPECT_EQ(told.starts_with(name) && told.ends_with("File too large"), full) << told;
        }
    }
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator("."), {}), 3);
    EXPECT_EQ(std::distance(std::filesystem::directory_iterator("old"), {}), 3);
    EXPECT_EQ(textOf("old.gif") + textOf("old.png") + textOf("old/0001.png"), "oldoldold");
}

TEST_F(Writers, TakeThePlaceOfAnEarlierFilmAndOfNothingElse) {
    make("film/mine.png", "mine");
    std::filesystem::create_symlink("linked.gif", "link.gif");
    make("linked.gif", "old");
    setMode("linked.gif", 0640);
    const std::vector<Shown> shorter(fewColours.begin(), fewColours.begin() + 1);
    for (const auto& film : {fewColours, shorter}) {
        std::filesystem::rename("film/mine.png", "mine.png");
        EXPECT_TRUE(writeAndRead(MakeDirectoryWriter, test::readDirectory, "film", film).pictures ==
                    film);
        std::filesystem::rename("mine.png", "film/mine.png");
    }
    EXPECT_EQ(textOf("film/mine.png"), "mine");
    writeAndRead(MakeGifWriter, test::readGif, "link.gif", shorter);
    EXPECT_TRUE(std::filesystem::is_symlink("link.gif"));
    EXPECT_EQ(modeOf("linked.gif"), 0640U);
}

} // namespace
