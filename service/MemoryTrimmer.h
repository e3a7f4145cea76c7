// MemoryTrimmer: gives the allocator's free memory back to the system once large requests and
// answers have stopped for a while. Trimming after every large answer would return pages that
// the next answer faults straight back in (page faults and TLB shoot-downs cost more than
// building the answer); waiting for a quiet moment keeps a burst fast and still brings the
// resident size back down after it. Owned by the HTTP front next to the worker pool whose
// threads run the trim; cancel() before that pool is joined. All calls are thread-safe.
#pragma once

#include <atomic>
#include <boost/asio/steady_timer.hpp>
#include <boost/asio/thread_pool.hpp>
#include <chrono>
#include <cstddef>
#include <mutex>

namespace ConfigurationService {

class MemoryTrimmer {
public:
    // Trims on pool's threads once quiet has passed without a large body or answer.
    MemoryTrimmer(boost::asio::thread_pool& pool, std::chrono::milliseconds quiet);

    // Notes that a large body or answer was just released.
    void noteLarge();
    // Drops a pending trim; later notes schedule again.
    void cancel();
    // How many trims ran.
    std::size_t trims() const { return m_trims.load(); }

private:
    void arm(std::chrono::steady_clock::duration after);
    void onTimer();

    const std::chrono::steady_clock::duration m_quiet;
    std::atomic<std::chrono::steady_clock::rep> m_lastLarge{0};
    std::atomic<std::size_t> m_trims{0};
    std::mutex m_mutex;  // guards m_timer and m_armed
    boost::asio::steady_timer m_timer;
    bool m_armed = false;
};

}  // namespace ConfigurationService
