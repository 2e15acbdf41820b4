#include "tests/fuzz/user.h"

#include "editor/editor_shell.h"
#include "platform/harness.h"
#include "platform/user/queue.h"
#include "tests/fuzz/fuzz.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QTest>
#include <QWheelEvent>
#include <QWindow>

#include <algorithm>
#include <array>
#include <vector>

namespace fuzz {

namespace {

constexpr int shortestPatience = 4; // turns: a key has to find its way to its field
constexpr int longestPatience = 64; // turns: what waits for a box to end would wait for ever
constexpr int longestLeave = 5000;  // turns

constexpr std::array namedKeys{
    Qt::Key_Tab,      Qt::Key_Backtab,   Qt::Key_Return, Qt::Key_Enter, Qt::Key_Escape,
    Qt::Key_Space,    Qt::Key_Backspace, Qt::Key_Delete, Qt::Key_Left,  Qt::Key_Right,
    Qt::Key_Up,       Qt::Key_Down,      Qt::Key_Home,   Qt::Key_End,   Qt::Key_PageUp,
    Qt::Key_PageDown, Qt::Key_F10,       Qt::Key_F4,     Qt::Key_F1,    Qt::Key_Menu,
};

int keyOf(std::uint8_t letter) {
    return QChar(char16_t{letter}).toUpper().unicode();
}

int timestamp = 0; // of the last click, in ms

QWindow* frontWindow() {
    if (const QWidget* popup = QApplication::activePopupWidget()) {
        return popup->windowHandle();
    }
    if (QWindow* focused = QGuiApplication::focusWindow()) {
        return focused;
    }
    const QWidget* modal = QApplication::activeModalWidget();
    return modal != nullptr ? modal->windowHandle() : nullptr;
}

/// The window at a place of another, which may be one that lies in it.
QWindow* windowAt(QWindow* window, QPoint& place) {
    for (QObject* child : window->children()) {
        auto* inner = qobject_cast<QWindow*>(child);
        if (inner != nullptr && inner->isVisible() && inner->geometry().contains(place)) {
            place -= inner->position();
            return windowAt(inner, place);
        }
    }
    return window;
}

void mouse(QWindow* window, QPoint place, QEvent::Type type, Qt::MouseButton button) {
    window = windowAt(window, place);
    const Qt::MouseButtons held =
        type == QEvent::MouseButtonPress ? Qt::MouseButtons(button) : Qt::NoButton;
    qt_handleMouseEvent(window, place, window->mapToGlobal(place), held,
                        type == QEvent::MouseMove ? Qt::NoButton : button, type, Qt::NoModifier,
                        ++timestamp);
}

void click(QWindow* window, QPoint place, Qt::MouseButton button, bool twice) {
    constexpr int longAgo = 10'000; // ms, so that two clicks are no double-click
    timestamp += longAgo;
    mouse(window, place, QEvent::MouseMove, button);
    for (int i = 0; i < (twice ? 2 : 1); ++i) {
        mouse(window, place, QEvent::MouseButtonPress, button);
        mouse(window, place, QEvent::MouseButtonRelease, button);
    }
}

/// What can be clicked or filled in the window in front.
std::vector<QWidget*> fieldsInFront() {
    const QWidget* popup = QApplication::activePopupWidget();
    const QWidget* front = popup != nullptr ? popup : QApplication::activeWindow();
    std::vector<QWidget*> found;
    for (QWidget* field : front == nullptr ? QList<QWidget*>() : front->findChildren<QWidget*>()) {
        if (field->isVisible() && field->isEnabled() && field->window() == front &&
            (field->focusPolicy() != Qt::NoFocus || qobject_cast<QAbstractButton*>(field))) {
            found.push_back(field);
        }
    }
    return found;
}

std::vector<QWindow*> visibleWindows() {
    std::vector<QWindow*> found;
    for (QWindow* window : QGuiApplication::topLevelWindows()) {
        if (window->isVisible()) {
            found.push_back(window);
        }
    }
    return found;
}

} // namespace

User::User(std::string_view bytes, std::filesystem::path files, const Place& place)
    : bytes_(bytes), files_(std::move(files)), place_(place) {
    turnBoxes();
    seam::answerFileDialogs([this](const std::string&) { return chooseFile(); });
    timer_.setSingleShot(true); // a repeating one starves while its own slot runs a loop
    QObject::connect(&timer_, &QTimer::timeout, [this] { goOn(); });
    timer_.start(0);
}

User::~User() {
    seam::answerBoxes(nullptr);
    seam::answerFileDialogs(nullptr);
}

std::uint8_t User::next() {
    if (bytes_.empty()) {
        return 0;
    }
    const auto byte = static_cast<std::uint8_t>(bytes_.front());
    bytes_.remove_prefix(1);
    return byte;
}

/// Whether something of what he did may still wait, or no window has come to the front yet.
bool User::programIsBusy() {
    ++patience_;
    return patience_ < shortestPatience ||
           (patience_ < longestPatience && (seam::messagesWait() || frontWindow() == nullptr));
}

void User::goOn() {
    timer_.start(0); // first: what he does may run a loop of the program's
    if (haste_ == 0 && programIsBusy()) {
        return;
    }
    patience_ = 0;
    if (place_.check && !seam::messagesWait() && !seam::toolkitLoopIsInnermost() &&
        QApplication::activeModalWidget() == nullptr) {
        place_.check();
    }
    if (pause_ > 0) {
        --pause_;
    } else if (!bytes_.empty()) {
        haste_ = std::max(haste_ - 1, 0);
        act();
    } else {
        leave();
    }
}

void User::act() {
    const std::uint8_t what = next();
    switch (what) {
    case '^':
        pressKey(keyOf(next()), Qt::ControlModifier, {});
        return;
    case '!':
        pressKey(keyOf(next()), Qt::AltModifier, {});
        return;
    case '~':
        pressNamed(next(), Qt::ShiftModifier);
        return;
    case '\\':
        pressNamed(next(), Qt::NoModifier);
        return;
    case '.':
        pause_ = next();
        return;
    case '=':
        haste_ = next() % 8;
        return;
    case '-':
        otherProgram();
        return;
    case '+':
        turnBoxes();
        return;
    default:
        if (!point(what)) {
            pressKey(keyOf(what), Qt::NoModifier, QString(QChar(char16_t{what})));
        }
    }
}

/// What is done with the mouse; false if that is nothing of it.
bool User::point(std::uint8_t what) {
    switch (what) {
    case '@':
        clickPlace(Qt::LeftButton);
        return true;
    case ':':
        clickPlace(Qt::RightButton);
        return true;
    case '#':
    case '"':
        clickField(what == '"');
        return true;
    case '&':
        drag();
        return true;
    case '%':
        clickWindow();
        return true;
    case '*':
        turnWheel();
        return true;
    case '<':
        if (QWindow* front = frontWindow()) {
            front->close();
        }
        return true;
    default:
        return false;
    }
}

void User::pressKey(int key, Qt::KeyboardModifiers held, const QString& text) {
    if (QWindow* front = frontWindow()) {
        qt_handleKeyEvent(front, QEvent::KeyPress, key, held, text);
        qt_handleKeyEvent(front, QEvent::KeyRelease, key, held, text);
    }
}

void User::pressNamed(std::uint8_t which, Qt::KeyboardModifiers held) {
    const std::size_t place = static_cast<std::size_t>(which < 'a' ? which : which - 'a');
    const Qt::Key key = namedKeys[place % namedKeys.size()];
    const bool line = key == Qt::Key_Return || key == Qt::Key_Enter;
    pressKey(key, held,
             line                   ? QStringLiteral("\r")
             : key == Qt::Key_Space ? QStringLiteral(" ")
                                    : QString());
}

void User::clickPlace(Qt::MouseButton button) {
    const int x = next();
    const int y = next();
    if (QWindow* front = frontWindow()) {
        click(front, {front->width() * x / 256, front->height() * y / 256}, button, false);
    }
}

void User::clickField(bool twice) {
    const std::size_t which = next();
    const std::vector<QWidget*> fields = fieldsInFront();
    if (!fields.empty()) {
        QWidget* field = fields[which % fields.size()];
        QWidget* window = field->window();
        click(window->windowHandle(), field->mapTo(window, field->rect().center()), Qt::LeftButton,
              twice);
    }
}

void User::drag() {
    const int corner[] = {next(), next(), next(), next()};
    if (QWindow* front = frontWindow()) {
        const auto at = [&](int x, int y) {
            return QPoint(front->width() * x / 256, front->height() * y / 256);
        };
        mouse(front, at(corner[0], corner[1]), QEvent::MouseButtonPress, Qt::LeftButton);
        mouse(front, at(corner[2], corner[3]), QEvent::MouseMove, Qt::LeftButton);
        mouse(front, at(corner[2], corner[3]), QEvent::MouseButtonRelease, Qt::LeftButton);
    }
}

void User::clickWindow() {
    const std::size_t which = next();
    const std::vector<QWindow*> windows = visibleWindows();
    if (!windows.empty()) {
        QWindow* window = windows[which % windows.size()];
        click(window, {window->width() / 2, window->height() / 2}, Qt::LeftButton, false);
    }
}

void User::turnWheel() {
    constexpr int notch = 120;
    const int turn = next() % 2 == 0 ? notch : -notch;
    if (QWindow* front = frontWindow()) {
        const QPoint place(front->width() / 2, front->height() / 2);
        QWheelEvent event(place, front->mapToGlobal(place), {}, QPoint(0, turn), Qt::NoButton,
                          Qt::NoModifier, Qt::NoScrollPhase, false);
        QCoreApplication::sendEvent(front, &event);
    }
}

void User::otherProgram() {
    const std::uint8_t what = next() % 4;
    if (EditorMainWindow && what < 2) {
        seam::minimise(EditorMainWindow, what == 0);
    } else if (EditorMainWindow) {
        PostMessageA(EditorMainWindow, WM_ACTIVATE, what == 2 ? WA_INACTIVE : WA_ACTIVE, 0);
    }
}

void User::turnBoxes() {
    realBoxes_ = !realBoxes_;
    if (realBoxes_) {
        seam::answerBoxes(nullptr);
        return;
    }
    seam::answerBoxes([this](const std::string&, const std::string&, UINT type) {
        constexpr std::array answers{IDYES, IDNO, IDCANCEL};
        return (type & MB_YESNOCANCEL) == MB_YESNOCANCEL ? answers[next() % answers.size()] : IDOK;
    });
}

/// Closes what is in front; the place sees to the program's own windows.
void User::leave() {
    demand(++leaving_ < longestLeave); // the program can be left
    if (QWidget* popup = QApplication::activePopupWidget()) {
        popup->close();
        return;
    }
    auto* box = qobject_cast<QDialog*>(QApplication::activeModalWidget());
    if (box != nullptr && seam::toolkitLoopIsInnermost()) {
        box->reject();
        return;
    }
    place_.close();
}

/// In the platform's form. Files that are there, and some that aren't.
std::optional<std::string> User::chooseFile() {
    static const std::vector<std::string> names{"two.zkt",
                                                "one.zkt",
                                                "still.zkt",
                                                "none.zkt",
                                                "locked.zkt",
                                                "new.zkt",
                                                "other",
                                                "no/such/place.zkt",
                                                "Sub",
                                                "Sub/deep.zkt",
                                                std::string(251, 'x'),
                                                "high.zkt",
                                                "low.zkt"};
    const std::size_t which = next();
    const std::size_t place = which >= '0' ? which - '0' : which;
    if (place % (names.size() + 1) == names.size()) {
        return std::nullopt;
    }
    std::string path = "C:" + (files_ / names[place % (names.size() + 1)]).native();
    std::ranges::replace(path, '/', '\\');
    return path;
}

} // namespace fuzz
