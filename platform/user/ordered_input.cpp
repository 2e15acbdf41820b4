#include "platform/user/ordered_input.h"

#include "platform/user/activation.h"
#include "platform/user/queue.h"
#include "platform/user/waker.h"

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
    QPointer<QWindow> window; // null for composed text, which goes where the keyboard is
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

/// Whether it goes where the keyboard is.
bool isTyped(const QEvent& event) {
    return isKey(event) || event.type() == QEvent::ShortcutOverride ||
           event.type() == QEvent::InputMethod;
}

bool isClick(const QEvent& event) {
    switch (event.type()) {
    case QEvent::MouseButtonPress:
    case QEvent::MouseButtonDblClick:
    case QEvent::MouseButtonRelease:
    case QEvent::Wheel:
        return true;
    case QEvent::Close:
        return !toolkitLoopIsInnermost(); // a box that has its answer closes by one, too
    case QEvent::MouseMove:
        return !waiting().empty(); // only so that it doesn't overtake a button
    default:
        return false;
    }
}

/// Whether something that came before this has yet to be seen to.
bool isBehind() {
    return !waiting().empty() || (toolkitLoopIsInnermost() ? toolkitLoopIsOver() : messagesWait());
}

bool hasToWait(const QEvent& event) {
    return isTyped(event) ? isBehind() || keyboardIsOnItsWay() : isClick(event) && isBehind();
}

/// Whether the toolkit's box that is up keeps the user from this window. Menus see to theirs.
bool isBarred(const QWindow& window) {
    const QWidget* box = QApplication::activeModalWidget();
    return box != nullptr && box->windowHandle() != &window &&
           QApplication::activePopupWidget() == nullptr;
}

/// Whether an underlined letter or a shortcut took the key.
bool takenAsShortcut(QWindow& window, const QKeyEvent& key) {
    return key.type() == QEvent::KeyPress &&
           qt_sendShortcutOverrideEvent(&window, key.timestamp(), key.key(), key.modifiers(),
                                        key.text(), key.isAutoRepeat(),
                                        static_cast<ushort>(key.count()));
}

/// Not sendEvent: fields take the focus only for what the user himself did.
void handOver(QObject& receiver, QEvent& event) {
    qApp->QApplication::notify(&receiver, &event);
}

void handOverKey(QWindow& window, QKeyEvent& key) {
    if (!takenAsShortcut(window, key)) {
        handOver(window, key);
    }
}

/// Whether it is too soon for a key: a window waits for the keyboard, or the key's own has gone and
/// no other one has the keyboard yet.
bool hasToWaitForKeyboard(const WaitingEvent& next) {
    return isTyped(*next.event) &&
           (keyboardIsOnItsWay() ||
            (next.window.isNull() && QGuiApplication::focusWindow() == nullptr &&
             keyboardMayReturn()));
}

} // namespace

bool OrderedApplication::notify(QObject* receiver, QEvent* event) {
    const bool fromUser =
        (event->spontaneous() && receiver->isWindowType()) || event->type() == QEvent::InputMethod;
    if (!fromUser || !hasToWait(*event)) {
        return QApplication::notify(receiver, event);
    }
    if (event->type() == QEvent::ShortcutOverride) {
        event->accept(); // the press itself comes next
        return true;
    }
    waiting().push_back(
        {qobject_cast<QWindow*>(receiver), std::unique_ptr<QEvent>(event->clone())});
    event->setAccepted(event->type() != QEvent::Close);
    wake();
    return true;
}

bool handOverInput() {
    if (waiting().empty() || hasToWaitForKeyboard(waiting().front())) {
        return false;
    }
    const WaitingEvent next = std::move(waiting().front());
    waiting().pop_front();
    QEvent& event = *next.event;
    QWindow* const focused = QGuiApplication::focusWindow();
    QWindow* const window = isKey(event) && focused != nullptr ? focused : next.window.data();
    if (event.type() == QEvent::InputMethod) {
        if (QObject* const object = QGuiApplication::focusObject()) {
            handOver(*object, event);
        }
    } else if (window == nullptr || !window->isVisible() || isBarred(*window)) {
        return true; // it goes to nobody
    } else if (isKey(event)) {
        handOverKey(*window, static_cast<QKeyEvent&>(event));
    } else {
        handOver(*window, event);
    }
    return true;
}

} // namespace seam
