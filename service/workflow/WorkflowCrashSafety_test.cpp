// A service killed with SIGKILL in the middle of a burst of node creations keeps every node it
// acknowledged after a restart, and its database passes SQLite's integrity check.
#include <gtest/gtest.h>
#include <signal.h>

#include <atomic>
#include <chrono>
#include <mutex>
#include <thread>

#include "RawPost.h"
#include "ServiceProcess.h"
#include "TicketFile.h"
#include "testing/ScratchDir.h"
#include "workflow/Database.h"
#include "workflow/WorkflowDispatcher.h"

namespace ConfigurationService {
namespace Workflow {
namespace {

using ServiceTesting::elementText;

constexpr int kWriters = 3;
constexpr int kMaxCreatesPerWriter = 2000;
constexpr int kAcksBeforeKill = 150;
const std::string kCookie = "OrvelWebApplication=crash-ticket";

ServiceTesting::RawAnswer post(int port, const std::string& message) {
    return ServiceTesting::rawPost(port, "<Message>" + message + "</Message>", kCookie,
                                   WorkflowDispatcher::kPath);
}

class Burst {
public:
    Burst(int port, std::string folder) : m_port(port), m_folder(std::move(folder)) {}

    // Each writer creates items one after another until one is not answered.
    void run(int writer) {
        for (int i = 0; i < kMaxCreatesPerWriter; ++i) {
            const ServiceTesting::RawAnswer answer =
                post(m_port, "<CreateNode><node><Node><Name>w" + std::to_string(writer) + "-" +
                                 std::to_string(i) + "</Name><UserId>crash</UserId><ParentId>" +
                                 m_folder + "</ParentId><Type>1</Type></Node></node></CreateNode>");
            if (answer.status != 200) {
                return;
            }
            std::lock_guard<std::mutex> lock(m_mutex);
            m_acknowledged.push_back(elementText(answer.body, "string"));
            ++m_count;
        }
    }
    int count() const { return m_count; }
    std::vector<std::string> acknowledged() {
        std::lock_guard<std::mutex> lock(m_mutex);
        return m_acknowledged;
    }

private:
    int m_port;
    std::string m_folder;
    std::mutex m_mutex;
    std::vector<std::string> m_acknowledged;
    std::atomic<int> m_count{0};
};

TEST(WorkflowCrashSafety, AcknowledgedNodesSurviveSigkill) {
    Quorvex::Testing::ScratchDir scratch;
    const ServiceTesting::TicketFile ticket(scratch.path(), "crash-ticket");
    ServiceTesting::ServiceProcess::Settings settings;
    settings.storeDirectory = scratch.file("store");
    settings.eventDirectory = scratch.file("events");
    settings.hostName = "Crash";

    std::string inbox;
    std::vector<std::string> acknowledged;
    {
        ServiceTesting::ServiceProcess service(settings);
        post(service.port(), "<Login><user><User><UserId>crash</UserId></User></user></Login>");
        inbox = elementText(
            post(service.port(), "<GetUserStatus><userId>crash</userId></GetUserStatus>").body,
            "InboxId");
        Burst burst(service.port(), inbox);
        std::vector<std::thread> writers;
        for (int w = 0; w < kWriters; ++w) {
            writers.emplace_back([&burst, w] { burst.run(w); });
        }
        for (int i = 0; i < 3000 && burst.count() < kAcksBeforeKill; ++i) {
            std::this_thread::sleep_for(std::chrono::milliseconds(10));
        }
        EXPECT_NE(service.stop(SIGKILL), -1);
        for (std::thread& writer : writers) {
            writer.join();
        }
        acknowledged = burst.acknowledged();
    }
    ASSERT_GE(acknowledged.size(), 1u);
    {
        ServiceTesting::ServiceProcess restarted(settings);
        const std::string listing = post(restarted.port(), "<GetFolderData><folderId>" + inbox +
                                                               "</folderId></GetFolderData>")
                                        .body;
        for (const std::string& id : acknowledged) {
            ASSERT_NE(std::string::npos, listing.find("<Id>" + id + "</Id>")) << id;
        }
        // At most one creation per writer was in flight; nothing else may appear.
        std::size_t nodes = 0;
        for (std::size_t at = 0; (at = listing.find("<Node>", at)) != std::string::npos; ++at) {
            ++nodes;
        }
        EXPECT_LE(nodes, acknowledged.size() + kWriters);
    }
    Database database(settings.storeDirectory + ".workflow.sqlite");
    EXPECT_EQ("ok", database.integrityCheck());
    EXPECT_EQ(Database::newestVersion(), database.version());
}

}  // namespace
}  // namespace Workflow
}  // namespace ConfigurationService
