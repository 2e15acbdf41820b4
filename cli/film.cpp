#include "cli/film.h"

#include "cli/check.h"
#include "cli/film_writer.h"
#include "cli/help.h"
#include "cli/interruption.h"
#include "cli/options.h"
#include "cli/progress.h"

#include <algorithm>
#include <cctype>
#include <cstdio>
#include <filesystem>
#include <optional>
#include <stdexcept>

namespace fs = std::filesystem;

static constexpr std::int64_t lastPictureStays = 1000; // ms, behind the end of the show

namespace {

struct FilmArguments {
    ReplayOptions stage;
    std::string shown; // what the film is of, for messages
    std::string out;
    bool still = false;
};

std::string readFilmArguments(const std::vector<std::string>& line, FilmArguments& film) {
    StageArguments arguments;
    std::string wrong = ReadArguments(
        line, {optionSize, optionSeed, optionMode, optionStill, optionWalkAbout}, arguments);
    if (!wrong.empty()) {
        return wrong;
    }
    // With a walk about the Toon may be left out, and isn't looked at.
    const std::size_t names = arguments.names.size();
    if (names > 2 || names < (arguments.walkAbout ? 1U : 2U)) {
        return arguments.walkAbout ? "with --walk-about it takes one OUT"
                                   : "it takes a FILE.zkt and one OUT";
    }
    film.stage = arguments.stage;
    film.shown = arguments.walkAbout ? "the walk about" : arguments.names.front();
    film.out = arguments.names.back();
    if (!arguments.walkAbout) {
        film.stage.toons = {arguments.names.front()};
    }
    if (arguments.still) {
        film.still = true;
        film.stage.longest = *arguments.still;
    }
    return "";
}

bool goesOn() {
    return Interruption() == 0;
}

/// Acts the show out and hands on its pictures. A still is what stands at the end.
ReplayEnd shoot(const FilmArguments& film, const std::function<void(const FilmPicture&)>& sink) {
    std::optional<FilmPicture> last;
    Reel reel([&](const FilmPicture& picture) {
        if (!film.still) {
            sink(picture);
        } else {
            last = picture;
        }
    });
    ReplayHooks hooks;
    hooks.picture = [&](std::int64_t moment, const RECT& drawn, const seam::PixelView& stage) {
        reel.draw(moment, drawn, stage);
    };
    hooks.goesOn = goesOn;
    ReplayEnd end = Replay(film.stage, hooks);
    reel.end(end.moment + lastPictureStays);
    if (last) {
        last->changed = {0, 0, last->pixels.width, last->pixels.height};
        last->to = last->from;
        sink(*last);
    }
    return end;
}

/// Acts the show out for a first time, to know its length and its colours.
FilmPlan planFilm(const FilmArguments& film) {
    FilmPlan plan;
    const ReplayEnd end = shoot(film, [&](const FilmPicture& picture) {
        ++plan.pictures;
        plan.colours.add(picture.pixels, picture.changed);
    });
    if (!end.message.empty()) {
        throw std::runtime_error(film.shown + ": the saver says: " + end.message);
    }
    if (film.still && end.shows > 0 && film.stage.longest > end.moment) {
        throw std::runtime_error(film.shown + ": the show ends at " + std::to_string(end.moment) +
                                 " ms");
    }
    plan.length = end.moment;
    return plan;
}

std::unique_ptr<FilmWriter> writerFor(const std::string& out, const FilmPlan& plan) {
    std::string extension = fs::path(out).extension();
    std::ranges::transform(extension, extension.begin(),
                           [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    if (extension == ".gif") {
        return MakeGifWriter(out, plan);
    }
    if (extension == ".png") {
        return MakePngWriter(out, plan);
    }
    if (!extension.empty() && !fs::is_directory(out)) {
        throw std::runtime_error(out + ": a film ends in .gif or .png, or is a directory");
    }
    return MakeDirectoryWriter(out, plan);
}

void makeFilm(const FilmArguments& film) {
    const FilmPlan plan = planFilm(film);
    if (!goesOn()) {
        return;
    }
    const std::unique_ptr<FilmWriter> writer = writerFor(film.out, plan);
    Progress progress(fs::path(film.out).filename(), plan.length);
    shoot(film, [&](const FilmPicture& picture) {
        if (goesOn()) {
            progress.show(picture.from);
            writer->add(picture);
        }
    });
    if (goesOn()) {
        writer->finish();
    }
}

} // namespace

int FilmCommand(const std::vector<std::string>& line) {
    FilmArguments film;
    CatchInterruptions();
    try {
        const std::string wrong = readFilmArguments(line, film);
        if (!wrong.empty()) {
            return TellWrongUsage("film", wrong);
        }
        const std::string unplayable = WhyUnplayable(film.stage.toons);
        if (!unplayable.empty()) {
            throw std::runtime_error(unplayable);
        }
        makeFilm(film);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "toon film: %s\n", error.what());
        return 1;
    }
    return goesOn() ? 0 : EndBySignal(Interruption());
}
