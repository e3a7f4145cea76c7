// Configuration::LocationMigrationFilter: the migration rules of one location (or the default
// rules of the site), by sender. Element "LocationMigrationFilter": "LocationName" ("" by
// default; the default filter has none) followed by one "MigrationRule" per rule, in the order of
// their keys. Rules are kept under their normalised AE title (RulesConfiguration::normalizeKey);
// of two rules with the same normalised title the first is kept.
// Thread-safety: the rule table is guarded by a readers-writer mutex, so lookups and additions
// may run on several threads at once; reading the whole filter (readVesk) replaces the rules in
// one step. The location name is a plain value: change it on one thread only.
#pragma once

#include <ace/SString.h>

#include <memory>
#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/MigrationRule.h"
#include "Configuration/RuleTable.h"

namespace Configuration {

class CONFIGURATION_API LocationMigrationFilter : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(LocationMigrationFilter);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "LocationMigrationFilter";

    // The location the filter belongs to ("" for the default filter).
    const ACE_CString& getLocationName() const { return m_locationName; }
    void setLocationName(const ACE_CString& name) { m_locationName = name; }

    // Stores a copy of rule under its normalised key; false when that key is taken.
    bool addMigrationRule(const MigrationRule& rule);
    // A new copy of the rule of aeTitle (normalised), or an empty pointer (at once, without
    // normalising, when the filter has no rule).
    std::unique_ptr<MigrationRule> findMigrationRule(const ACE_CString& aeTitle) const;
    // Whether the filter holds any rule.
    bool hasMigrationRules() const { return !m_rules.empty(); }
    // Every rule, in the order of their normalised keys.
    std::vector<MigrationRule> getMigrationRules() const { return m_rules.rules(); }
    // Replaces the rules by other's in one step (the location name stays).
    void replaceRules(const LocationMigrationFilter& other);

private:
    ACE_CString m_locationName;
    RuleTable<MigrationRule> m_rules;

    friend class RulesConfiguration;
};

}  // namespace Configuration
