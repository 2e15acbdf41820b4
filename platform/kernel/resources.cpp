// Resources of the program file, which Qt's resource system holds: bitmaps as whole .bmp files in
// ":/bitmap", dialogs in ":/dialog", tables of keys in ":/accelerators".

#include "platform/handle_table.h"
#include "platform/kernel.h"

#include <QtCore/QResource>

#include <cstring>
#include <string>

namespace {

struct FoundResource {
    QString path;
    QByteArray whole; // shares the program's own bytes where they aren't compressed
    qsizetype start = 0;

    const char* bytes() const {
        return whole.constData() + start;
    }

    std::size_t size() const {
        return static_cast<std::size_t>(whole.size() - start);
    }
};

/// What has been found so far, each resource once; it stays, for nothing ever gives it back.
seam::HandleTable<FoundResource> resources(seam::HandleKind::resource);

/// The folder of a type's resources and what stands in front of the bytes proper.
struct ResourceFolder {
    const char* path = nullptr;
    qsizetype header = 0;
};

ResourceFolder folderOf(ResourceName type) {
    constexpr qsizetype bitmapFileHeader = 14;
    if (type.text != nullptr) {
        return {};
    }
    if (type.number == RT_BITMAP.number) {
        return {":/bitmap", bitmapFileHeader};
    }
    if (type.number == RT_DIALOG.number) {
        return {":/dialog", 0};
    }
    return type.number == RT_ACCELERATOR.number ? ResourceFolder{":/accelerators", 0}
                                                : ResourceFolder{};
}

/// The path of the resource of this name, whatever its case; empty if there is none. The resources
/// themselves have names in lower case.
QString resourcePath(const char* folder, const std::string& name) {
    if (name.find('/') != std::string::npos) {
        return {}; // would lead into another type's folder
    }
    const QString path =
        QString::fromLatin1(folder) + QLatin1Char('/') + QString::fromStdString(name).toLower();
    return QResource(path).isValid() ? path : QString();
}

DWORD handleOf(const QString& path) {
    DWORD handle = 0;
    resources.forEach([&](DWORD number, const FoundResource& resource) {
        handle = resource.path == path ? number : handle;
    });
    return handle;
}

} // namespace

HRSRC FindResourceA(HINSTANCE, ResourceName name, ResourceName type) {
    const ResourceFolder folder = folderOf(type);
    if (folder.path == nullptr) {
        return nullptr;
    }
    const std::string wanted = name.text != nullptr ? name.text : std::to_string(name.number);
    const QString path = resourcePath(folder.path, wanted);
    if (const DWORD known = path.isEmpty() ? 0 : handleOf(path); known != 0) {
        return HRSRC{known};
    }
    const QByteArray whole = QResource(path).uncompressedData();
    if (path.isEmpty() || whole.size() <= folder.header) {
        return nullptr;
    }
    return HRSRC{
        resources.add(std::make_unique<FoundResource>(FoundResource{path, whole, folder.header}))};
}

HGLOBAL LoadResource(HINSTANCE, HRSRC resource) {
    const FoundResource* found = resources.find(resource.number);
    if (found == nullptr) {
        return nullptr;
    }
    // The copy begins where a record may begin; the bytes behind a file header don't.
    const HGLOBAL block = GlobalAlloc(GMEM_MOVEABLE, found->size());
    if (void* target = GlobalLock(block)) {
        std::memcpy(target, found->bytes(), found->size());
        GlobalUnlock(block);
    }
    return block;
}

const void* LockResource(HGLOBAL resource) {
    const void* bytes = GlobalLock(resource);
    GlobalUnlock(resource);
    return bytes;
}

BOOL FreeResource(HGLOBAL resource) {
    return resource && !GlobalFree(resource) ? TRUE : FALSE;
}

DWORD SizeofResource(HINSTANCE, HRSRC resource) {
    const FoundResource* found = resources.find(resource.number);
    return found != nullptr ? static_cast<DWORD>(found->size()) : 0;
}
