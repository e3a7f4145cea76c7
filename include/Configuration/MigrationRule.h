// Configuration::MigrationRule: the migration chain of the studies of one sender. Element
// "MigrationRule"; keys in order: "AE_Title" (the sender's AE title, "") and "Filter" (the chain,
// in the element form of ChainUtils, empty; absent reads as empty). Equal when the titles are
// equal and the chains hold the same definitions, types and flags in the same order.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ChainUtils.h"
#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API MigrationRule : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(MigrationRule);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "MigrationRule";

    MigrationRule() = default;
    // The rule of the sender key with the chain filter.
    MigrationRule(const ACE_CString& key, const ChainUtils::Chain& filter)
        : m_key(key), m_filter(filter) {}

    // The sender's AE title.
    const ACE_CString& key() const { return m_key; }
    void key(const ACE_CString& key) { m_key = key; }
    // The chain the sender's studies migrate along.
    const ChainUtils::Chain& filter() const { return m_filter; }
    void filter(const ChainUtils::Chain& filter) { m_filter = filter; }

private:
    ACE_CString m_key;
    ChainUtils::Chain m_filter;
};

}  // namespace Configuration
