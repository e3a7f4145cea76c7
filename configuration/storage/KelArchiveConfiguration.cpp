#include "Configuration/KelArchiveConfiguration.h"

#include <stdexcept>
#include <string>

#include "Configuration/DocumentNames.h"
#include "Quorvex/Log.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

constexpr const char kServers[] = "TivoliServers";

struct RequiredKey {
    const char* key;
    const char* missing;
};

const RequiredKey kServerKeys[] = {
    {"TivoliStorageManagerServerAddress", "Tivoli storage manager host name was not found."},
    {"TivoliStorageManagerServerPort", "Tivoli storage manager port was not found."},
    {"TivoliServerUserAccount", "Tivoli storage manager user was not found."},
    {"TivoliServerAccessPassword", "Tivoli storage manager password was not found."},
};
const RequiredKey kNodeKeys[] = {{"ArchiveLocalNodeName", "Archive node name was not found."}};

// Items of a map whose records cannot do without some keys: an item missing one fails the whole
// document's read with that key's message. Otherwise read, written and compared as wrapped items
// by key.
template <class Inner, std::size_t N>
struct StrictItems : Fields::Form {
    Inner inner;
    const RequiredKey (&required)[N];
    const char* itemKey;
    bool read(const Fields::In& in, const char* key) const {
        const Vesk::Element* wrapper = in.children.find(Fields::keyOf(key));
        if (wrapper != nullptr && wrapper->hasValue()) {
            const Vesk::MultiElementValue& items = wrapper->getMultiElement();
            for (const Vesk::Element& item : Fields::KeyRange{items, Fields::keyOf(itemKey)}) {
                for (const RequiredKey& r : required) {
                    if (!item.getMultiElement().has(Fields::keyOf(r.key))) {
                        throw std::runtime_error(r.missing);
                    }
                }
            }
        }
        return inner.read(in, key);
    }
    void write(Fields::Out& out, const char* key) const { inner.write(out, key); }
    template <class C>
    void compare(C& c) const {
        inner.compare(c);
    }
};

template <class Map, class KeyFn, std::size_t N>
auto strictItems(const char* itemKey, Map& map, KeyFn keyFn, const RequiredKey (&required)[N]) {
    auto inner = Fields::wrapped(itemKey, map, Fields::DropFailed, keyFn);
    return StrictItems<decltype(inner), N>{{}, inner, required, itemKey};
}

}  // namespace

template <class Self, class Io>
void KelArchiveConfiguration::fields(Self& self, Io& io) {
    io(kServers, strictItems(TivoliServerInfo::WELL_KNOWN_NAME, self.m_servers,
                             &TivoliServerInfo::getTivoliStorageManagerHostname, kServerKeys));
    io("ArchiveNodesConfiguration",
       strictItems(ArchiveLocalNodeInfo::WELL_KNOWN_NAME, self.m_nodes,
                   &ArchiveLocalNodeInfo::getLocalNodeName, kNodeKeys));
    io("ArchiveNodeStacksConfiguration",
       Fields::wrapped(ArchiveNodeStackInfo::WELL_KNOWN_NAME, self.m_stacks, Fields::DropFailed,
                       &ArchiveNodeStackInfo::getStackUid));
    io("TivoliServerDeletionTimeout", self.m_deletionTimeout);
    io("TivoliServerArchiveTimeOfDay", self.m_timeOfDay);
    io("TivoliServerArchiveDelayTime", self.m_delay);
    io("SqlBackupDirectory", self.m_sqlBackup);
    io("ArchivingSystem", self.m_archiving);
    io("VerifyStudyExistsOnPersistentServer", self.m_verify);
    io("DisableArchiveRequests", self.m_disableRequests);
}

CONFIGURATION_DEFINE_WRITE(KelArchiveConfiguration, KelArchiveConfiguration::WELL_KNOWN_NAME)
CONFIGURATION_DEFINE_EQUAL(KelArchiveConfiguration)

KelArchiveConfiguration::KelArchiveConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kKelArchive,
                     false) {}

// Every field but the servers is read first, so that a document without its servers still gives
// its other values; then the servers, whose absence fails the read.
bool KelArchiveConfiguration::readVesk(const Vesk::Element& element) {
    try {
        const Fields::In in{&element, element.getMultiElement()};
        Fields::Reader reader(in);
        auto allButServers = [&reader](const char* key, auto&& form) {
            if (std::string(key) != kServers) {
                reader(key, form);
            }
        };
        Fields::Access::visit(*this, allButServers);
        if (!in.children.has(Fields::keyOf(kServers))) {
            throw std::runtime_error("No Tivoli servers element found");
        }
        reader(kServers,
               strictItems(TivoliServerInfo::WELL_KNOWN_NAME, m_servers,
                           &TivoliServerInfo::getTivoliStorageManagerHostname, kServerKeys));
        return reader.complete();
    } catch (const std::exception& e) {
        Fields::logReadFailure("KelArchiveConfiguration", Fields::FailureForm::Failed, e.what());
        return false;
    }
}

const TivoliServerInfo& KelArchiveConfiguration::getTivoliServerInfoByAddress(
    const ACE_CString& address) const {
    for (const auto& entry : m_servers) {
        if (entry.first == address) {
            return entry.second;
        }
    }
    throw ArchiveNotConfiguredException(
        std::string("Tivoli server information not configured for ") + address.c_str());
}

const ArchiveLocalNodeInfo& KelArchiveConfiguration::getArchiveNodeInfo(
    const ACE_CString& name) const {
    const auto it = m_nodes.find(name);
    if (it == m_nodes.end()) {
        throw ArchiveNotConfiguredException(
            std::string("Unable to find Archive node configuration for ") + name.c_str());
    }
    return it->second;
}

const ArchiveNodeStackInfo& KelArchiveConfiguration::getArchiveStackInfo(
    const ACE_CString& stackUid) const {
    const auto it = m_stacks.find(stackUid);
    if (it == m_stacks.end()) {
        throw ArchiveNotConfiguredException(
            std::string("Unable to find Archive stack configuration for ") + stackUid.c_str());
    }
    return it->second;
}

const TivoliServerInfo& KelArchiveConfiguration::getTivoliServerInfo(
    const ACE_CString& localNodeName, const ACE_CString& tivoliServer) const {
    try {
        return getTivoliServerInfoByAddress(tivoliServer);
    } catch (const ArchiveNotConfiguredException& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "Exception caught. Reason %s. Trying to get default Tivoli server info.\n",
                    e.what());
    }
    try {
        const TivoliNodeInfo& fallback =
            getArchiveNodeInfo(localNodeName).getDefaultTivoliNodeInfo();
        return getTivoliServerInfoByAddress(fallback.getTivoliServer());
    } catch (const ArchiveNotConfiguredException&) {
        throw ArchiveNotConfiguredException(std::string("Unable to find Tivoli server info for ") +
                                            localNodeName.c_str());
    }
}

}  // namespace Configuration
