// Opening, reading and writing through a descriptor until all is done, and whole files. Paths are
// those of the file system.
#pragma once

#include "platform/kernel/descriptor.h"

#include <sys/types.h>

#include <cstddef>
#include <string>
#include <string_view>

namespace seam {

/// As open() does, and closed where another program is started; none with a reason in errno.
Descriptor openDescriptor(const std::string& path, int flags, mode_t mode = 0);

/// Reads or writes until `bytes` bytes have gone, the file ends or an error comes. Gives the number
/// transferred, or -1 on an error before the first byte. `error`, if not null, gets 0, or the errno
/// that has ended it.
ssize_t readFully(int descriptor, void* buffer, std::size_t bytes, int* error = nullptr);
ssize_t writeFully(int descriptor, const void* buffer, std::size_t bytes);

struct WholeFile {
    int error = 0; // 0, or the errno that kept it from being read
    std::string text;
};

/// Reads a regular file, of any size up to `limit` bytes; EFBIG for a larger one. Never waits.
WholeFile readWholeFile(const std::string& path, std::size_t limit);

/// Puts a file with this text in the place of the one at path, or makes it: written whole beside
/// it and renamed, so that nobody ever sees half of it. A link stays a link, and its target is
/// replaced. An old file's mode is kept, a new one has `newMode`. False with a reason in errno, and
/// the old file as it was, if anything fails, also if the old one is no regular file (EINVAL) or
/// may not be written.
bool replaceFile(const std::string& path, std::string_view text, mode_t newMode = 0600);

} // namespace seam
