#include "Configuration/KelExportRemoteScp.h"

#include "ReadOrder.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void KelExportRemoteScp::fields(Self& self, Io& io) {
    const auto remote = Fields::required(Fields::basePart<RemoteSCPConfiguration>(self));
    const char* const storageCommit = StorageCommitScpConfiguration::WELL_KNOWN_NAME;
    if constexpr (readingFields<Io>) {
        io("MaximumNumberOfConcurrentRequests", self.m_maxRequests);
        io("ResendEntireStudyOnRetry", self.m_resendEntireStudy);
        io("KeepAssociationOpenAcrossStudies", self.m_keepAssociationOpen);
        io("LocationAffinity", self.m_locationAffinity);
        io("HostAffinity", self.m_hostAffinity);
        io("BsnExport", self.m_bsnExport);
        io("DestinationInUseByAutoExportRule", self.m_inUseByRule);
        io("ForwardImages", Fields::optional(self.m_forwardImages, true));
        io("ForwardMPPS", Fields::optional(self.m_forwardMpps, false));
        io(RemoteSCPConfiguration::WELL_KNOWN_NAME, remote);
        io(storageCommit, Fields::optional(self.m_storageCommit));
    } else {
        io(RemoteSCPConfiguration::WELL_KNOWN_NAME, remote);
        io("MaximumNumberOfConcurrentRequests", self.m_maxRequests);
        io("ResendEntireStudyOnRetry", self.m_resendEntireStudy);
        io("KeepAssociationOpenAcrossStudies", self.m_keepAssociationOpen);
        io("ForwardImages", self.m_forwardImages);
        io("ForwardMPPS", self.m_forwardMpps);
        io("LocationAffinity", self.m_locationAffinity);
        io("HostAffinity", self.m_hostAffinity);
        io("BsnExport", self.m_bsnExport);
        io("DestinationInUseByAutoExportRule", self.m_inUseByRule);
        io(storageCommit, self.m_storageCommit);
    }
}

CONFIGURATION_DEFINE(KelExportRemoteScp, KelExportRemoteScp::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

}  // namespace Configuration
