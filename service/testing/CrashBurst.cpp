#include "CrashBurst.h"

#include <signal.h>

#include <atomic>
#include <chrono>
#include <mutex>
#include <thread>

namespace ServiceTesting {

CrashScene::CrashScene(const std::string& ticket, const std::string& hostName)
    : m_ticket(m_scratch.path(), ticket) {
    m_settings.storeDirectory = m_scratch.file("store");
    m_settings.eventDirectory = m_scratch.file("events");
    m_settings.hostName = hostName;
}

std::vector<Acknowledged> killMidBurst(
    ServiceProcess& service, int writers, int perWriter, int killAfter, int waitMs,
    const std::function<std::optional<std::string>(int writer, int index)>& write) {
    std::mutex mutex;
    std::vector<Acknowledged> acknowledged;
    std::atomic<int> count{0};
    std::vector<std::thread> threads;
    for (int w = 0; w < writers; ++w) {
        threads.emplace_back([&, w] {
            for (int i = 0; i < perWriter; ++i) {
                std::optional<std::string> answer = write(w, i);
                if (!answer) {
                    return;
                }
                std::lock_guard<std::mutex> lock(mutex);
                acknowledged.push_back({w, i, std::move(*answer)});
                ++count;
            }
        });
    }
    for (int waited = 0; waited < waitMs && count < killAfter; waited += 10) {
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    const bool killed = service.stop(SIGKILL) != -1;
    for (std::thread& thread : threads) {
        thread.join();
    }
    return killed ? acknowledged : std::vector<Acknowledged>();
}

std::size_t occurrences(const std::string& text, const std::string& needle) {
    std::size_t count = 0;
    for (std::size_t at = text.find(needle); at != std::string::npos;
         at = text.find(needle, at + needle.size())) {
        ++count;
    }
    return count;
}

}  // namespace ServiceTesting
