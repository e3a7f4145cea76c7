// The repository under many threads (run under ThreadSanitizer in CI): whole documents for every
// reader, cached reads that no hung service can stall, and one repository per process.
#include <gtest/gtest.h>

#include <chrono>
#include <cstdlib>
#include <functional>
#include <future>
#include <set>
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

const char* const kNames[] = {"One", "Two", "Three"};

class RepositoryConcurrency : public ::testing::Test {
protected:
    RepositoryConcurrency() {
        machine.env["QUORVEX_EVENT_DIR"] = events.path();
        local.name = "slave1";
        master.name = "master";
        connector->add("testhost", local);
        connector->add("slave1", local);
        connector->add("master", master);
        for (const char* n : kNames) {
            local.put("master", std::string("BrimmetServer\\") + n, stored(n),
                      "2010-01-01T00:00:00.000");
        }
        repository = std::make_unique<ConfigurationRepository>(connector);
        repository->SetMasterHostName("master");
    }

    Quorvex::Testing::ScratchDir events;
    Quorvex::Testing::FakeMachine machine;
    Quorvex::ScopedMachine scoped{machine};
    Testing::FakeService local, master;
    std::shared_ptr<Testing::FakeConnector> connector =
        std::make_shared<Testing::FakeConnector>("testhost");
    std::unique_ptr<ConfigurationRepository> repository;
};

TEST_F(RepositoryConcurrency, ReadersWritersAndRefreshersShareOneRepository) {
    const auto& names = kNames;
    std::atomic<int> failures{0};
    std::vector<std::thread> threads;
    for (int t = 0; t < 8; ++t) {
        threads.emplace_back([&, t] {
            for (int i = 0; i < 150; ++i) {
                TestDocument doc(names[(t + i) % 3]);
                if (repository->GetLatest(doc, i % 17 == 0) != 0 || doc.size != doc.name.length()) {
                    ++failures;
                }
                if (t == 0 && i % 10 == 0) {
                    repository->handle_signal(0);
                }
                if (t == 1 && i % 25 == 0) {
                    TestDocument written("Written");
                    written.name = "abc";
                    written.size = 3;
                    if (repository->Store(written) != 0) {
                        ++failures;
                    }
                }
                if (t == 2) {
                    machine.advanceMilliseconds(7000);
                    ConfigCacheItemInfo info;
                    repository->GetConfigCacheItemInfo("BrimmetServer\\One", info);
                }
            }
        });
    }
    for (std::thread& thread : threads) {
        thread.join();
    }
    EXPECT_EQ(failures, 0);
}

// Guards against the cache lock being held across a request: one service that stops answering
// stalled every thread's cached reads.
TEST_F(RepositoryConcurrency, CachedReadsGoOnWhileAServiceHangs) {
    TestDocument one("One");
    TestDocument two("Two");
    ASSERT_EQ(repository->GetLatest(one), 0);
    ASSERT_EQ(repository->GetLatest(two), 0);
    local.stall();
    auto hung = std::async(std::launch::async, [&] {
        TestDocument forced("One");
        return repository->GetLatest(forced, true);
    });
    for (int i = 0; i < 500 && local.waiting == 0; ++i) {
        std::this_thread::sleep_for(std::chrono::milliseconds(10));
    }
    ASSERT_EQ(local.waiting, 1);
    auto cached = std::async(std::launch::async, [&] {
        TestDocument again("Two");
        return repository->GetLatest(again) == 0 && again.name == "Two";
    });
    const bool served = cached.wait_for(std::chrono::seconds(5)) == std::future_status::ready;
    local.release();
    EXPECT_TRUE(served);
    EXPECT_TRUE(cached.get());
    EXPECT_EQ(hung.get(), 0);
}

// Cached reads are served from a view each thread keeps: guards against a view outliving a change
// that another thread made, by storing the document or through the change event.
TEST_F(RepositoryConcurrency, AThreadsCachedReadsSeeChangesMadeOnOtherThreads) {
    const std::function<void()> changes[] = {
        [&] {
            TestDocument written("One");
            written.name = "Uno";
            written.size = 3;
            ASSERT_EQ(repository->Store(written), 0);
        },
        [&] {
            local.put("master", "BrimmetServer\\One", stored("Eins"), "2011-01-01T00:00:00.000");
            repository->handle_signal(0);
        }};
    const char* const expected[] = {"Uno", "Eins"};
    for (int i = 0; i < 2; ++i) {
        TestDocument before("One");
        ASSERT_EQ(repository->GetLatest(before), 0);
        std::thread(changes[i]).join();
        TestDocument after("One");
        ASSERT_EQ(repository->GetLatest(after), 0);
        EXPECT_EQ(after.name, expected[i]) << i;
        EXPECT_EQ(after.size, after.name.length()) << i;
    }
}

// Guards against instance() locking a fresh mutex on every call: threads racing on first use
// each built a repository.
TEST(RepositoryInstance, ThreadsRacingOnFirstUseShareOneRepository) {
    Quorvex::Testing::ScratchDir store;
    Quorvex::Testing::ScratchDir events;
    setenv("QUORVEX_CONFIGURATION_STORE", store.path().c_str(), 1);
    setenv("QUORVEX_EVENT_DIR", events.path().c_str(), 1);
    std::promise<void> start;
    std::shared_future<void> go = start.get_future().share();
    std::vector<std::future<ConfigurationRepository*>> callers;
    for (int i = 0; i < 16; ++i) {
        callers.push_back(std::async(std::launch::async, [go] {
            go.wait();
            return ConfigurationRepository::instance();
        }));
    }
    start.set_value();
    std::set<ConfigurationRepository*> seen;
    for (auto& caller : callers) {
        seen.insert(caller.get());
    }
    EXPECT_EQ(seen.size(), 1u);
    EXPECT_NE(*seen.begin(), nullptr);
}

}  // namespace
}  // namespace Configuration
