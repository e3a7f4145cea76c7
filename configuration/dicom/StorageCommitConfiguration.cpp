#include "Configuration/StorageCommitConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void StorageCommitConfiguration::fields(Self& self, Io& io) {
    io("StorageCommitRemoteConfigurations",
       Fields::required(Fields::wrapped(StorageCommitRemoteSCPConfiguration::WELL_KNOWN_NAME,
                                        self.m_remotes, Fields::DropFailed)));
}

CONFIGURATION_DEFINE(StorageCommitConfiguration, StorageCommitConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

StorageCommitConfiguration::StorageCommitConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kStorageCommit,
                     false) {}

}  // namespace Configuration
