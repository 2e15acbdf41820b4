// Scroll bars, which only say what the user asks for: the program moves the thumb.
#include "platform/user/controls/control.h"

#include "platform/user/queue.h"
#include "platform/user/window.h"

#include <QScrollBar>

namespace seam {

namespace {

std::optional<WORD> codeOf(int action) {
    switch (action) {
    case QAbstractSlider::SliderSingleStepSub:
        return SB_LINEUP;
    case QAbstractSlider::SliderSingleStepAdd:
        return SB_LINEDOWN;
    case QAbstractSlider::SliderPageStepSub:
        return SB_PAGEUP;
    case QAbstractSlider::SliderPageStepAdd:
        return SB_PAGEDOWN;
    case QAbstractSlider::SliderMove:
        return SB_THUMBTRACK;
    default:
        return std::nullopt;
    }
}

class ScrollBar : public Control {
  public:
    ScrollBar(HWND handle, QWidget& dialog)
        : handle_(handle), bar_(new QScrollBar(Qt::Horizontal, &dialog)) {
        bar_->setFocusPolicy(Qt::StrongFocus);
        bar_->setPageStep(1);
        bar_->setInvertedControls(false); // the left arrow goes to the left
        QObject::connect(bar_, &QScrollBar::actionTriggered, bar_,
                         [this](int action) { tell(action); });
    }

    QWidget& widget() override {
        return *bar_;
    }

    std::optional<LRESULT> answer(UINT message, WPARAM wParam, LPARAM lParam) override {
        switch (message) {
        case SBM_SETPOS:
            bar_->setValue(static_cast<int>(wParam));
            return 0;
        case SBM_GETPOS:
            return bar_->value();
        case SBM_SETRANGE:
            bar_->setRange(static_cast<int>(wParam), static_cast<int>(lParam));
            return 0;
        default:
            return std::nullopt;
        }
    }

  private:
    /// Takes the movement back and tells the dialog of the wish.
    void tell(int action) {
        const auto code = codeOf(action);
        const int wanted = bar_->sliderPosition();
        bar_->setSliderPosition(bar_->value());
        const Window* window = findWindow(handle_);
        if (code && window != nullptr) {
            const auto wParam = static_cast<WPARAM>(MAKELONG(*code, wanted));
            queueInput({window->parent, WM_HSCROLL, wParam, LPARAM{handle_.number}, 0});
        }
    }

    HWND handle_;
    QScrollBar* bar_;
};

} // namespace

std::unique_ptr<Control> makeScrollBar(const ControlTemplate& /*made*/, HWND handle,
                                       QWidget& dialog) {
    return std::make_unique<ScrollBar>(handle, dialog);
}

} // namespace seam

BOOL SetScrollRange(HWND bar, int kind, int lowest, int highest, BOOL /*redraw*/) {
    SendMessageA(bar, seam::SBM_SETRANGE, static_cast<WPARAM>(lowest), highest);
    return kind == SB_CTL ? TRUE : FALSE;
}

int SetScrollPos(HWND bar, int kind, int position, BOOL /*redraw*/) {
    const int before = GetScrollPos(bar, kind);
    SendMessageA(bar, seam::SBM_SETPOS, static_cast<WPARAM>(position), 0);
    return before;
}

int GetScrollPos(HWND bar, int /*kind*/) {
    return static_cast<int>(SendMessageA(bar, seam::SBM_GETPOS, 0, 0));
}
