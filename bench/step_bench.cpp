// One step of a walk on a stage of 1920x1080, beside the floor: what two straight loops over the
// same pixels take. A step should take at most ten times the floor.
#include "bench/floor.h"
#include "platform/gdi/surface.h"
#include "platform/user.h"
#include "stage/sprite.h"

#include <benchmark/benchmark.h>

#include <vector>

namespace {

constexpr int stageWidth = 1920;
constexpr int stageHeight = 1080;
constexpr int figureSize = 130;
constexpr int strideX = 6;
constexpr int strideY = 2;

class MemoryStage : public seam::Surface {
  public:
    seam::PixelView pixels() override {
        return {pixels_.data(), stageWidth, stageHeight, stageWidth};
    }

    void touch(const RECT& area) override {
        benchmark::DoNotOptimize(area);
    }

  private:
    std::vector<DWORD> pixels_ =
        std::vector<DWORD>(static_cast<std::size_t>(stageWidth) * stageHeight, 0xFF6080A0);
};

MemoryStage& Stage() {
    static MemoryStage stage;
    return stage;
}

bool InDisc(int x, int y, int radius) {
    const int dx = x - figureSize / 2;
    const int dy = y - figureSize / 2;
    return dx * dx + dy * dy < radius * radius;
}

/// A disc on black with a black hole.
std::vector<DWORD> FigurePixels() {
    std::vector<DWORD> pixels;
    for (int y = 0; y < figureSize; ++y) {
        for (int x = 0; x < figureSize; ++x) {
            pixels.push_back(InDisc(x, y, 60) && !InDisc(x, y, 20) ? 0xFFCC4411 : 0xFF000000);
        }
    }
    return pixels;
}

HBITMAP MakeFigure(HDC dc) {
    HBITMAP figure = CreateCompatibleBitmap(dc, figureSize, figureSize);
    HDC memory = CreateCompatibleDC(dc);
    const HGDIOBJ before = SelectObject(memory, figure);
    HBRUSH colour = CreateSolidBrush(RGB(0xCC, 0x44, 0x11));
    for (int y = 0; y < figureSize; ++y) {
        for (int x = 0; x < figureSize; ++x) {
            const RECT pixel{x, y, x + 1, y + 1};
            if (InDisc(x, y, 60) && !InDisc(x, y, 20)) {
                FillRect(memory, &pixel, colour);
            }
        }
    }
    SelectObject(memory, before);
    DeleteDC(memory);
    DeleteObject(colour);
    return figure;
}

/// A place on a path over the stage.
POINT NextPlace(POINT place) {
    place.x = place.x + strideX > stageWidth - figureSize ? 0 : place.x + strideX;
    place.y = place.y + strideY > stageHeight - figureSize ? 0 : place.y + strideY;
    return place;
}

void Step(benchmark::State& state) {
    HDC dc = GetDC(nullptr);
    HBITMAP figure = MakeFigure(dc);
    Sprite sprite{};
    SpriteStamp(dc, figure, &sprite);
    SpriteSaveUnder(dc, &sprite);
    SpriteDraw(dc, &sprite);
    while (state.KeepRunning()) {
        const POINT next = NextPlace({sprite.x, sprite.y});
        HDC stamping = GetDC(nullptr);
        SpriteStamp(stamping, figure, &sprite);
        ReleaseDC(nullptr, stamping);
        SpriteMove(nullptr, &sprite, next.x, next.y);
    }
    SpriteFree(&sprite);
    DeleteObject(figure);
    ReleaseDC(nullptr, dc);
}

void Floor(benchmark::State& state) {
    const std::vector<DWORD> figure = FigurePixels();
    const std::vector<DWORD> under(figure.size(), 0xFF6080A0);
    POINT place{0, 0};
    while (state.KeepRunning()) {
        RestorePlain(Stage().pixels(), place.x, place.y, under.data(), figureSize);
        place = NextPlace(place);
        CompositePlain(Stage().pixels(), place.x, place.y, figure.data(), figureSize);
        benchmark::ClobberMemory();
    }
}

} // namespace

BENCHMARK(Floor);
BENCHMARK(Step);

HDC GetDC(HWND /*window*/) {
    return seam::makeSurfaceContext(Stage(), {0, 0, stageWidth, stageHeight});
}

int ReleaseDC(HWND /*window*/, HDC dc) {
    return DeleteDC(dc);
}

BENCHMARK_MAIN();
