// Configuration::StorageCommitScpConfiguration: the remote node that the archive asks to commit
// what it exported, and how long it waits for the answer (an export destination's settings).
//
// Element "StorageCommitScpConfiguration"; in order: the node (RemoteSCPConfiguration, child
// "RemoteScp": required, its absence is a logged read failure that ends the read), then
// "ResponseTimeOut" (int, 60).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include "Configuration/ConfigurationClass.h"
#include "Configuration/RemoteSCPConfiguration.h"

namespace Configuration {

class CONFIGURATION_API StorageCommitScpConfiguration : public RemoteSCPConfiguration {
    CONFIGURATION_CLASS(StorageCommitScpConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "StorageCommitScpConfiguration";

    // How long to wait for the node's answer (the caller's unit).
    int getResponseTimeOut() const { return m_responseTimeOut; }
    void setResponseTimeOut(int timeOut) { m_responseTimeOut = timeOut; }

private:
    int m_responseTimeOut = 60;
};

}  // namespace Configuration
