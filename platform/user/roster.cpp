#include "platform/user/roster.h"

#include "platform/kernel/descriptor.h"
#include "platform/user/native_window.h"

#include <QSocketNotifier>

#include <cstddef>
#include <cstring>
#include <map>
#include <memory>
#include <optional>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

namespace seam {

namespace {

struct Listener {
    std::unique_ptr<Descriptor> socket;
    std::unique_ptr<QSocketNotifier> notifier;
};

std::map<DWORD, Listener> listeners; // by window

HandleTable<Descriptor>& remotes() {
    static HandleTable<Descriptor> connections(HandleKind::remoteWindow);
    return connections;
}

/// The display as it stands in a name: offscreen, or that of X without its screen.
std::string displayName() {
    const QByteArray platform = qgetenv("QT_QPA_PLATFORM");
    if (!platform.isEmpty() && !platform.startsWith("xcb")) {
        return platform.split(':').constFirst().toStdString();
    }
    const std::string display = qgetenv("DISPLAY").toStdString();
    return display.substr(0, display.find('.', display.rfind(':')));
}

/// The address in the abstract namespace, which goes with the process that listens on it: user,
/// display, class and title.
std::optional<sockaddr_un> addressOf(const std::string& className, const std::string& title,
                                     socklen_t& length) {
    const std::string name =
        "dorbo/" + std::to_string(getuid()) + "/" + displayName() + "/" + className + "/" + title;
    sockaddr_un address{};
    address.sun_family = AF_UNIX;
    if (name.size() + 1 > sizeof address.sun_path) {
        return std::nullopt;
    }
    std::memcpy(address.sun_path + 1, name.data(), name.size());
    length = static_cast<socklen_t>(offsetof(sockaddr_un, sun_path) + 1 + name.size());
    return address;
}

std::unique_ptr<Descriptor> makeSocket() {
    return std::make_unique<Descriptor>(
        socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0));
}

/// Anybody may listen on a name: what we find must be run by the same user.
bool isOurs(const Descriptor& connection) {
    ucred peer{};
    socklen_t size = sizeof peer;
    return getsockopt(connection.number(), SOL_SOCKET, SO_PEERCRED, &peer, &size) == 0 &&
           peer.uid == getuid();
}

/// Another process that has connected: it may ask for the window to be raised, or hang up.
struct Visitor {
    Descriptor socket;
    QSocketNotifier notifier{socket.number(), QSocketNotifier::Read};
};

void receive(int listener, HWND window) {
    const int accepted = accept4(listener, nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK);
    Descriptor socket(accepted);
    if (accepted < 0 || !isOurs(socket)) {
        return; // another user's process is sent away at once
    }
    auto* visitor = new Visitor{std::move(socket)};
    QObject::connect(&visitor->notifier, &QSocketNotifier::activated, &visitor->notifier,
                     [visitor, window] {
                         char byte = 0;
                         const std::unique_ptr<Visitor> ended(visitor);
                         if (read(ended->socket.number(), &byte, 1) == 1) {
                             SetForegroundWindow(window);
                         }
                     });
}

} // namespace

void joinRoster(const Window& window) {
    socklen_t length = 0;
    const auto address = addressOf(window.windowClass->name, window.title, length);
    auto listener = makeSocket();
    if (window.title.empty() || !address || listener->number() < 0 ||
        bind(listener->number(), reinterpret_cast<const sockaddr*>(&*address), length) != 0 ||
        listen(listener->number(), 8) != 0) {
        return;
    }
    auto notifier = std::make_unique<QSocketNotifier>(listener->number(), QSocketNotifier::Read);
    const HWND handle = window.handle;
    const int number = listener->number();
    QObject::connect(notifier.get(), &QSocketNotifier::activated, notifier.get(),
                     [number, handle] { receive(number, handle); });
    listeners[handle.number] = {std::move(listener), std::move(notifier)};
}

void leaveRoster(HWND window) {
    const auto found = listeners.find(window.number);
    if (found != listeners.end()) {
        found->second.notifier.reset(); // before the descriptor that it watches
        listeners.erase(found);
    }
}

HWND findRemote(const std::string& className, const std::string& title) {
    socklen_t length = 0;
    const auto address = addressOf(className, title, length);
    auto connection = makeSocket();
    if (!address || connection->number() < 0 ||
        connect(connection->number(), reinterpret_cast<const sockaddr*>(&*address), length) != 0 ||
        !isOurs(*connection)) {
        return {};
    }
    return HWND{remotes().add(std::move(connection))};
}

bool isRemote(HWND window) {
    return remotes().find(window.number) != nullptr;
}

bool raiseRemote(HWND window) {
    const Descriptor* connection = remotes().find(window.number);
    return connection != nullptr && send(connection->number(), "r", 1, MSG_NOSIGNAL) == 1;
}

} // namespace seam
