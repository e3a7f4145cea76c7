// configctl's storage-topology commands: topology (text or --dot) and archive.
#include <iostream>
#include <map>
#include <stdexcept>
#include <string>

#include "Commands.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/StoredForm.h"
#include "Configuration/TopologySource.h"
#include "StorageTopologyReport.h"

namespace Configctl {
namespace {

// The topology queries' documents from the service, each fetched once per run.
class ClientTopology : public Configuration::TopologySource {
public:
    ClientTopology(Configuration::HttpConfigurationClient& client, const ACE_CString& host)
        : m_client(client), m_host(host) {}

    int load(Configuration::ConfigDoc& document) const override {
        const Vesk::Element* tree = fetch(document.path());
        return tree != nullptr && document.readVesk(*tree) ? 0 : -1;
    }
    void hostsOfModuleType(int moduleType, std::vector<ACE_CString>& hosts) const override {
        m_client.listHostsByModuleType(moduleType, hosts);
    }
    // The stored tree of path, or null when the service has none.
    const Vesk::Element* fetch(const ACE_CString& path) const {
        const std::string key = path.c_str();
        auto it = m_trees.find(key);
        if (it == m_trees.end()) {
            bool exists = false;
            m_client.checkForExistence(m_host, path, exists);
            Vesk::Element tree;
            if (exists) {
                Quorvex::ByteArray bytes;
                std::size_t length = 0;
                m_client.retrieve(m_host, path, bytes, length);
                Configuration::StoredForm::decode(bytes.get(), length, tree);
            }
            it = m_trees.emplace(key, std::make_pair(exists, tree)).first;
        }
        return it->second.first ? &it->second.second : nullptr;
    }

private:
    Configuration::HttpConfigurationClient& m_client;
    ACE_CString m_host;
    mutable std::map<std::string, std::pair<bool, Vesk::Element>> m_trees;
};

// Reads document from source; a missing required document is an error, an incomplete one a note.
void loadInto(const ClientTopology& source, Configuration::ConfigDoc& document, bool required,
              std::ostream& notes) {
    const Vesk::Element* tree = source.fetch(document.path());
    if (tree == nullptr) {
        if (required) {
            throw std::runtime_error(std::string("no document ") + document.path().c_str());
        }
        return;
    }
    if (!document.readVesk(*tree)) {
        notes << "(" << document.path().c_str() << " is incomplete)\n";
    }
}

}  // namespace

void Commands::topology() {
    expectArguments(0, 0, "topology [--dot] [--host NAME]");
    if (m_options.dot && m_options.json) {
        throw std::invalid_argument("topology: --dot or --output json, not both");
    }
    ClientTopology source(client(), host());
    Configuration::ScopedTopologySource scoped(source);
    StorageTopology topology;
    loadInto(source, topology.queues, true, notes());
    loadInto(source, topology.locations, true, notes());
    loadInto(source, topology.strategy, true, notes());
    loadInto(source, topology.archive, false, notes());
    if (m_options.dot) {
        printTopologyDot(topology, m_out);
    } else if (m_options.json) {
        printTopologyJson(topology, m_out);
    } else {
        printTopology(topology, m_out);
    }
}

void Commands::archive() {
    expectArguments(0, 0, "archive [--host NAME]");
    ClientTopology source(client(), host());
    Configuration::KelArchiveConfiguration archive;
    loadInto(source, archive, true, notes());
    if (m_options.json) {
        printArchiveJson(archive, m_out);
    } else {
        printArchive(archive, m_out);
    }
}

}  // namespace Configctl
