// ProcessesReport: a machine's processes table as an administrator reads it: one row per process
// (name, module type, state, executable, how many services are enabled and disabled), its
// services below it, then whether the table is valid; and the service-configurator text one
// process loads; both also as JSON. Stateless; thread-safe.
#pragma once

#include <ace/SString.h>

#include <ostream>
#include <string>

namespace Configuration {
class ProcessesAndServicesConfiguration;
}

namespace Configctl {

// Prints the processes and services of config to out.
void printProcesses(const Configuration::ProcessesAndServicesConfiguration& config,
                    std::ostream& out);
// The same as one JSON object: processes (each with its services), documentModuleType, valid and
// the reason when it is not.
void printProcessesJson(const Configuration::ProcessesAndServicesConfiguration& config,
                        std::ostream& out);
// The enabled services of the first selected process named processName as a JSON array of
// objects: service, directive.
void printServicesJson(const Configuration::ProcessesAndServicesConfiguration& config,
                       const ACE_CString& processName, std::ostream& out);

// The name of a module type ("storage server", ...; "module N" for an unknown number).
std::string moduleTypeName(unsigned int moduleType);

}  // namespace Configctl
