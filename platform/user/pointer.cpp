// The pointer, its shape and the screen's size.
#include "platform/user.h"
#include "platform/user/cursors.h"
#include "platform/user/frame_window.h"
#include "platform/user/native_window.h"
#include "platform/user/queue.h"
#include "platform/user/scale.h"
#include "platform/user/screens.h"
#include "platform/user/toolkit.h"
#include "platform/user/window.h"

#include <QCursor>
#include <QGuiApplication>
#include <QPixmap>
#include <QResource>
#include <QScreen>
#include <QtEndian>

#include <algorithm>
#include <optional>
#include <vector>

namespace seam {

namespace {

HCURSOR current{IDC_ARROW.number};
int displayCount = 0;
int boxes = 0; // how many are up

/// A cursor of the program file. Its handle is one more than its place in the list.
struct OwnCursor {
    QString file;
    QCursor cursor;
};

/// Those asked for so far. Never freed, like the application object.
std::vector<OwnCursor>& ownCursors() {
    static auto* const cursors = new std::vector<OwnCursor>;
    return *cursors;
}

/// The first picture in a cursor's file, which begins with 6 bytes and for each picture 16 more:
/// the hot spot stands in bytes 4 to 7 of these.
std::optional<QCursor> readCursor(const QString& path) {
    constexpr qsizetype hotSpotAt = 6 + 4;
    const QByteArray file = QResource(path).uncompressedData();
    QPixmap picture;
    if (file.size() < hotSpotAt + 4 || !picture.loadFromData(file)) {
        return std::nullopt;
    }
    const auto number = [&](qsizetype at) {
        return qFromLittleEndian<quint16>(file.constData() + hotSpotAt + at);
    };
    // The toolkit leaves the pixels of a pointer's picture as they are.
    const int scale = primaryScale();
    return QCursor(picture.scaled(picture.size() * scale), number(0) * scale, number(2) * scale);
}

HCURSOR loadOwn(const char* name) {
    const QString file = QStringLiteral(":/cursor/") + QString::fromLatin1(name).toLower();
    std::vector<OwnCursor>& known = ownCursors();
    auto found = std::find_if(known.begin(), known.end(),
                              [&](const OwnCursor& cursor) { return cursor.file == file; });
    if (found == known.end()) {
        const auto cursor = toolkit() ? readCursor(file) : std::nullopt;
        if (!cursor) {
            return {};
        }
        found = known.insert(known.end(), {file, *cursor});
    }
    return HCURSOR{static_cast<DWORD>(found - known.begin()) + 1};
}

QCursor cursorInForce() {
    if (boxes > 0) {
        return Qt::ArrowCursor;
    }
    if (!current || displayCount < 0) {
        return Qt::BlankCursor;
    }
    if (current.number <= ownCursors().size()) {
        return ownCursors()[current.number - 1].cursor;
    }
    return current.number == IDC_WAIT.number ? Qt::WaitCursor : Qt::ArrowCursor;
}

void applyToAll() {
    if (qGuiApp == nullptr) {
        return; // there is no window yet
    }
    const QCursor cursor = cursorInForce();
    forEachWindow([&](Window& window) {
        if (window.frame) {
            window.frame->setCursor(cursor);
        } else if (window.native) {
            applyCursor(*window.native);
        }
    });
    if (QWindow* cover = screenCover()) {
        applyCursor(*cover);
    }
}

} // namespace

void applyCursor(QWindow& window) {
    const QCursor cursor = cursorInForce();
    if (window.cursor() != cursor) {
        window.setCursor(cursor);
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
    if (instance) {
        return name.text != nullptr ? loadOwn(name.text) : HCURSOR{};
    }
    const bool known = name.number == IDC_ARROW.number || name.number == IDC_WAIT.number;
    return known ? HCURSOR{name.number} : HCURSOR{};
}

BOOL DestroyCursor(HCURSOR cursor) {
    return cursor ? TRUE : FALSE;
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
    const QPoint at = QPoint(x, y) + screenOrigin();
    QCursor::setPos(at);
    // The X server tells of a move only where there is one.
    HWND under;
    forEachWindow([&](const Window& window) {
        const QWindow* native = window.picture() != nullptr ? toolkitWindow(window) : nullptr;
        const bool inside = native != nullptr && window.visible &&
                            QRect(QPoint(), native->size()).contains(native->mapFromGlobal(at));
        under = inside && (!under || window.parent == under) ? window.handle : under;
    });
    POINT inWindow{x, y};
    if (ScreenToClient(under, &inWindow) != FALSE) {
        queueInput(
            {under, WM_MOUSEMOVE, 0, static_cast<LPARAM>(MAKELONG(inWindow.x, inWindow.y)), 0});
    }
    return TRUE;
}

int GetSystemMetrics(int index) {
    if (index == SM_CXBORDER || index == SM_CYBORDER) {
        return FrameWindow::border;
    }
    if ((index != SM_CXSCREEN && index != SM_CYSCREEN) || !toolkit()) {
        return 0;
    }
    const QSize size = QGuiApplication::primaryScreen()->geometry().size();
    return index == SM_CXSCREEN ? size.width() : size.height();
}
