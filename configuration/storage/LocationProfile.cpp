#include "Configuration/LocationProfile.h"

#include <ace/OS_NS_strings.h>

#include <algorithm>

#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

bool sameNoCase(const ACE_CString& a, const ACE_CString& b) {
    return a.length() == b.length() && ACE_OS::strncasecmp(a.c_str(), b.c_str(), a.length()) == 0;
}

}  // namespace

template <class Self, class Io>
void LocationProfile::fields(Self& self, Io& io) {
    io("ProfileName", self.m_name);
    io("LocalServers", self.m_servers);
    io("NewExamImageQuality", self.m_newQuality);
    io("PriorExamImageQuality", self.m_priorQuality);
    io("LocationType", self.m_type);
    io("PrefetchImages", self.m_prefetch);
    io("InternalWorkListHost", self.m_workListHost);
    io("RouteToLocation", self.m_routeTo);
    io("NetworkAffiliation", self.m_affiliation);
    io("CollectionMode", self.m_collectionMode);
    io("CollectIpFilters", self.m_ipFilters);
    io("MergeTraceLevels", self.m_traceLevels);
    io("EnableForwarding", self.m_forwarding);
    io("ForwardingDestinations", Fields::wrapped(KelExportRemoteScp::WELL_KNOWN_NAME,
                                                 self.m_destinations, Fields::DropFailed));
    io("EnableMergeNetworkCapture", self.m_captureEnabled);
    io("MergeNetworkCaptureShutOffTimer", self.m_captureShutOff);
    io("MergeNetworkCapturedFileRetentionTime", self.m_captureRetention);
    io("DicomModalityWorkListPort", self.m_dmwlPort);
}

CONFIGURATION_DEFINE(LocationProfile, LocationProfile::WELL_KNOWN_NAME, Fields::FailureForm::Failed)

void LocationProfile::removeLocalServer(const ACE_CString& host) {
    const auto it =
        std::find_if(m_servers.begin(), m_servers.end(),
                     [&](const ACE_CString& server) { return sameNoCase(server, host); });
    if (it != m_servers.end()) {
        m_servers.erase(it);
    }
}

bool LocationProfile::hasServer(const ACE_CString& host) const {
    return std::any_of(m_servers.begin(), m_servers.end(),
                       [&](const ACE_CString& server) { return sameNoCase(server, host); });
}

void LocationProfile::removeIpFilter(const ACE_CString& filter) {
    m_ipFilters.erase(std::remove(m_ipFilters.begin(), m_ipFilters.end(), filter),
                      m_ipFilters.end());
}

bool LocationProfile::hasFilter(const ACE_CString& filter) const {
    return m_ipFilters.empty() ||
           std::find(m_ipFilters.begin(), m_ipFilters.end(), filter) != m_ipFilters.end();
}

void LocationProfile::removeForwardDestination(const KelExportRemoteScp& destination) {
    m_destinations.erase(std::remove(m_destinations.begin(), m_destinations.end(), destination),
                         m_destinations.end());
}

}  // namespace Configuration
