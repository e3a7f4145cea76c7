// The storage topology's hot paths:
//   - findRegistrationRule over 10,000 rules, 1 and 2 threads (ns per look-up; the table is
//     shared under its readers-writer lock), next to the same look-up in a bare hash map;
//   - translateLinkDefinitionWithStackUid of the persistent keyword through a warm repository
//     over a loopback configuration service (µs per call, and service requests per call, which
//     must be 0 while the documents are cached), next to a literal queue, which needs no document.
#include <ace/Log_Msg.h>
#include <benchmark/benchmark.h>

#include <atomic>
#include <fstream>
#include <memory>
#include <sstream>
#include <string>
#include <unordered_map>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/MSMQCommonConfiguration.h"
#include "Configuration/RulesConfiguration.h"
#include "Configuration/StoredForm.h"
#include "Configuration/StringHash.h"
#include "Configuration/TopologySource.h"
#include "InProcessService.h"
#include "Vesk/XmlUtils.h"
#include "repository/HttpServiceConnection.h"

namespace {

using namespace Configuration;

constexpr int kRules = 10000;

ACE_CString title(int i) {
    return ("modality_" + std::to_string(i)).c_str();
}

const RulesConfiguration& rules() {
    static const RulesConfiguration table = [] {
        RulesConfiguration r;
        for (int i = 0; i < kRules; ++i) {
            r.addRegistrationRule(RegistrationRule(title(i), i % 2 == 0, i % 3 == 0, false, ""));
        }
        return r;
    }();
    return table;
}

void BM_FindRegistrationRule(benchmark::State& state) {
    const RulesConfiguration& table = rules();
    int i = static_cast<int>(state.thread_index()) * 7919;
    for (auto _ : state) {
        benchmark::DoNotOptimize(table.findRegistrationRule(title(i++ % kRules)));
    }
}

void BM_BareHashMapLookup(benchmark::State& state) {
    static const auto map = [] {
        std::unordered_map<ACE_CString, RegistrationRule, StringHash> m(1024);
        for (int i = 0; i < kRules; ++i) {
            m.emplace(RulesConfiguration::normalizeKey(title(i)),
                      RegistrationRule(title(i), true, false, false, ""));
        }
        return m;
    }();
    int i = 0;
    for (auto _ : state) {
        const auto it = map.find(RulesConfiguration::normalizeKey(title(i++ % kRules)));
        benchmark::DoNotOptimize(std::make_unique<RegistrationRule>(it->second));
    }
}

// Counts every request the repository sends to a service.
std::atomic<long> s_requests{0};

class CountingConnection : public ServiceConnection {
public:
    explicit CountingConnection(std::unique_ptr<ServiceConnection> inner)
        : m_inner(std::move(inner)) {}
    const ACE_CString& hostName() const override { return m_inner->hostName(); }
    void retrieve(const ACE_CString& h, const ACE_CString& n, Quorvex::ByteArray& d,
                  std::size_t& l) override {
        ++s_requests;
        m_inner->retrieve(h, n, d, l);
    }
    void store(const ACE_CString& h, const ACE_CString& n, const unsigned char* d, std::size_t l,
               const ACE_CString& t) override {
        ++s_requests;
        m_inner->store(h, n, d, l, t);
    }
    void getTimeStamp(const ACE_CString& h, const ACE_CString& n, BDateTime& t) override {
        ++s_requests;
        m_inner->getTimeStamp(h, n, t);
    }
    void listHosts(std::vector<ACE_CString>& hosts) override {
        ++s_requests;
        m_inner->listHosts(hosts);
    }
    void listItems(const ACE_CString& h, std::vector<_HttpConfigurationItemInfo>& i) override {
        ++s_requests;
        m_inner->listItems(h, i);
    }
    void registerService(const ACE_CString& h, const ACE_CString& s,
                         const ACE_CString& c) override {
        ++s_requests;
        m_inner->registerService(h, s, c);
    }
    void switchoverPersistent(const ACE_CString& p) override {
        ++s_requests;
        m_inner->switchoverPersistent(p);
    }
    void enableMergeNetworkCapture(bool e, const ACE_CString& h) override {
        ++s_requests;
        m_inner->enableMergeNetworkCapture(e, h);
    }
    void signalChanged() override { m_inner->signalChanged(); }
    void signalRestart() override { m_inner->signalRestart(); }
    void signalRefresh() override { m_inner->signalRefresh(); }

private:
    std::unique_ptr<ServiceConnection> m_inner;
};

class CountingConnector : public ServiceConnector {
public:
    explicit CountingConnector(const ServiceLocation& location) : m_inner(location) {}
    std::unique_ptr<ServiceConnection> connectLocal() const override {
        return std::make_unique<CountingConnection>(m_inner.connectLocal());
    }
    std::unique_ptr<ServiceConnection> connect(const ACE_CString& host) const override {
        return std::make_unique<CountingConnection>(m_inner.connect(host));
    }

private:
    HttpServiceConnector m_inner;
};

class RepositoryTopology : public TopologySource {
public:
    explicit RepositoryTopology(ConfigurationRepository& repository) : m_repository(repository) {}
    int load(ConfigDoc& document) const override { return m_repository.GetLatest(document); }
    void hostsOfModuleType(int, std::vector<ACE_CString>& hosts) const override {
        ++s_requests;
        hosts.clear();
    }

private:
    ConfigurationRepository& m_repository;
};

ConfigurationService::ServiceOptions quietService() {
    ConfigurationService::ServiceOptions options;
    options.logLevel = "error";
    return options;
}

std::string siteBytes(const char* name) {
    std::ifstream in(std::string(QUORVEX_EXAMPLES) + "/site/" + name + ".xml", std::ios::binary);
    std::ostringstream text;
    text << in.rdbuf();
    Vesk::Element tree;
    Vesk::XmlUtils::parse(text.str().data(), text.str().size(), tree);
    return StoredForm::encode(tree);
}

struct Site {
    ServiceTesting::InProcessService service{quietService()};
    std::unique_ptr<ConfigurationRepository> repository;
    std::unique_ptr<RepositoryTopology> source;
    std::unique_ptr<ScopedTopologySource> scoped;
    MSMQCommonConfiguration msmq;

    Site() {
        ACE_Log_Msg::instance()->priority_mask(LM_ERROR | LM_CRITICAL, ACE_Log_Msg::PROCESS);
        HttpConfigurationClient client(service.address().c_str(), true, false);
        for (const char* name : {"StrategyConfiguration", "Location", "MsmqCommon"}) {
            const std::string bytes = siteBytes(name);
            client.store("TestHost", (std::string("BrimmetServer\\") + name).c_str(),
                         reinterpret_cast<const unsigned char*>(bytes.data()), bytes.size(), "");
        }
        ServiceLocation location;
        location.localServer = service.address().c_str();
        location.servers["testhost"] = service.address();
        repository = std::make_unique<ConfigurationRepository>(
            std::make_shared<CountingConnector>(location));
        source = std::make_unique<RepositoryTopology>(*repository);
        scoped = std::make_unique<ScopedTopologySource>(*source);
        repository->GetLatest(msmq);
    }
};

Site& site() {
    static Site s;
    return s;
}

void translate(benchmark::State& state, const ACE_CString& definition) {
    Site& s = site();
    short type = 0;
    ACE_CString resolved, prefix, suffix;
    s.msmq.translateLinkDefinitionWithStackUid(definition, type, resolved, prefix, suffix);  // warm
    const long before = s_requests;
    for (auto _ : state) {
        if (!s.msmq.translateLinkDefinitionWithStackUid(definition, type, resolved, prefix,
                                                        suffix)) {
            state.SkipWithError("not resolved");
            break;
        }
    }
    state.counters["requests/call"] =
        static_cast<double>(s_requests - before) / static_cast<double>(state.iterations());
}

void BM_TranslatePersistentKeywordWarm(benchmark::State& state) {
    translate(state, ChainUtils::PersistentKeyword());
}

void BM_TranslateLiteralQueue(benchmark::State& state) {
    translate(state, "DIRECT=OS:qvx-north-01\\private$\\quorvexin");
}

BENCHMARK(BM_FindRegistrationRule)->Threads(1)->Threads(2)->UseRealTime();
BENCHMARK(BM_BareHashMapLookup);
BENCHMARK(BM_TranslatePersistentKeywordWarm)->Unit(benchmark::kMicrosecond);
BENCHMARK(BM_TranslateLiteralQueue)->Unit(benchmark::kMicrosecond);

}  // namespace

BENCHMARK_MAIN();
