#pragma once

#include <cstdint>
#include <mutex>
#include <unordered_map>
#include <utility>

namespace tvx::win {

/// What stands behind the numbers that are given out as handles. No number is used twice, so that a stale one is always
/// noticed. Any thread may use it.
template <class T>
class NumberTable {
public:
    /// The new number, a multiple of four as the system's handles are.
    std::uintptr_t add(T entry) {
        const std::lock_guard lock(m_mutex);
        m_last += 4;
        m_entries.emplace(m_last, std::move(entry));
        return m_last;
    }

    /// Gives what stands behind a number to a call, others being kept off meanwhile. False for unknown numbers.
    template <class Call>
    bool with(std::uintptr_t number, Call call) {
        const std::lock_guard lock(m_mutex);
        const auto found = m_entries.find(number);
        if (found == m_entries.end()) {
            return false;
        }
        call(found->second);
        return true;
    }

    /// Takes an entry out, so that its object ends outside the lock. An empty one for unknown numbers.
    T take(std::uintptr_t number) {
        const std::lock_guard lock(m_mutex);
        auto node = m_entries.extract(number);
        return node ? std::move(node.mapped()) : T();
    }

private:
    std::mutex m_mutex;
    std::unordered_map<std::uintptr_t, T> m_entries;
    std::uintptr_t m_last = 0;
};

} // namespace tvx::win
