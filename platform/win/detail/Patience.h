#pragma once

#include <algorithm>
#include <chrono>
#include <random>
#include <thread>

namespace tvx::registry {

/// How long to wait for other processes, in small uneven steps: whoever waits in step with others, or in steps that
/// grow, loses to those who come later.
class Patience {
public:
    /// Waits a little. Answers whether waiting makes sense any more: not after five seconds.
    bool wait() {
        const auto now = Clock::now();
        if (now >= m_end) {
            return false;
        }
        // A writer holds the store for some hundred microseconds; who waits for longer waits for something else.
        const bool isShort = now < m_end - longest + std::chrono::milliseconds(500);
        std::uniform_int_distribution<int> step(isShort ? 20 : 500, isShort ? 200 : 2000);
        std::this_thread::sleep_for(std::chrono::microseconds(step(m_random)));
        return true;
    }

private:
    using Clock = std::chrono::steady_clock;
    static constexpr std::chrono::seconds longest{5};

    Clock::time_point m_end = Clock::now() + longest;
    std::minstd_rand m_random{static_cast<unsigned>(m_end.time_since_epoch().count())};
};

} // namespace tvx::registry
