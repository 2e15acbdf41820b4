// Movable blocks of memory.

#include "platform/handle_table.h"
#include "platform/kernel.h"
#include "platform/kernel/counts.h"
#include "platform/kernel/faults.h"

#include <cstdlib>
#include <cstring>

namespace {

struct Block {
    Block() = default;
    Block(const Block&) = delete;
    Block& operator=(const Block&) = delete;

    ~Block() {
        std::free(bytes);
    }

    void* bytes = nullptr; // null in a block of 0 bytes
    std::size_t size = 0;
    unsigned locks = 0;
};

seam::HandleTable<Block> blocks(seam::HandleKind::memory);

/// A block is under 2 GiB, so that LONG counts its bytes.
constexpr std::size_t largestBlock = 0x7FFFFFFF;

/// Changes the size; false, and the block as it was, if there is no room.
bool resize(Block& block, std::size_t bytes, bool clear) {
    if (bytes > largestBlock) {
        return false;
    }
    if (bytes == 0) {
        std::free(block.bytes);
        block.bytes = nullptr;
        block.size = 0;
        return true;
    }
    void* moved =
        seam::faultDue(seam::Operation::block) ? nullptr : std::realloc(block.bytes, bytes);
    if (moved == nullptr) {
        return false;
    }
    if (clear && bytes > block.size) {
        std::memset(static_cast<char*>(moved) + block.size, 0, bytes - block.size);
    }
    block.bytes = moved;
    block.size = bytes;
    return true;
}

} // namespace

HGLOBAL GlobalAlloc(UINT flags, std::size_t bytes) {
    auto block = std::make_unique<Block>();
    if (!resize(*block, bytes, (flags & GMEM_ZEROINIT) != 0)) {
        return nullptr;
    }
    return HGLOBAL{blocks.add(std::move(block))};
}

HGLOBAL GlobalReAlloc(HGLOBAL block, std::size_t bytes, UINT flags) {
    Block* found = blocks.find(block.number);
    if (found == nullptr || found->locks > 0) {
        return nullptr;
    }
    return resize(*found, bytes, (flags & GMEM_ZEROINIT) != 0) ? block : HGLOBAL{};
}

void* GlobalLock(HGLOBAL block) {
    Block* found = blocks.find(block.number);
    if (found == nullptr || found->bytes == nullptr) {
        return nullptr;
    }
    ++found->locks;
    return found->bytes;
}

BOOL GlobalUnlock(HGLOBAL block) {
    Block* found = blocks.find(block.number);
    if (found == nullptr || found->locks == 0) {
        return FALSE;
    }
    --found->locks;
    return found->locks > 0 ? TRUE : FALSE;
}

HGLOBAL GlobalFree(HGLOBAL block) {
    return !block || blocks.take(block.number) ? HGLOBAL{} : block;
}

std::size_t seam::liveMemoryBlocks() {
    return blocks.live();
}
