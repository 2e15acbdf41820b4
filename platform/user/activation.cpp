#include "platform/user/activation.h"

#include "platform/user/queue.h"

#include <QGuiApplication>
#include <QPointer>
#include <QTimer>
#include <QWindow>

#include <chrono>

namespace seam {

namespace {

class Expectation : public QObject {
  public:
    Expectation() {
        using namespace std::chrono_literals;
        patience_.setSingleShot(true);
        patience_.setInterval(2s);
        connect(&patience_, &QTimer::timeout, this, [this] { drop(); });
        connect(qGuiApp, &QGuiApplication::focusWindowChanged, this,
                [this](const QWindow* focused) {
                    if (focused != nullptr && focused == window_) {
                        drop();
                    }
                });
    }

    void expect(QWindow& window) {
        if (QGuiApplication::focusWindow() != &window) {
            window_ = &window;
            patience_.start();
        }
        window.requestActivate();
    }

    bool waits() const {
        return !window_.isNull();
    }

  private:
    void drop() {
        window_.clear();
        patience_.stop();
        wake();
    }

    QPointer<QWindow> window_;
    QTimer patience_;
};

/// Kept, like the application object, until the process ends.
Expectation& expectation() {
    static auto* const instance = new Expectation;
    return *instance;
}

} // namespace

void activate(QWindow& window) {
    expectation().expect(window);
}

bool keyboardIsOnItsWay() {
    return expectation().waits();
}

} // namespace seam
