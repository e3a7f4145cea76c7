// Configuration::MSMQCommonConfiguration: the site's storage topology (site-wide document
// "MsmqCommon"): the migration chain of each location, the persistent targets (the first is the
// current one, the rest future ones) with their mirrors, the mirror stack of each persistent
// stack, legacy mirror GUIDs, retired persistent targets, the cache targets, the suite queues and
// the tuning of the migration workers. Its queries combine it, at the moment of the query, with
// the strategy document (which stack is active) and the location document (the main location).
//
// Keys as read, with defaults (<host> is ConfigDoc::getLocalHostName()):
//   "CalyraQueuesEnabled" true; "CalyraNormalPriorityQueue" "DIRECT=OS:<host>\private$\calyranorm";
//   "CalyraLowPriorityQueue" "DIRECT=OS:<host>\private$\calyralow"; "CalyraConvertinQueue"
//   "DIRECT=OS:<host>\private$\convertin"; "internalWorkListQueue" "";
//   "internalWorkListQueueIsStatisticsOnly" false; "TimeToLive" 86400 s; "TimeToReach" 86400 s;
//   "CacheTargets" (repeated children, queue names) empty; "maxMigrationThreadsPerSource" 1;
//   "numberOfMigrationThreads" 20; "MigrationRequestPollingInterval" 60;
//   "VerifyMigrationFrequencyInMinutes" 720; then
//   "LocationMigrationChains": "LocationMigrationChain" items ("LocationName", "MigrationChain"
//     in the chain form of ChainUtils); required: without it the read fails as a whole;
//   "PersistentTargets", "RetiredPersistentTargets": list values of ("Persistent", "Mirror");
//   "Mirrors": list value of ("PersistentStackGuid", "MirrorStackGuid");
//   "LegacyMirrorStackMappings": "LegacyMirrorStackMapping" items.
// The pair lists are optional (absent: left as they are). writeVesk gives an empty pointer: the
// library reads this document but never writes it.
//
// The object is a plain value owned by its caller, not thread-safe. The topology queries are
// const and build their own strategy and location documents through the process's
// TopologySource (by default the repository), so concurrent callers share nothing here.
#pragma once

#include <ace/SString.h>

#include <map>
#include <utility>
#include <vector>

#include "Configuration/ChainUtils.h"
#include "Configuration/ConfigurationClass.h"
#include "Configuration/LegacyMirrorStackMapping.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API MSMQCommonConfiguration : public TypedConfigDoc<MSMQCommonConfiguration> {
    CONFIGURATION_CLASS(MSMQCommonConfiguration);

public:
    // A pair of queues (persistent, mirror) or of stack GUIDs (persistent, mirror).
    using QueuePair = std::pair<ACE_CString, ACE_CString>;
    using QueuePairs = std::vector<QueuePair>;
    // Location name to its migration chain.
    using LocationChains = std::map<ACE_CString, ChainUtils::Chain>;

    // The site-wide document "MsmqCommon" with the defaults above.
    MSMQCommonConfiguration();

    // Location name to its migration chain.
    const LocationChains& getLocationMigrationChains() const { return m_chains; }
    void setLocationMigrationChains(const LocationChains& chains) { m_chains = chains; }
    // The persistent targets: the first is the current one.
    const QueuePairs& getPersistentTargets() const { return m_persistent; }
    void setPersistentTargets(const QueuePairs& targets) { m_persistent = targets; }
    void addPersistentTarget(const QueuePair& target) { m_persistent.push_back(target); }
    // Removes every pair equal to target.
    void removePersistentTarget(const QueuePair& target);
    // The (persistent stack GUID, mirror stack GUID) pairs.
    const QueuePairs& getMirrors() const { return m_mirrors; }
    void setMirrors(const QueuePairs& mirrors) { m_mirrors = mirrors; }
    void addMirror(const QueuePair& mirror) { m_mirrors.push_back(mirror); }
    // Removes every pair equal to mirror.
    void removeMirror(const QueuePair& mirror);
    // Former persistent targets, still read but no longer written.
    const QueuePairs& getRetiredPersistentTargets() const { return m_retired; }
    void setRetiredPersistentTargets(const QueuePairs& targets) { m_retired = targets; }
    void addRetiredPersistentTarget(const QueuePair& target) { m_retired.push_back(target); }
    // Removes every pair equal to target.
    void removeRetiredPersistentTarget(const QueuePair& target);
    // The cache targets: the first is the active cache.
    const std::vector<ACE_CString>& getCacheMigrationTargets() const { return m_caches; }
    void setCacheMigrationTargets(const std::vector<ACE_CString>& queues) { m_caches = queues; }
    void addCacheMigrationTarget(const ACE_CString& queue) { m_caches.push_back(queue); }
    // Old mirror GUIDs of mirror machines and their new ones.
    const std::vector<LegacyMirrorStackMapping>& getLegacyMirrorStackMappings() const {
        return m_legacy;
    }
    void setLegacyMirrorStackMappings(const std::vector<LegacyMirrorStackMapping>& mappings) {
        m_legacy = mappings;
    }
    // The suite's normal-priority queue.
    const ACE_CString& getCalyraNormalPriorityQueue() const { return m_normalQueue; }
    void setCalyraNormalPriorityQueue(const ACE_CString& queue) { m_normalQueue = queue; }
    // The suite's low-priority queue.
    const ACE_CString& getCalyraLowPriorityQueue() const { return m_lowQueue; }
    void setCalyraLowPriorityQueue(const ACE_CString& queue) { m_lowQueue = queue; }
    // The suite's conversion-in queue.
    const ACE_CString& getCalyraConvertinQueue() const { return m_convertinQueue; }
    void setCalyraConvertinQueue(const ACE_CString& queue) { m_convertinQueue = queue; }
    // Whether the suite queues are used.
    bool getCalyraQueuesEnabled() const { return m_suiteQueuesEnabled; }
    void setCalyraQueuesEnabled(bool enabled) { m_suiteQueuesEnabled = enabled; }
    // The internal work-list queue ("" when none).
    const ACE_CString& getInternalWorkListQueue() const { return m_workListQueue; }
    void setInternalWorkListQueue(const ACE_CString& queue) { m_workListQueue = queue; }
    // Whether the internal work-list queue only collects statistics.
    bool getInternalWorkListQueueIsStatisticsOnly() const { return m_workListStatisticsOnly; }
    void setInternalWorkListQueueIsStatisticsOnly(bool only) { m_workListStatisticsOnly = only; }
    // Seconds a message lives.
    unsigned int getTimeToLive() const { return m_timeToLive; }
    void setTimeToLive(unsigned int seconds) { m_timeToLive = seconds; }
    // Seconds a message may take to reach its queue.
    unsigned int getTimeToReach() const { return m_timeToReach; }
    void setTimeToReach(unsigned int seconds) { m_timeToReach = seconds; }
    // Migration threads one source may use.
    unsigned int getMaxMigrationThreadsPerSource() const { return m_threadsPerSource; }
    void setMaxMigrationThreadsPerSource(unsigned int count) { m_threadsPerSource = count; }
    // Migration threads in all.
    unsigned int getNumberOfMigrationThreads() const { return m_threads; }
    void setNumberOfMigrationThreads(unsigned int count) { m_threads = count; }
    // How often migration requests are polled for.
    unsigned int getMigrationRequestPollingInterval() const { return m_pollingInterval; }
    void setMigrationRequestPollingInterval(unsigned int interval) { m_pollingInterval = interval; }
    // Minutes between verifications of migrated studies.
    unsigned int getVerifyMigrationFrequency() const { return m_verifyMinutes; }
    void setVerifyMigrationFrequency(unsigned int minutes) { m_verifyMinutes = minutes; }

    // The active persistent stack: the main location's first link must be the persistent keyword
    // (any case); prefix and suffix are its text around the host, so that prefix + stackUid +
    // suffix is the stack's input queue. False when anything is missing or no stack is active.
    bool getActivePersistentStackUid(ACE_CString& stackUid, ACE_CString& prefix,
                                     ACE_CString& suffix) const;
    // The mirror of the active persistent stack, from the main location's second link (the
    // mirror keyword); logs when no stack is active or the active one has no mirror.
    bool getActivePersistentMirrorStackUid(ACE_CString& stackUid, ACE_CString& prefix,
                                           ACE_CString& suffix) const;
    // The mirror of the given persistent stack, with the prefix and suffix of the main
    // location's mirror link.
    bool getMirrorStackUidForPersistentStack(const ACE_CString& persistentStackUid,
                                             ACE_CString& mirrorStackUid, ACE_CString& prefix,
                                             ACE_CString& suffix) const;
    // The mirror GUID of the first "Mirrors" pair whose persistent GUID is exactly stackUid.
    bool getMirrorStackForPersistentStack(const ACE_CString& stackUid,
                                          ACE_CString& mirrorStackUid) const;
    // The persistent queue of the first persistent, then retired, target whose mirror queue is
    // on mirrorHost (equivalent host names).
    bool getPersistentForMirror(const ACE_CString& mirrorHost, ACE_CString& persistentQueue) const;
    // The first cache target; false when there is none or it is empty.
    bool getActiveCache(ACE_CString& queue) const;
    // The new GUID of the mirror machine's old mirror stack GUID; "" when not mapped.
    ACE_CString GetNewMirrorStackID(const ACE_CString& oldGuid, const ACE_CString& machine) const;
    // Resolves a link definition: the persistent keyword to the active stack and the mirror
    // keyword to its mirror (type 1), the cache keyword to the active cache (type 3), anything
    // else to itself (type 4). When no stack is active but the local configuration service knows
    // hosts of module type 8 (storage stacks), logs critically and throws std::runtime_error;
    // without such hosts, or when the service cannot be asked (logged), it returns false.
    bool translateLinkDefinitionWithStackUid(const ACE_CString& definition, short& type,
                                             ACE_CString& resolved, ACE_CString& prefix,
                                             ACE_CString& suffix) const;
    // Retires the current persistent target when a future one exists (not stored here).
    bool switchPersistent();

private:
    bool GetPersistentLinkDefinition(ACE_CString& definition) const;
    bool GetMirrorLinkDefinition(ACE_CString& definition) const;
    bool linkDefinition(std::size_t index, ACE_CString& definition) const;
    bool getPersistentTargetsFromVesk(const Vesk::MultiElementValue& children, const char* key,
                                      QueuePairs& targets);
    bool getMirrorsFromVesk(const Vesk::MultiElementValue& children);
    bool readLocationChains(const Vesk::MultiElementValue& children);

    LocationChains m_chains;
    QueuePairs m_persistent;
    QueuePairs m_mirrors;
    std::vector<LegacyMirrorStackMapping> m_legacy;
    QueuePairs m_retired;
    std::vector<ACE_CString> m_caches;
    ACE_CString m_normalQueue;
    ACE_CString m_lowQueue;
    ACE_CString m_convertinQueue;
    bool m_suiteQueuesEnabled = true;
    ACE_CString m_workListQueue;
    bool m_workListStatisticsOnly = false;
    unsigned int m_timeToLive = 86400;
    unsigned int m_timeToReach = 86400;
    unsigned int m_threadsPerSource = 1;
    unsigned int m_threads = 20;
    unsigned int m_pollingInterval = 60;
    unsigned int m_verifyMinutes = 720;
};

}  // namespace Configuration
