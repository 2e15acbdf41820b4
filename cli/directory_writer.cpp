#include "cli/film_writer.h"

#include "cli/png_format.h"

#include <algorithm>
#include <cerrno>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <set>
#include <stdexcept>
#include <sys/stat.h>

namespace {

namespace fs = std::filesystem;

constexpr const char* timesName = "times.txt";

/// Rows of a picture, packed for themselves, so that they need not be packed again with the next
/// picture if they look the same there.
struct Band {
    Bytes chunk;   // as it stands in the file
    uLong sum = 0; // of the bytes before they were packed, and how many they were
    z_off_t size = 0;
};

class DirectoryWriter : public FilmWriter {
  public:
    DirectoryWriter(const std::string& path, const FilmPlan& plan);
    ~DirectoryWriter() override;
    void add(const FilmPicture& picture) override;
    void finish() override;

  private:
    void writeFile(const std::string& name, const Bytes& bytes) const;
    void pack(const FilmPicture& picture);
    Bytes whole(const seam::PixelView& picture) const;
    std::set<std::string> earlier() const;
    void refuseToReplaceOthers(const std::set<std::string>& ours) const;

    std::string shown_; // the path as the user gave it
    fs::path path_;
    bool made_;     // by us
    fs::path work_; // where the pictures lie until all are there
    PngPixels pixels_;
    Packer packer_{Packer::Form::part};
    Bytes rows_;
    std::vector<Band> bands_;
    std::vector<std::string> names_;
    std::string times_;
};

constexpr LONG bandRows = 32;

/// Whether the directory is a new one.
bool makeDirectory(const std::string& path) {
    const bool made = mkdir(path.c_str(), 0777) == 0;
    if (!made && errno != EEXIST) {
        FailWith(path, errno);
    }
    if (!fs::is_directory(path)) {
        FailWith(path, ENOTDIR);
    }
    return made;
}

DirectoryWriter::DirectoryWriter(const std::string& path, const FilmPlan& plan)
    : shown_(path), path_(fs::absolute(path)), made_(makeDirectory(path)), pixels_(plan.colours) {
    std::string work = path_ / ".film-XXXXXX";
    if (mkdtemp(work.data()) == nullptr) {
        const int error = errno;
        if (made_) {
            rmdir(path_.c_str());
        }
        FailWith(path, error);
    }
    work_ = work;
}

DirectoryWriter::~DirectoryWriter() {
    std::error_code ignored;
    fs::remove_all(work_, ignored);
    if (made_) {
        fs::remove(path_, ignored); // stays if anything is in it
    }
}

void DirectoryWriter::writeFile(const std::string& name, const Bytes& bytes) const {
    std::FILE* file = std::fopen((work_ / name).c_str(), "wbxe");
    const bool written =
        file != nullptr && std::fwrite(bytes.data(), 1, bytes.size(), file) == bytes.size();
    int error = errno;
    if (file != nullptr && std::fclose(file) != 0 && written) {
        error = errno;
    } else if (written) {
        return;
    }
    FailWith(shown_ + "/" + name, error);
}

/// Packs those bands anew in which something has changed.
void DirectoryWriter::pack(const FilmPicture& picture) {
    const LONG height = picture.pixels.height;
    bands_.resize(static_cast<std::size_t>((height + bandRows - 1) / bandRows));
    for (LONG top = picture.changed.top / bandRows * bandRows; top < picture.changed.bottom;
         top += bandRows) {
        Band& band = bands_[static_cast<std::size_t>(top / bandRows)];
        pixels_.rowsOf(picture.pixels,
                       {0, top, picture.pixels.width, std::min(top + bandRows, height)}, rows_);
        Bytes content;
        if (top == 0) {
            content = {0x78, 0x9C}; // how a stream begins
        }
        packer_.append(content, rows_);
        band = {{}, adler32_z(1, rows_.data(), rows_.size()), static_cast<z_off_t>(rows_.size())};
        AppendChunk(band.chunk, "IDAT", content);
    }
}

/// The file of the picture: its bands, and behind them the end of the stream that they make.
Bytes DirectoryWriter::whole(const seam::PixelView& picture) const {
    Bytes bytes = pixels_.head(picture.width, picture.height, {});
    uLong sum = 1;
    for (const Band& band : bands_) {
        bytes.insert(bytes.end(), band.chunk.begin(), band.chunk.end());
        sum = adler32_combine(sum, band.sum, band.size);
    }
    Bytes end = {0x03, 0x00}; // an empty last block
    AppendNumber(end, static_cast<std::uint32_t>(sum));
    AppendChunk(bytes, "IDAT", end);
    AppendEnd(bytes);
    return bytes;
}

void DirectoryWriter::add(const FilmPicture& picture) {
    constexpr std::size_t digits = 4;
    std::string number = std::to_string(names_.size() + 1);
    number.insert(0, digits - std::min(number.size(), digits), '0');
    names_.push_back(number + ".png");
    times_ += names_.back() + " " + std::to_string(picture.from) + " " +
              std::to_string(picture.to - picture.from) + "\n";
    pack(picture);
    writeFile(names_.back(), whole(picture.pixels));
}

/// The pictures of an earlier film, by the list that it left, and that list.
std::set<std::string> DirectoryWriter::earlier() const {
    std::set<std::string> names;
    std::ifstream list(path_ / timesName);
    for (std::string line; std::getline(list, line);) {
        const std::string name = line.substr(0, line.find(' '));
        if (!name.ends_with(".png") || name.find('/') != std::string::npos) {
            return {}; // somebody else's list
        }
        names.insert(name);
    }
    if (!names.empty()) {
        names.insert(timesName);
    }
    return names;
}

void DirectoryWriter::refuseToReplaceOthers(const std::set<std::string>& ours) const {
    for (const std::string& name : names_) {
        if (!ours.contains(name) && fs::exists(fs::symlink_status(path_ / name))) {
            throw std::runtime_error(shown_ + "/" + name + ": it is there, and of no film");
        }
    }
}

void DirectoryWriter::finish() {
    std::set<std::string> surplus = earlier();
    writeFile(timesName, Bytes(times_.begin(), times_.end()));
    names_.emplace_back(timesName);
    refuseToReplaceOthers(surplus);
    for (const std::string& name : names_) {
        std::error_code error;
        fs::rename(work_ / name, path_ / name, error);
        if (error) {
            FailWith(shown_ + "/" + name, error.value());
        }
        surplus.erase(name);
    }
    std::error_code ignored;
    for (const std::string& name : surplus) {
        fs::remove(path_ / name, ignored);
    }
    fs::remove(work_, ignored);
}

} // namespace

std::unique_ptr<FilmWriter> MakeDirectoryWriter(const std::string& path, const FilmPlan& plan) {
    return std::make_unique<DirectoryWriter>(path, plan);
}
