// Test support for the storage classes: the example site's documents (examples/site) and a
// topology source that serves documents from memory and counts what it is asked. Test support
// only; a source's calls are thread-safe once it is set up.
#pragma once

#include <atomic>
#include <map>
#include <stdexcept>
#include <string>
#include <vector>

#include "Configuration/ConfigDoc.h"
#include "Configuration/TopologySource.h"
#include "Vesk/Element.h"
#include "model/ElementTestSupport.h"

namespace Configuration {
namespace Testing {

// The tree of examples/site/<name>.xml.
inline Vesk::Element siteDocument(const std::string& name) {
    return sampleDocument("../../../examples/site/" + name + ".xml");
}

// A site held in memory: documents by path (as the site's files), hosts of module type 8.
class MemoryTopology : public TopologySource {
public:
    // The example site's strategy and location documents.
    static MemoryTopology exampleSite() {
        MemoryTopology site;
        site.put("BrimmetServer\\StrategyConfiguration", siteDocument("StrategyConfiguration"));
        site.put("BrimmetServer\\Location", siteDocument("Location"));
        return site;
    }
    MemoryTopology() = default;
    MemoryTopology(const MemoryTopology& other)
        : documents(other.documents),
          stackHosts(other.stackHosts),
          unreachable(other.unreachable) {}

    void put(const std::string& path, const Vesk::Element& tree) { documents[path] = tree; }

    int load(ConfigDoc& document) const override {
        ++loads;
        const auto it = documents.find(document.path().c_str());
        return it != documents.end() && document.readVesk(it->second) ? 0 : -1;
    }
    void hostsOfModuleType(int moduleType, std::vector<ACE_CString>& hosts) const override {
        ++hostQueries;
        if (unreachable) {
            throw std::runtime_error("service unreachable");
        }
        hosts = moduleType == 8 ? stackHosts : std::vector<ACE_CString>();
    }

    std::map<std::string, Vesk::Element> documents;
    std::vector<ACE_CString> stackHosts;  // hosts running a storage stack
    bool unreachable = false;
    mutable std::atomic<int> loads{0};
    mutable std::atomic<int> hostQueries{0};
};

}  // namespace Testing
}  // namespace Configuration
