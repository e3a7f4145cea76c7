#include "Configuration/LocationMigrationFilter.h"

#include "Configuration/RulesConfiguration.h"
#include "StorageForms.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void LocationMigrationFilter::fields(Self& self, Io& io) {
    io("LocationName", self.m_locationName);
    io(MigrationRule::WELL_KNOWN_NAME, StorageFields::rules(self.m_rules));
}

CONFIGURATION_DEFINE(LocationMigrationFilter, LocationMigrationFilter::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

bool LocationMigrationFilter::addMigrationRule(const MigrationRule& rule) {
    return m_rules.add(RulesConfiguration::normalizeKey(rule.key()), rule);
}

std::unique_ptr<MigrationRule> LocationMigrationFilter::findMigrationRule(
    const ACE_CString& aeTitle) const {
    if (m_rules.empty()) {
        return nullptr;
    }
    return m_rules.find(RulesConfiguration::normalizeKey(aeTitle));
}

void LocationMigrationFilter::replaceRules(const LocationMigrationFilter& other) {
    m_rules = other.m_rules;
}

}  // namespace Configuration
