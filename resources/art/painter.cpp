#include "resources/art/painter.h"

#include <algorithm>
#include <cmath>
#include <stdexcept>
#include <string>
#include <utility>

namespace art {

namespace {

// Outlines are drawn this much larger in each direction and brought down by majority.
constexpr int Fine = 8;

// A span of a fine row that lies inside, as fine column numbers, the end not included.
using Span = std::pair<int, int>;

std::vector<Span> spansOfRow(const Outline& outline, double y) {
    std::vector<double> crossings;
    for (std::size_t i = 0; i < outline.size(); ++i) {
        const Point a = outline[i];
        const Point b = outline[(i + 1) % outline.size()];
        if ((a.y <= y) != (b.y <= y)) {
            crossings.push_back(a.x + (b.x - a.x) * (y - a.y) / (b.y - a.y));
        }
    }
    std::sort(crossings.begin(), crossings.end());
    std::vector<Span> spans;
    for (std::size_t i = 0; i + 1 < crossings.size(); i += 2) {
        spans.emplace_back(static_cast<int>(std::ceil(crossings[i] * Fine - 0.5)),
                           static_cast<int>(std::ceil(crossings[i + 1] * Fine - 0.5)));
    }
    return spans;
}

// An outline and the rows that it reaches over.
struct Extent {
    const Outline* outline;
    double top;
    double bottom;
};

std::vector<Extent> extents(const std::vector<Outline>& outlines) {
    std::vector<Extent> all;
    for (const Outline& outline : outlines) {
        const auto [top, bottom] = std::minmax_element(outline.begin(), outline.end(),
                                                       [](Point a, Point b) { return a.y < b.y; });
        all.push_back({&outline, top->y, bottom->y});
    }
    return all;
}

void fillFineRow(std::vector<bool>& row, const std::vector<Extent>& outlines, double y) {
    std::fill(row.begin(), row.end(), false);
    const int width = static_cast<int>(row.size());
    for (const Extent& extent : outlines) {
        if (y < extent.top || y > extent.bottom) {
            continue;
        }
        for (const auto& [from, to] : spansOfRow(*extent.outline, y)) {
            for (int x = std::max(from, 0); x < std::min(to, width); ++x) {
                row[static_cast<std::size_t>(x)] = true;
            }
        }
    }
}

bool touches(const Mask& mask, int x, int y) {
    return mask.at(x - 1, y) != 0 || mask.at(x + 1, y) != 0 || mask.at(x, y - 1) != 0 ||
           mask.at(x, y + 1) != 0;
}

// Takes away pixels that hang on by one side only: they would make a knot in the line.
Mask withoutBumps(const Mask& mask) {
    Mask even = mask;
    for (int y = 0; y < mask.height; ++y) {
        for (int x = 0; x < mask.width; ++x) {
            const int sides =
                mask.at(x - 1, y) + mask.at(x + 1, y) + mask.at(x, y - 1) + mask.at(x, y + 1);
            if (sides < 2) {
                even.set(x, y, 0);
            }
        }
    }
    return even;
}

Ink inkAt(const Part& part, const Mask& mask, int x, int y) {
    if (mask.at(x + part.shadow, y + part.shadow) == 0) {
        return part.shade;
    }
    return part.glow && mask.at(x - 2, y - 2) == 0 ? *part.glow : part.lit;
}

void fillInk(Picture& picture, const Part& part, const Mask& mask, const Mask& within) {
    for (int y = 0; y < picture.height; ++y) {
        for (int x = 0; x < picture.width; ++x) {
            if (mask.at(x, y) == 0 || within.at(x, y) == 0) {
                continue;
            }
            picture.set(x, y, inkAt(part, mask, x, y).at(x, y));
        }
    }
}

Colour stampColour(char letter) {
    static const std::string letters = ".rgybmcdlRGYBMCW";
    const std::size_t number = letters.find(letter);
    if (number == std::string::npos || number == Black) {
        throw std::invalid_argument(std::string("no colour has the letter ") + letter);
    }
    return static_cast<Colour>(number);
}

// The see-through pixels that hang together with the one given; they are marked as seen.
std::vector<std::pair<int, int>> collectHole(const Picture& picture, Mask& seen, int x, int y) {
    std::vector<std::pair<int, int>> hole = {{x, y}};
    seen.set(x, y, 1);
    for (std::size_t i = 0; i < hole.size(); ++i) {
        const auto [cx, cy] = hole[i];
        const std::pair<int, int> sides[] = {
            {cx - 1, cy}, {cx + 1, cy}, {cx, cy - 1}, {cx, cy + 1}};
        for (const auto& [nx, ny] : sides) {
            if (picture.contains(nx, ny) && picture.at(nx, ny) == Black && seen.at(nx, ny) == 0) {
                seen.set(nx, ny, 1);
                hole.emplace_back(nx, ny);
            }
        }
    }
    return hole;
}

} // namespace

Mask coverage(const std::vector<Outline>& outlines, int width, int height) {
    Mask mask(width, height);
    const std::vector<Extent> all = extents(outlines);
    std::vector<bool> row(static_cast<std::size_t>(width * Fine));
    for (int y = 0; y < height; ++y) {
        std::vector<int> counts(static_cast<std::size_t>(width));
        for (int line = 0; line < Fine; ++line) {
            fillFineRow(row, all, y + (line + 0.5) / Fine);
            for (std::size_t x = 0; x < row.size(); ++x) {
                counts[x / Fine] += row[x] ? 1 : 0;
            }
        }
        for (int x = 0; x < width; ++x) {
            mask.set(x, y, counts[static_cast<std::size_t>(x)] * 2 >= Fine * Fine);
        }
    }
    return mask;
}

Mask paintOutlined(Picture& picture, const Part& part, Colour line) {
    Mask mask = withoutBumps(coverage(part.outlines, picture.width, picture.height));
    for (int y = 0; y < picture.height; ++y) {
        for (int x = 0; x < picture.width; ++x) {
            if (mask.at(x, y) == 0 && touches(mask, x, y)) {
                picture.set(x, y, line);
            }
        }
    }
    fillInk(picture, part, mask, mask);
    return mask;
}

void paintWithin(Picture& picture, const Part& part, const Mask& within) {
    fillInk(picture, part, coverage(part.outlines, picture.width, picture.height), within);
}

void stamp(Picture& picture, int left, int top, const std::vector<std::string>& rows, Ink skin) {
    int y = top;
    for (const std::string& row : rows) {
        int x = left;
        for (const char letter : row) {
            if (letter != ' ') {
                picture.set(x, y, letter == 's' ? skin.at(x, y) : stampColour(letter));
            }
            ++x;
        }
        ++y;
    }
}

void fillSpecks(Picture& picture, std::size_t limit, Colour colour) {
    Mask seen(picture.width, picture.height);
    for (int y = 0; y < picture.height; ++y) {
        for (int x = 0; x < picture.width; ++x) {
            if (picture.at(x, y) != Black || seen.at(x, y) != 0) {
                continue;
            }
            const auto hole = collectHole(picture, seen, x, y);
            for (const auto& [hx, hy] : hole.size() <= limit ? hole : decltype(hole){}) {
                picture.set(hx, hy, colour);
            }
        }
    }
}

} // namespace art
