#include "platform/user/queue.h"

#include "platform/harness.h"
#include "platform/user/accelerators.h"
#include "platform/user/clock.h"
#include "platform/user/ending.h"
#include "platform/user/ordered_input.h"
#include "platform/user/overlay.h"
#include "platform/user/timers.h"
#include "platform/user/toolkit.h"
#include "platform/user/waker.h"
#include "platform/user/window.h"
#include "platform/user/window_picture.h"

#include <QCoreApplication>
#include <QThread>

#include <chrono>
#include <deque>
#include <exception>
#include <thread>
#include <utility>

namespace seam {

namespace {

std::deque<MSG> posted;
std::deque<MSG> input;
bool quitAsked = false;
int quitCode = 0;

/// How many loops of the toolkit ran when one of the program's own last took a message.
int ownLevel = 0;

/// What a handler threw within a loop of the toolkit's.
std::exception_ptr thrown;

/// How many messages are handled at one go while a loop of the toolkit is innermost.
constexpr int batch = 32;

/// Which messages a loop asks for.
struct Filter {
    HWND window;
    UINT lowest = 0;
    UINT highest = 0;
    UINT except = 0; // a message that is left where it is

    bool takes(UINT message) const {
        return (lowest == 0 && highest == 0) || (message >= lowest && message <= highest);
    }

    bool takes(const MSG& message) const {
        return (!window || message.hwnd == window) && takes(message.message) &&
               (except == 0 || message.message != except);
    }
};

int toolkitLevel() {
    return QThread::currentThread()->loopLevel();
}

DWORD messageTime() {
    return static_cast<DWORD>(clockNow());
}

bool takeFrom(std::deque<MSG>& queue, const Filter& filter, bool remove, MSG& message) {
    for (auto it = queue.begin(); it != queue.end(); ++it) {
        if (filter.takes(*it)) {
            message = *it;
            if (remove) {
                queue.erase(it);
            }
            return true;
        }
    }
    return false;
}

bool takeQuit(const Filter& filter, bool remove, MSG& message) {
    if (!quitAsked || !filter.takes(WM_QUIT) || filter.except == WM_QUIT) {
        return false;
    }
    message = {HWND{}, WM_QUIT, static_cast<WPARAM>(quitCode), 0, messageTime()};
    quitAsked = !remove;
    return true;
}

bool takePaint(const Filter& filter, MSG& message) {
    HWND found;
    forEachWindow([&](Window& window) {
        if (!found && window.paintNeeded && window.visible && !window.dying &&
            (!filter.window || filter.window == window.handle)) {
            found = window.handle;
        }
    });
    if (!found || !filter.takes(WM_PAINT)) {
        return false;
    }
    message = {found, WM_PAINT, 0, 0, messageTime()};
    return true;
}

bool takeTimer(const Filter& filter, bool remove, MSG& message) {
    if (!filter.takes(WM_TIMER)) {
        return false;
    }
    const auto due = dueTimer(filter.window, !filter.window);
    if (!due) {
        return false;
    }
    if (remove) {
        timerTaken(*due);
    }
    message = {due->window, WM_TIMER, due->id, 0, messageTime()};
    return true;
}

bool take(const Filter& filter, bool remove, MSG& message) {
    return takeFrom(posted, filter, remove, message) || takeQuit(filter, remove, message) ||
           takeFrom(input, filter, remove, message) || takePaint(filter, message) ||
           takeTimer(filter, remove, message);
}

/// Lets the toolkit queue what has come in; it hands nothing to the program from here.
void pump() {
    ownLevel = toolkitLevel();
    flushWindows();
    QCoreApplication::processEvents();
    while (!messagesWait() && handOverInput()) {
    }
}

/// Sleeps until the toolkit has something or a timer is due, or moves the clock there.
void waitForMore() {
    const auto deadline = nextDeadline();
    if (clockIsManual() && deadline) {
        moveClock(*deadline);
        return;
    }
    armWaker(deadline);
    QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
}

void waitFor(const Filter& filter, MSG& message) {
    for (;;) {
        pump();
        if (take(filter, true, message)) {
            return;
        }
        waitForMore();
    }
}

/// What the toolkit's own loop can't do for us: posted messages, paints and timers. Input waits
/// until the box has been answered, and so does a request to close what lies under it.
bool takeWithinToolkitLoop(MSG& message) {
    const Filter all;
    Filter withoutClose;
    withoutClose.except = boxIsUp() ? WM_CLOSE : 0;
    return takeFrom(posted, withoutClose, true, message) || takePaint(all, message) ||
           takeTimer(all, true, message);
}

/// Whether a message of this kind waits for the window.
bool waits(HWND window, UINT message) {
    MSG found{};
    return takeFrom(posted, {window, message, message}, false, found);
}

/// The toolkit's loops can't pass an exception on: it is kept until the loop has ended.
void dispatchWithinToolkitLoop(const MSG& message) {
    try {
        DispatchMessageA(&message);
    } catch (...) {
        thrown = std::current_exception();
    }
}

} // namespace

void rethrowFromToolkitLoop() {
    if (thrown) {
        std::rethrow_exception(std::exchange(thrown, nullptr));
    }
}

bool messagesWait() {
    return !posted.empty() || !input.empty();
}

bool toolkitLoopIsInnermost() {
    return QCoreApplication::instance() != nullptr && toolkitLevel() > ownLevel;
}

void drainWithinToolkitLoop() {
    if (!toolkitLoopIsInnermost()) {
        return;
    }
    const int level = ownLevel; // a handler may run a loop of the program's, which sets it
    while (!toolkitLoopIsOver() &&
           handOverInput()) { // in the order in which this loop would have had it
    }
    MSG message{};
    int handled = 0;
    while (handled < batch && !thrown && takeWithinToolkitLoop(message)) {
        dispatchWithinToolkitLoop(message);
        ownLevel = level;
        ++handled;
    }
    flushWindows();
    if (quitAsked || thrown) {
        rejectToolkitModal();
    }
    auto deadline = nextDeadline();
    if (clockIsManual() && handled == 0 && deadline) {
        moveClock(*deadline);
    }
    const bool ending = quitAsked || thrown; // one box or menu at a time
    const bool again = handled == batch || ending || (clockIsManual() && deadline);
    armWaker(again ? clockNow() : deadline);
}

void queuePosted(const MSG& message) {
    if (message.message == WM_CLOSE && waits(message.hwnd, WM_CLOSE)) {
        return; // a window closes once
    }
    posted.push_back(message);
    posted.back().time = messageTime();
    wake();
}

void queueInput(const MSG& message) {
    if (message.message == WM_MOUSEMOVE && !input.empty() && input.back().message == WM_MOUSEMOVE &&
        input.back().hwnd == message.hwnd) {
        input.pop_back(); // only where the pointer is now matters
    }
    if (message.message == WM_ACTIVATEAPP) {
        // A loss that was over before it could be told of is none.
        std::erase_if(input, [&](const MSG& waiting) {
            return waiting.message == WM_ACTIVATEAPP && waiting.hwnd == message.hwnd;
        });
    }
    input.push_back(message);
    input.back().time = messageTime();
    wake();
}

void forgetMessagesOf(HWND window) {
    const auto ofWindow = [window](const MSG& message) { return message.hwnd == window; };
    std::erase_if(posted, ofWindow);
    std::erase_if(input, ofWindow);
}

void wake() {
    if (toolkitLoopIsInnermost()) {
        wakeToolkitLoop();
    }
}

void flushWindows() {
    forEachWindow([](Window& window) {
        if (WindowPicture* picture = window.picture()) {
            picture->tellWatcher();
            picture->flush();
        }
    });
}

void waitForMessage(MSG& message) {
    const InnerDepth withoutTable; // a dialog's keys are the toolkit's
    Filter withoutQuit;
    withoutQuit.except = WM_QUIT;
    waitFor(withoutQuit, message);
}

bool runUntil(std::int64_t milliseconds) {
    const InnerDepth withoutTable;
    MSG message{};
    for (;;) {
        pump();
        if (take({}, true, message)) {
            if (message.message == WM_QUIT) {
                return false;
            }
            DispatchMessageA(&message);
            continue;
        }
        const auto deadline = nextDeadline();
        moveClock(deadline && *deadline < milliseconds ? *deadline : milliseconds);
        if (!deadline || *deadline > milliseconds) {
            flushWindows();
            return true;
        }
    }
}

} // namespace seam

using namespace seam;

BOOL GetMessageA(MSG* message, HWND window, UINT lowest, UINT highest) {
    if (message == nullptr || window || lowest != 0 || highest != 0 || !toolkit()) {
        return FALSE;
    }
    endWindowsAtExit();
    loopAsksForMessage();
    waitFor({}, *message);
    return message->message != WM_QUIT ? TRUE : FALSE;
}

BOOL PeekMessageA(MSG* message, HWND window, UINT lowest, UINT highest, UINT remove) {
    if (message == nullptr || !toolkit()) {
        return FALSE;
    }
    pump();
    return take({window, lowest, highest}, (remove & PM_REMOVE) != 0, *message) ? TRUE : FALSE;
}

BOOL TranslateMessage(const MSG* /*message*/) {
    return FALSE;
}

static bool isMouseMessage(UINT message) {
    return message >= WM_MOUSEMOVE && message <= WM_MBUTTONUP;
}

/// What the window says of the place where the mouse is; it also sets the pointer's shape there.
static LRESULT hitTest(const MSG& message) {
    POINT corner{0, 0};
    ScreenToClient(message.hwnd, &corner);
    const auto at = static_cast<DWORD>(message.lParam);
    const auto x = static_cast<std::int16_t>(LOWORD(at)) - corner.x;
    const auto y = static_cast<std::int16_t>(HIWORD(at)) - corner.y;
    const LRESULT hit =
        SendMessageA(message.hwnd, WM_NCHITTEST, 0, static_cast<LPARAM>(MAKELONG(x, y)));
    SendMessageA(
        message.hwnd, WM_SETCURSOR, message.hwnd.number,
        static_cast<LPARAM>(MAKELONG(static_cast<LONG>(hit), static_cast<LONG>(message.message))));
    return hit;
}

LRESULT DispatchMessageA(const MSG* message) {
    if (findWindow(message->hwnd) == nullptr) {
        return 0;
    }
    const InnerDepth inner;
    if (message->message == WM_COMMAND && isDisabled(message->hwnd)) {
        return 0; // what the user did before a dialog came up over the window
    }
    if (message->message == WM_TIMER) {
        traceTick(message->wParam);
    } else if (isMouseMessage(message->message)) {
        const LRESULT hit = hitTest(*message);
        if (hit != HTCLIENT) {
            return hit == HTCAPTION && message->message == WM_LBUTTONDOWN
                       ? SendMessageA(message->hwnd, WM_NCLBUTTONDOWN, HTCAPTION, 0)
                       : 0;
        }
    }
    return SendMessageA(message->hwnd, message->message, message->wParam, message->lParam);
}

LRESULT SendMessageA(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    const Window* found = findWindow(window);
    return found == nullptr ? 0 : found->windowClass->procedure(window, message, wParam, lParam);
}

BOOL PostMessageA(HWND window, UINT message, WPARAM wParam, LPARAM lParam) {
    if (findWindow(window) == nullptr) {
        const bool passedOn =
            message == WM_CLOSE || message == WM_HELP || message == WM_CONTEXTMENU;
        return passedOn && IsWindow(window) ? TRUE : FALSE; // it has no queue of ours
    }
    queuePosted({window, message, wParam, lParam, 0});
    return TRUE;
}

void PostQuitMessage(int exitCode) {
    quitAsked = true;
    quitCode = exitCode;
    wake();
}

void Sleep(DWORD milliseconds) {
    if (clockIsManual()) {
        moveClock(clockNow() + milliseconds);
    } else if (milliseconds == 0) {
        std::this_thread::yield();
    } else {
        std::this_thread::sleep_for(std::chrono::milliseconds(milliseconds));
    }
}
