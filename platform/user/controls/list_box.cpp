// List boxes, and the list of a directory in them.
#include "platform/user/controls/control.h"

#include "platform/kernel.h"
#include "platform/kernel/paths.h"
#include "platform/user/text.h"

#include <QAbstractListModel>
#include <QKeyEvent>
#include <QListView>

#include <algorithm>
#include <cctype>
#include <cstring>
#include <vector>

namespace seam {

namespace {

/// Small letters and capitals are the same here; what differs only in that stands in the order of
/// its bytes.
bool standsBefore(const std::string& a, const std::string& b) {
    const auto folded = [](unsigned char c) { return std::tolower(c); };
    const auto less = [folded](char x, char y) {
        return folded(static_cast<unsigned char>(x)) < folded(static_cast<unsigned char>(y));
    };
    if (std::lexicographical_compare(a.begin(), a.end(), b.begin(), b.end(), less)) {
        return true;
    }
    return !std::lexicographical_compare(b.begin(), b.end(), a.begin(), a.end(), less) && a < b;
}

/// Bytes as the program knows them, shown as text.
class Entries : public QAbstractListModel {
  public:
    using QAbstractListModel::QAbstractListModel;

    int rowCount(const QModelIndex& parent) const override {
        return parent.isValid() ? 0 : static_cast<int>(entries_.size());
    }

    QVariant data(const QModelIndex& index, int role) const override {
        return role == Qt::DisplayRole ? shownText(entries_[static_cast<std::size_t>(index.row())])
                                       : QVariant();
    }

    const std::vector<std::string>& all() const {
        return entries_;
    }

    void replace(std::vector<std::string> entries) {
        beginResetModel();
        entries_ = std::move(entries);
        endResetModel();
    }

  private:
    std::vector<std::string> entries_;
};

class ListView : public QListView {
  public:
    ListView(HWND handle, QWidget* dialog) : QListView(dialog), handle_(handle) {
        connect(this, &QListView::doubleClicked, this, [this] { notify(handle_, LBN_DBLCLK); });
        connect(this, &QListView::clicked, this, [this] { notify(handle_, LBN_SELCHANGE); });
    }

  protected:
    /// The space bar does what a double-click does.
    void keyPressEvent(QKeyEvent* event) override {
        if (event->key() == Qt::Key_Space && selectionModel()->hasSelection()) {
            notify(handle_, LBN_DBLCLK);
            return;
        }
        const QModelIndex before = currentIndex();
        QListView::keyPressEvent(event);
        if (currentIndex() != before) {
            notify(handle_, LBN_SELCHANGE);
        }
    }

  private:
    HWND handle_;
};

bool atRootOfDrive() {
    const auto directory = currentDirectory();
    const auto known = drives();
    return !directory || std::any_of(known.begin(), known.end(), [&](const Drive& drive) {
        return *directory == (drive.root.empty() ? "/" : drive.root);
    });
}

bool listed(const WIN32_FIND_DATAA& found, WPARAM wanted) {
    if ((found.dwFileAttributes & FILE_ATTRIBUTE_HIDDEN) != 0) {
        return false;
    }
    return (found.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0
               ? (wanted & DDL_DIRECTORY) != 0
               : (wanted & DDL_EXCLUSIVE) == 0 || (wanted & DDL_ARCHIVE) != 0;
}

std::string entryOf(const WIN32_FIND_DATAA& found) {
    const std::string name = static_cast<const char*>(found.cFileName);
    return (found.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY) != 0 ? "[" + name + "]" : name;
}

void addMatches(std::vector<std::string>& entries, WPARAM wanted, const char* pattern) {
    WIN32_FIND_DATAA found{};
    const HANDLE search = FindFirstFileA(pattern, &found);
    if (search == INVALID_HANDLE_VALUE) {
        return;
    }
    do {
        if (listed(found, wanted)) {
            entries.push_back(entryOf(found));
        }
    } while (FindNextFileA(search, &found) != FALSE);
    FindClose(search);
}

void addDirectory(std::vector<std::string>& entries, WPARAM wanted, const char* pattern) {
    addMatches(entries, wanted, pattern);
    if ((wanted & DDL_DIRECTORY) != 0 && !atRootOfDrive()) {
        entries.emplace_back("[..]");
    }
    if ((wanted & DDL_DRIVES) != 0) {
        for (const Drive& drive : drives()) {
            entries.push_back({'[', '-', static_cast<char>(std::tolower(drive.letter)), '-', ']'});
        }
    }
}

class ListBox : public Control {
  public:
    ListBox(const ControlTemplate& made, HWND handle, QWidget& dialog)
        : list_(new ListView(handle, &dialog)), entries_(new Entries(list_)),
          sorts_((made.style & LBS_SORT) != 0) {
        list_->setModel(entries_);
        list_->setUniformItemSizes(true);
        list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
        list_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
        list_->setFrameStyle(QFrame::Box | QFrame::Plain);
    }

    QWidget& widget() override {
        return *list_;
    }

    std::optional<LRESULT> answer(UINT message, WPARAM wParam, LPARAM lParam) override {
        switch (message) {
        case LB_ADDSTRING:
            return add(reinterpret_cast<const char*>(lParam));
        case LB_RESETCONTENT:
            entries_->replace({});
            return 0;
        case LB_SETCURSEL:
            return select(static_cast<int>(wParam));
        case LB_GETCURSEL:
            return selected();
        case LB_GETTEXT:
            return copyText(wParam, reinterpret_cast<char*>(lParam));
        case LB_GETTEXTLEN:
            return copyText(wParam, nullptr);
        case LB_GETCOUNT:
            return static_cast<LRESULT>(entries_->all().size());
        case LB_DIR:
            return addNames(wParam, reinterpret_cast<const char*>(lParam));
        default:
            return std::nullopt;
        }
    }

  private:
    LRESULT add(const char* text) {
        std::vector<std::string> entries = entries_->all();
        const auto place =
            sorts_ ? std::upper_bound(entries.begin(), entries.end(), text, standsBefore)
                   : entries.end();
        const auto row = place - entries.begin();
        entries.insert(place, text);
        entries_->replace(std::move(entries));
        return row;
    }

    LRESULT addNames(WPARAM wanted, const char* pattern) {
        std::vector<std::string> entries = entries_->all();
        addDirectory(entries, wanted, pattern);
        if (sorts_) {
            std::sort(entries.begin(), entries.end(), standsBefore);
        }
        entries_->replace(std::move(entries));
        return static_cast<LRESULT>(entries_->all().size()) - 1;
    }

    LRESULT select(int row) {
        list_->setCurrentIndex(entries_->index(row));
        return selected();
    }

    LRESULT selected() const {
        const QModelIndexList rows = list_->selectionModel()->selectedRows();
        return rows.isEmpty() ? LB_ERR : rows.front().row();
    }

    LRESULT copyText(WPARAM row, char* target) const {
        if (row >= entries_->all().size()) {
            return LB_ERR;
        }
        const std::string& text = entries_->all()[row];
        if (target != nullptr) {
            std::memcpy(target, text.c_str(), text.size() + 1);
        }
        return static_cast<LRESULT>(text.size());
    }

    ListView* list_;
    Entries* entries_;
    bool sorts_;
};

} // namespace

std::unique_ptr<Control> makeListBox(const ControlTemplate& made, HWND handle, QWidget& dialog) {
    return std::make_unique<ListBox>(made, handle, dialog);
}

} // namespace seam
