#include "tests/fuzz/user.h"

#include "cli/replay.h"
#include "editor/editor_shell.h"
#include "platform/user/queue.h"
#include "saver/saver_main.h"
#include "saver/toon_player.h"
#include "stage/backdrop.h"
#include "tests/fuzz/fuzz.h"
#include "tests/fuzz/ground.h"

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QTest>
#include <QTimer>
#include <QWheelEvent>
#include <QWindow>

#include <algorithm>
#include <array>
#include <map>
#include <optional>

namespace fuzz {

namespace {

/// What the user hasn't done yet, and how he goes about it.
struct {
    std::string_view bytes;
    int pause = 0;    // turns to let pass
    int haste = 0;    // things to do without waiting
    int patience = 0; // turns that the program has had for what waits
    int leaving = 0;  // turns
    bool realBoxes = true;
} user;

std::uint8_t next() {
    if (user.bytes.empty()) {
        return 0;
    }
    const auto byte = static_cast<std::uint8_t>(user.bytes.front());
    user.bytes.remove_prefix(1);
    return byte;
}

/// The one that the next byte stands for.
template <typename List>
typename List::value_type nextOf(const List& list, int first = 0) {
    const int place = next();
    const int from = place < first ? place : place - first;
    return list.empty() ? typename List::value_type{}
                        : *(list.begin() + from % static_cast<int>(list.size()));
}

// ---- Keys ---------------------------------------------------------------------------------------

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

void pressKey(int key, Qt::KeyboardModifiers held, const QString& text = {}) {
    if (QWindow* front = frontWindow()) {
        qt_handleKeyEvent(front, QEvent::KeyPress, key, held, text);
        qt_handleKeyEvent(front, QEvent::KeyRelease, key, held, text);
    }
}

void pressLetter(std::uint8_t letter, Qt::KeyboardModifiers held) {
    const QChar typed(char16_t{letter});
    pressKey(typed.toUpper().unicode(), held, held == Qt::NoModifier ? QString(typed) : QString());
}

void pressNamed(Qt::KeyboardModifiers held) {
    static constexpr std::array keys{
        Qt::Key_Tab,      Qt::Key_Backtab,   Qt::Key_Return, Qt::Key_Enter, Qt::Key_Escape,
        Qt::Key_Space,    Qt::Key_Backspace, Qt::Key_Delete, Qt::Key_Left,  Qt::Key_Right,
        Qt::Key_Up,       Qt::Key_Down,      Qt::Key_Home,   Qt::Key_End,   Qt::Key_PageUp,
        Qt::Key_PageDown, Qt::Key_F10,       Qt::Key_F4,     Qt::Key_F1,    Qt::Key_Menu,
    };
    const Qt::Key key = nextOf(keys, 'a');
    const bool line = key == Qt::Key_Return || key == Qt::Key_Enter;
    pressKey(key, held, QLatin1String(line ? "\r" : key == Qt::Key_Space ? " " : ""));
}

// ---- Mouse --------------------------------------------------------------------------------------

struct Spot {
    QWindow* window = nullptr; // none: nothing is done there
    QPoint place;
};

/// In the window in front, in its 256ths.
Spot nextSpot() {
    const int x = next();
    const int y = next();
    QWindow* front = frontWindow();
    return front == nullptr ? Spot{}
                            : Spot{front, {front->width() * x / 256, front->height() * y / 256}};
}

/// The same place in a window that lies there in that one, if there is any.
Spot innermost(const Spot& spot) {
    for (QObject* child : spot.window->children()) {
        auto* inner = qobject_cast<QWindow*>(child);
        if (inner != nullptr && inner->isVisible() && inner->geometry().contains(spot.place)) {
            return innermost({inner, spot.place - inner->position()});
        }
    }
    return spot;
}

int timestamp = 0; // of the last event, in ms

void mouse(const Spot& spot, QEvent::Type type, Qt::MouseButton button) {
    if (spot.window != nullptr) {
        const auto [window, place] = innermost(spot);
        const bool down = type == QEvent::MouseButtonPress;
        qt_handleMouseEvent(window, place, window->mapToGlobal(place),
                            down ? Qt::MouseButtons(button) : Qt::NoButton,
                            type == QEvent::MouseMove ? Qt::NoButton : button, type, Qt::NoModifier,
                            ++timestamp);
    }
}

void click(const Spot& spot, Qt::MouseButton button = Qt::LeftButton, int times = 1) {
    constexpr int longAgo = 10'000; // ms, so that two clicks are no double-click
    timestamp += longAgo;
    mouse(spot, QEvent::MouseMove, button);
    for (; times > 0; --times) {
        mouse(spot, QEvent::MouseButtonPress, button);
        mouse(spot, QEvent::MouseButtonRelease, button);
    }
}

void drag() {
    const Spot from = nextSpot();
    const Spot to = nextSpot();
    mouse(from, QEvent::MouseButtonPress, Qt::LeftButton);
    mouse(to, QEvent::MouseMove, Qt::LeftButton);
    mouse(to, QEvent::MouseButtonRelease, Qt::LeftButton);
}

/// On what can be clicked or filled in the window in front.
void clickField(int times) {
    const QWidget* popup = QApplication::activePopupWidget();
    QWidget* front = popup != nullptr ? popup->window() : QApplication::activeWindow();
    QList<QWidget*> fields = front != nullptr ? front->findChildren<QWidget*>() : QList<QWidget*>();
    fields.removeIf([&](const QWidget* field) {
        const bool takes =
            field->focusPolicy() != Qt::NoFocus || qobject_cast<const QAbstractButton*>(field);
        return !takes || !field->isVisible() || !field->isEnabled() || field->window() != front;
    });
    if (const QWidget* field = nextOf(fields)) {
        const QPoint middle = field->mapTo(front, field->rect().center());
        click({front->windowHandle(), middle}, Qt::LeftButton, times);
    }
}

void clickWindow() {
    QWindowList windows = QGuiApplication::topLevelWindows();
    windows.removeIf([](const QWindow* window) { return !window->isVisible(); });
    if (QWindow* window = nextOf(windows)) {
        click({window, {window->width() / 2, window->height() / 2}});
    }
}

void turnWheel() {
    constexpr int notch = 120;
    const int turn = next() % 2 == 0 ? notch : -notch;
    if (QWindow* front = frontWindow()) {
        const QPoint place(front->width() / 2, front->height() / 2);
        QWheelEvent event(place, front->mapToGlobal(place), {}, QPoint(0, turn), Qt::NoButton,
                          Qt::NoModifier, Qt::NoScrollPhase, false);
        QCoreApplication::sendEvent(front, &event);
    }
}

// ---- Windows, boxes and files -------------------------------------------------------------------

void otherProgram() {
    const int what = next() % 4;
    if (EditorMainWindow && what < 2) {
        seam::minimise(EditorMainWindow, what == 0);
    } else if (EditorMainWindow) {
        PostMessageA(EditorMainWindow, WM_ACTIVATE, what == 2 ? WA_INACTIVE : WA_ACTIVE, 0);
    }
}

void turnBoxes() {
    user.realBoxes = !user.realBoxes;
    if (user.realBoxes) {
        seam::answerBoxes(nullptr);
        return;
    }
    seam::answerBoxes([](const std::string&, const std::string&, UINT type) {
        static constexpr std::array answers{IDYES, IDNO, IDCANCEL};
        return (type & MB_YESNOCANCEL) == MB_YESNOCANCEL ? nextOf(answers) : IDOK;
    });
}

/// In the platform's form. Files that are there, and some that aren't.
std::optional<std::string> chooseFile(const std::filesystem::path& toons) {
    static const std::vector<std::optional<std::string>> names{"two.zkt",
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
                                                               "low.zkt",
                                                               std::nullopt};
    std::optional<std::string> path = nextOf(names, '0');
    if (path) {
        path = "C:" + (toons / *path).native();
        std::ranges::replace(*path, '/', '\\');
    }
    return path;
}

/// Closes what is in front, one window each time that it is called.
void leave() {
    constexpr int longestLeave = 5000;
    demand(++user.leaving < longestLeave); // the program can be left
    auto* box = qobject_cast<QDialog*>(QApplication::activeModalWidget());
    if (QWidget* popup = QApplication::activePopupWidget()) {
        popup->close();
    } else if (box != nullptr && seam::toolkitLoopIsInnermost()) {
        box->reject();
    } else {
        const HWND open[] = {PlayerWindow, EditorMainWindow, SaverWindow};
        const HWND* inner =
            std::ranges::find_if(open, [](HWND window) { return IsWindow(window); });
        inner != std::end(open)
            ? PostMessageA(*inner, WM_CLOSE, 0, 0)
            : PostMessageA(FindWindowA("dialog", nullptr), WM_COMMAND, IDCANCEL, 0);
    }
}

// ---- One thing after the other ------------------------------------------------------------------

void act() {
    static const std::map<std::uint8_t, void (*)()> acts{
        {'^', [] { pressLetter(next(), Qt::ControlModifier); }},
        {'!', [] { pressLetter(next(), Qt::AltModifier); }},
        {'~', [] { pressNamed(Qt::ShiftModifier); }},
        {'\\', [] { pressNamed(Qt::NoModifier); }},
        {'@', [] { click(nextSpot()); }},
        {':', [] { click(nextSpot(), Qt::RightButton); }},
        {'#', [] { clickField(1); }},
        {'"', [] { clickField(2); }},
        {'&', drag},
        {'%', clickWindow},
        {'*', turnWheel},
        {'.', [] { user.pause = next(); }},
        {'=', [] { user.haste = next() % 8; }},
        {'-', otherProgram},
        {'<', [] { frontWindow() != nullptr&& frontWindow()->close(); }},
        {'+', turnBoxes},
    };
    const std::uint8_t what = next();
    const auto meant = acts.find(what);
    meant != acts.end() ? meant->second() : pressLetter(what, Qt::NoModifier);
}

/// Whether something of what he did may still wait, or no window has come to the front yet.
bool programIsBusy() {
    constexpr int shortestPatience = 4; // turns: a key has to find its way to its field
    constexpr int longestPatience = 64; // turns: what waits for a box to end would wait for ever
    ++user.patience;
    return user.patience < shortestPatience ||
           (user.patience < longestPatience && (seam::messagesWait() || frontWindow() == nullptr));
}

void goOn() {
    if (user.haste == 0 && programIsBusy()) {
        return;
    }
    user.patience = 0;
    if (!seam::messagesWait() && !seam::toolkitLoopIsInnermost() &&
        QApplication::activeModalWidget() == nullptr) {
        checkFrameEditor();
    }
    if (user.pause > 0) {
        --user.pause;
    } else if (!user.bytes.empty()) {
        user.haste = std::max(user.haste - 1, 0);
        act();
    } else {
        leave();
    }
}

/// Runs the program until he has left, and takes what it then leaves to the next loop.
void useProgram(const std::function<void()>& program) {
    QTimer timer;
    timer.setSingleShot(true); // a repeating one starves while its own slot runs a loop
    QObject::connect(&timer, &QTimer::timeout, [&timer] {
        timer.start(0); // first: what he does may run a loop of the program's
        goOn();
    });
    timer.start(0);
    program();
    seam::answerBoxes(nullptr);
    seam::answerFileDialogs(nullptr);
    timer.stop();
    seam::runUntil(seam::clockNow()); // the quit that a window's end has posted
    DeleteObject(BackdropBitmap);     // the next stage's start would free it
    BackdropBitmap = nullptr;
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
}

} // namespace

void runWithUser(std::string_view bytes, const std::function<void()>& program) {
    const ReplayGround ground;
    beginAnew(ground.toons());
    GetSystemMetrics(SM_CXSCREEN); // makes the toolkit
    const seam::HandleCounts handles = seam::liveHandles();
    const auto widgets = QApplication::topLevelWidgets().size();
    const auto windows = QGuiApplication::topLevelWindows().size();
    user = {bytes};
    turnBoxes();
    seam::answerFileDialogs([&](const std::string&) { return chooseFile(ground.toons()); });
    useProgram(program);
    demand(!prepared || seam::liveHandles() == handles);
    demand(!prepared || QApplication::topLevelWidgets().size() == widgets);
    demand(!prepared || QGuiApplication::topLevelWindows().size() == windows);
    checkToons(ground.toons());
}

} // namespace fuzz
