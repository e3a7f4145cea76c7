// configctl's machine commands: processes (a machine's processes and services as a table) and
// services (the service-configurator text one process of the machine loads).
#include <ostream>
#include <string>

#include "Commands.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "Configuration/ProcessesAndServicesConfiguration.h"
#include "Configuration/StoredForm.h"
#include "ProcessesReport.h"

namespace Configctl {

// The processes table of --host (default: the service's own host), which must be stored.
void Commands::loadProcesses(Configuration::ProcessesAndServicesConfiguration& config) {
    const ACE_CString machine = host();
    bool found = false;
    client().checkForExistence(machine, config.path(), found);
    if (!found) {
        throw Configuration::HttpConfigurationPathNotFoundException(
            ACE_CString("the processes table of host ") + machine + " not found");
    }
    Quorvex::ByteArray bytes;
    std::size_t length = 0;
    client().retrieve(machine, config.path(), bytes, length);
    Vesk::Element tree;
    Configuration::StoredForm::decode(bytes.get(), length, tree);
    if (!config.readVesk(tree)) {
        notes() << "(incomplete: the table lacks keys; defaults are shown for them)\n";
    }
}

void Commands::processes() {
    expectArguments(0, 0, "processes [--host NAME]");
    Configuration::ProcessesAndServicesConfiguration config;
    loadProcesses(config);
    if (m_options.json) {
        printProcessesJson(config, m_out);
    } else {
        printProcesses(config, m_out);
    }
}

void Commands::services() {
    expectArguments(1, 1, "services PROCESS [--host NAME]");
    Configuration::ProcessesAndServicesConfiguration config;
    loadProcesses(config);
    const ACE_CString name = m_options.arguments[0].c_str();
    bool known = false;
    for (const auto& process : config.getProcesses()) {
        known = known || (process.getProcessName() == name && process.isSelected());
    }
    if (!known) {
        throw Configuration::HttpConfigurationPathNotFoundException(
            ACE_CString("selected process ") + name + " of host " + host() + " not found");
    }
    if (m_options.json) {
        printServicesJson(config, name, m_out);
        return;
    }
    const ACE_CString directives = config.getServiceDirectives(name);
    m_out << directives.c_str();
}

}  // namespace Configctl
