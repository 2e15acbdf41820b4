#include "platform/user/waker.h"

#include "platform/harness.h"
#include "platform/user/clock.h"

#include <QApplication>
#include <QDialog>
#include <QDrag>
#include <QTimer>

#include <algorithm>
#include <limits>
#include <vector>

namespace seam {

namespace {

class Waker : public QObject {
  public:
    Waker() {
        timer_.setSingleShot(true);
        timer_.setTimerType(Qt::PreciseTimer);
        QObject::connect(&timer_, &QTimer::timeout, this, [] { drainWithinToolkitLoop(); });
    }

    void arm(std::optional<std::int64_t> deadline) {
        if (deadline == deadline_ && timer_.isActive() == deadline.has_value()) {
            return;
        }
        deadline_ = deadline;
        if (!deadline) {
            timer_.stop();
            return;
        }
        const std::int64_t wait = clockIsManual() ? 0 : *deadline - clockNow();
        timer_.start(
            static_cast<int>(std::clamp<std::int64_t>(wait, 0, std::numeric_limits<int>::max())));
    }

  protected:
    bool event(QEvent* event) override {
        if (event->type() == QEvent::User) {
            drainWithinToolkitLoop();
            return true;
        }
        return QObject::event(event);
    }

  private:
    QTimer timer_;
    std::optional<std::int64_t> deadline_;
};

/// What the running loops show, the innermost one last.
std::vector<const QWidget*>& shownInLoops() {
    static auto* const widgets = new std::vector<const QWidget*>;
    return *widgets;
}

/// Made after the application object and, like it, kept until the process ends.
Waker& waker() {
    static auto* const instance = new Waker;
    return *instance;
}

} // namespace

void armWaker(std::optional<std::int64_t> deadline) {
    waker().arm(deadline);
}

void wakeToolkitLoop() {
    QCoreApplication::postEvent(&waker(), new QEvent(QEvent::User));
}

ToolkitLoop::ToolkitLoop(const QWidget& shown) {
    shownInLoops().push_back(&shown);
}

ToolkitLoop::~ToolkitLoop() {
    shownInLoops().pop_back();
}

bool toolkitLoopIsOver() {
    return !shownInLoops().empty() && !shownInLoops().back()->isVisible();
}

void rejectToolkitModal() {
    if (QWidget* popup = QApplication::activePopupWidget()) {
        popup->close();
    } else if (auto* dialog = qobject_cast<QDialog*>(QApplication::activeModalWidget())) {
        dialog->reject();
    } else {
        QDrag::cancel(); // text that is dragged out of a field
    }
}

} // namespace seam
