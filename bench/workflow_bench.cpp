// User-workflow folder operations through the library's client against the service, with the
// database on disk: node creations per second (one client, and four at once) next to the same
// creation posted bare, and GetFolderData of a folder holding 10,000 items (ms) next to the bare
// post of the same request (the client's share is reading the records). Prints figures and
// ratios; no thresholds.
#include <algorithm>
#include <chrono>
#include <cstdio>
#include <thread>
#include <vector>

#include "Configuration/HttpConfigurationClient.h"
#include "InProcessService.h"
#include "Quorvex/BDateTime.h"
#include "RawPost.h"

namespace {

using Clock = std::chrono::steady_clock;
using Configuration::HttpConfigurationClient;
using Configuration::UwfNodeData;

constexpr int kCreates = 1000;
constexpr int kThreads = 4;
constexpr int kFolderItems = 10000;
constexpr int kReads = 5;
const char* const kPath = "/Sundrel/UserWorkflowService/UserWorkFlow.ashx";

double seconds(Clock::time_point since) {
    return std::chrono::duration<double>(Clock::now() - since).count();
}

// Creates count items under folder through the client; returns the seconds it took.
double createItems(const HttpConfigurationClient& client, const ACE_CString& folder, int count) {
    auto node = UwfNodeData::Create();
    node->UserId = "bench";
    node->ParentId = folder;
    node->Type = UwfNodeData::Item;
    BDateTime modified;
    const auto start = Clock::now();
    for (int i = 0; i < count; ++i) {
        node->Name = ACE_CString("item ") + std::to_string(i).c_str();
        client.UwfCreateNode(*node, modified);
    }
    return seconds(start);
}

double createItemsBare(int port, const std::string& folder, int count) {
    const std::string message =
        "<Message><CreateNode><node><Node><Name>bare</Name><UserId>bench"
        "</UserId><ParentId>" +
        folder +
        "</ParentId><Type>1</Type></Node></node></CreateNode>"
        "</Message>";
    const std::string cookie =
        std::string("OrvelWebApplication=") + ServiceTesting::InProcessService::kTicket;
    const auto start = Clock::now();
    for (int i = 0; i < count; ++i) {
        ServiceTesting::rawPost(port, message, cookie, kPath);
    }
    return seconds(start);
}

// The median of kReads runs of read, in ms.
template <class Read>
double medianMs(Read read) {
    std::vector<double> runs;
    for (int i = 0; i < kReads; ++i) {
        const auto start = Clock::now();
        read();
        runs.push_back(seconds(start) * 1000);
    }
    std::sort(runs.begin(), runs.end());
    return runs[runs.size() / 2];
}

}  // namespace

int main() {
    ServiceTesting::InProcessService service;
    const HttpConfigurationClient client(service.address().c_str(), true, false);
    auto user = Configuration::UwfUserData::Create();
    user->UserId = "bench";
    std::vector<Configuration::SmartPtr<UwfNodeData>> roots;
    client.UwfLoginUser(*user, roots);
    client.UwfGetUserStatus("bench", *user);

    const double one = createItems(client, user->InboxId, kCreates);
    const double bare = createItemsBare(service.port(), user->InboxId.c_str(), kCreates);
    std::printf("creates, one client:   %8.0f /s  (bare post %8.0f /s, ratio %.2f)\n",
                kCreates / one, kCreates / bare, bare / one);

    const auto start = Clock::now();
    std::vector<std::thread> threads;
    const int share = (kFolderItems - 2 * kCreates) / kThreads;
    for (int t = 0; t < kThreads; ++t) {
        threads.emplace_back([&] { createItems(client, user->InboxId, share); });
    }
    for (auto& thread : threads) {
        thread.join();
    }
    const double together = seconds(start);
    std::printf("creates, %d clients:    %8.0f /s  (ratio to one client %.2f)\n", kThreads,
                kThreads * share / together, (kThreads * share / together) / (kCreates / one));

    std::size_t count = 0;
    const double read = medianMs([&] {
        std::vector<Configuration::SmartPtr<UwfNodeData>> nodes;
        client.UwfGetFolderData(user->MasterFolderId, BDateTime(), nodes);
        client.UwfGetFolderData(user->InboxId.c_str(), BDateTime(), nodes);
        count = nodes.size();
    });
    const std::string cookie =
        std::string("OrvelWebApplication=") + ServiceTesting::InProcessService::kTicket;
    const double readBare = medianMs([&] {
        ServiceTesting::rawPost(service.port(),
                                "<Message><GetFolderData><folderId>" +
                                    std::string(user->InboxId.c_str()) +
                                    "</folderId></GetFolderData></Message>",
                                cookie, kPath);
    });
    std::printf("GetFolderData of %zu items: %7.1f ms  (bare post %7.1f ms, ratio %.2f)\n", count,
                read, readBare, read / readBare);
    return 0;
}
