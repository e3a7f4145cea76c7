// Configuration::RulesConfiguration: the site-wide document "RoutingRules" (element
// "RulesConfiguration"): per sending AE title, the suite queues its studies are registered on
// and the chain they migrate along, by default or per location.
//
// Children in written order: "MigrationRulesConfiguration" ("MigrationRule" items: the default
// filter), "LocationMigrationFilters" ("LocationMigrationFilter" items, by location name),
// "RegistrationRulesConfiguration" ("RegistrationRule" items). Read in the order location
// filters, default filter, registration rules; a missing child leaves its rules as they were and
// makes the read incomplete; a rule is added whatever its own read gave. Rules are written in the
// order of their keys.
// Rule keys are AE titles normalised by normalizeKey (upper case, nothing trimmed).
//
// Thread-safety: lookups (findRegistrationRule, findDefaultMigrationRule,
// findLocationMigrationRule, has..., get...) may run on several threads while another thread
// adds rules or re-reads the document: every table is guarded by a readers-writer mutex, and a
// re-read builds the new tables first and swaps each in one step. Copying and comparing are safe
// against such readers too; two threads must not re-read the same object at once.
#pragma once

#include <ace/RW_Thread_Mutex.h>
#include <ace/SString.h>

#include <map>
#include <memory>
#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/LocationMigrationFilter.h"
#include "Configuration/RegistrationRule.h"
#include "Configuration/RuleTable.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API RulesConfiguration : public TypedConfigDoc<RulesConfiguration> {
    CONFIGURATION_CLASS(RulesConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "RulesConfiguration";

    // The site-wide document "RoutingRules" without rules.
    RulesConfiguration();
    RulesConfiguration(const RulesConfiguration& other);
    RulesConfiguration& operator=(const RulesConfiguration& other);
    ~RulesConfiguration() override;

    // A copy of text with every byte upper-cased (locale toupper); nothing trimmed.
    static ACE_CString normalizeKey(const ACE_CString& text);

    // Stores a copy of rule under its normalised key; false when the table refuses it (the key
    // is taken).
    bool addRegistrationRule(const RegistrationRule& rule);
    // Removes the rule under rule's normalised key; false when there is none.
    bool removeRegistrationRule(const RegistrationRule& rule);
    // A new copy of aeTitle's registration rule, or an empty pointer (at once, without
    // normalising, when there is no rule at all).
    std::unique_ptr<RegistrationRule> findRegistrationRule(const ACE_CString& aeTitle) const;
    // Whether there is any registration rule.
    bool hasRegistrationRules() const { return !m_registration.empty(); }
    // Appends every registration rule to rules, in the order of their keys.
    void getRegistrationRules(std::vector<RegistrationRule>& rules) const;

    // The site's default migration filter.
    const LocationMigrationFilter& getDefaultMigrationFilter() const { return m_default; }
    LocationMigrationFilter& getDefaultMigrationFilter() { return m_default; }
    // A new copy of aeTitle's rule in the default filter, or an empty pointer.
    std::unique_ptr<MigrationRule> findDefaultMigrationRule(const ACE_CString& aeTitle) const;
    // A new copy of aeTitle's rule in location's filter (exact name), or an empty pointer.
    std::unique_ptr<MigrationRule> findLocationMigrationRule(const ACE_CString& location,
                                                             const ACE_CString& aeTitle) const;
    // Stores filter (a copy) under its location name, replacing one stored there.
    void setLocationMigrationFilter(const LocationMigrationFilter& filter);
    // The names of the locations with a filter of their own, in order.
    std::vector<ACE_CString> getLocationNames() const;

private:
    using Filters = std::map<ACE_CString, LocationMigrationFilter>;

    Filters filtersSnapshot() const;

    RuleTable<RegistrationRule> m_registration;
    LocationMigrationFilter m_default;
    Filters m_filters;
    mutable ACE_RW_Thread_Mutex m_filtersLock;  // guards m_filters
};

}  // namespace Configuration
