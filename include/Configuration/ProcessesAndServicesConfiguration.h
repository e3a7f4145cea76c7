// Configuration::ProcessesAndServicesConfiguration: the per-machine document
// "ProcessesAndServices": the server processes a machine runs and, inside each, the services the
// process loads through the ACE service configurator.
//
// Element "ProcessesAndServices" with the child "ModuleType" first (u32: the module type of the
// process that wrote it; a new document takes the process-wide value; absent: unchanged, and the
// read still complete), then one "Process" child per process, in order (reading replaces the
// table: a document without processes reads as an empty table). "Process" holds "ProcessName"
// (string, empty), "State" (i32, 1: selected; 0: the machine does not run it), "ModuleType" (u32,
// 0), "Singleton" (flag, false), "Executable" (string, empty), then one "Service" child per
// service. "Service" holds "ServiceName" (string, empty), "State" (i32, 1: enabled; 0: disabled),
// "Definition" (string, empty: the directive that loads it, "dynamic NAME Service_Object *
// LIBRARY:_make_NAME() \"ARGUMENTS\"" or "static NAME").
//
// The default table is a single-server machine (module types in ModuleTypes below):
//   QuorvexStorageServer (storage server, singleton): the object request broker (five worker
//     threads, IIOP 6464, SSL 7575), "Storage Service" (-ArchiveMode off), "Duplicate Merge
//     Service" (-DuplicateMerge), "Qrscp Service" and "Storage Commit Service" enabled; the other
//     storage roles disabled: archive (-ArchiveMode on), workstation (-AutoDelete off), cache
//     (-AutoDelete all), archive update (-UpdateArchive on) and migrated-only clean-up.
//   QuorvexExportServer (export server, singleton): the object request broker (two worker
//     threads, IIOP 6465, SSL 7576), "KelExport Service", "Auto Export Service" and "Query Module
//     Service" enabled; "Qrscp KelExport Service" (-QrscpMode on) disabled.
//   QuorvexMigrationServer (migration server, singleton): "Migration Service" and "Registration
//     Service" enabled; "Heartbeat Service" (linked statically) enabled.
//   QuorvexArchiveServer (tape archive): not selected; a single server keeps no tape library.
//
// The process-wide module type and process name are set once by the running process; they are
// thread-safe. Documents are plain values owned by their callers; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

// The kinds of module a process can be, as stored in "ModuleType" and registered with the
// configuration service.
namespace ModuleTypes {
constexpr unsigned int kNone = 0;
constexpr unsigned int kStorageServer = 1;    // DICOM storage, query/retrieve, commitment
constexpr unsigned int kExportServer = 2;     // export, automatic export, query module
constexpr unsigned int kMigrationServer = 3;  // migration and registration between locations
constexpr unsigned int kArchiveServer = 4;    // tape archive
constexpr unsigned int kWebServer = 5;        // web administration and viewing
constexpr unsigned int kWebService = 6;       // web services (export, study authority)
}  // namespace ModuleTypes

class CONFIGURATION_API ProcessesAndServicesConfiguration
    : public TypedConfigDoc<ProcessesAndServicesConfiguration> {
    CONFIGURATION_CLASS(ProcessesAndServicesConfiguration);

public:
    // One service a process loads.
    class CONFIGURATION_API Service : public virtual Vesk::Serializable {
        CONFIGURATION_CLASS(Service);

    public:
        Service() = default;
        // A service with its display name, directive and state (0: disabled).
        explicit Service(const ACE_CString& name, const ACE_CString& definition = ACE_CString(),
                         int state = 1)
            : m_name(name), m_state(state), m_definition(definition) {}

        // Display name of the service.
        const ACE_CString& getServiceName() const { return m_name; }
        void setServiceName(const ACE_CString& name) { m_name = name; }
        // 0: disabled; any other value: enabled.
        int getState() const { return m_state; }
        void setState(int state) { m_state = state; }
        // Whether the service is enabled (state not 0).
        bool isEnabled() const { return m_state != 0; }
        // The service-configurator directive that loads the service.
        const ACE_CString& getDefinition() const { return m_definition; }
        void setDefinition(const ACE_CString& definition) { m_definition = definition; }

    private:
        ACE_CString m_name;
        int m_state = 1;
        ACE_CString m_definition;
    };

    // One server process of the machine.
    class CONFIGURATION_API Process : public virtual Vesk::Serializable {
        CONFIGURATION_CLASS(Process);

    public:
        Process() = default;
        // A selected process with its name, executable and module type.
        explicit Process(const ACE_CString& name, const ACE_CString& executable = ACE_CString(),
                         unsigned int moduleType = ModuleTypes::kNone)
            : m_name(name), m_moduleType(moduleType), m_executable(executable) {}

        // The process's name.
        const ACE_CString& getProcessName() const { return m_name; }
        void setProcessName(const ACE_CString& name) { m_name = name; }
        // 0: not run on this machine; any other value: selected.
        int getState() const { return m_state; }
        void setState(int state) { m_state = state; }
        // Whether the machine runs the process (state not 0).
        bool isSelected() const { return m_state != 0; }
        // The kind of module the process is (ModuleTypes).
        unsigned int getModuleType() const { return m_moduleType; }
        void setModuleType(unsigned int moduleType) { m_moduleType = moduleType; }
        // Whether only one instance may run.
        bool isSingleton() const { return m_singleton; }
        void setSingleton(bool singleton) { m_singleton = singleton; }
        // The program file started for the process.
        const ACE_CString& getExecutable() const { return m_executable; }
        void setExecutable(const ACE_CString& executable) { m_executable = executable; }
        // The services of the process, in order.
        const std::vector<Service>& getServices() const { return m_services; }
        void setServices(const std::vector<Service>& services) { m_services = services; }
        // Appends a service.
        void addService(const Service& service) { m_services.push_back(service); }

    private:
        ACE_CString m_name;
        int m_state = 1;
        unsigned int m_moduleType = ModuleTypes::kNone;
        bool m_singleton = false;
        ACE_CString m_executable;
        std::vector<Service> m_services;
    };

    // The per-machine document "ProcessesAndServices" holding the single-server table.
    ProcessesAndServicesConfiguration();

    // The processes, in order.
    const std::vector<Process>& getProcesses() const { return m_processes; }
    void setProcesses(const std::vector<Process>& processes) { m_processes = processes; }
    // Appends a process.
    void addProcess(const Process& process) { m_processes.push_back(process); }
    // The module type stored in the document ("ModuleType").
    unsigned int getDocumentModuleType() const { return m_documentModuleType; }
    void setDocumentModuleType(unsigned int moduleType) { m_documentModuleType = moduleType; }

    // For every selected process its name and "\r\n", then "\t" + definition + "\r\n" for each of
    // its enabled services.
    ACE_CString getServiceInfo() const;
    // The service-configurator text of one process: "\t" + definition + "\r\n" for each enabled
    // service of the first selected process with that name; empty when there is none.
    ACE_CString getServiceDirectives(const ACE_CString& processName) const;
    // False, with the reason, when no process is selected or when both export services
    // ("KelExport Service" and "Qrscp KelExport Service") are enabled on the machine.
    bool isValid(ACE_CString& reason) const;

    // The module type of the running process (process-wide, 0 until set).
    static unsigned int getModuleType();
    static void setModuleType(unsigned int moduleType);
    // The name of the running process (process-wide, empty until set).
    static ACE_CString getProcessName();
    static void setProcessName(const ACE_CString& name);

private:
    void fillDefaultTable();

    unsigned int m_documentModuleType;
    std::vector<Process> m_processes;
};

}  // namespace Configuration
