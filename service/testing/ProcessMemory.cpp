// Resident memory of a process, read from /proc/<pid>/statm.
#include "ProcessMemory.h"

#include <unistd.h>

#include <chrono>
#include <fstream>
#include <string>

namespace ServiceTesting {

std::size_t residentBytes(pid_t pid) {
    std::ifstream statm("/proc/" + std::to_string(pid) + "/statm");
    std::size_t total = 0;
    std::size_t resident = 0;
    if (!(statm >> total >> resident)) {
        return 0;
    }
    return resident * static_cast<std::size_t>(::sysconf(_SC_PAGESIZE));
}

PeakWatch::PeakWatch(pid_t pid) : m_pid(pid), m_peak(residentBytes(pid)) {
    m_sampler = std::thread([this] {
        while (!m_stop.load()) {
            const std::size_t now = residentBytes(m_pid);
            std::size_t seen = m_peak.load();
            while (now > seen && !m_peak.compare_exchange_weak(seen, now)) {
            }
            std::this_thread::sleep_for(std::chrono::milliseconds(2));
        }
    });
}

PeakWatch::~PeakWatch() {
    m_stop = true;
    m_sampler.join();
}

}  // namespace ServiceTesting
