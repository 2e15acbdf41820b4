#include "platform/user/icons.h"

#include <QFile>

#include <map>

namespace seam {

namespace {

/// What title bars and panels ask for. The largest picture is for the desktop's menus; a window
/// would only carry its weight.
constexpr int sizes[] = {16, 22, 24, 32, 48, 64, 128};

QString fileOf(WORD number, int size) {
    return QStringLiteral(":/icon/%1/%2.png").arg(number).arg(size);
}

QIcon readIcon(HICON icon) {
    QIcon pictures;
    for (const int size : sizes) {
        const QString file = fileOf(static_cast<WORD>(icon.number), size);
        if (icon && QFile::exists(file)) {
            pictures.addFile(file);
        }
    }
    return pictures;
}

} // namespace

QIcon iconOf(HICON icon) {
    // Each once: the toolkit keeps what it has drawn of an icon, and takes a second one for
    // another. Never freed, like the application object.
    static auto* const known = new std::map<DWORD, QIcon>;
    const auto found = known->find(icon.number);
    return found != known->end() ? found->second
                                 : known->emplace(icon.number, readIcon(icon)).first->second;
}

QIcon programIcon() {
    constexpr DWORD number = 100;
    return iconOf(HICON{number});
}

} // namespace seam

// A program loads its icon before it has a screen, so only the file is looked for here.
HICON LoadIconA(HINSTANCE instance, ResourceName name) {
    const bool ours = instance && name.text == nullptr;
    return ours && QFile::exists(seam::fileOf(name.number, 32)) ? HICON{name.number} : HICON{};
}
