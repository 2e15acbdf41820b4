#include "platform/user/ordered_input.h"

#include "platform/user/queue.h"

#include <QKeyEvent>
#include <QPointer>
#include <QWidget>
#include <QWindow>

#include <deque>
#include <memory>

/// Looks a key up among the shortcuts and underlined letters, as the toolkit does before a window
/// gets it. The toolkit exports it for the inline functions of its own test header, which declares
/// it with these words; they hold for all of its sixth version.
Q_GUI_EXPORT bool qt_sendShortcutOverrideEvent(QObject* receiver, ulong timestamp, int key,
                                               Qt::KeyboardModifiers modifiers, const QString& text,
                                               bool autoRepeat, ushort count);

namespace seam {

namespace {

struct WaitingEvent {
    QPointer<QWindow> window;
    std::unique_ptr<QEvent> event;
};

/// Never freed, like the application object.
std::deque<WaitingEvent>& waiting() {
    static auto* const events = new std::deque<WaitingEvent>;
    return *events;
}

bool isKey(const QEvent& event) {
    return event.type() == QEvent::KeyPress || event.type() == QEvent::KeyRelease;
}

bool isButton(const QEvent& event) {
    return event.type() == QEvent::MouseButtonPress ||
           event.type() == QEvent::MouseButtonDblClick ||
           event.type() == QEvent::MouseButtonRelease || event.type() == QEvent::Wheel;
}

/// Whether something that came before this has yet to be seen to.
bool isBehind() {
    return !toolkitLoopIsInnermost() && (!waiting().empty() || messagesWait());
}

/// A move waits only so that it doesn't overtake a button.
bool hasToWait(const QEvent& event) {
    const bool move = event.type() == QEvent::MouseMove && !waiting().empty();
    return (isKey(event) || isButton(event) || move) && isBehind();
}

/// The window that a key is for by now. A box that has just come up may not have the keyboard yet,
/// but nobody else gets a key meanwhile.
QWindow* keyWindow() {
    const QWidget* box = QApplication::activeModalWidget();
    return box != nullptr ? box->windowHandle() : QGuiApplication::focusWindow();
}

/// Whether an underlined letter or a shortcut took the key.
bool takenAsShortcut(QWindow& window, const QKeyEvent& key) {
    return key.type() == QEvent::KeyPress &&
           qt_sendShortcutOverrideEvent(&window, key.timestamp(), key.key(), key.modifiers(),
                                        key.text(), key.isAutoRepeat(),
                                        static_cast<ushort>(key.count()));
}

/// Not sendEvent: fields take the focus only for what the user himself did.
void handOver(QWindow& window, QEvent& event) {
    qApp->QApplication::notify(&window, &event);
}

} // namespace

bool OrderedApplication::notify(QObject* receiver, QEvent* event) {
    if (!event->spontaneous() || !receiver->isWindowType()) {
        return QApplication::notify(receiver, event);
    }
    if (event->type() == QEvent::ShortcutOverride && isBehind()) {
        event->accept(); // the press itself comes next
        return true;
    }
    if (hasToWait(*event)) {
        waiting().push_back(
            {static_cast<QWindow*>(receiver), std::unique_ptr<QEvent>(event->clone())});
        return true;
    }
    return QApplication::notify(receiver, event);
}

bool handOverInput() {
    if (waiting().empty()) {
        return false;
    }
    const WaitingEvent next = std::move(waiting().front());
    waiting().pop_front();
    const bool key = isKey(*next.event);
    QWindow* const wanted = key ? keyWindow() : nullptr;
    QWindow* const window = wanted != nullptr ? wanted : next.window.data();
    if (window != nullptr && window->isVisible() &&
        !(key && takenAsShortcut(*window, static_cast<QKeyEvent&>(*next.event)))) {
        handOver(*window, *next.event);
    }
    return true;
}

} // namespace seam
