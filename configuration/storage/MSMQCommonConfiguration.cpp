#include "Configuration/MSMQCommonConfiguration.h"

#include <algorithm>
#include <stdexcept>

#include "Configuration/DocumentNames.h"
#include "Configuration/MSMQConfiguration.h"
#include "Quorvex/Log.h"
#include "StorageForms.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

constexpr const char kLocationChains[] = "LocationMigrationChains";
constexpr const char kLocationChain[] = "LocationMigrationChain";
constexpr const char kLocationName[] = "LocationName";
constexpr const char kMigrationChain[] = "MigrationChain";

ACE_CString localQueue(const char* name) {
    return MSMQConfiguration::BuildQueue(ConfigDoc::getLocalHostName(), name);
}

template <class C, class V>
void eraseEvery(C& container, const V& value) {
    container.erase(std::remove(container.begin(), container.end(), value), container.end());
}

// A list of pairs under key: absent or without a value, the list is left as it is.
template <class Pairs>
bool readPairs(const Vesk::MultiElementValue& children, const char* key, Pairs& pairs,
               const char* first, const char* second) {
    const Vesk::Element* list = children.find(Fields::keyOf(key));
    if (list == nullptr || !list->hasValue()) {
        return true;
    }
    return Fields::pairs(pairs, first, second).read(Fields::In{nullptr, children}, key);
}

}  // namespace

// Compared only (with the chains, which operator== adds): reading has an order and messages of
// its own, and the document is never written.
template <class Self, class Io>
void MSMQCommonConfiguration::fields(Self& self, Io& io) {
    io("PersistentTargets", self.m_persistent);
    io("Mirrors", self.m_mirrors);
    io("LegacyMirrorStackMappings", self.m_legacy);
    io("RetiredPersistentTargets", self.m_retired);
    io("CacheTargets", self.m_caches);
    io("CalyraNormalPriorityQueue", self.m_normalQueue);
    io("CalyraLowPriorityQueue", self.m_lowQueue);
    io("CalyraConvertinQueue", self.m_convertinQueue);
    io("CalyraQueuesEnabled", self.m_suiteQueuesEnabled);
    io("internalWorkListQueue", self.m_workListQueue);
    io("internalWorkListQueueIsStatisticsOnly", self.m_workListStatisticsOnly);
    io("TimeToLive", self.m_timeToLive);
    io("TimeToReach", self.m_timeToReach);
    io("maxMigrationThreadsPerSource", self.m_threadsPerSource);
    io("numberOfMigrationThreads", self.m_threads);
    io("MigrationRequestPollingInterval", self.m_pollingInterval);
    io("VerifyMigrationFrequencyInMinutes", self.m_verifyMinutes);
}

bool operator==(const MSMQCommonConfiguration& a, const MSMQCommonConfiguration& b) {
    return Fields::equal(a, b) && StorageFields::sameLinks(a.m_chains, b.m_chains);
}

MSMQCommonConfiguration::MSMQCommonConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kMsmqCommon, false),
      m_normalQueue(localQueue("calyranorm")),
      m_lowQueue(localQueue("calyralow")),
      m_convertinQueue(localQueue("convertin")) {}

Quorvex::auto_ptr<Vesk::Element> MSMQCommonConfiguration::writeVesk() const {
    return Quorvex::auto_ptr<Vesk::Element>();
}

bool MSMQCommonConfiguration::readVesk(const Vesk::Element& element) {
    try {
        const Vesk::MultiElementValue& children = element.getMultiElement();
        Fields::Reader read(Fields::In{&element, children});
        read("CalyraQueuesEnabled", m_suiteQueuesEnabled);
        read("CalyraNormalPriorityQueue", m_normalQueue);
        read("CalyraLowPriorityQueue", m_lowQueue);
        read("CalyraConvertinQueue", m_convertinQueue);
        read("internalWorkListQueue", m_workListQueue);
        read("internalWorkListQueueIsStatisticsOnly", m_workListStatisticsOnly);
        read("TimeToLive", m_timeToLive);
        read("TimeToReach", m_timeToReach);
        read("CacheTargets", m_caches);
        read("maxMigrationThreadsPerSource", m_threadsPerSource);
        read("numberOfMigrationThreads", m_threads);
        read("MigrationRequestPollingInterval", m_pollingInterval);
        read("VerifyMigrationFrequencyInMinutes", m_verifyMinutes);
        bool complete = readLocationChains(children) && read.complete();
        complete =
            getPersistentTargetsFromVesk(children, "PersistentTargets", m_persistent) && complete;
        complete = getPersistentTargetsFromVesk(children, "RetiredPersistentTargets", m_retired) &&
                   complete;
        complete = getMirrorsFromVesk(children) && complete;
        Fields::Reader legacy(Fields::In{&element, children});
        legacy("LegacyMirrorStackMappings",
               Fields::wrapped(LegacyMirrorStackMapping::WELL_KNOWN_NAME, m_legacy));
        return legacy.complete() && complete;
    } catch (const Vesk::TrelException& e) {
        QUORVEX_LOG(LM_ERROR,
                    "MSMQCommonConfiguration::readVesk: Failed. TrelException Exception: %s\n",
                    e.what());
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR, "MSMQCommonConfiguration::readVesk: Failed. Standard Exception: %s\n",
                    e.what());
    }
    return false;
}

bool MSMQCommonConfiguration::readLocationChains(const Vesk::MultiElementValue& children) {
    const Vesk::Element* chains = children.find(Fields::keyOf(kLocationChains));
    if (chains == nullptr || !chains->hasValue()) {
        throw std::runtime_error("No location migration chains element found");
    }
    m_chains.clear();
    bool complete = true;
    for (const Vesk::Element& item :
         Fields::KeyRange{chains->getMultiElement(), Fields::keyOf(kLocationChain)}) {
        const Vesk::MultiElementValue& keys = item.getMultiElement();
        ACE_CString name;
        if (!Fields::readScalar(keys, kLocationName, name)) {
            throw std::runtime_error("No location name was found for a location migration chain.");
        }
        const Vesk::Element* chain = keys.find(Fields::keyOf(kMigrationChain));
        if (chain == nullptr || !chain->hasValue()) {
            throw std::runtime_error(
                "No migration chain element found for location migration chain.");
        }
        ChainUtils::Chain links;
        complete =
            ChainUtils::getChainFromVesk(Fields::keyOf(kMigrationChain), keys, links) && complete;
        m_chains[name] = links;
    }
    return complete;
}

bool MSMQCommonConfiguration::getPersistentTargetsFromVesk(const Vesk::MultiElementValue& children,
                                                           const char* key, QueuePairs& targets) {
    try {
        return readPairs(children, key, targets, "Persistent", "Mirror");
    } catch (const Vesk::TrelException& e) {
        QUORVEX_LOG(LM_ERROR,
                    "MSMQCommonConfiguration::getPersistentTargetsFromVesk: Failed. TrelException: "
                    "%s\n",
                    e.what());
        return false;
    }
}

bool MSMQCommonConfiguration::getMirrorsFromVesk(const Vesk::MultiElementValue& children) {
    try {
        return readPairs(children, "Mirrors", m_mirrors, "PersistentStackGuid", "MirrorStackGuid");
    } catch (const Vesk::TrelException& e) {
        QUORVEX_LOG(LM_ERROR,
                    "MSMQCommonConfiguration::getMirrorsFromVesk: Failed. TrelException: %s\n",
                    e.what());
        return false;
    }
}

void MSMQCommonConfiguration::removePersistentTarget(const QueuePair& target) {
    eraseEvery(m_persistent, target);
}

void MSMQCommonConfiguration::removeMirror(const QueuePair& mirror) {
    eraseEvery(m_mirrors, mirror);
}

void MSMQCommonConfiguration::removeRetiredPersistentTarget(const QueuePair& target) {
    eraseEvery(m_retired, target);
}

bool MSMQCommonConfiguration::switchPersistent() {
    if (m_persistent.size() < 2) {
        QUORVEX_LOG(
            LM_CRITICAL,
            "MSMQCommonConfiguration::switchPersistent: Unable to persistent switchover, no "
            "future persistents specified in list.\n");
        return false;
    }
    const QueuePair current = m_persistent.front();
    m_retired.push_back(current);
    removePersistentTarget(current);
    return true;
}

}  // namespace Configuration
