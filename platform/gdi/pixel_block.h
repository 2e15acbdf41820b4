// The memory behind the pixels of a bitmap.
#pragma once

#include "platform/types.h"

#include <cstddef>
#include <memory>

namespace seam {

/// Gives the pixels back; see makePixels. A count of 0 is for pixels that live for ever.
struct PixelRelease {
    std::size_t count = 0;
    void operator()(DWORD* pixels) const;
};

using PixelBlock = std::unique_ptr<DWORD[], PixelRelease>;

/// Room for `count` pixels with any contents; null if there is no memory.
PixelBlock makePixels(std::size_t count);

} // namespace seam
