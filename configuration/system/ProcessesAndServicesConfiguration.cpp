#include "Configuration/ProcessesAndServicesConfiguration.h"

#include <atomic>
#include <mutex>

#include "Configuration/DocumentNames.h"
#include "Configuration/NoCaseCompare.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

using Process = ProcessesAndServicesConfiguration::Process;
using Service = ProcessesAndServicesConfiguration::Service;

const char kExportService[] = "KelExport Service";
const char kQrscpExportService[] = "Qrscp KelExport Service";

std::atomic<unsigned int> s_moduleType{ModuleTypes::kNone};

std::mutex& processNameMutex() {
    static std::mutex mutex;
    return mutex;
}

ACE_CString& processName() {
    static ACE_CString name;
    return name;
}

bool equalNoCase(const ACE_CString& a, const char* b) {
    const NoCaseCompare less;
    return !less(a, b) && !less(b, a);
}

// Whether a selected process enables a service of that name (ignoring case).
bool enabledAnywhere(const std::vector<Process>& processes, const char* serviceName) {
    for (const Process& process : processes) {
        if (!process.isSelected()) {
            continue;
        }
        for (const Service& service : process.getServices()) {
            if (service.isEnabled() && equalNoCase(service.getServiceName(), serviceName)) {
                return true;
            }
        }
    }
    return false;
}

void appendDirectives(const Process& process, ACE_CString& text) {
    for (const Service& service : process.getServices()) {
        if (service.isEnabled()) {
            text += "\t";
            text += service.getDefinition();
            text += "\r\n";
        }
    }
}

}  // namespace

template <class Self, class Io>
void ProcessesAndServicesConfiguration::Service::fields(Self& self, Io& io) {
    io("ServiceName", self.m_name);
    io("State", self.m_state);
    io("Definition", self.m_definition);
}

CONFIGURATION_DEFINE(ProcessesAndServicesConfiguration::Service, "Service",
                     Fields::FailureForm::Failed)

template <class Self, class Io>
void ProcessesAndServicesConfiguration::Process::fields(Self& self, Io& io) {
    io("ProcessName", self.m_name);
    io("State", self.m_state);
    io("ModuleType", self.m_moduleType);
    io("Singleton", self.m_singleton);
    io("Executable", self.m_executable);
    io("Service", self.m_services);
}

CONFIGURATION_DEFINE(ProcessesAndServicesConfiguration::Process, "Process",
                     Fields::FailureForm::Failed)

template <class Self, class Io>
void ProcessesAndServicesConfiguration::fields(Self& self, Io& io) {
    io("ModuleType", Fields::optional(self.m_documentModuleType));
    io("Process", self.m_processes);
}

CONFIGURATION_DEFINE(ProcessesAndServicesConfiguration, "ProcessesAndServices",
                     Fields::FailureForm::Failed)

ProcessesAndServicesConfiguration::ProcessesAndServicesConfiguration()
    : TypedConfigDoc(
          ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kProcessesAndServices, true),
      m_documentModuleType(getModuleType()) {
    fillDefaultTable();
}

ACE_CString ProcessesAndServicesConfiguration::getServiceInfo() const {
    ACE_CString text;
    for (const Process& process : m_processes) {
        if (process.isSelected()) {
            text += process.getProcessName();
            text += "\r\n";
            appendDirectives(process, text);
        }
    }
    return text;
}

ACE_CString ProcessesAndServicesConfiguration::getServiceDirectives(
    const ACE_CString& processName) const {
    ACE_CString text;
    for (const Process& process : m_processes) {
        if (process.isSelected() && process.getProcessName() == processName) {
            appendDirectives(process, text);
            break;
        }
    }
    return text;
}

bool ProcessesAndServicesConfiguration::isValid(ACE_CString& reason) const {
    bool anySelected = false;
    for (const Process& process : m_processes) {
        anySelected = anySelected || process.isSelected();
    }
    if (!anySelected) {
        reason = "No process is selected";
        return false;
    }
    if (enabledAnywhere(m_processes, kExportService) &&
        enabledAnywhere(m_processes, kQrscpExportService)) {
        reason = "KelExport and QRSCP KelExport may not run on the same server";
        return false;
    }
    return true;
}

unsigned int ProcessesAndServicesConfiguration::getModuleType() {
    return s_moduleType.load();
}

void ProcessesAndServicesConfiguration::setModuleType(unsigned int moduleType) {
    s_moduleType.store(moduleType);
}

ACE_CString ProcessesAndServicesConfiguration::getProcessName() {
    std::lock_guard<std::mutex> lock(processNameMutex());
    return processName();
}

void ProcessesAndServicesConfiguration::setProcessName(const ACE_CString& name) {
    std::lock_guard<std::mutex> lock(processNameMutex());
    processName() = name;
}

}  // namespace Configuration
