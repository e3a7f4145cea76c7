// The example site's system documents end to end: the site-wide settings, the installed solution
// and a storage server's and a web server's processes tables, stored as bytes through a running
// configuration service of each machine and read back through that machine's repository.
#include <gtest/gtest.h>

#include <memory>
#include <string>

#include "Configuration/ApplicationLocationConfiguration.h"
#include "Configuration/ConfigurationRepository.h"
#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/OrvelSystemCommonConfiguration.h"
#include "Configuration/ProcessesAndServicesConfiguration.h"
#include "InProcessService.h"
#include "Quorvex/Host.h"
#include "ThroughServiceSupport.h"
#include "testing/FakeMachine.h"

namespace Configuration {
namespace {

Vesk::Element siteFile(const std::string& file) {
    return ThroughService::exampleDocument("site/" + file);
}

// One machine of the site: its service, its repository, and the site's documents in its store.
struct Machine {
    explicit Machine(const char* host, const char* processesFile)
        : service(options(host)), client(service.address().c_str(), true, false) {
        repository = ThroughService::repositoryAt(service.address(), Quorvex::HostKey(host));
        put(host, OrvelSystemCommonConfiguration().path(), "OrvelSystemCommon.xml");
        put(host, ApplicationLocationConfiguration().path(), "ApplicationLocation.xml");
        put(host, ProcessesAndServicesConfiguration().path(), processesFile);
    }
    static ConfigurationService::ServiceOptions options(const char* host) {
        ConfigurationService::ServiceOptions o;
        o.hostName = host;
        return o;
    }
    void put(const char* host, const ACE_CString& path, const char* file) {
        ThroughService::storeTree(client, host, path, siteFile(file));
    }

    ServiceTesting::InProcessService service;
    HttpConfigurationClient client;
    std::unique_ptr<ConfigurationRepository> repository;
};

struct MachineRow {
    const char* host;
    const char* file;
    unsigned int moduleType;
    const char* serviceInfo;  // what the machine's processes load
};

const MachineRow kMachines[] = {
    {"Store1", "ProcessesAndServices.StorageServer.xml", ModuleTypes::kStorageServer,
     "QuorvexStorageServer\r\n"
     "\tdynamic OrbService Service_Object * QuorvexOrb:_make_OrbService() \"-ORBThreads 5 "
     "-ORBListenEndpoints iiop://:6464/ssl_port=7575 -ORBDottedDecimalAddresses 1\"\r\n"
     "\tdynamic ArchiveStorageService Service_Object * "
     "QuorvexStorage:_make_ArchiveStorageService() "
     "\"-ArchiveMode on\"\r\n"
     "\tdynamic ArchiveUpdateStorageService Service_Object * "
     "QuorvexStorage:_make_ArchiveUpdateStorageService() \"-ArchiveMode on -UpdateArchive on "
     "-AutoDelete off\"\r\n"
     "\tdynamic DuplicateMergeService Service_Object * "
     "QuorvexStorage:_make_DuplicateMergeService() "
     "\"-DuplicateMerge\"\r\n"
     "\tdynamic QrscpService Service_Object * QuorvexQrscp:_make_QrscpService()\r\n"
     "\tdynamic StorageCommitService Service_Object * "
     "QuorvexStorageCommit:_make_StorageCommitService()\r\n"
     "QuorvexExportServer\r\n"
     "\tdynamic OrbService Service_Object * QuorvexOrb:_make_OrbService() \"-ORBThreads 2 "
     "-ORBListenEndpoints iiop://:6465/ssl_port=7576 -ORBDottedDecimalAddresses 1\"\r\n"
     "\tdynamic KelExportService Service_Object * QuorvexKelExport:_make_KelExportService()\r\n"
     "\tdynamic AutoExportService Service_Object * QuorvexAutoExport:_make_AutoExportService()\r\n"
     "QuorvexMigrationServer\r\n"
     "\tdynamic MigrationService Service_Object * QuorvexMigration:_make_MigrationService()\r\n"
     "\tdynamic RegistrationService Service_Object * "
     "QuorvexMigration:_make_RegistrationService()\r\n"
     "\tstatic HeartbeatService\r\n"
     "QuorvexArchiveServer\r\n"
     "\tdynamic TapeArchiveService Service_Object * QuorvexTapeArchive:_make_TapeArchiveService() "
     "\"-Library TSM1\"\r\n"},
    {"Web1", "ProcessesAndServices.WebServer.xml", ModuleTypes::kWebServer,
     "QuorvexWebServer\r\n"
     "\tdynamic OrbService Service_Object * QuorvexOrb:_make_OrbService() \"-ORBThreads 2 "
     "-ORBListenEndpoints iiop://:6465/ssl_port=7576 -ORBDottedDecimalAddresses 1\"\r\n"
     "\tdynamic ViewerService Service_Object * QuorvexViewer:_make_ViewerService() \"-Sessions "
     "60\"\r\n"
     "\tdynamic AdministrationService Service_Object * "
     "QuorvexAdministration:_make_AdministrationService()\r\n"
     "QuorvexWebServices\r\n"
     "\tdynamic ExportWebService Service_Object * QuorvexWebServices:_make_ExportWebService() "
     "\"-Port 8443\"\r\n"
     "QuorvexReportServer\r\n"},
};

class SystemSite : public testing::TestWithParam<MachineRow> {};

TEST_P(SystemSite, EachMachineReadsItsProcessesAndTheSiteThroughItsRepository) {
    const MachineRow& row = GetParam();
    Machine machine(row.host, row.file);
    ProcessesAndServicesConfiguration direct;
    ASSERT_TRUE(direct.readVesk(siteFile(row.file)));
    ProcessesAndServicesConfiguration processes;
    ASSERT_EQ(0, machine.repository->GetLatest(processes));
    EXPECT_EQ(direct, processes);
    EXPECT_EQ(row.moduleType, processes.getDocumentModuleType());
    ACE_CString reason;
    EXPECT_TRUE(processes.isValid(reason)) << reason.c_str();
    EXPECT_EQ(std::string(row.serviceInfo), processes.getServiceInfo().c_str());

    OrvelSystemCommonConfiguration site;
    ASSERT_EQ(0, machine.repository->GetLatest(site));
    EXPECT_EQ(ACE_CString("Northmed Regional Imaging"), site.getSiteName());
    EXPECT_EQ(ACE_CString("10.20.1.12"), site.getMasterDBServer());
    EXPECT_EQ(8001u, site.getIntegrationEngineHostPort());

    ApplicationLocationConfiguration location;
    ASSERT_EQ(0, machine.repository->GetLatest(location));
    EXPECT_EQ(3u, location.getProductDefinitions().getProductDefinitions().size());
    EXPECT_EQ(12u, location.getApplicationDefinitions().getApplicationDefinitions().size());
    // Every selected process of the machine is an application of the solution with a folder.
    Quorvex::Testing::FakeMachine fake;
    fake.inheritEnvironment = false;
    fake.env = {{"QUORVEX_STORAGE_BIN", "C:\\Program Files\\Quorvex\\Storage\\bin"},
                {"QUORVEX_WEB_BIN", "C:\\Program Files\\Quorvex\\Web\\bin"}};
    Quorvex::ScopedMachine scoped(fake);
    for (const auto& process : processes.getProcesses()) {
        if (process.isSelected()) {
            const std::string folder = location.getProductBinPath(process.getProcessName()).c_str();
            EXPECT_EQ(0u, std::string(process.getExecutable().c_str()).rfind(folder + "\\", 0))
                << process.getProcessName().c_str() << " in " << folder;
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Machines, SystemSite, testing::ValuesIn(kMachines),
                         [](const testing::TestParamInfo<MachineRow>& info) {
                             return info.param.host;
                         });

}  // namespace
}  // namespace Configuration
