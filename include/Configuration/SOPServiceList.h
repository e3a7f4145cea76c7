// Configuration::SOPServiceList: the services of the SOP service document. Element
// "SOPServiceList" with one child "SOPService" per service, in document order; every service is
// kept, also one whose read was incomplete. Reading appends to what the list holds. Read-only:
// writeVesk throws std::exception ("SOPServiceList::writeVesk - Not supported.").
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/SOPService.h"

namespace Configuration {

class CONFIGURATION_API SOPServiceList : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(SOPServiceList);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "SOPServiceList";

    // The services, in document order.
    const std::vector<SOPService>& getSOPServices() const { return m_services; }

private:
    friend class SOPServiceConfiguration;

    std::vector<SOPService> m_services;
};

}  // namespace Configuration
