// HttpConfigurationClient from several threads: one client per thread, the host-name caches
// shared. Meant to run under ThreadSanitizer too (filter HttpClientConcurrency.*).
#include <gtest/gtest.h>

#include <atomic>
#include <condition_variable>
#include <cstring>
#include <thread>

#include "Quorvex/Base64Coder.h"
#include "client/HttpClientTestSupport.h"

namespace Configuration {
namespace {

using Testing::LegacyOk;
using Testing::ScriptedResponse;

const int THREADS = 8;
const int ROUNDS = 15;

// Lets every thread start its first request at the same moment.
class StartLine {
public:
    void arriveAndWait() {
        std::unique_lock<std::mutex> lock(m_mutex);
        if (++m_arrived == THREADS) {
            m_condition.notify_all();
        }
        m_condition.wait(lock, [this] { return m_arrived >= THREADS; });
    }

private:
    std::mutex m_mutex;
    std::condition_variable m_condition;
    int m_arrived = 0;
};

TEST(HttpClientConcurrency, OneClientPerThreadSharesTheHostNameCaches) {
    const std::string document(3000, 'x');
    const ACE_CString encoded = Base64Coder::Encode(
        reinterpret_cast<const unsigned char*>(document.data()), document.size());
    std::unique_ptr<Testing::RecordingHttpServer> servers[] = {Testing::StartFreshServer(),
                                                               Testing::StartFreshServer()};
    for (auto& server : servers) {
        Testing::AnswerHostNames(*server);
        server->setDefault(ScriptedResponse::Ok(
            LegacyOk("<Configuration>" + std::string(encoded.c_str()) +
                     "</Configuration><ConfigurationExists>1</ConfigurationExists>")));
    }

    StartLine start;
    std::atomic<int> failures{0};
    std::vector<std::thread> threads;
    for (int t = 0; t < THREADS; ++t) {
        threads.emplace_back([&, t] {
            start.arriveAndWait();
            try {
                const HttpConfigurationClient client(servers[t % 2]->authority().c_str(), false,
                                                     false);
                for (int round = 0; round < ROUNDS; ++round) {
                    Quorvex::ByteArray data;
                    std::size_t length = 0;
                    client.retrieve("h", "n", data, length);
                    bool exists = false;
                    client.checkForExistence("h", "n", exists);
                    const bool ok = exists && length == document.size() &&
                                    std::memcmp(data.get(), document.data(), length) == 0 &&
                                    client.hostName() == "cfg-host";
                    failures += ok ? 0 : 1;
                }
            } catch (const std::exception& e) {
                ADD_FAILURE() << e.what();
                ++failures;
            }
        });
    }
    for (auto& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(0, failures.load());
    for (auto& server : servers) {
        EXPECT_EQ(1u, server->countBody(Testing::HOST_NAME_REQUEST));
        EXPECT_EQ(1u, server->countBody(Testing::MASTER_HOST_NAME_REQUEST));
        EXPECT_EQ(2u + THREADS / 2 * ROUNDS * 2, server->requestCount());
    }
}

}  // namespace
}  // namespace Configuration
