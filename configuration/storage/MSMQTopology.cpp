// The topology queries of MSMQCommonConfiguration: each combines this document with the strategy
// and location documents as they are at the moment of the query.
#include <ace/OS_NS_strings.h>

#include <stdexcept>
#include <vector>

#include "Configuration/LocationConfiguration.h"
#include "Configuration/MSMQCommonConfiguration.h"
#include "Configuration/MSMQConfiguration.h"
#include "Configuration/StrategyConfiguration.h"
#include "Configuration/TopologySource.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"

namespace Configuration {
namespace {

// The module type of storage stack hosts in the configuration service's numbering.
constexpr int kStorageStackModuleType = 8;

#define QUORVEX_NO_ACTIVE_STACK                                                                 \
    "MSMQCommonConfiguration::translateLinkDefinition: Unable to determine active stack based " \
    "on strategy configuration. Please diagnose and use OrvelWeb to configure an active stack."

bool sameNoCase(const ACE_CString& a, const ACE_CString& b) {
    return a.length() == b.length() && ACE_OS::strncasecmp(a.c_str(), b.c_str(), a.length()) == 0;
}

// prefix: the text up to and including the first ':'; suffix: from the first '\' on, which must
// come after the colon.
bool splitAroundHost(const ACE_CString& definition, ACE_CString& prefix, ACE_CString& suffix) {
    const ACE_CString::size_type colon = definition.find(':');
    const ACE_CString::size_type backslash = definition.find('\\');
    if (colon == ACE_CString::npos || backslash == ACE_CString::npos || backslash < colon) {
        return false;
    }
    prefix = definition.substring(0, colon + 1);
    suffix = definition.substring(backslash);
    return true;
}

// The active stack of the strategy document as it is stored now (a document that cannot be read
// has no active stack).
bool activeStack(StrategyStack& stack) {
    StrategyConfiguration strategy;
    topologySource().load(strategy);
    return strategy.TryGetActiveStack(stack);
}

// No stack is active: a site without storage stacks answers false quietly; a site with some is
// misconfigured, which is logged and thrown with the given text.
bool noActiveStack(const char* thrownText) {
    std::vector<ACE_CString> hosts;
    try {
        topologySource().hostsOfModuleType(kStorageStackModuleType, hosts);
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "MSMQCommonConfiguration::translateLinkDefinition: Unable to list the storage "
                    "stack hosts: %s\n",
                    e.what());
        return false;
    }
    if (hosts.empty()) {
        return false;
    }
    QUORVEX_LOG(LM_CRITICAL, QUORVEX_NO_ACTIVE_STACK "\n");
    throw std::runtime_error(thrownText);
}

}  // namespace

bool MSMQCommonConfiguration::linkDefinition(std::size_t index, ACE_CString& definition) const {
    LocationConfiguration locations;
    topologySource().load(locations);
    const LocationProfile* main = locations.getMainCalyraProfile();
    if (main == nullptr) {
        return false;
    }
    const auto chain = m_chains.find(main->getProfileName());
    if (chain == m_chains.end() || chain->second.size() <= index) {
        return false;
    }
    definition = chain->second[index].getDefinition();
    return definition.length() != 0;
}

bool MSMQCommonConfiguration::GetPersistentLinkDefinition(ACE_CString& definition) const {
    return linkDefinition(0, definition);
}

bool MSMQCommonConfiguration::GetMirrorLinkDefinition(ACE_CString& definition) const {
    return linkDefinition(1, definition);
}

bool MSMQCommonConfiguration::getActivePersistentStackUid(ACE_CString& stackUid,
                                                          ACE_CString& prefix,
                                                          ACE_CString& suffix) const {
    ACE_CString definition;
    if (!GetPersistentLinkDefinition(definition) ||
        !sameNoCase(definition, ChainUtils::PersistentKeyword()) ||
        !splitAroundHost(definition, prefix, suffix)) {
        return false;
    }
    StrategyStack active;
    if (!activeStack(active)) {
        return false;
    }
    stackUid = active.getStackUid();
    return true;
}

bool MSMQCommonConfiguration::getActivePersistentMirrorStackUid(ACE_CString& stackUid,
                                                                ACE_CString& prefix,
                                                                ACE_CString& suffix) const {
    ACE_CString definition;
    if (!GetMirrorLinkDefinition(definition) ||
        !sameNoCase(definition, ChainUtils::PersistentMirrorKeyword()) ||
        !splitAroundHost(definition, prefix, suffix)) {
        return false;
    }
    StrategyStack active;
    if (!activeStack(active)) {
        QUORVEX_LOG(
            LM_CRITICAL,
            "MSMQCommonConfiguration::getActivePersistentMirror: Unable to determine active "
            "stack based on strategy configuration. Please diagnose and use OrvelWeb to "
            "configure an active stack.\n");
        return false;
    }
    ACE_CString mirror;
    if (!getMirrorStackForPersistentStack(active.getStackUid(), mirror)) {
        QUORVEX_LOG(
            LM_DEBUG,
            "MSMQCommonConfiguration::getActivePersistentMirror: Unable to determine mirror "
            "for active stack %s.\n",
            active.getStackUid().c_str());
        return false;
    }
    stackUid = mirror;
    return true;
}

bool MSMQCommonConfiguration::getMirrorStackUidForPersistentStack(
    const ACE_CString& persistentStackUid, ACE_CString& mirrorStackUid, ACE_CString& prefix,
    ACE_CString& suffix) const {
    ACE_CString definition;
    return GetMirrorLinkDefinition(definition) && splitAroundHost(definition, prefix, suffix) &&
           getMirrorStackForPersistentStack(persistentStackUid, mirrorStackUid);
}

bool MSMQCommonConfiguration::getMirrorStackForPersistentStack(const ACE_CString& stackUid,
                                                               ACE_CString& mirrorStackUid) const {
    mirrorStackUid.clear();
    for (const QueuePair& mirror : m_mirrors) {
        if (mirror.first == stackUid) {
            mirrorStackUid = mirror.second;
            return true;
        }
    }
    return false;
}

bool MSMQCommonConfiguration::getPersistentForMirror(const ACE_CString& mirrorHost,
                                                     ACE_CString& persistentQueue) const {
    for (const QueuePairs* targets : {&m_persistent, &m_retired}) {
        for (const QueuePair& target : *targets) {
            ACE_CString host;
            ACE_CString name;
            if (MSMQConfiguration::ParseDirectFormattedMSMQ(target.second, host, name) &&
                Quorvex::HostNamesEquivalent(host, mirrorHost)) {
                persistentQueue = target.first;
                return true;
            }
        }
    }
    return false;
}

bool MSMQCommonConfiguration::getActiveCache(ACE_CString& queue) const {
    if (m_caches.empty() || m_caches.front().length() == 0) {
        return false;
    }
    queue = m_caches.front();
    return true;
}

ACE_CString MSMQCommonConfiguration::GetNewMirrorStackID(const ACE_CString& oldGuid,
                                                         const ACE_CString& machine) const {
    for (const LegacyMirrorStackMapping& mapping : m_legacy) {
        if (mapping.getOldMirrorStackGuid() == oldGuid &&
            mapping.getMirrorMachineName() == machine) {
            return mapping.getNewMirrorStackGuid();
        }
    }
    return ACE_CString();
}

bool MSMQCommonConfiguration::translateLinkDefinitionWithStackUid(const ACE_CString& definition,
                                                                  short& type,
                                                                  ACE_CString& resolved,
                                                                  ACE_CString& prefix,
                                                                  ACE_CString& suffix) const {
    const bool persistent = sameNoCase(definition, ChainUtils::PersistentKeyword());
    if (persistent || sameNoCase(definition, ChainUtils::PersistentMirrorKeyword())) {
        if (!splitAroundHost(definition, prefix, suffix)) {
            return false;
        }
        type = ChainUtils::ActiveStack;
        StrategyStack active;
        if (!activeStack(active)) {
            // The two texts differ on purpose: the mirror's keeps the log line's newline.
            return noActiveStack(persistent ? QUORVEX_NO_ACTIVE_STACK
                                            : QUORVEX_NO_ACTIVE_STACK "\n");
        }
        if (persistent) {
            resolved = active.getStackUid();
            return true;
        }
        return getMirrorStackForPersistentStack(active.getStackUid(), resolved);
    }
    if (sameNoCase(definition, ChainUtils::CacheKeyword())) {
        type = ChainUtils::Cache;
        return getActiveCache(resolved);
    }
    type = ChainUtils::LiteralQueue;
    resolved = definition;
    return true;
}

}  // namespace Configuration
