// The dialogs for choosing a file: the toolkit's own, with paths of the platform's form.
#include "platform/common_dialogs.h"

#include "platform/harness.h"
#include "platform/kernel/paths.h"
#include "platform/kernel/text.h"
#include "platform/user/overlay.h"
#include "platform/user/scale.h"
#include "platform/user/text.h"
#include "platform/user/toolkit.h"

#include <QComboBox>
#include <QDir>
#include <QFile>
#include <QFileDialog>
#include <QLineEdit>
#include <QListView>
#include <QMessageBox>
#include <QSettings>
#include <QUrl>
#include <QWindow>

#include <memory>
#include <optional>
#include <string_view>
#include <utility>

namespace seam {

namespace {

FileAnswer answerInstead;

/// A path of the file system as the toolkit has it; nothing if its bytes aren't UTF-8: the toolkit
/// knows no such names, shows none and gives none.
std::optional<QString> toolkitPath(const std::string& path) {
    const QString decoded = QFile::decodeName(path.c_str());
    return QFile::encodeName(decoded).toStdString() == path ? std::optional(decoded) : std::nullopt;
}

/// The directory, or else the nearest one above it, that the toolkit has a name for.
QString nearestDirectory(std::string path) {
    for (;;) {
        if (const auto known = path.empty() ? QStringLiteral("/") : toolkitPath(path)) {
            return *known;
        }
        path.resize(path.find_last_of('/'));
    }
}

/// Where the dialog begins, as a path of the file system.
std::string startDirectory(const char* wanted) {
    const std::string given = wanted == nullptr ? "" : wanted;
    const PathLookup found = given.empty() ? PathLookup{} : lookUpPath(given);
    return found.exists ? found.path : currentDirectory().value_or(homeDirectory());
}

/// "text\0pattern\0...\0" as the toolkit has its filters, "text (patterns)". "*.*" stands for every
/// name, also one without a point.
QStringList filtersOf(const char* pairs) {
    QStringList filters;
    while (pairs != nullptr && *pairs != '\0') {
        const std::string_view text = pairs;
        const std::string_view pattern = text.data() + text.size() + 1;
        pairs = pattern.data() + pattern.size() + 1;
        QStringList patterns =
            shownText(std::string(pattern)).split(QLatin1Char(';'), Qt::SkipEmptyParts);
        patterns.replaceInStrings(QStringLiteral("*.*"), QStringLiteral("*"));
        filters.append(shownText(std::string(text)) + QStringLiteral(" (") +
                       patterns.join(QLatin1Char(' ')) + QLatin1Char(')'));
    }
    return filters;
}

class FileDialog : public Overlay<QFileDialog> {
  public:
    FileDialog(const OPENFILENAME& asked, AcceptMode mode)
        : Overlay(asked.hwndOwner), owner_(asked.hwndOwner), size_(asked.nMaxFile) {
        constexpr int leastWidth = 426; // the toolkit's own where its texts are of plain size
        setMinimumWidth(dialogLength(leastWidth));
        setOptions(DontUseNativeDialog | DontConfirmOverwrite | HideNameFilterDetails |
                   DontUseCustomDirectoryIcons);
        setAcceptMode(mode);
        setFileMode(AnyFile);
        setViewMode(List);
        setSidebarUrls({});
        if (auto* sidebar = findChild<QListView*>(QStringLiteral("sidebar"))) {
            sidebar->hide();
        }
        if (asked.lpstrTitle != nullptr) {
            setWindowTitle(shownText(asked.lpstrTitle));
        }
        setFilters(asked);
        setStart(asked);
    }

    /// What was chosen, in the platform's form.
    const std::string& path() const {
        return path_;
    }

    /// From 1; 0 without filters.
    DWORD filterIndex() const {
        const auto& filters = *findChild<QComboBox*>(QStringLiteral("fileTypeCombo"));
        return nameFilters().isEmpty() ? 0 : static_cast<DWORD>(filters.currentIndex() + 1);
    }

  protected:
    void accept() override {
        const QString chosen = chosenPath();
        if (chosen.isEmpty() || QFileInfo(chosen).isDir()) {
            goInto(chosen);
            return;
        }
        path_ = platformPath(QFile::encodeName(chosen).toStdString(), drives());
        if (path_.empty()) {
            refuse(QStringLiteral("The path can't be used."));
        } else if (path_.size() >= size_) {
            refuse(QStringLiteral("The path is too long."));
        } else {
            done(Accepted);
        }
    }

  private:
    void setFilters(const OPENFILENAME& asked) {
        const QStringList filters = filtersOf(asked.lpstrFilter);
        if (filters.isEmpty()) {
            return;
        }
        setNameFilters(filters);
        const auto index = static_cast<qsizetype>(asked.nFilterIndex) - 1;
        selectNameFilter(filters.value(index, filters.first()));
    }

    /// The directory to begin with, and the name that stands there first.
    void setStart(const OPENFILENAME& asked) {
        std::string directory = startDirectory(asked.lpstrInitialDir);
        const PathLookup file = lookUpPath(asked.lpstrFile, drives(), directory);
        const std::size_t nameAt = file.path.find_last_of('/') + 1;
        if (nameAt > 0) {
            directory = file.path.substr(0, nameAt - 1);
        }
        setDirectory(nearestDirectory(directory));
        if (const auto name = toolkitPath(file.path.substr(nameAt))) {
            nameField().setText(*name);
            nameField().selectAll();
        }
    }

    QLineEdit& nameField() const {
        return *findChild<QLineEdit*>(QStringLiteral("fileNameEdit"));
    }

    /// The toolkit takes quote marks for the bounds of several names; here there is one.
    QString chosenPath() const {
        const QString typed = nameField().text();
        const QString chosen = typed.contains(QLatin1Char('"')) ? directory().filePath(typed)
                                                                : selectedFiles().value(0);
        return chosen.isEmpty() ? chosen : QDir::cleanPath(chosen);
    }

    /// The name that stands there already stays for the new directory, unless it was the way.
    void goInto(const QString& chosen) {
        if (QDir::cleanPath(directory().filePath(nameField().text())) == chosen) {
            nameField().clear();
        }
        if (!chosen.isEmpty()) {
            setDirectory(chosen);
        }
    }

    void refuse(const QString& why) {
        // On the heap, like the dialog itself; both go when the owner does.
        const auto box = std::make_unique<Overlay<QMessageBox>>(owner_);
        box->setWindowTitle(windowTitle());
        box->setText(why);
        box->setIcon(QMessageBox::Warning);
        connect(this, &QDialog::finished, box.get(), &QDialog::reject);
        execOver(*box, windowHandle());
    }

    HWND owner_;
    DWORD size_;
    std::string path_;
};

/// The toolkit would keep the directories gone to in a file of its own, for all its programs.
void keepNoTraces() {
    QSettings::setPath(QSettings::NativeFormat, QSettings::UserScope, QStringLiteral("/dev/null"));
}

/// What is too long counts as cancelled: nobody would see why it is refused.
BOOL takeAnswer(OPENFILENAME& asked) {
    const auto path = answerInstead(asked.lpstrTitle == nullptr ? "" : asked.lpstrTitle);
    if (!path || path->size() >= asked.nMaxFile) {
        return FALSE;
    }
    copyCut(*path, asked.lpstrFile, asked.nMaxFile);
    return TRUE;
}

BOOL chooseFile(OPENFILENAME& asked, QFileDialog::AcceptMode mode) {
    if (asked.lpstrFile == nullptr || asked.nMaxFile == 0) {
        return FALSE;
    }
    if (answerInstead) {
        return takeAnswer(asked);
    }
    if (!toolkit()) {
        return FALSE;
    }
    keepNoTraces();
    const auto dialog = std::make_unique<FileDialog>(asked, mode);
    if (runOver(*dialog, asked.hwndOwner) != QDialog::Accepted) {
        return FALSE;
    }
    copyCut(dialog->path(), asked.lpstrFile, asked.nMaxFile);
    asked.nFilterIndex = dialog->filterIndex();
    return TRUE;
}

} // namespace

void answerFileDialogs(FileAnswer answer) {
    answerInstead = std::move(answer);
}

} // namespace seam

using namespace seam;

BOOL GetOpenFileNameA(OPENFILENAME* dialog) {
    return chooseFile(*dialog, QFileDialog::AcceptOpen);
}

BOOL GetSaveFileNameA(OPENFILENAME* dialog) {
    return chooseFile(*dialog, QFileDialog::AcceptSave);
}
