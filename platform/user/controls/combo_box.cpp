// Drop-down lists, of texts and of items that the program draws.
#include "platform/gdi/encoding.h"
#include "platform/user/controls/control.h"
#include "platform/user/controls/item_painter.h"
#include "platform/user/scale.h"
#include "platform/user/text.h"
#include "platform/user/window.h"

#include <QAbstractItemView>
#include <QComboBox>
#include <QFocusEvent>
#include <QPainter>
#include <QStyleOptionComboBox>
#include <QStylePainter>
#include <QStyledItemDelegate>

#include <algorithm>

namespace seam {

namespace {

constexpr int textRoom = 8; // of a closed list, above and below its text together
constexpr int itemRoom = 6; // the same for an item that the program draws
constexpr int dataRole = Qt::UserRole;

std::uintptr_t dataOf(const QVariant& data) {
    return static_cast<std::uintptr_t>(data.toULongLong());
}

/// Has the program draw the rows of the open list.
class DrawnRows : public QStyledItemDelegate {
  public:
    DrawnRows(HWND handle, int height, QObject* parent)
        : QStyledItemDelegate(parent), handle_(handle), height_(height) {}

    void paint(QPainter* painter, const QStyleOptionViewItem& option,
               const QModelIndex& index) const override {
        paintItem(*painter, option.rect, option.palette.color(QPalette::Base),
                  {handle_, ODT_COMBOBOX, static_cast<UINT>(index.row()), 0,
                   dataOf(index.data(dataRole))});
    }

    QSize sizeHint(const QStyleOptionViewItem& option,
                   const QModelIndex& /*index*/) const override {
        return {option.rect.width(), height_};
    }

  private:
    HWND handle_;
    int height_;
};

class DropDown : public QComboBox {
  public:
    DropDown(HWND handle, bool drawn, QWidget* dialog)
        : QComboBox(dialog), handle_(handle), drawn_(drawn) {
        connect(this, &QComboBox::activated, this, [this] { notify(handle_, CBN_SELCHANGE); });
    }

    void showPopup() override {
        notify(handle_, CBN_DROPDOWN);
        QComboBox::showPopup();
    }

    void hidePopup() override {
        const bool open = view()->isVisible();
        QComboBox::hidePopup();
        if (open) {
            notify(handle_, CBN_CLOSEUP);
        }
    }

  protected:
    /// A white field, as in a list, and not the grey of a button.
    void paintEvent(QPaintEvent* /*event*/) override {
        QStylePainter painter(this);
        QStyleOptionComboBox option;
        initStyleOption(&option);
        painter.drawComplexControl(QStyle::CC_ComboBox, option);
        const QRect field = style()->subControlRect(QStyle::CC_ComboBox, &option,
                                                    QStyle::SC_ComboBoxEditField, this);
        const QColor ground = palette().color(isEnabled() ? QPalette::Base : QPalette::Button);
        painter.fillRect(field, ground);
        if (drawn_) {
            paintItem(painter, field, ground, drawnItem());
        } else {
            paintText(painter, field);
        }
    }

    void focusInEvent(QFocusEvent* event) override {
        QComboBox::focusInEvent(event);
        if (event->reason() != Qt::PopupFocusReason) { // its own list is a part of it
            notify(handle_, CBN_SETFOCUS);
        }
    }

    void focusOutEvent(QFocusEvent* event) override {
        QComboBox::focusOutEvent(event);
        if (event->reason() != Qt::PopupFocusReason) {
            notify(handle_, CBN_KILLFOCUS);
        }
    }

  private:
    DrawnItem drawnItem() const {
        const UINT state = (hasFocus() ? ODS_FOCUS : 0U) | (isEnabled() ? 0U : ODS_DISABLED);
        return {handle_, ODT_COMBOBOX, static_cast<UINT>(currentIndex()), state,
                dataOf(currentData(dataRole))};
    }

    void paintText(QPainter& painter, QRect field) const {
        field.adjust(1, 1, -1, -1);
        const bool marked = hasFocus() && !view()->isVisible();
        if (marked) {
            painter.fillRect(field, palette().color(QPalette::Highlight));
        }
        const QPalette::ColorRole role = marked ? QPalette::HighlightedText : QPalette::Text;
        painter.setPen(palette().color(isEnabled() ? QPalette::Active : QPalette::Disabled, role));
        painter.drawText(field.adjusted(2, 0, 0, 0), Qt::AlignLeft | Qt::AlignVCenter,
                         currentText());
    }

    HWND handle_;
    bool drawn_;
};

class ComboBox : public Control {
  public:
    ComboBox(const ControlTemplate& made, HWND handle, QWidget& dialog)
        : handle_(handle), drawn_((made.style & CBS_OWNERDRAWVARIABLE) != 0),
          box_(new DropDown(handle, drawn_, &dialog)), whole_(made.place.height) {
        box_->view()->setTextElideMode(Qt::ElideNone);
    }

    QWidget& widget() override {
        return *box_;
    }

    /// The template's height is that of the open list; closed, the control is as high as an item.
    int height(int /*template's*/) override {
        const int item = itemHeight(static_cast<UINT>(-1));
        const int closed = item + dialogLength(drawn_ ? itemRoom : textRoom);
        if (drawn_) {
            box_->setItemDelegate(new DrawnRows(handle_, item, box_));
        }
        box_->setMaxVisibleItems(std::max((whole_ - closed) / item, 1));
        return closed;
    }

    std::string text() const override {
        return toWindows1252(box_->currentText());
    }

    std::optional<LRESULT> answer(UINT message, WPARAM wParam, LPARAM lParam) override {
        switch (message) {
        case CB_ADDSTRING:
            return insert(box_->count(), lParam);
        case CB_INSERTSTRING:
            return insert(static_cast<int>(wParam), lParam);
        case CB_RESETCONTENT:
            box_->clear();
            return 0;
        case CB_SETCURSEL:
            box_->setCurrentIndex(holds(wParam) ? static_cast<int>(wParam) : -1);
            return box_->currentIndex();
        case CB_GETCURSEL:
            return box_->currentIndex();
        case CB_GETCOUNT:
            return box_->count();
        case CB_GETITEMDATA:
            return holds(wParam) ? static_cast<LRESULT>(
                                       dataOf(box_->itemData(static_cast<int>(wParam), dataRole)))
                                 : CB_ERR;
        case CB_SETEXTENDEDUI:
            return 0; // the toolkit's lists open by the arrows as they are
        default:
            return std::nullopt;
        }
    }

  private:
    bool holds(WPARAM row) const {
        return row < static_cast<WPARAM>(box_->count());
    }

    LRESULT insert(int row, LPARAM item) {
        const int place = row < 0 ? box_->count() : std::min(row, box_->count());
        const int before = box_->currentIndex();
        if (drawn_) {
            box_->insertItem(
                place,
                QString::number(box_->count() + 1), // for screen readers, and to find it by digits
                QVariant::fromValue<qulonglong>(static_cast<std::uintptr_t>(item)));
        } else {
            box_->insertItem(place, shownText(reinterpret_cast<const char*>(item)));
        }
        if (before < 0) {
            box_->setCurrentIndex(-1); // the toolkit selects the first
        }
        return place;
    }

    int itemHeight(UINT item) const {
        const int line = box_->fontMetrics().height();
        const Window* window = findWindow(handle_);
        if (!drawn_ || window == nullptr) {
            return line;
        }
        const auto plainLine = static_cast<UINT>(line * 100 / dialogPercent());
        MEASUREITEMSTRUCT measured{
            ODT_COMBOBOX, static_cast<UINT>(window->id), item, 0, plainLine, 0};
        SendMessageA(window->parent, WM_MEASUREITEM, static_cast<WPARAM>(window->id),
                     reinterpret_cast<LPARAM>(&measured));
        return std::max(dialogLength(static_cast<int>(measured.itemHeight)), 1);
    }

    HWND handle_;
    bool drawn_;
    DropDown* box_;
    int whole_;
};

} // namespace

std::unique_ptr<Control> makeComboBox(const ControlTemplate& made, HWND handle, QWidget& dialog) {
    return std::make_unique<ComboBox>(made, handle, dialog);
}

} // namespace seam
