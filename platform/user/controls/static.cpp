// Texts, frames and icons.
#include "platform/user/controls/control.h"

#include "platform/gdi/encoding.h"
#include "platform/user/icons.h"
#include "platform/user/scale.h"
#include "platform/user/text.h"

#include <QLabel>

#include <cstdlib>

namespace seam {

namespace {

constexpr int iconSize = 32;

/// A line of one pixel round what the other controls stand on.
void makeFrame(QLabel& label, const QColor& colour) {
    label.setFrameStyle(QFrame::Box | QFrame::Plain);
    label.setLineWidth(1);
    QPalette palette = label.palette();
    palette.setColor(QPalette::WindowText, colour);
    label.setPalette(palette);
    label.setAttribute(Qt::WA_TransparentForMouseEvents);
}

Qt::Alignment alignmentOf(DWORD kind) {
    switch (kind) {
    case SS_CENTER:
        return Qt::AlignHCenter | Qt::AlignTop;
    case SS_RIGHT:
        return Qt::AlignRight | Qt::AlignTop;
    default:
        return Qt::AlignLeft | Qt::AlignTop;
    }
}

class Static : public Control {
  public:
    Static(const ControlTemplate& made, QWidget& dialog)
        : label_(new QLabel(&dialog)), kind_(made.style & SS_TYPEMASK),
          oneLine_(made.place.height < 2 * label_->fontMetrics().lineSpacing()) {
        label_->setTextFormat(Qt::PlainText);
        label_->setMargin(0);
        switch (kind_) {
        case SS_BLACKFRAME:
            makeFrame(*label_, Qt::black);
            break;
        case SS_GRAYFRAME:
            makeFrame(*label_, label_->palette().color(QPalette::Dark));
            break;
        case SS_ICON:
            showIcon(std::atoi(made.text.c_str()));
            break;
        default:
            label_->setWordWrap(true);
            label_->setAlignment(alignmentOf(kind_));
            Static::setText(made.text);
        }
    }

    QWidget& widget() override {
        return *label_;
    }

    /// A line's last word may be a little wider on a dense screen, where it would be cut.
    int leastWidth() const override {
        const QSize text = label_->fontMetrics().size(Qt::TextShowMnemonic, label_->text());
        return oneLine_ && kind_ == SS_LEFT ? text.width() : 0;
    }

    std::string text() const override {
        return toWindows1252(label_->text());
    }

    void setText(const std::string& text) override {
        label_->setText(shownText(text).replace(QLatin1Char('\r'), QLatin1Char('\n')));
    }

  private:
    /// An icon has its own size, whatever the template says.
    void showIcon(int number) {
        const int size = dialogLength(iconSize);
        const HICON icon{static_cast<DWORD>(number)};
        label_->setPixmap(iconOf(icon).pixmap(size));
        label_->setMinimumSize(size, size);
    }

    QLabel* label_;
    DWORD kind_;
    bool oneLine_;
};

} // namespace

std::unique_ptr<Control> makeStatic(const ControlTemplate& made, HWND /*handle*/, QWidget& dialog) {
    return std::make_unique<Static>(made, dialog);
}

} // namespace seam
