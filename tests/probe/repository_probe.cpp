// A second process for the repository's integration tests: reads a site-wide test document
// through this process's repository, says so on stdout ("initial <name>"), then runs the ACE
// reactor (which delivers the machine's change event) until the document's name reads as
// expected ("seen <name>", exit 0) or the time is up ("timeout <name>", exit 1). Between
// events it reads through the cache only, so a new name can only come from the event.
//
//   repository_probe DOCUMENT EXPECTED_NAME TIMEOUT_MS
#include <ace/Reactor.h>
#include <ace/Time_Value.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>

#include "Configuration/ConfigurationRepository.h"
#include "model/TestDocument.h"

int main(int argc, char** argv) {
    if (argc != 4) {
        std::fprintf(stderr, "usage: repository_probe DOCUMENT EXPECTED_NAME TIMEOUT_MS\n");
        return 2;
    }
    const std::string expected = argv[2];
    const auto deadline =
        std::chrono::steady_clock::now() + std::chrono::milliseconds(std::atoi(argv[3]));
    Configuration::ConfigurationRepository* repository =
        Configuration::ConfigurationRepository::instance();
    Configuration::Testing::TestDocument doc(argv[1]);
    if (repository->GetLatest(doc) != 0) {
        std::printf("unreadable %s\n", argv[1]);
        return 1;
    }
    std::printf("initial %s\n", doc.name.c_str());
    std::fflush(stdout);
    while (std::chrono::steady_clock::now() < deadline) {
        ACE_Time_Value slice(0, 50000);
        ACE_Reactor::instance()->run_reactor_event_loop(slice);
        repository->GetLatest(doc);
        if (expected == doc.name.c_str()) {
            std::printf("seen %s\n", doc.name.c_str());
            return 0;
        }
    }
    std::printf("timeout %s\n", doc.name.c_str());
    return 1;
}
