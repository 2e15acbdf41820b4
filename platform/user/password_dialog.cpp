#include "platform/user/password_dialog.h"

#include "platform/harness.h"
#include "platform/user/password_store.h"
#include "platform/user/scale.h"
#include "platform/user/text.h"

#include <QApplication>
#include <QDialogButtonBox>
#include <QFormLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QPushButton>
#include <QVBoxLayout>
#include <QWindow>

#include <algorithm>

namespace seam {

namespace {

using std::chrono::milliseconds;

/// Wrong passwords since the last right one, and when the next may be tried, by the seam's clock.
struct Attempts {
    int wrong = 0;
    std::int64_t next = 0;
};

Attempts attempts;

milliseconds delayLeft() {
    return milliseconds(std::max<std::int64_t>(attempts.next - clockNow(), 0));
}

void countWrong() {
    constexpr int mostDoublings = 16;
    const milliseconds delay =
        passwordPatience().firstDelay * (1 << std::min(attempts.wrong, mostDoublings));
    ++attempts.wrong;
    attempts.next = clockNow() + std::min(delay, passwordPatience().longestDelay).count();
}

} // namespace

PasswordPatience& passwordPatience() {
    static PasswordPatience patience;
    return patience;
}

void forgetWrongPasswords() {
    attempts = {};
}

PasswordDialog::PasswordDialog(HWND owner, const QString& title)
    : Overlay<QDialog>(owner), text_(new QLabel), form_(new QFormLayout), message_(new QLabel),
      buttons_(new QDialogButtonBox(QDialogButtonBox::Ok | QDialogButtonBox::Cancel)),
      ok_(buttons_->button(QDialogButtonBox::Ok)) {
    constexpr int leastWidth = 320; // for what it says to stand on one line
    setWindowTitle(title);
    setWindowFlags(Qt::Dialog | Qt::CustomizeWindowHint | Qt::WindowTitleHint |
                   Qt::WindowCloseButtonHint);
    auto* layout = new QVBoxLayout(this);
    layout->setSizeConstraint(QLayout::SetFixedSize);
    layout->addWidget(text_);
    layout->addLayout(form_);
    layout->addWidget(message_);
    layout->addWidget(buttons_);
    for (QLabel* label : {text_, message_}) {
        label->setTextFormat(Qt::PlainText);
        label->setWordWrap(true);
        label->setMinimumWidth(dialogLength(leastWidth));
        label->setMinimumHeight(fontMetrics().lineSpacing()); // room before there is a message
    }
    ok_->setDefault(true);
    QObject::connect(ok_, &QPushButton::clicked, this, [this] {
        if (delayLeft().count() == 0) {
            submit();
        }
    });
    QObject::connect(buttons_, &QDialogButtonBox::rejected, this, &QDialog::reject);
    delay_.setSingleShot(true);
    delay_.setTimerType(Qt::PreciseTimer);
    QObject::connect(&delay_, &QTimer::timeout, this, [this] { holdBack(); });
    holdBack();
    qApp->installEventFilter(this);
}

void PasswordDialog::explain(const QString& text) {
    text_->setText(text);
}

PasswordField* PasswordDialog::addField(const QString& label) {
    auto* field = new PasswordField(this);
    form_->addRow(label, field);
    setTabOrder(field, ok_);
    setTabOrder(ok_, buttons_->button(QDialogButtonBox::Cancel));
    return field;
}

void PasswordDialog::refuse(const std::string& what, const StoredPassword& broken) {
    explain(shownText(what + ", because " + broken.reason +
                      ".\n\nTo begin anew, remove this file:\n" + passwordFile()));
    delay_.stop();
    message_->hide();
    ok_->hide();
    buttons_->button(QDialogButtonBox::Cancel)->setDefault(true);
}

void PasswordDialog::say(const QString& message) {
    message_->setText(message);
}

bool PasswordDialog::check(PasswordField& field) {
    const StoredPassword stored = readPassword();
    if (stored.state == PasswordState::none || isPassword(stored, field.secret().bytes())) {
        forgetWrongPasswords();
        return true;
    }
    countWrong();
    field.clear();
    field.setFocus();
    holdBack();
    return false;
}

/// OK comes back when the delay is over; till then the message counts the seconds.
void PasswordDialog::holdBack() {
    constexpr milliseconds second{1000};
    const milliseconds left = delayLeft();
    ok_->setEnabled(left.count() == 0);
    if (left.count() > 0) {
        const auto seconds = (left + second - milliseconds(1)) / second;
        say(QStringLiteral("Wrong password. You may try again in %1 s.").arg(seconds));
        delay_.start(left - (seconds - 1) * second);
    } else if (!message_->text().isEmpty()) {
        say(QStringLiteral("Wrong password. Please try again."));
    }
}

/// The key that brought the dialog up may still be held: what it repeats is for nobody, lest it be
/// a password, or the OK to none. The toolkit doesn't always know a repetition: its release and
/// press come at the same time. Those of a key that has gone down here may come as fast as that.
bool PasswordDialog::isRepetition(const QKeyEvent& key) {
    if (key.key() == Qt::Key_Backspace) {
        return false;
    }
    const bool known = pressedHere_.contains(key.nativeScanCode());
    const std::pair keyAndTime(key.nativeScanCode(), key.timestamp());
    if (key.isAutoRepeat() || (!known && key.timestamp() != 0 && released_ == keyAndTime)) {
        return true;
    }
    pressedHere_.insert(key.nativeScanCode());
    return false;
}

/// Sees the keys before anybody else, and hands those of the dialog's window to the field itself:
/// what has not come from the window system is of no interest to the bridge that tells assistive
/// programs of keys.
bool PasswordDialog::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() != QEvent::KeyPress && event->type() != QEvent::KeyRelease) {
        return Overlay<QDialog>::eventFilter(watched, event);
    }
    const auto& key = static_cast<const QKeyEvent&>(*event);
    if (event->type() == QEvent::KeyRelease) {
        released_ = {key.nativeScanCode(), key.timestamp()};
    } else if (isRepetition(key)) {
        return true;
    } else {
        keyPressed();
    }
    if (watched == windowHandle() && focusWidget() != nullptr) {
        QCoreApplication::sendEvent(focusWidget(), event);
        return true;
    }
    return false;
}

} // namespace seam
