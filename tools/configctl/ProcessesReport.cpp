#include "ProcessesReport.h"

#include <cstddef>
#include <string>

#include "Configuration/ProcessesAndServicesConfiguration.h"
#include "JsonText.h"

namespace Configctl {
namespace {

using Configuration::ProcessesAndServicesConfiguration;
using Process = ProcessesAndServicesConfiguration::Process;
using Service = ProcessesAndServicesConfiguration::Service;

const char* const kModuleTypeNames[] = {
    "none",           "storage server", "export server", "migration server",
    "archive server", "web server",     "web service"};

std::string padded(const std::string& text, std::size_t width) {
    return text.size() >= width ? text + " " : text + std::string(width - text.size(), ' ');
}

std::string serviceCounts(const Process& process) {
    std::size_t enabled = 0;
    for (const Service& service : process.getServices()) {
        enabled += service.isEnabled() ? 1 : 0;
    }
    return std::to_string(enabled) + " enabled, " +
           std::to_string(process.getServices().size() - enabled) + " disabled";
}

void printProcess(const Process& process, std::ostream& out) {
    const std::string type = std::to_string(process.getModuleType()) + " (" +
                             moduleTypeName(process.getModuleType()) + ")";
    out << padded(process.getProcessName().c_str(), 26) << padded(type, 21)
        << padded(process.isSelected() ? "selected" : "not run", 10)
        << padded(process.getExecutable().c_str(), 34) << serviceCounts(process)
        << (process.isSingleton() ? ", singleton" : "") << "\n";
    for (const Service& service : process.getServices()) {
        out << "    " << padded(service.isEnabled() ? "enabled" : "disabled", 10)
            << service.getServiceName().c_str() << "\n";
    }
}

void writeProcessJson(const Process& process, JsonWriter& json) {
    json.beginObject().field("process", process.getProcessName());
    json.field("moduleType", process.getModuleType());
    json.field("moduleTypeName", moduleTypeName(process.getModuleType()));
    json.field("selected", process.isSelected()).field("executable", process.getExecutable());
    json.field("singleton", process.isSingleton()).key("services").beginArray();
    for (const Service& service : process.getServices()) {
        json.beginObject().field("service", service.getServiceName());
        json.field("enabled", service.isEnabled()).endObject();
    }
    json.endArray().endObject();
}

}  // namespace

std::string moduleTypeName(unsigned int moduleType) {
    const std::size_t count = sizeof kModuleTypeNames / sizeof kModuleTypeNames[0];
    return moduleType < count ? kModuleTypeNames[moduleType]
                              : "module " + std::to_string(moduleType);
}

void printProcesses(const ProcessesAndServicesConfiguration& config, std::ostream& out) {
    out << padded("PROCESS", 26) << padded("MODULE TYPE", 21) << padded("STATE", 10)
        << padded("EXECUTABLE", 34) << "SERVICES\n";
    for (const Process& process : config.getProcesses()) {
        printProcess(process, out);
    }
    ACE_CString reason;
    out << "\nWritten by module type " << config.getDocumentModuleType() << " ("
        << moduleTypeName(config.getDocumentModuleType()) << "); "
        << (config.isValid(reason) ? std::string("valid")
                                   : std::string("invalid: ") + reason.c_str())
        << "\n";
}

void printProcessesJson(const ProcessesAndServicesConfiguration& config, std::ostream& out) {
    JsonWriter json(out);
    json.beginObject().key("processes").beginArray();
    for (const Process& process : config.getProcesses()) {
        writeProcessJson(process, json);
    }
    ACE_CString reason;
    const bool valid = config.isValid(reason);
    json.endArray().field("documentModuleType", config.getDocumentModuleType());
    json.field("valid", valid).key("invalidReason").optional(reason.c_str()).endObject();
}

void printServicesJson(const ProcessesAndServicesConfiguration& config,
                       const ACE_CString& processName, std::ostream& out) {
    JsonWriter json(out);
    json.beginArray();
    for (const Process& process : config.getProcesses()) {
        if (!process.isSelected() || process.getProcessName() != processName) {
            continue;
        }
        for (const Service& service : process.getServices()) {
            if (service.isEnabled()) {
                json.beginObject().field("service", service.getServiceName());
                json.field("directive", service.getDefinition()).endObject();
            }
        }
        break;
    }
    json.endArray();
}

}  // namespace Configctl
