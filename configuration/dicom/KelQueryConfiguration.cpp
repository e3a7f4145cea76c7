// The query module's document, its remote archives and its prefetch section.
#include "Configuration/KelQueryConfiguration.h"

#include <cstdlib>

#include "Configuration/DocumentNames.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

int numberLikeAtoi(const ACE_CString& text) {
    return std::atoi(text.c_str());
}

constexpr const char kArchives[] = "Archives";

}  // namespace

// Reading also takes "Organization" a second time after "QueryModel"; as it reads the same first
// child again, it is left out.
template <class Self, class Io>
void KelQueryRemoteSCPConfiguration::fields(Self& self, Io& io) {
    io(RemoteSCPConfiguration::WELL_KNOWN_NAME,
       Fields::required(Fields::basePart<RemoteSCPConfiguration>(self)));
    io("MergeArkCompatibility", self.m_mergeArkCompatibility);
    io("Organization", self.m_organization);
    io("QueryModel",
       Fields::required(Fields::text(self.m_queryModel, numberLikeAtoi,
                                     [](int model) { return Fields::toText(model); })));
}

CONFIGURATION_DEFINE(KelQueryRemoteSCPConfiguration,
                     KelQueryRemoteSCPConfiguration::WELL_KNOWN_NAME, Fields::FailureForm::Failed)

template <class Self, class Io>
void PrefetchConfiguration__::fields(Self& self, Io& io) {
    io("TreatOtherIdsAsPrimary", self.m_treatOtherIdsAsPrimary);
    io("PrefetchOutsideNormalBusinessHours", self.m_outsideBusinessHours);
    io("PrefetchDaysBefore", self.m_daysBefore);
    io("PrefetchMaxRetries", self.m_maxRetries);
    io("PrefetchEnabled", self.m_enabled);
}

CONFIGURATION_DEFINE(PrefetchConfiguration__, PrefetchConfiguration__::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

// Reading takes "LongTermStorageArchive" before "CleanupInterval"; a scalar never ends a read, so
// the order of the two cannot show.
template <class Self, class Io>
void KelQueryConfiguration::fields(Self& self, Io& io) {
    io("MaxConcurrentArchiveMoves", self.m_maxConcurrentMoves);
    io("MoveAttemptCount", self.m_moveAttemptCount);
    io("QueryTimeout", self.m_queryTimeout);
    io("MoveTimeout", self.m_moveTimeout);
    io("MoveTimeoutOnError", self.m_moveTimeoutOnError);
    io("KelQueryAETitle", self.m_aeTitle);
    io("CleanupInterval", self.m_cleanupInterval);
    io("LongTermStorageArchive", self.m_longTermStorageArchive);
    io("ConnectionPoolingEnabled", self.m_connectionPooling);
    io("MaxConnectionsInPool", self.m_maxConnectionsInPool);
    io("MaxResultsPerQuery", self.m_maxResultsPerQuery);
    io(kArchives, Fields::required(Fields::wrapped(KelQueryRemoteSCPConfiguration::WELL_KNOWN_NAME,
                                                   self.m_archives, Fields::DropFailed)));
    io(PrefetchConfiguration__::WELL_KNOWN_NAME, Fields::optional(self.m_prefetch));
}

CONFIGURATION_DEFINE(KelQueryConfiguration, KelQueryConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

KelQueryConfiguration::KelQueryConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kKelQuery, false) {}

}  // namespace Configuration
