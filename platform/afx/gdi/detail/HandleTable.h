#pragma once

#include <cstdint>
#include <deque>
#include <memory>
#include <utility>
#include <vector>

namespace tvx::afx {

/// Hands out numbers for objects and finds the objects again. A number is never dereferenced: a stale, foreign or made
/// up one is simply not found, because each use of a slot has another generation and each table another tag.
///
/// 32 bits: tag (4), generation (8), slot (20). Freed slots are used again in the order they were freed, so that a
/// stale number stays unknown for as long as possible. For one thread at a time.
template <class T>
class HandleTable {
public:
    /// @param tag 1..15, different for each table, so that the numbers of two tables never mean each other's objects
    explicit HandleTable(std::uint32_t tag) : tag_(tag << kTagShift) {}

    /// Keeps `object` and answers its number, 0 when the table is full.
    [[nodiscard]] std::uintptr_t add(std::shared_ptr<T> object) {
        const std::uint32_t slot = freeSlot();
        if (slot > kSlotMask) {
            return 0;
        }
        slots_[slot].object = std::move(object);
        return tag_ | (static_cast<std::uint32_t>(slots_[slot].generation) << kGenerationShift) | slot;
    }

    /// The object of that number, null when there is none (any more).
    [[nodiscard]] std::shared_ptr<T> find(std::uintptr_t number) const {
        const Slot* slot = slotOf(number);
        return slot ? slot->object : nullptr;
    }

    /// Forgets the number. The result is what it stood for, null when it stood for nothing.
    std::shared_ptr<T> take(std::uintptr_t number) {
        auto* slot = const_cast<Slot*>(slotOf(number));
        if (!slot) {
            return nullptr;
        }
        ++slot->generation;
        freed_.push_back(static_cast<std::uint32_t>(number & kSlotMask));
        return std::exchange(slot->object, nullptr);
    }

    /// How many numbers are in use.
    [[nodiscard]] std::size_t size() const {
        return slots_.size() - freed_.size();
    }

private:
    struct Slot {
        std::shared_ptr<T> object;
        std::uint8_t generation = 1;
    };
    static constexpr unsigned kTagShift = 28;
    static constexpr unsigned kGenerationShift = 20;
    static constexpr std::uint32_t kSlotMask = 0xFFFFF;
    /// So many slots wait before one is used again.
    static constexpr std::size_t kQuarantine = 256;

    std::uint32_t freeSlot() {
        if (freed_.size() > kQuarantine || (!freed_.empty() && slots_.size() > kSlotMask)) {
            const std::uint32_t slot = freed_.front();
            freed_.pop_front();
            return slot;
        }
        if (slots_.size() > kSlotMask) {
            return kSlotMask + 1;
        }
        slots_.emplace_back();
        return static_cast<std::uint32_t>(slots_.size() - 1);
    }

    const Slot* slotOf(std::uintptr_t number) const {
        const std::size_t index = number & kSlotMask;
        if (number >> 32 || index >= slots_.size() || (number & (0xFU << kTagShift)) != tag_) {
            return nullptr;
        }
        const Slot& slot = slots_[index];
        return slot.object && slot.generation == ((number >> kGenerationShift) & 0xFF) ? &slot : nullptr;
    }

    std::uint32_t tag_;
    std::vector<Slot> slots_;
    std::deque<std::uint32_t> freed_;
};

} // namespace tvx::afx
