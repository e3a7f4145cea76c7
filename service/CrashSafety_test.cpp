// A service killed with SIGKILL in the middle of a burst of stores keeps every acknowledged store
// byte for byte after a restart, and never reads an unfinished write as an item.
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/wait.h>

#include <atomic>
#include <chrono>
#include <filesystem>
#include <mutex>
#include <random>
#include <thread>

#include "Quorvex/Base64Coder.h"
#include "RawPost.h"
#include "ServiceProcess.h"
#include "TicketFile.h"
#include "testing/ScratchDir.h"

namespace ConfigurationService {
namespace {

using ServiceTesting::elementText;

constexpr int kWriters = 3;
constexpr int kMaxStoresPerWriter = 400;
constexpr int kAcksBeforeKill = 60;

std::string payload(int writer, int index) {
    std::mt19937 random(static_cast<unsigned>(writer * 100000 + index));
    std::string bytes(1 + random() % 20000, '\0');
    for (char& c : bytes) {
        c = static_cast<char>(random());
    }
    return bytes;
}

std::string base64(const std::string& bytes) {
    return Base64Coder::Encode(reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size())
        .c_str();
}

std::string docName(int writer, int index) {
    return "Burst\\W" + std::to_string(writer) + "\\" + std::to_string(index);
}

std::string storeBody(const std::string& name, const std::string& bytes) {
    return "<Store><Host>Crash</Host><ConfigurationName>" + name +
           "</ConfigurationName><Configuration>" + base64(bytes) + "</Configuration></Store>";
}

class Burst {
public:
    Burst(int port, std::string cookie) : m_port(port), m_cookie(std::move(cookie)) {}

    // Each writer stores its documents one after another until a store is not answered.
    void run(int writer) {
        for (int i = 0; i < kMaxStoresPerWriter; ++i) {
            const ServiceTesting::RawAnswer answer = ServiceTesting::rawPost(
                m_port, storeBody(docName(writer, i), payload(writer, i)), m_cookie);
            if (elementText(answer.body, "ReturnStatus") != "1") {
                return;
            }
            std::lock_guard<std::mutex> lock(m_mutex);
            m_acknowledged.emplace_back(writer, i);
            ++m_count;
        }
    }
    int count() const { return m_count; }
    std::vector<std::pair<int, int>> acknowledged() {
        std::lock_guard<std::mutex> lock(m_mutex);
        return m_acknowledged;
    }

private:
    int m_port;
    std::string m_cookie;
    std::mutex m_mutex;
    std::vector<std::pair<int, int>> m_acknowledged;
    std::atomic<int> m_count{0};
};

TEST(CrashSafety, AcknowledgedStoresSurviveSigkill) {
    Quorvex::Testing::ScratchDir scratch;
    const ServiceTesting::TicketFile ticket(scratch.path(), "crash-ticket");
    const std::string cookie = "OrvelWebApplication=crash-ticket";
    ServiceTesting::ServiceProcess::Settings settings;
    settings.storeDirectory = scratch.file("store");
    settings.eventDirectory = scratch.file("events");
    settings.hostName = "Crash";

    std::vector<std::pair<int, int>> acknowledged;
    {
        ServiceTesting::ServiceProcess service(settings);
        Burst burst(service.port(), cookie);
        std::vector<std::thread> writers;
        for (int w = 0; w < kWriters; ++w) {
            writers.emplace_back([&burst, w] { burst.run(w); });
        }
        for (int i = 0; i < 1000 && burst.count() < kAcksBeforeKill; ++i) {
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
        EXPECT_NE(service.stop(SIGKILL), -1);
        for (std::thread& writer : writers) {
            writer.join();
        }
        acknowledged = burst.acknowledged();
    }
    ASSERT_GE(acknowledged.size(), 1u);

    ServiceTesting::ServiceProcess restarted(settings);
    for (const auto& entry : std::filesystem::directory_iterator(settings.storeDirectory)) {
        EXPECT_NE(entry.path().filename().string().rfind(".__temp__", 0), 0u)
            << "leftover " << entry.path();
    }
    for (const auto& ack : acknowledged) {
        const ServiceTesting::RawAnswer got = ServiceTesting::rawPost(
            restarted.port(),
            "<Retrieve><Host>crash</Host><ConfigurationName>" + docName(ack.first, ack.second) +
                "</ConfigurationName></Retrieve>",
            cookie);
        ASSERT_EQ(elementText(got.body, "Configuration"), base64(payload(ack.first, ack.second)))
            << docName(ack.first, ack.second);
    }
    // At most one store per writer was in flight; nothing else may appear.
    const std::string listing =
        ServiceTesting::rawPost(restarted.port(), "<ListItems><Host>*</Host></ListItems>", cookie)
            .body;
    std::size_t items = 0;
    for (std::size_t at = 0; (at = listing.find("<ConfigurationItem>", at)) != std::string::npos;
         ++at) {
        ++items;
    }
    EXPECT_GE(items, acknowledged.size());
    EXPECT_LE(items, acknowledged.size() + kWriters);
    EXPECT_EQ(listing.find(".__temp__"), std::string::npos);
}

TEST(CrashSafety, SigtermStopsTheServiceCleanly) {
    Quorvex::Testing::ScratchDir scratch;
    const ServiceTesting::TicketFile ticket(scratch.path(), "stop-ticket");
    ServiceTesting::ServiceProcess::Settings settings;
    settings.storeDirectory = scratch.file("store");
    settings.eventDirectory = scratch.file("events");
    ServiceTesting::ServiceProcess service(settings);
    ServiceTesting::rawPost(service.port(), "<GetHostName></GetHostName>", "");
    const int status = service.stop(SIGTERM);
    ASSERT_TRUE(WIFEXITED(status)) << status;
    EXPECT_EQ(WEXITSTATUS(status), 0);
    // The lock went with the process: the directory can be opened again at once.
    ServiceTesting::ServiceProcess again(settings);
}

}  // namespace
}  // namespace ConfigurationService
