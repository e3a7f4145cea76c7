// Configuration::StorageCommitConfiguration: the site-wide document "StorageCommit": the remote
// nodes that may ask the archive for storage commitment.
//
// Element "StorageCommit" with one child "StorageCommitRemoteConfigurations" holding one
// "StorageCommitRemoteScp" per node. The child is required (its absence is a logged read failure
// that keeps the list); a child without a value empties the list; a node whose read is
// incomplete is dropped and makes the read incomplete.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/StorageCommitRemoteSCPConfiguration.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API StorageCommitConfiguration
    : public TypedConfigDoc<StorageCommitConfiguration> {
    CONFIGURATION_CLASS(StorageCommitConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "StorageCommit";

    // The site-wide document "StorageCommit" with no node.
    StorageCommitConfiguration();

    // The nodes that ask the archive for commitment, in stored order.
    const std::vector<StorageCommitRemoteSCPConfiguration>& getRemoteConfigurations() const {
        return m_remotes;
    }
    void setRemoteConfigurations(const std::vector<StorageCommitRemoteSCPConfiguration>& remotes) {
        m_remotes = remotes;
    }

private:
    std::vector<StorageCommitRemoteSCPConfiguration> m_remotes;
};

}  // namespace Configuration
