#include "platform/user/password_field.h"

#include <QAccessible>
#include <QAccessibleWidget>
#include <QApplication>
#include <QKeyEvent>
#include <QPainter>
#include <QStyle>
#include <QStyleOptionFrame>

#include <algorithm>
#include <sodium.h>

namespace seam {

namespace {

constexpr int margin = 2; // between the panel's edge and the bullets

/// Tells a screen reader that what is typed here is a secret.
class AccessibleField : public QAccessibleWidget {
  public:
    explicit AccessibleField(QWidget* field)
        : QAccessibleWidget(field, QAccessible::EditableText) {}

    QAccessible::State state() const override {
        QAccessible::State state = QAccessibleWidget::state();
        state.passwordEdit = true;
        state.editable = true;
        return state;
    }
};

QAccessibleInterface* makeAccessible(const QString& /*className*/, QObject* object) {
    auto* field = dynamic_cast<PasswordField*>(object);
    return field != nullptr ? new AccessibleField(field) : nullptr;
}

/// One character in UTF-8, wiped when it goes.
struct Utf8 {
    char bytes[4] = {};
    std::size_t size = 0;

    explicit Utf8(char32_t code) {
        if (code < 0x80) {
            bytes[size++] = static_cast<char>(code);
            return;
        }
        const int more = code < 0x800 ? 1 : code < 0x10000 ? 2 : 3; // bytes that go on with it
        const unsigned lead[] = {0, 0xC0, 0xE0, 0xF0};
        bytes[size++] = static_cast<char>(lead[more] | (code >> (6 * more)));
        for (int left = more - 1; left >= 0; --left) {
            bytes[size++] = static_cast<char>(0x80U | ((code >> (6 * left)) & 0x3FU));
        }
    }

    ~Utf8() {
        sodium_memzero(bytes, sizeof bytes);
    }

    Utf8(const Utf8&) = delete;
    Utf8& operator=(const Utf8&) = delete;
};

bool isText(const QKeyEvent& event) {
    constexpr Qt::KeyboardModifiers commands =
        Qt::ControlModifier | Qt::AltModifier | Qt::MetaModifier;
    const QString text = event.text();
    return !text.isEmpty() && (text.at(0).isPrint() || text.at(0).isSurrogate()) &&
           (event.modifiers() & commands) == 0;
}

} // namespace

PasswordField::PasswordField(QWidget* parent) : QWidget(parent) {
    [[maybe_unused]] static const bool told = [] {
        QAccessible::installFactory(makeAccessible);
        return true;
    }();
    setFocusPolicy(Qt::StrongFocus);
    setCursor(Qt::IBeamCursor);
    setContextMenuPolicy(Qt::PreventContextMenu);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
}

void PasswordField::clear() {
    secret_.clear();
    update();
}

QSize PasswordField::sizeHint() const {
    constexpr int characters = 20;
    const int frame = style()->pixelMetric(QStyle::PM_DefaultFrameWidth, nullptr, this) + margin;
    return {fontMetrics().horizontalAdvance(QLatin1Char('x')) * characters + 2 * frame,
            fontMetrics().height() + 2 * frame};
}

void PasswordField::type(const QString& text) {
    for (qsizetype at = 0; at < text.size(); ++at) {
        char32_t code = text.at(at).unicode();
        if (text.at(at).isHighSurrogate() && at + 1 < text.size()) {
            code = QChar::surrogateToUcs4(text.at(at), text.at(at + 1));
            ++at;
        }
        const Utf8 character(code);
        if (!secret_.append({character.bytes, character.size})) {
            QApplication::beep();
            break;
        }
    }
    update();
}

void PasswordField::keyPressEvent(QKeyEvent* event) {
    if (event->key() == Qt::Key_U && event->modifiers() == Qt::ControlModifier) {
        clear();
    } else if (event->key() == Qt::Key_Backspace) {
        secret_.removeLast();
        update();
    } else if (isText(*event)) {
        type(event->text());
    } else {
        QWidget::keyPressEvent(event);
    }
}

void PasswordField::paintEvent(QPaintEvent* /*event*/) {
    QStyleOptionFrame option;
    option.initFrom(this);
    option.lineWidth = style()->pixelMetric(QStyle::PM_DefaultFrameWidth, &option, this);
    option.state |= QStyle::State_Sunken;
    QPainter painter(this);
    style()->drawPrimitive(QStyle::PE_PanelLineEdit, &option, &painter, this);

    const int frame = option.lineWidth + margin;
    const QRect inside = rect().adjusted(frame, frame, -frame, -frame);
    const QChar bullet(style()->styleHint(QStyle::SH_LineEdit_PasswordCharacter, &option, this));
    const QString bullets(static_cast<qsizetype>(secret_.characters()), bullet);
    const int width = fontMetrics().horizontalAdvance(bullets);
    const int end =
        inside.left() + std::min(width, inside.width() - 1); // the last ones stay in view
    painter.setClipRect(inside);
    painter.setPen(palette().color(QPalette::Text));
    painter.drawText(end - width, inside.top() + fontMetrics().ascent(), bullets);
    if (hasFocus()) {
        painter.drawLine(end, inside.top(), end, inside.bottom());
    }
}

} // namespace seam
