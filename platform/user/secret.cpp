#include "platform/user/secret.h"

#include "platform/codepage.h"

#include <algorithm>
#include <new>
#include <sodium.h>
#include <sys/prctl.h>

namespace seam {

Secret::Secret() {
    if (sodium_init() >= 0) {
        memory_ = static_cast<char*>(sodium_malloc(capacity));
    } else {
        memory_ = nullptr;
    }
    if (memory_ == nullptr) {
        throw std::bad_alloc();
    }
    sodium_memzero(memory_, capacity);
}

Secret::~Secret() {
    sodium_free(memory_); // which wipes it
}

bool Secret::append(std::string_view character) {
    if (character.size() > capacity - size_) {
        return false;
    }
    std::copy(character.begin(), character.end(), memory_ + size_);
    size_ += character.size();
    return true;
}

void Secret::cutTo(std::size_t size) {
    sodium_memzero(memory_ + size, size_ - size);
    size_ = size;
}

void Secret::removeLast() {
    std::size_t size = size_;
    while (size > 0 && continuesUtf8(memory_[size - 1])) {
        --size;
    }
    cutTo(size > 0 ? size - 1 : 0);
}

void Secret::clear() {
    cutTo(0);
}

std::size_t Secret::characters() const {
    return size_ - static_cast<std::size_t>(std::count_if(memory_, memory_ + size_, continuesUtf8));
}

NoDumps::NoDumps() : before_(prctl(PR_GET_DUMPABLE) == 1) {
    prctl(PR_SET_DUMPABLE, 0);
}

NoDumps::~NoDumps() {
    if (before_) {
        prctl(PR_SET_DUMPABLE, 1);
    }
}

} // namespace seam
