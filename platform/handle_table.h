// The table behind the handles of one kind. Only the seam includes it.
#pragma once

#include "platform/types.h"

#include <deque>
#include <memory>
#include <utility>
#include <vector>

namespace seam {

/// Bits of a handle's number: 31 always set, 27 to 30 the kind, 14 to 26 the generation, 0 to 13
/// the slot. Every table has a kind of its own, so that a handle of one is refused by another.
enum class HandleKind : DWORD {
    window,
    deviceContext,
    gdiObject,
    palette,
    memory,
    file,
    search,
    resource,
    device,
    key,
    remoteWindow,
    menu,
    accelerators
};

template <class Object>
class HandleTable {
  public:
    explicit HandleTable(HandleKind kind) : kind_(kind) {}

    /// Takes the object in and gives its number; 0 if all 16384 slots are taken.
    DWORD add(std::unique_ptr<Object> object) {
        std::size_t slot = 0;
        if (!free_.empty()) {
            slot = free_.front(); // the one that has lain longest: its old handles are the oldest
            free_.pop_front();
        } else if (slots_.size() <= slotMask) {
            slot = slots_.size();
            slots_.emplace_back();
        } else {
            return 0;
        }
        slots_[slot].object = std::move(object);
        ++live_;
        return number(slot);
    }

    /// The object of a number, or null if the number is stale or was never given by this table.
    Object* find(DWORD number) const {
        const std::size_t slot = number & slotMask;
        if (slot >= slots_.size() || this->number(slot) != number) {
            return nullptr;
        }
        return slots_[slot].object.get();
    }

    /// Takes the object out; null as in find. The number is stale from here on.
    std::unique_ptr<Object> take(DWORD number) {
        if (find(number) == nullptr) {
            return nullptr;
        }
        Slot& slot = slots_[number & slotMask];
        slot.generation = (slot.generation + 1) & generationMask;
        free_.push_back(number & slotMask);
        --live_;
        return std::move(slot.object);
    }

    /// How many objects the table holds.
    std::size_t live() const {
        return live_;
    }

    /// Calls visit(number, object) for each object; visit must not add or take.
    template <class Visit>
    void forEach(Visit visit) const {
        for (std::size_t slot = 0; slot < slots_.size(); ++slot) {
            if (slots_[slot].object) {
                visit(number(slot), *slots_[slot].object);
            }
        }
    }

  private:
    struct Slot {
        std::unique_ptr<Object> object;
        DWORD generation = 0;
    };

    static constexpr DWORD slotMask = 0x3FFF;
    static constexpr DWORD generationMask = 0x1FFF;

    DWORD number(std::size_t slot) const {
        return 0x80000000U | (static_cast<DWORD>(kind_) << 27) | (slots_[slot].generation << 14) |
               static_cast<DWORD>(slot);
    }

    HandleKind kind_;
    std::vector<Slot> slots_;
    std::deque<std::size_t> free_;
    std::size_t live_ = 0;
};

} // namespace seam
