// Configuration::AutoExportRule: one named automatic export rule: when enabled, studies matching
// its criteria go to its destinations.
//
// Element "AutoExportRule". The name is the element's attribute "Name": without it nothing else
// is read and the read fails (unlogged). Keys: "Enabled" (flag, false; required), "Criteria" and
// "Destinations" (each child a Criterion or Destination whatever its key; an absent list makes
// the read incomplete and keeps what it held; a list without a value keeps it too; an item whose
// read is incomplete is dropped). Failures are logged as "AutoExportRule::readVesk: Failed.
// Standard Exception: %s\n". Read-only: writeVesk throws std::exception
// ("AutoExportRule::writeVesk - Class cannot be serialized.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/Criterion.h"
#include "Configuration/Destination.h"

namespace Configuration {

class CONFIGURATION_API AutoExportRule : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(AutoExportRule);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "AutoExportRule";

    // The rule's name.
    const ACE_CString& getName() const { return m_name; }
    void setName(const ACE_CString& name) { m_name = name; }
    // Whether the rule applies.
    bool getEnabled() const { return m_enabled; }
    void setEnabled(bool enabled) { m_enabled = enabled; }
    // The conditions, in stored order.
    const std::vector<Criterion>& getCriteria() const { return m_criteria; }
    void setCriteria(const std::vector<Criterion>& criteria) { m_criteria = criteria; }
    // The targets, in stored order.
    const std::vector<Destination>& getDestinations() const { return m_destinations; }
    void setDestinations(const std::vector<Destination>& destinations) {
        m_destinations = destinations;
    }

    // True when a destination of the rule has that name, compared without regard to case.
    bool hasDestination(const ACE_CString& name) const;

private:
    ACE_CString m_name;
    bool m_enabled = false;
    std::vector<Criterion> m_criteria;
    std::vector<Destination> m_destinations;
};

}  // namespace Configuration
