// What takes the pictures of a film, one after another, and makes a file of them. What goes wrong
// comes as a std::runtime_error that names the file; nothing is left of it then, nor when the
// writer goes before its end.
#pragma once

#include "cli/colours.h"
#include "cli/reel.h"

#include <memory>
#include <string>

/// What is known of a film before it is written.
struct FilmPlan {
    int pictures = 0;
    std::int64_t length = 0; // ms
    Colours colours;
};

class FilmWriter {
  public:
    FilmWriter() = default;
    FilmWriter(const FilmWriter&) = delete;
    FilmWriter& operator=(const FilmWriter&) = delete;
    virtual ~FilmWriter() = default;

    /// The next picture. It comes when the one before goes.
    virtual void add(const FilmPicture& picture) = 0;

    /// Ends the film and puts it into its place.
    virtual void finish() = 0;
};

/// A GIF that plays for ever: the changed rectangle of each picture, one palette for all where 256
/// colours are enough, and otherwise one each. A picture with more keeps the 256 nearest ones. Its
/// clock counts hundredths of a second: each picture comes at the nearest one, and one that would
/// stand for none is left out.
std::unique_ptr<FilmWriter> MakeGifWriter(const std::string& path, const FilmPlan& plan);

/// An animated PNG that plays for ever, a plain one where there is one picture: the changed
/// rectangle of each picture, by palette where 256 colours are enough. Times are exact.
std::unique_ptr<FilmWriter> MakePngWriter(const std::string& path, const FilmPlan& plan);

/// A directory, made if it is missing, with pictures 0001.png, 0002.png and so on, and times.txt,
/// of which each line tells a picture, when it comes and how long it stands, in ms. The pictures of
/// an earlier film there, by its times.txt, are replaced by it; anything else of these names is an
/// error.
std::unique_ptr<FilmWriter> MakeDirectoryWriter(const std::string& path, const FilmPlan& plan);
