// OpenFile and what works on its handles.

#include "platform/handle_table.h"
#include "platform/kernel.h"
#include "platform/kernel/counts.h"
#include "platform/kernel/descriptor.h"
#include "platform/kernel/faults.h"
#include "platform/kernel/paths.h"
#include "platform/kernel/text.h"
#include "platform/kernel/transfer.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <cerrno>

namespace {

seam::HandleTable<seam::Descriptor> openFiles(seam::HandleKind::file);

bool asksForWriting(UINT style) {
    return (style & (OF_READWRITE | OF_CREATE)) != 0;
}

/// 0, or the errno that keeps a thing that is there from being opened in this style. Judged before
/// the thing is touched: opening a FIFO or a device alone can have effects.
int refusal(const struct stat& status, UINT style) {
    constexpr mode_t anybodyWrites = S_IWUSR | S_IWGRP | S_IWOTH;
    if (S_ISDIR(status.st_mode)) {
        return EISDIR;
    }
    if (!S_ISREG(status.st_mode)) {
        return EINVAL;
    }
    return asksForWriting(style) && (status.st_mode & anybodyWrites) == 0 ? EACCES : 0;
}

/// Opens what stands at a path of the file system, or makes it if the style says so. 0, or the
/// errno of the failure; then nothing has been made or cut.
int openRegular(const std::string& path, UINT style, seam::Descriptor& opened) {
    struct stat status = {};
    const bool there = stat(path.c_str(), &status) == 0;
    if (!there && (errno != ENOENT || (style & OF_CREATE) == 0)) {
        return errno;
    }
    if (const int error = there ? refusal(status, style) : 0; error != 0) {
        return error;
    }
    constexpr mode_t newFileMode = 0666;
    const int access = asksForWriting(style) ? O_RDWR : O_RDONLY;
    const int make = there ? 0 : O_CREAT;
    opened = seam::openDescriptor(path, access | make | O_NONBLOCK | O_NOCTTY, newFileMode);
    if (!opened || fstat(opened.number(), &status) != 0) {
        return errno;
    }
    if (!S_ISREG(status.st_mode)) {
        return EINVAL;
    }
    const bool cuts = (style & OF_CREATE) != 0;
    return cuts && (seam::faultDue(seam::Operation::change) || ftruncate(opened.number(), 0) != 0)
               ? errno
               : 0;
}

int openPath(const seam::PathLookup& place, UINT style, seam::Descriptor& opened) {
    if (place.error != 0) {
        return place.error;
    }
    return place.asFolder ? EISDIR : openRegular(place.path, style, opened);
}

/// Opens into a table's slot that was taken before, so that a full table leaves no file behind.
DWORD openIntoTable(const seam::PathLookup& place, UINT style, int& error) {
    const DWORD handle = openFiles.add(std::make_unique<seam::Descriptor>());
    error = handle == 0 ? EMFILE : openPath(place, style, *openFiles.find(handle));
    if (error != 0) {
        openFiles.take(handle);
    }
    return handle;
}

LONG transferred(ssize_t count) {
    return static_cast<LONG>(count);
}

} // namespace

HFILE OpenFile(const char* name, OFSTRUCT* found, UINT style) {
    const std::vector<seam::Drive> known = seam::drives();
    const seam::PathLookup place =
        seam::lookUpPath(name != nullptr ? name : "", known, seam::currentDirectory());
    int error = 0;
    const DWORD handle = openIntoTable(place, style, error);
    if (found != nullptr) {
        const std::string path = seam::platformPath(place.path, known);
        *found = {};
        found->cBytes = sizeof(OFSTRUCT);
        found->fFixedDisk = path.starts_with("C:") ? 1 : 0;
        found->nErrCode = static_cast<WORD>(error);
        seam::copyCut(path, found->szPathName, sizeof found->szPathName);
    }
    return error == 0 ? HFILE{handle} : HFILE_ERROR;
}

LONG _hread(HFILE file, void* buffer, LONG bytes) {
    const seam::Descriptor* opened = openFiles.find(file.number);
    if (opened == nullptr || bytes < 0) {
        return -1;
    }
    return transferred(seam::readFully(opened->number(), buffer, static_cast<std::size_t>(bytes)));
}

LONG _hwrite(HFILE file, const void* buffer, LONG bytes) {
    const seam::Descriptor* opened = openFiles.find(file.number);
    if (opened == nullptr || bytes < 0) {
        return -1;
    }
    return transferred(seam::writeFully(opened->number(), buffer, static_cast<std::size_t>(bytes)));
}

HFILE _lclose(HFILE file) {
    return openFiles.take(file.number) ? HFILE{} : HFILE_ERROR;
}

DWORD GetFileSize(HFILE file, DWORD* high) {
    const seam::Descriptor* opened = openFiles.find(file.number);
    struct stat status = {};
    if (opened == nullptr || fstat(opened->number(), &status) != 0) {
        return 0xFFFFFFFF;
    }
    const auto size = static_cast<std::uint64_t>(status.st_size);
    if (high != nullptr) {
        *high = static_cast<DWORD>(size >> 32);
    }
    return static_cast<DWORD>(size);
}

std::size_t seam::liveFiles() {
    return openFiles.live();
}
