// Configuration::StorageCommitRemoteSCPConfiguration: a remote node that asks the archive to
// commit instances it sent.
//
// Element "StorageCommitRemoteScp"; in order: the node (RemoteSCPConfiguration, child
// "RemoteScp": required, its absence is a logged read failure that ends the read),
// "MaxMinutesToWaitForImagesToArrive" (unsigned int, 30: how long a request may wait for
// instances not yet arrived), "RespondInSameAssociation" (flag, false).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include "Configuration/ConfigurationClass.h"
#include "Configuration/RemoteSCPConfiguration.h"

namespace Configuration {

class CONFIGURATION_API StorageCommitRemoteSCPConfiguration : public RemoteSCPConfiguration {
    CONFIGURATION_CLASS(StorageCommitRemoteSCPConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "StorageCommitRemoteScp";

    // Minutes a request may wait for instances that have not arrived yet.
    unsigned int getMaxMinutesToWaitForImagesToArrive() const { return m_maxMinutesToWait; }
    void setMaxMinutesToWaitForImagesToArrive(unsigned int minutes) {
        m_maxMinutesToWait = minutes;
    }
    // Whether the answer goes back on the requesting association.
    bool getRespondInSameAssociation() const { return m_respondInSameAssociation; }
    void setRespondInSameAssociation(bool same) { m_respondInSameAssociation = same; }

private:
    unsigned int m_maxMinutesToWait = 30;
    bool m_respondInSameAssociation = false;
};

}  // namespace Configuration
