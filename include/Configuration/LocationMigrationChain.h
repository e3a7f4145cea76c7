// Configuration::LocationMigrationChain: a location and its migration chain. Element
// "LocationMigrationChain"; keys in order: "LocationName" ("") and "MigrationChain" (the chain in
// the element form of ChainUtils, empty; absent reads as empty). Equal when the names are equal
// and the chains hold the same definitions, types and flags in order.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ChainUtils.h"
#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API LocationMigrationChain : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(LocationMigrationChain);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "LocationMigrationChain";

    LocationMigrationChain() = default;
    // The chain of location.
    LocationMigrationChain(const ACE_CString& location, const ChainUtils::Chain& chain)
        : m_location(location), m_chain(chain) {}

    // The location's name.
    const ACE_CString& getLocationName() const { return m_location; }
    void setLocationName(const ACE_CString& name) { m_location = name; }
    // The location's chain.
    const ChainUtils::Chain& getMigrationChain() const { return m_chain; }
    void setMigrationChain(const ChainUtils::Chain& chain) { m_chain = chain; }

private:
    ACE_CString m_location;
    ChainUtils::Chain m_chain;
};

}  // namespace Configuration
