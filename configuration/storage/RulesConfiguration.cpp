#include "Configuration/RulesConfiguration.h"

#include <ace/Guard_T.h>

#include <cctype>

#include "Configuration/DocumentNames.h"
#include "StorageForms.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

constexpr const char kDefaultRules[] = "MigrationRulesConfiguration";
constexpr const char kLocationFilters[] = "LocationMigrationFilters";
constexpr const char kRegistrationRules[] = "RegistrationRulesConfiguration";

template <class Filters>
auto filtersForm(Filters& filters) {
    return Fields::wrapped(LocationMigrationFilter::WELL_KNOWN_NAME, filters, Fields::KeepFailed,
                           &LocationMigrationFilter::getLocationName);
}

}  // namespace

RulesConfiguration::RulesConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kRoutingRules,
                     false) {}

RulesConfiguration::RulesConfiguration(const RulesConfiguration& other)
    : Vesk::Serializable(other),
      TypedConfigDoc(other),
      m_registration(other.m_registration),
      m_default(other.m_default),
      m_filters(other.filtersSnapshot()) {}

RulesConfiguration& RulesConfiguration::operator=(const RulesConfiguration& other) {
    if (this != &other) {
        ConfigDoc::operator=(other);
        m_registration = other.m_registration;
        m_default.replaceRules(other.m_default);
        Filters filters = other.filtersSnapshot();
        ACE_Write_Guard<ACE_RW_Thread_Mutex> guard(m_filtersLock);
        m_filters.swap(filters);
    }
    return *this;
}

RulesConfiguration::~RulesConfiguration() = default;

ACE_CString RulesConfiguration::normalizeKey(const ACE_CString& text) {
    ACE_CString key(text);
    for (ACE_CString::size_type i = 0; i < key.length(); ++i) {
        key[i] = static_cast<char>(std::toupper(static_cast<unsigned char>(key[i])));
    }
    return key;
}

// Location filters first, then the default filter, then the registration rules; each table is
// built aside and swapped in, so concurrent lookups see the old rules or the new ones.
bool RulesConfiguration::readVesk(const Vesk::Element& element) {
    try {
        const Vesk::MultiElementValue& children = element.getMultiElement();
        const Fields::In in{&element, children};
        Filters filters;
        bool complete = filtersForm(filters).read(in, kLocationFilters);
        if (children.has(Fields::keyOf(kLocationFilters))) {
            ACE_Write_Guard<ACE_RW_Thread_Mutex> guard(m_filtersLock);
            m_filters.swap(filters);
        }
        complete = StorageFields::rules(m_default.m_rules, MigrationRule::WELL_KNOWN_NAME)
                       .read(in, kDefaultRules) &&
                   complete;
        complete = StorageFields::rules(m_registration, RegistrationRule::WELL_KNOWN_NAME)
                       .read(in, kRegistrationRules) &&
                   complete;
        return complete;
    } catch (const std::exception& e) {
        Fields::logReadFailure("RulesConfiguration", Fields::FailureForm::Failed, e.what());
        return false;
    }
}

Quorvex::auto_ptr<Vesk::Element> RulesConfiguration::writeVesk() const {
    Quorvex::auto_ptr<Vesk::Element> root(new Vesk::Element(Fields::keyOf(WELL_KNOWN_NAME), -1));
    try {
        Fields::Out out{root.get(), root->addMultiElement()};
        StorageFields::rules(m_default.m_rules, MigrationRule::WELL_KNOWN_NAME)
            .write(out, kDefaultRules);
        const Filters filters = filtersSnapshot();
        filtersForm(filters).write(out, kLocationFilters);
        StorageFields::rules(m_registration, RegistrationRule::WELL_KNOWN_NAME)
            .write(out, kRegistrationRules);
    } catch (const Vesk::TrelException&) {
        throw Vesk::Serializable::SerializableEx();
    }
    return root;
}

bool operator==(const RulesConfiguration& a, const RulesConfiguration& b) {
    return a.m_registration == b.m_registration && a.m_default == b.m_default &&
           a.filtersSnapshot() == b.filtersSnapshot();
}

bool RulesConfiguration::addRegistrationRule(const RegistrationRule& rule) {
    return m_registration.add(normalizeKey(rule.key()), rule);
}

bool RulesConfiguration::removeRegistrationRule(const RegistrationRule& rule) {
    return m_registration.remove(normalizeKey(rule.key()));
}

std::unique_ptr<RegistrationRule> RulesConfiguration::findRegistrationRule(
    const ACE_CString& aeTitle) const {
    if (m_registration.empty()) {
        return nullptr;
    }
    return m_registration.find(normalizeKey(aeTitle));
}

void RulesConfiguration::getRegistrationRules(std::vector<RegistrationRule>& rules) const {
    for (RegistrationRule& rule : m_registration.rules()) {
        rules.push_back(std::move(rule));
    }
}

std::unique_ptr<MigrationRule> RulesConfiguration::findDefaultMigrationRule(
    const ACE_CString& aeTitle) const {
    return m_default.findMigrationRule(aeTitle);
}

std::unique_ptr<MigrationRule> RulesConfiguration::findLocationMigrationRule(
    const ACE_CString& location, const ACE_CString& aeTitle) const {
    ACE_Read_Guard<ACE_RW_Thread_Mutex> guard(m_filtersLock);
    const auto it = m_filters.find(location);
    return it == m_filters.end() ? nullptr : it->second.findMigrationRule(aeTitle);
}

void RulesConfiguration::setLocationMigrationFilter(const LocationMigrationFilter& filter) {
    ACE_Write_Guard<ACE_RW_Thread_Mutex> guard(m_filtersLock);
    m_filters[filter.getLocationName()] = filter;
}

std::vector<ACE_CString> RulesConfiguration::getLocationNames() const {
    ACE_Read_Guard<ACE_RW_Thread_Mutex> guard(m_filtersLock);
    std::vector<ACE_CString> names;
    for (const auto& entry : m_filters) {
        names.push_back(entry.first);
    }
    return names;
}

RulesConfiguration::Filters RulesConfiguration::filtersSnapshot() const {
    ACE_Read_Guard<ACE_RW_Thread_Mutex> guard(m_filtersLock);
    return m_filters;
}

}  // namespace Configuration
