// A service killed with SIGKILL in the middle of a burst of node creations keeps every node it
// acknowledged after a restart, and its database passes SQLite's integrity check.
#include <gtest/gtest.h>
#include <signal.h>

#include <optional>

#include "CrashBurst.h"
#include "RawPost.h"
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

TEST(WorkflowCrashSafety, AcknowledgedNodesSurviveSigkill) {
    const ServiceTesting::CrashScene scene("crash-ticket", "Crash");
    std::string inbox;
    std::vector<ServiceTesting::Acknowledged> acknowledged;
    {
        ServiceTesting::ServiceProcess service(scene.settings());
        const int port = service.port();
        post(port, "<Login><user><User><UserId>crash</UserId></User></user></Login>");
        inbox = elementText(
            post(port, "<GetUserStatus><userId>crash</userId></GetUserStatus>").body, "InboxId");
        acknowledged = ServiceTesting::killMidBurst(
            service, kWriters, kMaxCreatesPerWriter, kAcksBeforeKill, 30000,
            [&](int writer, int index) -> std::optional<std::string> {
                const ServiceTesting::RawAnswer answer = post(
                    port, "<CreateNode><node><Node><Name>w" + std::to_string(writer) + "-" +
                              std::to_string(index) + "</Name><UserId>crash</UserId><ParentId>" +
                              inbox + "</ParentId><Type>1</Type></Node></node></CreateNode>");
                if (answer.status != 200) {
                    return std::nullopt;
                }
                return elementText(answer.body, "string");
            });
    }
    ASSERT_GE(acknowledged.size(), 1u);
    {
        ServiceTesting::ServiceProcess restarted(scene.settings());
        const std::string listing = post(restarted.port(), "<GetFolderData><folderId>" + inbox +
                                                               "</folderId></GetFolderData>")
                                        .body;
        for (const auto& ack : acknowledged) {
            ASSERT_NE(std::string::npos, listing.find("<Id>" + ack.answer + "</Id>")) << ack.answer;
        }
        // At most one creation per writer was in flight; nothing else may appear.
        EXPECT_LE(ServiceTesting::occurrences(listing, "<Node>"), acknowledged.size() + kWriters);
    }
    Database database(scene.settings().storeDirectory + ".workflow.sqlite");
    EXPECT_EQ("ok", database.integrityCheck());
    EXPECT_EQ(Database::newestVersion(), database.version());
}

}  // namespace
}  // namespace Workflow
}  // namespace ConfigurationService
