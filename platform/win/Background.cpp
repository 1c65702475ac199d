#include "platform/win/Background.h"

#include "platform/win/Handle.h"
#include "platform/win/detail/KernelObject.h"

#include <atomic>
#include <csignal>
#include <cxxabi.h>
#include <sys/eventfd.h>
#include <system_error>
#include <thread>

namespace tvx {

/// What the two threads share.
struct win::BackgroundState {
    explicit BackgroundState(std::function<void()> toDo) : work(std::move(toDo)) {}

    std::function<void()> work;
    std::atomic<bool> isDone = false;
    std::shared_ptr<KernelObject> signal{};

    void run() {
        try {
            work();
            work = nullptr;
        } catch (abi::__forced_unwind&) {
            throw;
        } catch (...) {
            work = nullptr; // there is nobody to tell
        }
        isDone.store(true, std::memory_order_release);
        if (signal) {
            ::eventfd_write(signal->descriptor(), 1);
        }
    }
};

namespace {

/// Signals of the process are the other threads' business.
class NoSignals {
public:
    NoSignals() {
        sigset_t all;
        sigfillset(&all);
        ::pthread_sigmask(SIG_SETMASK, &all, &m_before);
    }
    ~NoSignals() {
        ::pthread_sigmask(SIG_SETMASK, &m_before, nullptr);
    }
    NoSignals(const NoSignals&) = delete;
    NoSignals& operator=(const NoSignals&) = delete;

private:
    sigset_t m_before{};
};

bool startThread(const std::shared_ptr<win::BackgroundState>& state) {
    const NoSignals quiet;
    try {
        std::thread([state] { state->run(); }).detach();
        return true;
    } catch (const std::system_error&) {
        return false;
    }
}

} // namespace

BackgroundWork::BackgroundWork(std::function<void()> work)
    : m_state(std::make_shared<win::BackgroundState>(std::move(work))) {
    win::Descriptor event(::eventfd(0, EFD_CLOEXEC));
    if (event) {
        m_state->signal = std::make_shared<win::KernelObject>(std::move(event));
    }
    if (m_state->signal && startThread(m_state)) {
        m_handle = win::makeHandle(m_state->signal, win::Inheritance::None);
        return;
    }
    m_state->signal = nullptr;
    m_state->run();
}

BackgroundWork::BackgroundWork(BackgroundWork&& other) noexcept
    : m_state(std::move(other.m_state)), m_handle(std::exchange(other.m_handle, nullptr)) {}

BackgroundWork& BackgroundWork::operator=(BackgroundWork&& other) noexcept {
    std::swap(m_state, other.m_state);
    std::swap(m_handle, other.m_handle);
    return *this;
}

BackgroundWork::~BackgroundWork() {
    if (m_handle) {
        CloseHandle(m_handle);
    }
}

bool BackgroundWork::isDone(DWORD timeout) const {
    if (m_state && m_handle && timeout > 0) {
        WaitForSingleObject(m_handle, timeout);
    }
    return m_state && m_state->isDone.load(std::memory_order_acquire);
}

} // namespace tvx
