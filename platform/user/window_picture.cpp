#include "platform/user/window_picture.h"

#include "platform/harness.h"

#include <algorithm>
#include <cstring>
#include <utility>

namespace seam {

namespace {

PictureWatcher pictureWatcher;

} // namespace

void watchPictures(PictureWatcher watcher) {
    pictureWatcher = std::move(watcher);
}

WindowPicture::~WindowPicture() {
    dropSurface(*this);
}

void WindowPicture::touch(const RECT& area) {
    const QRect rectangle(area.left, area.top, area.right - area.left, area.bottom - area.top);
    dirty_ |= rectangle;
    if (pictureWatcher) {
        untold_ |= rectangle;
    }
}

void WindowPicture::tellWatcher() {
    const QRect drawn = std::exchange(untold_, QRect());
    if (pictureWatcher && !drawn.isEmpty()) {
        const RECT area{drawn.x(), drawn.y(), drawn.x() + drawn.width(),
                        drawn.y() + drawn.height()};
        pictureWatcher(owner_, area, pixels());
    }
}

QImage WindowPicture::copyPicture() {
    const PixelView now = pixels();
    return now.bits == nullptr ? QImage()
                               : QImage(reinterpret_cast<const uchar*>(now.bits), now.width,
                                        now.height, now.stride * 4, QImage::Format_RGB32)
                                     .copy();
}

void WindowPicture::pastePicture(const QImage& kept) {
    const PixelView now = pixels();
    for (int y = 0; y < std::min(now.height, kept.height()); ++y) {
        std::memcpy(now.bits + static_cast<std::ptrdiff_t>(y) * now.stride, kept.constScanLine(y),
                    static_cast<std::size_t>(std::min(now.width, kept.width())) * 4);
    }
}

} // namespace seam
