#include "cli/out_file.h"

#include <cerrno>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <filesystem>
#include <stdexcept>
#include <sys/stat.h>
#include <unistd.h>

namespace fs = std::filesystem;

void FailWith(const std::string& path, int error) {
    throw std::runtime_error(path + ": " + std::strerror(error));
}

OutFile::OutFile(const std::string& path) : shown_(path) {
    std::error_code error;
    const fs::file_status status = fs::status(path, error);
    if (fs::exists(status) && !fs::is_regular_file(status)) {
        throw std::runtime_error(path + ": it is no regular file");
    }
    constexpr fs::perms anybodyWrites =
        fs::perms::owner_write | fs::perms::group_write | fs::perms::others_write;
    if (fs::exists(status) && (status.permissions() & anybodyWrites) == fs::perms::none) {
        FailWith(path, EACCES); // read-only by its mode bits, for whoever it is
    }
    if (fs::exists(status) && access(path.c_str(), W_OK) != 0) {
        FailWith(path, errno);
    }
    target_ = fs::weakly_canonical(fs::absolute(path, error), error);
    beside_ = target_ + ".XXXXXX";
    const int descriptor = target_.empty() ? -1 : mkostemp(beside_.data(), O_CLOEXEC);
    if (descriptor < 0) {
        FailWith(path, error ? error.value() : errno);
    }
    file_ = fdopen(descriptor, "wb");
    if (file_ == nullptr) {
        const int reason = errno;
        close(descriptor);
        unlink(beside_.c_str());
        FailWith(path, reason);
    }
}

OutFile::~OutFile() {
    if (file_ != nullptr) {
        std::fclose(file_);
        unlink(beside_.c_str());
    }
}

void OutFile::write(const void* bytes, std::size_t count) {
    if (std::fwrite(bytes, 1, count, file_) != count) {
        FailWith(shown_, errno);
    }
}

void OutFile::writeAt(long place, const Bytes& bytes) {
    if (std::fseek(file_, place, SEEK_SET) != 0) {
        FailWith(shown_, errno);
    }
    write(bytes.data(), bytes.size());
    if (std::fseek(file_, 0, SEEK_END) != 0) {
        FailWith(shown_, errno);
    }
}

/// The mode of the file at the path, or the one that a new file gets.
static mode_t modeFor(const std::string& path) {
    struct stat status = {};
    if (stat(path.c_str(), &status) == 0) {
        return status.st_mode & 07777;
    }
    const mode_t mask = umask(0);
    umask(mask);
    return 0666 & ~mask;
}

void OutFile::commit() {
    if (std::fflush(file_) != 0 || fchmod(fileno(file_), modeFor(target_)) != 0 ||
        fsync(fileno(file_)) != 0 || rename(beside_.c_str(), target_.c_str()) != 0) {
        FailWith(shown_, errno);
    }
    std::fclose(file_);
    file_ = nullptr;
}
