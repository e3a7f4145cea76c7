#include "Configuration/TopologySource.h"

#include <atomic>

#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/ServiceLocation.h"

namespace Configuration {
namespace {

// Documents from the process's repository; hosts from this machine's configuration service
// ("localhost": the service the environment names). In embedded mode there is no service to ask
// and the site knows no host.
class ProcessTopologySource : public TopologySource {
public:
    int load(ConfigDoc& document) const override {
        return ConfigurationRepository::instance()->GetLatest(document);
    }
    void hostsOfModuleType(int moduleType, std::vector<ACE_CString>& hosts) const override {
        const ServiceLocation location = ServiceLocation::fromEnvironment();
        if (location.storeDirectory.length() != 0) {
            hosts.clear();
            return;
        }
        HttpConfigurationClient client(location.localServer, true, location.useHttps);
        client.listHostsByModuleType(moduleType, hosts);
    }
};

const ProcessTopologySource s_processSource;
std::atomic<const TopologySource*> s_current{&s_processSource};

}  // namespace

TopologySource::~TopologySource() = default;

const TopologySource& topologySource() {
    return *s_current.load(std::memory_order_acquire);
}

ScopedTopologySource::ScopedTopologySource(const TopologySource& source)
    : m_previous(s_current.exchange(&source, std::memory_order_acq_rel)) {}

ScopedTopologySource::~ScopedTopologySource() {
    s_current.store(m_previous, std::memory_order_release);
}

}  // namespace Configuration
