// configctl's machine commands against a real service: a storage server's processes table as a
// table, the directives one process loads, and the site-wide settings printed with the master
// database's password masked.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>
#include <string>

#include "InProcessService.h"
#include "ToolRun.h"

namespace Configctl {
namespace {

using Testing::configctl;
using Testing::ToolRun;

class SystemCommands : public ::testing::Test {
protected:
    SystemCommands() {
        const std::string site = std::string(QUORVEX_EXAMPLES) + "/site/";
        EXPECT_EQ(0,
                  configctl(server + " put --host Store1 'BrimmetServer\\ProcessesAndServices' " +
                            site + "ProcessesAndServices.StorageServer.xml")
                      .status);
        EXPECT_EQ(0, configctl(server + " put 'BrimmetServer\\OrvelSystemCommon' " + site +
                               "OrvelSystemCommon.xml")
                         .status);
    }
    ServiceTesting::InProcessService service;
    const std::string server = "--server " + service.address();
};

TEST_F(SystemCommands, ProcessesPrintsEachProcessWithItsServices) {
    const ToolRun run = configctl(server + " processes --host Store1");
    ASSERT_EQ(0, run.status) << run.out;
    const char* const kExpected[] = {
        "PROCESS                   MODULE TYPE          STATE     EXECUTABLE",
        "QuorvexExportServer       2 (export server)    selected  C:\\Program Files\\Quorvex\\"
        "Storage\\bin\\QuorvexExportServer.exe 3 enabled, 1 disabled, singleton\n"
        "    enabled   Object Request Broker\n"
        "    enabled   KelExport Service\n"
        "    disabled  Qrscp KelExport Service\n",
        "QuorvexWebServer          5 (web server)       not run   ",
        "\nWritten by module type 1 (storage server); valid\n",
    };
    for (const char* expected : kExpected) {
        EXPECT_NE(std::string::npos, run.out.find(expected)) << expected << "\n--- in ---\n"
                                                             << run.out;
    }
    EXPECT_EQ(3, configctl(server + " processes --host Nowhere").status);  // not found
}

TEST_F(SystemCommands, ServicesPrintsTheDirectivesOneProcessLoads) {
    const ToolRun run = configctl(server + " services QuorvexArchiveServer --host Store1");
    ASSERT_EQ(0, run.status) << run.out;
    EXPECT_EQ(
        "\tdynamic TapeArchiveService Service_Object * "
        "QuorvexTapeArchive:_make_TapeArchiveService() \"-Library TSM1\"\r\n",
        run.out);
    // A process the machine does not run is not found.
    EXPECT_EQ(3, configctl(server + " services QuorvexWebServer --host Store1").status);
    EXPECT_EQ(6, configctl(server + " services --host Store1").status);  // bad input
}

TEST_F(SystemCommands, TheMasterDatabasePasswordIsNeverPrinted) {
    const ToolRun run = configctl(server + " get 'BrimmetServer\\OrvelSystemCommon'");
    ASSERT_EQ(0, run.status) << run.out;
    EXPECT_EQ(std::string::npos, run.out.find("Nm-2024!db"));
    EXPECT_NE(std::string::npos,
              run.out.find("<e k=\"MasterDatabasePassword\"><s>********</s></e>"));
    EXPECT_NE(std::string::npos, run.out.find("<e k=\"MasterDatabaseUser\"><s>orvel_svc</s></e>"));
}

}  // namespace
}  // namespace Configctl
