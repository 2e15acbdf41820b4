// Draws the program's pictures into the directory that is given: draw_art resources

#include "resources/art/bmp_file.h"
#include "resources/art/gallery.h"

#include <cstdio>

int main(int argc, char** argv) {
    if (argc != 2) {
        std::fprintf(stderr, "usage: draw_art DIRECTORY\n");
        return 2;
    }
    const std::string directory = argv[1];
    for (const art::Exhibit& exhibit : art::drawGallery()) {
        const std::string path = directory + "/" + exhibit.file;
        if (!art::writeFile(path, exhibit.bytes)) {
            std::fprintf(stderr, "draw_art: can't write %s\n", path.c_str());
            return 1;
        }
    }
    return 0;
}
