// The remote DICOM nodes: the shared identity and the two storage commitment nodes, which keep it
// in their child "RemoteScp".
#include "Configuration/RemoteSCPConfiguration.h"

#include "Configuration/StorageCommitRemoteSCPConfiguration.h"
#include "Configuration/StorageCommitScpConfiguration.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void RemoteSCPConfiguration::fields(Self& self, Io& io) {
    io("RemoteHostDescription", self.m_description);
    io("RemoteDICOMSCPAETitle", self.m_aeTitle);
    io("HostName", self.m_hostName);
    io("Port", self.m_port);
}

CONFIGURATION_DEFINE(RemoteSCPConfiguration, RemoteSCPConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

template <class Self, class Io>
void StorageCommitScpConfiguration::fields(Self& self, Io& io) {
    io(RemoteSCPConfiguration::WELL_KNOWN_NAME,
       Fields::required(Fields::basePart<RemoteSCPConfiguration>(self)));
    io("ResponseTimeOut", self.m_responseTimeOut);
}

CONFIGURATION_DEFINE(StorageCommitScpConfiguration, StorageCommitScpConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

template <class Self, class Io>
void StorageCommitRemoteSCPConfiguration::fields(Self& self, Io& io) {
    io(RemoteSCPConfiguration::WELL_KNOWN_NAME,
       Fields::required(Fields::basePart<RemoteSCPConfiguration>(self)));
    io("MaxMinutesToWaitForImagesToArrive", self.m_maxMinutesToWait);
    io("RespondInSameAssociation", self.m_respondInSameAssociation);
}

CONFIGURATION_DEFINE(StorageCommitRemoteSCPConfiguration,
                     StorageCommitRemoteSCPConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

}  // namespace Configuration
