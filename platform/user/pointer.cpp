// The pointer, its shape and the screen's size.
#include "platform/user.h"
#include "platform/user/cursors.h"
#include "platform/user/native_window.h"
#include "platform/user/screens.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QCursor>
#include <QGuiApplication>
#include <QScreen>

namespace seam {

namespace {

HCURSOR current{IDC_ARROW.number};
int displayCount = 0;
int boxes = 0; // how many are up

Qt::CursorShape shapeInForce() {
    if (boxes > 0) {
        return Qt::ArrowCursor;
    }
    if (!current || displayCount < 0) {
        return Qt::BlankCursor;
    }
    return current.number == IDC_WAIT.number ? Qt::WaitCursor : Qt::ArrowCursor;
}

void applyToAll() {
    forEachWindow([](Window& window) {
        if (window.native) {
            applyCursor(*window.native);
        }
    });
    if (QWindow* cover = screenCover()) {
        applyCursor(*cover);
    }
}

} // namespace

void applyCursor(QWindow& window) {
    const Qt::CursorShape shape = shapeInForce();
    if (window.cursor().shape() != shape) {
        window.setCursor(shape);
    }
}

BoxPointer::BoxPointer() {
    ++boxes;
    applyToAll();
}

BoxPointer::~BoxPointer() {
    --boxes;
    applyToAll();
}

} // namespace seam

using namespace seam;

HCURSOR LoadCursorA(HINSTANCE instance, ResourceName name) {
    const bool known = name.number == IDC_ARROW.number || name.number == IDC_WAIT.number;
    return !instance && known ? HCURSOR{name.number} : HCURSOR{};
}

HCURSOR SetCursor(HCURSOR cursor) {
    const HCURSOR before = current;
    current = cursor;
    if (before != cursor) {
        applyToAll();
    }
    return before;
}

int ShowCursor(BOOL show) {
    displayCount += show != FALSE ? 1 : -1;
    applyToAll();
    return displayCount;
}

BOOL GetCursorPos(POINT* point) {
    if (!toolkit()) {
        return FALSE;
    }
    const QPoint at = QCursor::pos() - screenOrigin();
    *point = {at.x(), at.y()};
    return TRUE;
}

BOOL SetCursorPos(int x, int y) {
    if (!toolkit()) {
        return FALSE;
    }
    QCursor::setPos(QPoint(x, y) + screenOrigin());
    return TRUE;
}

int GetSystemMetrics(int index) {
    if ((index != SM_CXSCREEN && index != SM_CYSCREEN) || !toolkit()) {
        return 0;
    }
    const QSize size = QGuiApplication::primaryScreen()->geometry().size();
    return index == SM_CXSCREEN ? size.width() : size.height();
}
