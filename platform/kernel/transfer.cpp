#include "platform/kernel/transfer.h"

#include "platform/kernel/faults.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <climits>
#include <cstdio>
#include <cstdlib>
#include <memory>

namespace seam {

namespace {

template <class Byte, class Transfer>
ssize_t transferFully(Byte* buffer, std::size_t bytes, int* error, Transfer transfer) {
    std::size_t done = 0;
    *error = 0;
    while (done < bytes) {
        const ssize_t count = transfer(buffer + done, bytes - done);
        if (count < 0 && errno == EINTR) {
            continue;
        }
        if (count < 0) {
            *error = errno;
        }
        if (count < 0 && done == 0) {
            return -1;
        }
        if (count <= 0) {
            break;
        }
        done += static_cast<std::size_t>(count);
    }
    return static_cast<ssize_t>(done);
}

/// Reads on to the end of the file. The size told is no more than a start: a file of /proc tells 0.
WholeFile readToEnd(int file, std::size_t sizeTold, std::size_t limit) {
    constexpr std::size_t chunk = 65536;
    std::string text;
    std::size_t room = sizeTold + chunk;
    while (sizeTold <= limit && text.size() <= limit) {
        const std::size_t before = text.size();
        text.resize(std::min(before + room, limit + 1));
        int error = 0;
        const ssize_t count = readFully(file, text.data() + before, text.size() - before, &error);
        if (error != 0) {
            return {error, {}}; // part of a file must not pass for the whole
        }
        const std::size_t filled = before + static_cast<std::size_t>(count);
        if (filled < text.size()) {
            text.resize(filled);
            return {0, std::move(text)};
        }
        room = chunk;
    }
    return {EFBIG, {}};
}

/// The path of what the links at `path` lead to; the path itself where there is nothing yet.
std::string withoutLinks(const std::string& path) {
    const std::unique_ptr<char, decltype(&std::free)> real(realpath(path.c_str(), nullptr),
                                                           &std::free);
    if (real) {
        return real.get();
    }
    char target[PATH_MAX];
    const bool missing = errno == ENOENT; // and no circle of links
    const ssize_t length = missing ? readlink(path.c_str(), target, sizeof target) : -1;
    if (length <= 0) {
        return path;
    }
    const std::string next(target, static_cast<std::size_t>(length));
    const bool whole = next.front() == '/';
    return withoutLinks(whole ? next : path.substr(0, path.rfind('/') + 1) + next);
}

constexpr mode_t anybodyWrites = S_IWUSR | S_IWGRP | S_IWOTH;

/// The mode that a file takes over from the one it replaces; 0, and a reason in errno, if that must
/// not be replaced.
mode_t modeForReplacing(const std::string& path, mode_t newMode) {
    struct stat status = {};
    if (stat(path.c_str(), &status) != 0) {
        return errno == ENOENT ? newMode : 0;
    }
    if (!S_ISREG(status.st_mode)) {
        errno = EINVAL;
        return 0;
    }
    if ((status.st_mode & anybodyWrites) == 0) {
        errno = EACCES;
        return 0;
    }
    const bool writable = faccessat(AT_FDCWD, path.c_str(), W_OK, AT_EACCESS) == 0;
    return writable ? status.st_mode & 07777 : 0;
}

} // namespace

Descriptor openDescriptor(const std::string& path, int flags, mode_t mode) {
    return Descriptor(faultDue(Operation::open) ? -1 : open(path.c_str(), flags | O_CLOEXEC, mode));
}

ssize_t readFully(int descriptor, void* buffer, std::size_t bytes, int* error) {
    int unasked = 0;
    return transferFully(static_cast<char*>(buffer), bytes, error != nullptr ? error : &unasked,
                         [descriptor](char* at, std::size_t left) {
                             return faultDue(Operation::read, &left) ? -1
                                                                     : read(descriptor, at, left);
                         });
}

ssize_t writeFully(int descriptor, const void* buffer, std::size_t bytes) {
    int unasked = 0;
    return transferFully(static_cast<const char*>(buffer), bytes, &unasked,
                         [descriptor](const char* at, std::size_t left) {
                             return faultDue(Operation::write, &left) ? -1
                                                                      : write(descriptor, at, left);
                         });
}

WholeFile readWholeFile(const std::string& path, std::size_t limit) {
    const Descriptor file = openDescriptor(path, O_RDONLY | O_NONBLOCK | O_NOCTTY);
    struct stat status = {};
    if (!file || fstat(file.number(), &status) != 0) {
        return {errno, {}};
    }
    if (!S_ISREG(status.st_mode)) {
        return {EINVAL, {}};
    }
    return readToEnd(file.number(), static_cast<std::size_t>(status.st_size), limit);
}

bool replaceFile(const std::string& path, std::string_view text, mode_t newMode) {
    const std::string target = withoutLinks(path);
    const mode_t mode = modeForReplacing(target, newMode);
    if (mode == 0) {
        return false;
    }
    std::string beside = target + ".XXXXXX";
    const Descriptor file(faultDue(Operation::open) ? -1 : mkostemp(beside.data(), O_CLOEXEC));
    if (!file) {
        return false;
    }
    const bool written =
        writeFully(file.number(), text.data(), text.size()) == static_cast<ssize_t>(text.size()) &&
        !faultDue(Operation::change) && fchmod(file.number(), mode) == 0 &&
        !faultDue(Operation::change) && fsync(file.number()) == 0 && !faultDue(Operation::rename) &&
        rename(beside.c_str(), target.c_str()) == 0;
    if (!written) {
        const int reason = errno;
        unlink(beside.c_str());
        errno = reason;
    }
    return written;
}

} // namespace seam
