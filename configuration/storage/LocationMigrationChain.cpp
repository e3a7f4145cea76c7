#include "Configuration/LocationMigrationChain.h"

#include "StorageForms.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void LocationMigrationChain::fields(Self& self, Io& io) {
    io("LocationName", self.m_location);
    io("MigrationChain", StorageFields::chain(self.m_chain));
}

CONFIGURATION_DEFINE_READ(LocationMigrationChain, Fields::FailureForm::Failed)
CONFIGURATION_DEFINE_WRITE(LocationMigrationChain, LocationMigrationChain::WELL_KNOWN_NAME)

bool operator==(const LocationMigrationChain& a, const LocationMigrationChain& b) {
    return Fields::equal(a, b) && StorageFields::sameLinks(a.m_chain, b.m_chain);
}

}  // namespace Configuration
