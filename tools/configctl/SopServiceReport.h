// SopServiceReport: a SOP service document as an administrator reads it: per service its UID,
// name, object type, template and whether it is offered, then the transfer syntaxes it accepts
// (the enabled ones, by UID and name) as a table; so what a server will negotiate shows without
// reading the XML; as text or JSON. Stateless; thread-safe.
#pragma once

#include <ostream>

namespace Configuration {
class SOPServiceConfiguration;
}

namespace Configctl {

// Prints the resolved services of config to out.
void printSopServices(const Configuration::SOPServiceConfiguration& config, std::ostream& out);
// The same as one JSON object; each service lists every transfer syntax with whether it is enabled.
void printSopServicesJson(const Configuration::SOPServiceConfiguration& config, std::ostream& out);

}  // namespace Configctl
