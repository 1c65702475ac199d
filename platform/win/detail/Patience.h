#pragma once

#include <algorithm>
#include <chrono>
#include <optional>
#include <random>
#include <thread>

namespace tvx::registry {

/// How long to wait for other processes, in small uneven steps: whoever waits in step with others, or in steps that
/// grow, loses to those who come later.
class Patience {
public:
    explicit Patience(std::chrono::milliseconds length)
        : m_end(Clock::now() + length), m_long(m_end - length + brief) {}

    /// Waits a little. Answers whether waiting makes sense any more: not when the time is over.
    bool wait() {
        const auto now = Clock::now();
        if (now >= m_end) {
            return false;
        }
        // A writer holds the store for some hundred microseconds; who waits for longer waits for something else.
        const bool isShort = now < m_long;
        std::uniform_int_distribution<int> step(isShort ? 20 : 500, isShort ? 200 : 2000);
        std::this_thread::sleep_for(std::chrono::microseconds(step(m_random)));
        return true;
    }

private:
    using Clock = std::chrono::steady_clock;
    static constexpr std::chrono::milliseconds brief{500};

    Clock::time_point m_end;
    Clock::time_point m_long; ///< from then on it is something else
    std::minstd_rand m_random{static_cast<unsigned>(m_end.time_since_epoch().count())};
};

/// The waits of a store. Whoever has waited in vain waits hardly at all from then on, until the other process is seen
/// to have ended its writing: a program that keeps twenty values need not stand still for twenty times as long.
class Waiting {
public:
    /// Waits a little. Answers whether waiting makes sense any more.
    bool wait(bool isFirst) {
        if (isFirst || !m_patience) {
            m_patience.emplace(m_isInVain ? std::chrono::milliseconds(20) : std::chrono::seconds(5));
        }
        const bool makesSense = m_patience->wait();
        m_isInVain = m_isInVain || !makesSense;
        return makesSense;
    }
    /// Something could be written.
    void end() {
        m_isInVain = false;
    }

private:
    std::optional<Patience> m_patience; ///< of the wait that is going on
    bool m_isInVain = false;
};

} // namespace tvx::registry
