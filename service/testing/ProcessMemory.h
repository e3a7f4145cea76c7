// ProcessMemory: the resident memory of a process (from /proc), and PeakWatch, which samples it
// on a thread of its own every few milliseconds while it lives, to catch the peak of a burst.
// PeakWatch's peak() may be read from any thread.
#pragma once

#include <sys/types.h>

#include <atomic>
#include <cstddef>
#include <thread>

namespace ServiceTesting {

// Resident bytes of process pid now; 0 when it cannot be read.
std::size_t residentBytes(pid_t pid);

class PeakWatch {
public:
    // Starts sampling pid.
    explicit PeakWatch(pid_t pid);
    ~PeakWatch();
    PeakWatch(const PeakWatch&) = delete;
    PeakWatch& operator=(const PeakWatch&) = delete;

    // The highest resident size seen so far.
    std::size_t peak() const { return m_peak.load(); }

private:
    pid_t m_pid;
    std::atomic<bool> m_stop{false};
    std::atomic<std::size_t> m_peak{0};
    std::thread m_sampler;
};

}  // namespace ServiceTesting
