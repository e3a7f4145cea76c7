// A second process for the storage-topology integration test: asks, through this process's
// repository and the library's default topology source, for the queue of the active persistent
// stack and of its mirror ("initial <queue> <mirror queue>"), then runs the ACE reactor (which
// delivers the machine's change event) until the active stack is the expected one ("seen <queue>
// <mirror queue>", exit 0) or the time is up ("timeout <queue>", exit 1). Between events the
// documents come from the repository's cache, so a new answer can only come from the event.
//
//   topology_probe EXPECTED_STACK_UID TIMEOUT_MS
#include <ace/Reactor.h>
#include <ace/Time_Value.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/MSMQCommonConfiguration.h"

namespace {

// "<queue> <mirror queue>" as the topology gives them now; the active stack's UID in uid.
std::string resolve(Configuration::MSMQCommonConfiguration& msmq, ACE_CString& uid) {
    Configuration::ConfigurationRepository::instance()->GetLatest(msmq);
    ACE_CString prefix, suffix, mirror, mirrorPrefix, mirrorSuffix;
    uid.clear();
    if (!msmq.getActivePersistentStackUid(uid, prefix, suffix) ||
        !msmq.getActivePersistentMirrorStackUid(mirror, mirrorPrefix, mirrorSuffix)) {
        return "unresolved";
    }
    return std::string((prefix + uid + suffix).c_str()) + " " +
           (mirrorPrefix + mirror + mirrorSuffix).c_str();
}

}  // namespace

int main(int argc, char** argv) {
    if (argc != 3) {
        std::fprintf(stderr, "usage: topology_probe EXPECTED_STACK_UID TIMEOUT_MS\n");
        return 2;
    }
    const ACE_CString expected = argv[1];
    const auto deadline =
        std::chrono::steady_clock::now() + std::chrono::milliseconds(std::atoi(argv[2]));
    Configuration::MSMQCommonConfiguration msmq;
    ACE_CString uid;
    std::string queues = resolve(msmq, uid);
    std::printf("initial %s\n", queues.c_str());
    std::fflush(stdout);
    while (std::chrono::steady_clock::now() < deadline) {
        ACE_Time_Value slice(0, 50000);
        ACE_Reactor::instance()->run_reactor_event_loop(slice);
        queues = resolve(msmq, uid);
        if (uid == expected) {
            std::printf("seen %s\n", queues.c_str());
            return 0;
        }
    }
    std::printf("timeout %s\n", queues.c_str());
    return 1;
}
