// configctl's storage commands against a real service holding the example site: the chains as
// stored and resolved, the Graphviz graph, and the tape archive without its passwords.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>
#include <string>

#include "ExampleSite.h"
#include "InProcessService.h"
#include "ToolRun.h"

namespace Configctl {
namespace {

using Testing::configctl;
using ToolOutput = Testing::ToolRun;

class StorageCommands : public ::testing::Test {
protected:
    StorageCommands() {
        for (const char* name : Testing::kStorageSiteDocuments) {
            const std::string file = std::string(QUORVEX_EXAMPLES) + "/site/" + name + ".xml";
            EXPECT_EQ(configctl(server + " put 'BrimmetServer\\" + name + "' " + file).status, 0);
        }
    }
    ServiceTesting::InProcessService service;
    const std::string server = "--server " + service.address();
};

TEST_F(StorageCommands, TopologyPrintsEachChainStoredAndResolved) {
    const ToolOutput run = configctl(server + " topology");
    ASSERT_EQ(run.status, 0) << run.out;
    const char* const kExpected[] = {
        "Location Main Hospital (main, LAN)\n  servers  qvx-main-01, qvx-main-02\n"
        "  chain    [__PERSISTENT__]->[__MIRROR__]\n"
        "  resolved [9B2E7C14-5D3A-4E8F-A1B6-2C7D8E9F0A1B]->"
        "[D1E2F3A4-B5C6-4D7E-8F90-A1B2C3D4E5F6]\n",
        "Location Eastside Clinic (remote over WAN, WAN)\n  servers  qvx-east-01\n"
        "  chain    [qvx-east-01]->[__CACHE__]->[__PERSISTENT__]\n"
        "  resolved [qvx-east-01]->[qvx-cache-01]->[9B2E7C14-5D3A-4E8F-A1B6-2C7D8E9F0A1B]\n",
        "  3F2504E0-4F89-11D3-9A0C-0305E82C3301  retired  mirror "
        "5A6B7C8D-9E0F-4A1B-8C2D-3E4F5A6B7C8D\n",
        "Retired target     DIRECT=OS:3F2504E0-4F89-11D3-9A0C-0305E82C3301\\private$\\quorvexin",
        "Tape server        tsm-b.archive.hospital.example:1500\n",
    };
    for (const char* expected : kExpected) {
        EXPECT_NE(run.out.find(expected), std::string::npos) << expected << "\n--- in ---\n"
                                                             << run.out;
    }
}

TEST_F(StorageCommands, TopologyAsAGraph) {
    const ToolOutput run = configctl(server + " topology --dot");
    ASSERT_EQ(run.status, 0) << run.out;
    EXPECT_EQ(run.out.rfind("digraph storage {\n", 0), 0u) << run.out;
    EXPECT_EQ(run.out.substr(run.out.size() - 2), "}\n");
    const char* const kExpected[] = {
        "\"location Main Hospital\" -> \"stack 9B2E7C14-5D3A-4E8F-A1B6-2C7D8E9F0A1B\" "
        "[label=\"Main Hospital 1\"]",
        "\"stack 9B2E7C14-5D3A-4E8F-A1B6-2C7D8E9F0A1B\" -> \"stack "
        "D1E2F3A4-B5C6-4D7E-8F90-A1B2C3D4E5F6\" [style=dashed, label=\"mirror\"]",
        "\"host qvx-cache-01\" [shape=cylinder",
        "\"stack C4D5E6F7-0819-4A2B-8C3D-4E5F60718293\" -> \"tape "
        "tsm-a.archive.hospital.example\" [style=dotted, label=\"/quorvex/stack3\"]",
    };
    for (const char* expected : kExpected) {
        EXPECT_NE(run.out.find(expected), std::string::npos) << expected << "\n--- in ---\n"
                                                             << run.out;
    }
}

TEST_F(StorageCommands, PasswordsAreNeverPrinted) {
    for (const std::string& command : {std::string(" archive"), std::string(" topology"),
                                       std::string(" get 'BrimmetServer\\KelArchive'")}) {
        const ToolOutput run = configctl(server + command);
        EXPECT_EQ(run.status, 0) << run.out;
        EXPECT_EQ(run.out.find("change-me"), std::string::npos) << command;
    }
    EXPECT_NE(configctl(server + " archive").out.find("user qvx_archive  password ********\n"),
              std::string::npos);
    EXPECT_NE(configctl(server + " get 'BrimmetServer\\KelArchive'")
                  .out.find("<e k=\"TivoliServerAccessPassword\"><s>********</s></e>"),
              std::string::npos);
    EXPECT_EQ(configctl(server + " topology --host Nobody").status, 1);
}

}  // namespace
}  // namespace Configctl
