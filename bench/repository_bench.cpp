// The repository's cost, in one run against a configuration service on loopback:
//   - a cached read (GetLatest of a small document already in the cache), 1 and 2 threads;
//   - a cold read (GetLatest of a document not yet cached: timestamp + retrieve + decode + read);
//   - a bare retrieve with the HTTP client alone (one request), for scale;
//   - the two requests of a cold read by the HTTP client alone.
// cold / bare shows the cost of a cold read in requests; cold / (timestamp + retrieve) shows what
// the repository adds on top of the transport.
#include <ace/Log_Msg.h>
#include <benchmark/benchmark.h>

#include <cstdint>
#include <memory>
#include <string>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/StoredForm.h"
#include "InProcessService.h"
#include "model/TestDocument.h"
#include "repository/HttpServiceConnection.h"

namespace {

using namespace Configuration;

constexpr int kColdDocuments = 3000;

using SmallDoc = Testing::TestDocument;

ConfigurationService::ServiceOptions quietService() {
    ConfigurationService::ServiceOptions options;
    options.logLevel = "error";
    return options;
}

struct World {
    ServiceTesting::InProcessService service{quietService()};
    std::unique_ptr<HttpConfigurationClient> client;
    std::unique_ptr<ConfigurationRepository> repository;
    ServiceLocation location;

    World() {
        ACE_Log_Msg::instance()->priority_mask(LM_ERROR | LM_CRITICAL, ACE_Log_Msg::PROCESS);
        client = std::make_unique<HttpConfigurationClient>(service.address().c_str(), true, false);
        const std::string bytes = StoredForm::encode(*SmallDoc().writeVesk());
        const auto* data = reinterpret_cast<const unsigned char*>(bytes.data());
        client->store("TestHost", "BrimmetServer\\TestDoc", data, bytes.size(), "");
        for (int i = 0; i < kColdDocuments; ++i) {
            const std::string name = "BrimmetServer\\Cold" + std::to_string(i);
            client->store("TestHost", name.c_str(), data, bytes.size(), "");
        }
        location.localServer = service.address().c_str();
        location.servers["testhost"] = service.address();
        repository = std::make_unique<ConfigurationRepository>(
            std::make_shared<HttpServiceConnector>(location));
        SmallDoc warm;
        repository->GetLatest(warm);
    }
};

World& world() {
    static World w;
    return w;
}

void BM_CachedGetLatest(benchmark::State& state) {
    ConfigurationRepository& repository = *world().repository;
    SmallDoc doc;
    for (auto _ : state) {
        if (repository.GetLatest(doc) != 0) {
            state.SkipWithError("GetLatest failed");
            break;
        }
    }
}

// Every run starts with a repository of its own, whose cache is empty, and reads each stored
// document once: every read in the loop is a cold one (timestamp, retrieve, decode).
void BM_ColdGetLatest(benchmark::State& state) {
    World& w = world();
    ConfigurationRepository repository(std::make_shared<HttpServiceConnector>(w.location));
    int next = 0;
    for (auto _ : state) {
        const std::string name = "Cold" + std::to_string(next++ % kColdDocuments);
        SmallDoc doc(name.c_str());
        if (repository.GetLatest(doc) != 0) {
            state.SkipWithError("GetLatest failed");
            break;
        }
    }
}

void BM_BareClientRetrieve(benchmark::State& state) {
    World& w = world();
    for (auto _ : state) {
        Quorvex::ByteArray bytes;
        std::size_t length = 0;
        w.client->retrieve("TestHost", "BrimmetServer\\TestDoc", bytes, length);
        benchmark::DoNotOptimize(length);
    }
}

// The two requests a cold read makes ("GetLastModifiedTime", then "Retrieve"), by one client
// alone: the floor under a cold read, which must wait for both answers in turn.
void BM_BareTimestampAndRetrieve(benchmark::State& state) {
    World& w = world();
    for (auto _ : state) {
        BDateTime timestamp;
        w.client->getTimeStamp("TestHost", "BrimmetServer\\TestDoc", timestamp);
        Quorvex::ByteArray bytes;
        std::size_t length = 0;
        w.client->retrieve("TestHost", "BrimmetServer\\TestDoc", bytes, length);
        benchmark::DoNotOptimize(length);
    }
}

// A loop of private work of about a cached read's length on each thread, sharing nothing: how
// much parallelism the machine gives this run, to read the cached rows by (2 threads vs 1 can
// reach 2 only when two cores are free).
void BM_BareThreadScaling(benchmark::State& state) {
    std::uint64_t value = static_cast<std::uint64_t>(state.thread_index()) + 1;
    for (auto _ : state) {
        for (int i = 0; i < 40; ++i) {
            value = value * 6364136223846793005u + 1442695040888963407u;
        }
        benchmark::DoNotOptimize(value);
    }
}

BENCHMARK(BM_CachedGetLatest)->Threads(1)->Threads(2)->UseRealTime();
BENCHMARK(BM_BareThreadScaling)->Threads(1)->Threads(2)->UseRealTime();
BENCHMARK(BM_ColdGetLatest)->Iterations(kColdDocuments)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_BareClientRetrieve)->Iterations(2000)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_BareTimestampAndRetrieve)->Iterations(2000)->Unit(benchmark::kMicrosecond);

}  // namespace

BENCHMARK_MAIN();
