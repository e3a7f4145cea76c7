// The processes table of a single-server machine: what a freshly installed machine runs.
#include <string>

#include "Configuration/ProcessesAndServicesConfiguration.h"

namespace Configuration {
namespace {

using Process = ProcessesAndServicesConfiguration::Process;
using Service = ProcessesAndServicesConfiguration::Service;

// "dynamic NAME Service_Object * LIBRARY:_make_NAME()" with its arguments, if any, quoted.
ACE_CString dynamicService(const char* name, const char* library, const char* arguments = "") {
    ACE_CString text("dynamic ");
    text += name;
    text += " Service_Object * ";
    text += library;
    text += ":_make_";
    text += name;
    text += "()";
    if (*arguments != '\0') {
        text += " \"";
        text += arguments;
        text += "\"";
    }
    return text;
}

Service service(const char* displayName, const ACE_CString& definition, bool enabled) {
    return Service(displayName, definition, enabled ? 1 : 0);
}

// The object request broker: worker threads, IIOP and SSL ports, dotted-decimal addresses.
Service orb(int threads, int iiopPort, int sslPort) {
    const ACE_CString arguments =
        ACE_CString("-ORBThreads ") + std::to_string(threads).c_str() +
        " -ORBListenEndpoints iiop://:" + std::to_string(iiopPort).c_str() +
        "/ssl_port=" + std::to_string(sslPort).c_str() + " -ORBDottedDecimalAddresses 1";
    return service("Object Request Broker",
                   dynamicService("OrbService", "QuorvexOrb", arguments.c_str()), true);
}

Service storage(const char* displayName, const char* name, const char* arguments, bool enabled) {
    return service(displayName, dynamicService(name, "QuorvexStorage", arguments), enabled);
}

Process storageServer() {
    Process p("QuorvexStorageServer", "QuorvexStorageServer.exe", ModuleTypes::kStorageServer);
    p.setSingleton(true);
    p.addService(orb(5, 6464, 7575));
    p.addService(storage("Storage Service", "StorageService", "-ArchiveMode off", true));
    p.addService(
        storage("Archive Storage Service", "ArchiveStorageService", "-ArchiveMode on", false));
    p.addService(storage("Workstation Storage Service", "WorkstationStorageService",
                         "-ArchiveMode off -AutoDelete off", false));
    p.addService(storage("Cache Storage Service", "CacheStorageService",
                         "-ArchiveMode off -AutoDelete all", false));
    p.addService(storage("Archive Update Storage Service", "ArchiveUpdateStorageService",
                         "-ArchiveMode on -UpdateArchive on -AutoDelete off", false));
    p.addService(storage("Migrated-Only Storage Service", "MigratedOnlyStorageService",
                         "-ArchiveMode off -AutoDelete migrated-only", false));
    p.addService(
        storage("Duplicate Merge Service", "DuplicateMergeService", "-DuplicateMerge", true));
    p.addService(service("Qrscp Service", dynamicService("QrscpService", "QuorvexQrscp"), true));
    p.addService(service("Storage Commit Service",
                         dynamicService("StorageCommitService", "QuorvexStorageCommit"), true));
    return p;
}

Process exportServer() {
    Process p("QuorvexExportServer", "QuorvexExportServer.exe", ModuleTypes::kExportServer);
    p.setSingleton(true);
    p.addService(orb(2, 6465, 7576));
    p.addService(
        service("KelExport Service", dynamicService("KelExportService", "QuorvexKelExport"), true));
    p.addService(service(
        "Qrscp KelExport Service",
        dynamicService("QrscpKelExportService", "QuorvexKelExport", "-QrscpMode on"), false));
    p.addService(service("Auto Export Service",
                         dynamicService("AutoExportService", "QuorvexAutoExport"), true));
    p.addService(service("Query Module Service",
                         dynamicService("QueryModuleService", "QuorvexKelQuery"), true));
    return p;
}

Process migrationServer() {
    Process p("QuorvexMigrationServer", "QuorvexMigrationServer.exe",
              ModuleTypes::kMigrationServer);
    p.setSingleton(true);
    p.addService(
        service("Migration Service", dynamicService("MigrationService", "QuorvexMigration"), true));
    p.addService(service("Registration Service",
                         dynamicService("RegistrationService", "QuorvexMigration"), true));
    p.addService(service("Heartbeat Service", "static HeartbeatService", true));
    return p;
}

Process archiveServer() {
    Process p("QuorvexArchiveServer", "QuorvexArchiveServer.exe", ModuleTypes::kArchiveServer);
    p.setSingleton(true);
    p.setState(0);
    p.addService(service("Tape Archive Service",
                         dynamicService("TapeArchiveService", "QuorvexTapeArchive"), true));
    return p;
}

}  // namespace

void ProcessesAndServicesConfiguration::fillDefaultTable() {
    m_processes = {storageServer(), exportServer(), migrationServer(), archiveServer()};
}

}  // namespace Configuration
