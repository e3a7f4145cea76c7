// Eight threads reading, storing and refreshing through one repository (run under
// ThreadSanitizer in CI). Every read must give a whole document, never a torn one.
#include <gtest/gtest.h>

#include <thread>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/StoredForm.h"
#include "model/TestDocument.h"
#include "repository/FakeServices.h"
#include "testing/FakeMachine.h"
#include "testing/ScratchDir.h"

namespace Configuration {
namespace {

using Testing::TestDocument;

std::string stored(const std::string& name) {
    TestDocument doc;
    doc.name = name.c_str();
    doc.size = static_cast<unsigned>(name.size());  // size always matches name: a torn read shows
    return StoredForm::encode(*doc.writeVesk());
}

TEST(RepositoryConcurrency, ReadersWritersAndRefreshersShareOneRepository) {
    Quorvex::Testing::ScratchDir events;
    Quorvex::Testing::FakeMachine machine;
    machine.env["QUORVEX_EVENT_DIR"] = events.path();
    Quorvex::ScopedMachine scoped(machine);
    Testing::FakeService local, master;
    local.name = "slave1";
    master.name = "master";
    auto connector = std::make_shared<Testing::FakeConnector>("testhost");
    connector->add("testhost", local);
    connector->add("slave1", local);
    connector->add("master", master);
    const char* names[] = {"One", "Two", "Three"};
    for (const char* n : names) {
        local.put("master", std::string("BrimmetServer\\") + n, stored(n),
                  "2010-01-01T00:00:00.000");
    }
    ConfigurationRepository repository(connector);
    repository.SetMasterHostName("master");

    std::atomic<int> failures{0};
    std::vector<std::thread> threads;
    for (int t = 0; t < 8; ++t) {
        threads.emplace_back([&, t] {
            for (int i = 0; i < 150; ++i) {
                TestDocument doc(names[(t + i) % 3]);
                if (repository.GetLatest(doc, i % 17 == 0) != 0 || doc.size != doc.name.length()) {
                    ++failures;
                }
                if (t == 0 && i % 10 == 0) {
                    repository.handle_signal(0);
                }
                if (t == 1 && i % 25 == 0) {
                    TestDocument written("Written");
                    written.name = "abc";
                    written.size = 3;
                    if (repository.Store(written) != 0) {
                        ++failures;
                    }
                }
                if (t == 2) {
                    machine.advanceMilliseconds(7000);
                    ConfigCacheItemInfo info;
                    repository.GetConfigCacheItemInfo("BrimmetServer\\One", info);
                }
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(failures, 0);
}

}  // namespace
}  // namespace Configuration
