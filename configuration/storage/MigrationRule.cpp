#include "Configuration/MigrationRule.h"

#include "StorageForms.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void MigrationRule::fields(Self& self, Io& io) {
    io("AE_Title", self.m_key);
    io("Filter", StorageFields::chain(self.m_filter));
}

CONFIGURATION_DEFINE_READ(MigrationRule, Fields::FailureForm::PartialDefaultsNoStop)
CONFIGURATION_DEFINE_WRITE(MigrationRule, MigrationRule::WELL_KNOWN_NAME)

bool operator==(const MigrationRule& a, const MigrationRule& b) {
    return Fields::equal(a, b) && StorageFields::sameLinks(a.m_filter, b.m_filter);
}

}  // namespace Configuration
