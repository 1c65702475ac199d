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
    explicit HandleTable(std::uint32_t tag) : m_tag(tag << tagShift) {}

    /// Keeps `object` and answers its number, 0 when the table is full.
    [[nodiscard]] std::uintptr_t add(std::shared_ptr<T> object) {
        const std::uint32_t slot = freeSlot();
        if (slot > slotMask) {
            return 0;
        }
        m_slots[slot].object = std::move(object);
        return m_tag | (static_cast<std::uint32_t>(m_slots[slot].generation) << generationShift) | slot;
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
        m_freed.push_back(static_cast<std::uint32_t>(number & slotMask));
        return std::exchange(slot->object, nullptr);
    }

    /// How many numbers are in use.
    [[nodiscard]] std::size_t size() const {
        return m_slots.size() - m_freed.size();
    }

private:
    struct Slot {
        std::shared_ptr<T> object;
        std::uint8_t generation = 1;
    };
    static constexpr unsigned tagShift = 28;
    static constexpr unsigned generationShift = 20;
    static constexpr std::uint32_t slotMask = 0xFFFFF;
    /// So many slots wait before one is used again.
    static constexpr std::size_t quarantine = 256;

    std::uint32_t freeSlot() {
        if (m_freed.size() > quarantine || (!m_freed.empty() && m_slots.size() > slotMask)) {
            const std::uint32_t slot = m_freed.front();
            m_freed.pop_front();
            return slot;
        }
        if (m_slots.size() > slotMask) {
            return slotMask + 1;
        }
        m_slots.emplace_back();
        return static_cast<std::uint32_t>(m_slots.size() - 1);
    }

    const Slot* slotOf(std::uintptr_t number) const {
        const std::size_t index = number & slotMask;
        if (number >> 32 || index >= m_slots.size() || (number & (0xFU << tagShift)) != m_tag) {
            return nullptr;
        }
        const Slot& slot = m_slots[index];
        return slot.object && slot.generation == ((number >> generationShift) & 0xFF) ? &slot : nullptr;
    }

    std::uint32_t m_tag;
    std::vector<Slot> m_slots;
    std::deque<std::uint32_t> m_freed;
};

} // namespace tvx::afx
