// The example DICOM site (examples/site: nine documents) read through the repository from a
// configuration service on loopback:
//   - cold: a fresh repository reads every document (timestamp + retrieve + decode + read);
//   - warm: the same documents again from the repository's cache;
// both as µs per document, with their ratio. And AutoExportConfiguration::isDestinationUsed over
// 1,000 rules of two destinations each: ns per call for a name the last rule holds (in another
// case) and for a name no rule holds, and ns per rule tried.
#include <ace/Log_Msg.h>
#include <benchmark/benchmark.h>

#include <chrono>
#include <cstdio>
#include <fstream>
#include <functional>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "Configuration/AutoExportConfiguration.h"
#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/KelExportGlobalConfiguration.h"
#include "Configuration/KelExportLocalConfiguration.h"
#include "Configuration/KelExportRemoteConfigurations.h"
#include "Configuration/KelExportWebService.h"
#include "Configuration/KelQueryConfiguration.h"
#include "Configuration/QrscpConfiguration.h"
#include "Configuration/SSCPConfiguration.h"
#include "Configuration/StorageCommitConfiguration.h"
#include "Configuration/StoredForm.h"
#include "InProcessService.h"
#include "Vesk/XmlUtils.h"
#include "repository/HttpServiceConnection.h"

namespace {

using namespace Configuration;

constexpr int kRules = 1000;

std::string siteFile(const std::string& name) {
    std::ifstream in(std::string(QUORVEX_EXAMPLES) + "/site/" + name + ".xml", std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    return text.str();
}

// The site's documents, one object of each class.
std::vector<std::unique_ptr<ConfigDoc>> siteDocuments() {
    std::vector<std::unique_ptr<ConfigDoc>> documents;
    documents.push_back(std::make_unique<SSCPConfiguration>());
    documents.push_back(std::make_unique<QrscpConfiguration>());
    documents.push_back(std::make_unique<StorageCommitConfiguration>());
    documents.push_back(std::make_unique<KelExportGlobalConfiguration>());
    documents.push_back(std::make_unique<KelExportLocalConfiguration>());
    documents.push_back(std::make_unique<KelExportRemoteConfigurations>());
    documents.push_back(std::make_unique<KelExportWebService>());
    documents.push_back(std::make_unique<AutoExportConfiguration>());
    documents.push_back(std::make_unique<KelQueryConfiguration>());
    return documents;
}

ConfigurationService::ServiceOptions quietService() {
    ConfigurationService::ServiceOptions options;
    options.logLevel = "error";
    return options;
}

struct World {
    ServiceTesting::InProcessService service{quietService()};
    ServiceLocation location;
    std::unique_ptr<ConfigurationRepository> warm;

    World() {
        ACE_Log_Msg::instance()->priority_mask(LM_ERROR | LM_CRITICAL, ACE_Log_Msg::PROCESS);
        HttpConfigurationClient client(service.address().c_str(), true, false);
        for (const auto& document : siteDocuments()) {
            const std::string name(document->path().c_str() +
                                   ConfigDoc::getConfigurationRegistryPath().length());
            const std::string xml = siteFile(name);
            Vesk::Element tree;
            Vesk::XmlUtils::parse(xml.data(), xml.size(), tree);
            const std::string bytes = StoredForm::encode(tree);
            client.store("TestHost", document->path().c_str(),
                         reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size(), "");
        }
        location.localServer = service.address().c_str();
        location.servers["testhost"] = service.address();
        warm = fresh();
        readAll(*warm);
    }
    std::unique_ptr<ConfigurationRepository> fresh() const {
        return std::make_unique<ConfigurationRepository>(
            std::make_shared<HttpServiceConnector>(location));
    }
    static bool readAll(ConfigurationRepository& repository) {
        for (const auto& document : siteDocuments()) {
            if (repository.GetLatest(*document) != 0) {
                return false;
            }
        }
        return true;
    }
};

World& world() {
    static World w;
    return w;
}

// Seconds per document of the last run of each, for the closing ratio.
double g_coldPerDocument = 0;
double g_warmPerDocument = 0;

void perDocument(benchmark::State& state, double seconds, double& keep) {
    const double documents = static_cast<double>(state.iterations()) * siteDocuments().size();
    keep = seconds / documents;
    state.counters["us_per_doc"] = keep * 1e6;
}

void BM_SiteCold(benchmark::State& state) {
    World& w = world();
    double seconds = 0;
    for (auto _ : state) {
        state.PauseTiming();
        std::unique_ptr<ConfigurationRepository> repository = w.fresh();
        state.ResumeTiming();
        const auto start = std::chrono::steady_clock::now();
        if (!World::readAll(*repository)) {
            state.SkipWithError("GetLatest failed");
            break;
        }
        seconds += std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count();
        state.PauseTiming();
        repository.reset();
        state.ResumeTiming();
    }
    perDocument(state, seconds, g_coldPerDocument);
}

void BM_SiteWarm(benchmark::State& state) {
    World& w = world();
    const auto start = std::chrono::steady_clock::now();
    for (auto _ : state) {
        if (!World::readAll(*w.warm)) {
            state.SkipWithError("GetLatest failed");
            break;
        }
    }
    perDocument(state,
                std::chrono::duration<double>(std::chrono::steady_clock::now() - start).count(),
                g_warmPerDocument);
}

// 1,000 rules of two destinations each, read from a document as an administrator stores it.
const AutoExportConfiguration& manyRules() {
    static const AutoExportConfiguration config = [] {
        std::string xml = "<e k=\"AutoExport\"><l><e k=\"AutoExportRules\"><l>";
        for (int i = 0; i < kRules; ++i) {
            xml += "<e k=\"AutoExportRule\"><a n=\"Name\" v=\"rule " + std::to_string(i) +
                   "\"/><l><e k=\"Enabled\"><s>1</s></e><e k=\"Criteria\"><l><e k=\"Modality\">"
                   "<s>CT</s></e></l></e><e k=\"Destinations\"><l>";
            for (const char* prefix : {"Archive node ", "Partner node "}) {
                xml += "<e k=\"Destination\"><l><e k=\"DestinationName\"><s>" +
                       std::string(prefix) + std::to_string(i) +
                       "</s></e><e k=\"IsStorageCommitRequired\"><s>false</s></e></l></e>";
            }
            xml += "</l></e></l></e>";
        }
        xml +=
            "</l></e><e k=\"Enabled\"><s>1</s></e><e k=\"MaxRetries\"><s>5</s></e>"
            "<e k=\"RetryDelay\"><s>10</s></e></l></e>";
        Vesk::Element tree;
        Vesk::XmlUtils::parse(xml.data(), xml.size(), tree);
        AutoExportConfiguration read;
        read.readVesk(tree);
        return read;
    }();
    return config;
}

void BM_IsDestinationUsed(benchmark::State& state, const char* name, bool expected) {
    const AutoExportConfiguration& config = manyRules();
    const ACE_CString asked(name);
    for (auto _ : state) {
        if (config.isDestinationUsed(asked) != expected) {
            state.SkipWithError("wrong answer");
            break;
        }
    }
    state.counters["ns_per_rule"] =
        benchmark::Counter(static_cast<double>(state.iterations()) * kRules,
                           benchmark::Counter::kIsRate | benchmark::Counter::kInvert);
}

BENCHMARK(BM_SiteCold)->Iterations(300)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_SiteWarm)->Unit(benchmark::kMicrosecond);
BENCHMARK_CAPTURE(BM_IsDestinationUsed, last_rule_other_case, "PARTNER NODE 999", true);
BENCHMARK_CAPTURE(BM_IsDestinationUsed, no_rule, "Partner node 1000", false);

}  // namespace

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    if (g_warmPerDocument > 0) {
        std::printf("site of %zu documents: cold %.1f us/doc, warm %.2f us/doc, cold/warm %.0fx\n",
                    siteDocuments().size(), g_coldPerDocument * 1e6, g_warmPerDocument * 1e6,
                    g_coldPerDocument / g_warmPerDocument);
    }
    return 0;
}
