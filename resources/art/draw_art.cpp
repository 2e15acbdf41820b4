// Draws the program's pictures into the directory that is given: draw_art resources
// With --model-sheet it draws who he is, for the documents: draw_art --model-sheet sheet.png

#include "resources/art/bmp_file.h"
#include "resources/art/gallery.h"
#include "resources/art/model_sheet.h"
#include "resources/art/png_file.h"

#include <cstdio>
#include <string>

namespace {

bool write(const std::string& path, const std::vector<std::uint8_t>& bytes) {
    const bool written = art::writeFile(path, bytes);
    if (!written) {
        std::fprintf(stderr, "draw_art: can't write %s\n", path.c_str());
    }
    return written;
}

bool drawAll(const std::string& directory) {
    for (const art::Exhibit& exhibit : art::drawGallery()) {
        if (!write(directory + "/" + exhibit.file, exhibit.bytes)) {
            return false;
        }
    }
    return true;
}

} // namespace

int main(int argc, char** argv) {
    const std::string first = argc > 1 ? argv[1] : "";
    const bool sheet = first == "--model-sheet" && argc == 3;
    if (!sheet && (argc != 2 || first.starts_with("-"))) {
        std::fprintf(stderr, "usage: draw_art DIRECTORY | --model-sheet FILE\n");
        return 2;
    }
    const bool drawn =
        sheet ? write(argv[2], art::pngBytes(art::drawModelSheet())) : drawAll(first);
    return drawn ? 0 : 1;
}
