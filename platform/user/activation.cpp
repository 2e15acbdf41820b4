#include "platform/user/activation.h"

#include "platform/user/queue.h"

#include <QElapsedTimer>
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
        patience_.setInterval(500ms);
        connect(&patience_, &QTimer::timeout, this, [this] { askAgain(); });
        connect(qGuiApp, &QGuiApplication::focusWindowChanged, this,
                [this](const QWindow* focused) {
                    if (focused != nullptr) {
                        without_.invalidate();
                        wake();
                    }
                    if (focused != nullptr && focused == window_) {
                        drop();
                    }
                });
    }

    void expect(QWindow& window) {
        if (QGuiApplication::focusWindow() != &window) {
            window_ = &window;
            asked_ = 1;
            patience_.start();
        }
        window.requestActivate();
    }

    bool waits() const {
        return !window_.isNull();
    }

    bool mayReturn() {
        if (!without_.isValid()) {
            without_.start();
            patience_.start();
        }
        return !without_.hasExpired(longest);
    }

  private:
    /// A window manager passes over a window that it hasn't seen to yet.
    void askAgain() {
        constexpr int most = 4;
        const bool lost = without_.isValid() && !without_.hasExpired(longest);
        if (!lost && (window_.isNull() || asked_ == most)) {
            drop();
            return;
        }
        if (!window_.isNull()) {
            ++asked_;
            window_->requestActivate();
        }
        patience_.start();
    }

    void drop() {
        window_.clear();
        patience_.stop();
        wake();
    }

    QPointer<QWindow> window_;
    static constexpr qint64 longest = 2000; // milliseconds

    int asked_ = 0;         // how often
    QElapsedTimer without_; // since a key found no window with the keyboard
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

bool keyboardMayReturn() {
    return expectation().mayReturn();
}

} // namespace seam
