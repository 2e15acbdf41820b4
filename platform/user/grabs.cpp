#include "platform/user/grabs.h"

#include "platform/user/toolkit.h"

#include <QEvent>
#include <QTimer>
#include <QWindow>

#include <algorithm>

namespace seam {

namespace {

constexpr int retryMilliseconds = 100;

class InputHolder : public QObject {
  public:
    InputHolder() {
        retry_.setSingleShot(true);
        connect(&retry_, &QTimer::timeout, this, [this] { take(); });
    }

    void hold(bool hold) {
        if (held_ && !hold) {
            letGo();
        }
        held_ = hold;
        take();
    }

    bool held() const {
        return held_;
    }

    void push(QWindow& window) {
        remove(window);
        windows_.push_back(&window);
        window.installEventFilter(this);
        connect(&window, &QObject::destroyed, this, [this, gone = &window] { remove(*gone); });
        take();
    }

    /// Only by its address: it may be about to go.
    void remove(const QWindow& window) {
        const bool inFront = isInFront(window);
        std::erase(windows_, &window);
        if (owner_ == &window) {
            owner_ = nullptr;
        }
        if (inFront) {
            take();
        }
    }

    const std::vector<QWindow*>& windows() const {
        return windows_;
    }

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override {
        if (event->type() == QEvent::Expose && !windows_.empty() && watched == windows_.back()) {
            take();
        }
        return false;
    }

  private:
    bool isInFront(const QWindow& window) const {
        return !windows_.empty() && windows_.back() == &window;
    }

    /// A grab of our own passes from one window to the other without a gap.
    void take() {
        if (!held_ || windows_.empty() || xConnection() == nullptr) {
            retry_.stop();
            return;
        }
        QWindow& window = *windows_.back();
        if (!window.isExposed() || owner_ == &window) {
            return; // it will be told of, or has them
        }
        const bool keyboard = window.setKeyboardGrabEnabled(true);
        const bool pointer = window.setMouseGrabEnabled(true);
        if (keyboard && pointer) {
            owner_ = &window;
        } else {
            retry_.start(retryMilliseconds);
        }
    }

    void letGo() {
        if (!windows_.empty() && windows_.back()->handle() != nullptr) {
            windows_.back()->setKeyboardGrabEnabled(false);
            windows_.back()->setMouseGrabEnabled(false);
        }
        owner_ = nullptr;
    }

    bool held_ = false;
    const QWindow* owner_ = nullptr; // the one that has both
    std::vector<QWindow*> windows_;  // the one in front last
    QTimer retry_;
};

/// Kept, like the application object, until the process ends.
InputHolder& holder() {
    static auto* const instance = new InputHolder;
    return *instance;
}

} // namespace

void holdInput(bool hold) {
    if (toolkit()) {
        holder().hold(hold);
    }
}

bool inputIsHeld() {
    return holder().held();
}

void bringForward(QWindow& window) {
    holder().push(window);
}

void giveBack(const QWindow& window) {
    holder().remove(window);
}

const std::vector<QWindow*>& windowsInFront() {
    return holder().windows();
}

} // namespace seam
