// A trim once large traffic has paused.
#include "MemoryTrimmer.h"

#include <malloc.h>

namespace ConfigurationService {

using Clock = std::chrono::steady_clock;

MemoryTrimmer::MemoryTrimmer(boost::asio::thread_pool& pool, std::chrono::milliseconds quiet)
    : m_quiet(quiet), m_timer(pool.get_executor()) {}

void MemoryTrimmer::noteLarge() {
    m_lastLarge = Clock::now().time_since_epoch().count();
    std::lock_guard<std::mutex> lock(m_mutex);
    if (!m_armed) {
        m_armed = true;
        arm(m_quiet);
    }
}

void MemoryTrimmer::cancel() {
    std::lock_guard<std::mutex> lock(m_mutex);
    m_armed = false;
    m_timer.cancel();
}

// Called with m_mutex held.
void MemoryTrimmer::arm(Clock::duration after) {
    m_timer.expires_after(after);
    m_timer.async_wait([this](const boost::system::error_code& error) {
        if (!error) {
            onTimer();
        }
    });
}

void MemoryTrimmer::onTimer() {
    {
        std::lock_guard<std::mutex> lock(m_mutex);
        if (!m_armed) {
            return;
        }
        const Clock::duration since =
            Clock::now() - Clock::time_point(Clock::duration(m_lastLarge.load()));
        if (since < m_quiet) {
            arm(m_quiet - since);
            return;
        }
        m_armed = false;
    }
    ::malloc_trim(0);
    ++m_trims;
}

}  // namespace ConfigurationService
