#include "platform/user/controls/item_painter.h"

#include "platform/gdi/surface.h"
#include "platform/user/window.h"

#include <QImage>

namespace seam {

namespace {

/// A picture of its own, for the time of one drawing.
class ItemSurface : public Surface {
  public:
    ItemSurface(QSize size, const QColor& ground) : image_(size, QImage::Format_RGB32) {
        image_.fill(ground);
    }

    ~ItemSurface() override {
        dropSurface(*this);
    }

    PixelView pixels() override {
        return {reinterpret_cast<DWORD*>(image_.bits()), image_.width(), image_.height(),
                static_cast<int>(image_.bytesPerLine() / 4)};
    }

    void touch(const RECT& /*area*/) override {}

    const QImage& image() const {
        return image_;
    }

  private:
    QImage image_;
};

} // namespace

void paintItem(QPainter& painter, const QRect& place, const QColor& ground, const DrawnItem& item) {
    const Window* control = findWindow(item.control);
    if (control == nullptr || place.isEmpty()) {
        return;
    }
    ItemSurface surface(place.size(), ground);
    const RECT area{0, 0, place.width(), place.height()};
    const HDC dc = makeSurfaceContext(surface, area);
    const DRAWITEMSTRUCT drawing{item.kind,  static_cast<UINT>(control->id),
                                 item.item,  ODA_DRAWENTIRE,
                                 item.state, item.control,
                                 dc,         area,
                                 item.data};
    SendMessageA(control->parent, WM_DRAWITEM, static_cast<WPARAM>(control->id),
                 reinterpret_cast<LPARAM>(&drawing));
    DeleteDC(dc);
    painter.drawImage(place.topLeft(), surface.image());
}

} // namespace seam
