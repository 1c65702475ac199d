#pragma once

#include <algorithm>
#include <cstddef>
#include <type_traits>
#include <vector>

namespace tvx::afx {

/// A sequence with its free room in the middle, at the place of the last change: changes one beside the other, in
/// either direction, cost nothing, and any other one moves only what lies between.
/// @tparam T numbers and the like
template <typename T>
class GapBuffer {
    static_assert(std::is_trivially_copyable_v<T>);

public:
    std::size_t size() const {
        return m_room.size() - m_gap;
    }
    const T& operator[](std::size_t index) const {
        return m_room[index < m_start ? index : index + m_gap];
    }
    void insert(std::size_t index, T value) {
        if (m_gap == 0) {
            grow(std::max<std::size_t>(2 * m_room.size(), 16));
        }
        moveGap(index);
        m_room[m_start++] = value;
        --m_gap;
    }
    void erase(std::size_t index) {
        moveGap(index);
        ++m_gap;
    }
    void clear() {
        *this = {};
    }
    void reserve(std::size_t count) {
        if (count > m_room.size()) {
            grow(count);
        }
    }
    /// The first index from `from` to before `end` that holds the value; `end` when there is none.
    std::size_t find(const T& value, std::size_t from, std::size_t end) const {
        const std::size_t middle = std::clamp(m_start, from, end);
        const auto at = [this](std::size_t index) { return m_room.begin() + static_cast<std::ptrdiff_t>(index); };
        const auto found = std::find(at(from), at(middle), value);
        if (found != at(middle)) {
            return static_cast<std::size_t>(found - m_room.begin());
        }
        const auto behind = std::find(at(middle + m_gap), at(end + m_gap), value);
        return static_cast<std::size_t>(behind - m_room.begin()) - m_gap;
    }

private:
    /// The gap goes to the end first, so that the elements lie in one piece.
    void grow(std::size_t room) {
        moveGap(size());
        const std::size_t count = size();
        m_room.resize(room);
        m_gap = room - count;
    }
    void moveGap(std::size_t index) {
        const auto at = [this](std::size_t i) { return m_room.begin() + static_cast<std::ptrdiff_t>(i); };
        if (index < m_start) {
            std::copy_backward(at(index), at(m_start), at(m_start + m_gap));
        } else {
            std::copy(at(m_start + m_gap), at(index + m_gap), at(m_start));
        }
        m_start = index;
    }

    std::vector<T> m_room;
    std::size_t m_start = 0; ///< of the gap
    std::size_t m_gap = 0;
};

} // namespace tvx::afx
