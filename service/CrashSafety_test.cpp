// A service killed with SIGKILL in the middle of a burst of stores keeps every acknowledged store
// byte for byte after a restart, and never reads an unfinished write as an item.
#include <gtest/gtest.h>
#include <signal.h>
#include <sys/wait.h>

#include <filesystem>
#include <optional>
#include <random>

#include "CrashBurst.h"
#include "Quorvex/Base64Coder.h"
#include "RawPost.h"

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
    return ServiceTesting::itemBody("Store", "Crash", name,
                                    "<Configuration>" + base64(bytes) + "</Configuration>");
}

TEST(CrashSafety, AcknowledgedStoresSurviveSigkill) {
    const ServiceTesting::CrashScene scene("crash-ticket", "Crash");
    const std::string cookie = scene.cookie();
    std::vector<ServiceTesting::Acknowledged> acknowledged;
    {
        ServiceTesting::ServiceProcess service(scene.settings());
        const int port = service.port();
        acknowledged = ServiceTesting::killMidBurst(
            service, kWriters, kMaxStoresPerWriter, kAcksBeforeKill, 10000,
            [&](int writer, int index) -> std::optional<std::string> {
                const ServiceTesting::RawAnswer answer = ServiceTesting::rawPost(
                    port, storeBody(docName(writer, index), payload(writer, index)), cookie);
                if (elementText(answer.body, "ReturnStatus") != "1") {
                    return std::nullopt;
                }
                return answer.body;
            });
    }
    ASSERT_GE(acknowledged.size(), 1u);

    ServiceTesting::ServiceProcess restarted(scene.settings());
    for (const auto& entry : std::filesystem::directory_iterator(scene.settings().storeDirectory)) {
        EXPECT_NE(entry.path().filename().string().rfind(".__temp__", 0), 0u)
            << "leftover " << entry.path();
    }
    for (const auto& ack : acknowledged) {
        const ServiceTesting::RawAnswer got = ServiceTesting::rawPost(
            restarted.port(),
            "<Retrieve><Host>crash</Host><ConfigurationName>" + docName(ack.writer, ack.index) +
                "</ConfigurationName></Retrieve>",
            cookie);
        ASSERT_EQ(elementText(got.body, "Configuration"), base64(payload(ack.writer, ack.index)))
            << docName(ack.writer, ack.index);
    }
    // At most one store per writer was in flight; nothing else may appear.
    const std::string listing =
        ServiceTesting::rawPost(restarted.port(), "<ListItems><Host>*</Host></ListItems>", cookie)
            .body;
    const std::size_t items = ServiceTesting::occurrences(listing, "<ConfigurationItem>");
    EXPECT_GE(items, acknowledged.size());
    EXPECT_LE(items, acknowledged.size() + kWriters);
    EXPECT_EQ(listing.find(".__temp__"), std::string::npos);
}

TEST(CrashSafety, SigtermStopsTheServiceCleanly) {
    const ServiceTesting::CrashScene scene("stop-ticket", "");
    ServiceTesting::ServiceProcess service(scene.settings());
    ServiceTesting::rawPost(service.port(), "<GetHostName></GetHostName>", "");
    const int status = service.stop(SIGTERM);
    ASSERT_TRUE(WIFEXITED(status)) << status;
    EXPECT_EQ(WEXITSTATUS(status), 0);
    // The lock went with the process: the directory can be opened again at once.
    ServiceTesting::ServiceProcess again(scene.settings());
}

}  // namespace
}  // namespace ConfigurationService
