// configctl end to end against a real service: exit codes, one-line errors, documents in and out.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>
#include <fstream>

#include "InProcessService.h"
#include "ToolOptions.h"
#include "ToolRun.h"

namespace Configctl {
namespace {

using Testing::configctl;
using Testing::shell;
using Testing::ToolRun;

TEST(Configctl, PutThenGetPrintsTheDocumentIndented) {
    ServiceTesting::InProcessService service;
    const std::string server = "--server " + service.address();
    const std::string file = service.storeDirectory() + "-doc.xml";
    std::ofstream(file) << "<e k=\"StorageSCP\"><l><e k=\"Port\"><s>104</s></e></l></e>";
    EXPECT_EQ(configctl(server + " put 'Brimmet\\DicomScp' " + file).status, 0);
    const ToolRun got = configctl(server + " get 'Brimmet\\DicomScp'");
    EXPECT_EQ(got.status, 0) << got.out;
    EXPECT_NE(got.out.find("\n  <l>\n    <e k=\"Port\"><s>104</s></e>"), std::string::npos)
        << got.out;
    EXPECT_EQ(configctl(server + " exists 'Brimmet\\DicomScp'").out, "yes\n");
    const ToolRun items = configctl(server + " items --host '*'");
    EXPECT_NE(items.out.find("TestHost  Brimmet\\DicomScp"), std::string::npos) << items.out;
}

// Each kind of failure has its own exit status (documented in --help) and one line on stderr.
TEST(Configctl, FailuresExitWithTheirOwnStatusAndOneLine) {
    ServiceTesting::InProcessService service;
    const std::string server = "--server " + service.address();
    const std::string malformed = service.storeDirectory() + "-malformed.xml";
    std::ofstream(malformed) << "<Probe/>";
    const std::string noTicket = "QUORVEX_SERVICE_TICKET_FILE=/nonexistent/ticket";
    const struct {
        std::string environment;
        std::string arguments;
        int status;
    } kFailures[] = {
        {"", server + " get Absent", 3},
        {noTicket, server + " items", 4},
        {"", "--server 127.0.0.1:1 hosts", 5},
        {"", "--frobnicate hosts", 6},
        {"", "--output yaml hosts", 6},
        {"", server + " get", 6},
        {"", server + " put Doc /nonexistent.xml", 6},
        {"", server + " put Doc " + malformed, 6},
    };
    for (const auto& failure : kFailures) {
        const ToolRun run =
            shell(failure.environment + " " + CONFIGCTL_BINARY + " " + failure.arguments);
        EXPECT_EQ(run.status, failure.status) << failure.arguments << ": " << run.out;
        EXPECT_EQ(run.out.rfind("configctl: ", 0), 0u) << run.out;
        EXPECT_EQ(run.out.find('\n'), run.out.size() - 1) << run.out;
    }
}

TEST(Configctl, VersionPrintsTheProjectVersion) {
    const ToolRun run = configctl("--version");
    EXPECT_EQ(run.status, 0);
    EXPECT_EQ(run.out.rfind("configctl ", 0), 0u) << run.out;
    EXPECT_EQ(run.out.find('\n'), run.out.size() - 1) << run.out;
}

// The SOP service sample, stored as is: each service with the syntaxes it accepts, by UID and name.
TEST(Configctl, SopPrintsEachServiceWithTheSyntaxesItAccepts) {
    ServiceTesting::InProcessService service;
    const std::string server = "--server " + service.address();
    const std::string sample = std::string(QUORVEX_EXAMPLES) + "/dicom/SOPServiceConfiguration.xml";
    ASSERT_EQ(configctl(server + " put 'BrimmetServer\\SOPServiceConfiguration' " + sample).status,
              0);
    const ToolRun sop = configctl(server + " sop");
    ASSERT_EQ(sop.status, 0) << sop.out;
    const char* const kExpected[] = {
        "69 services (66 offered), 28 transfer syntaxes, 8 templates\n",
        "\nVideo Photographic Image Storage\n"
        "  UID          1.2.840.10008.5.1.4.1.1.77.1.4.1\n"
        "  Object type  IMAGE\n"
        "  Template     Video\n"
        "  Offered      yes\n"
        "  Transfer syntaxes: 3 of 11 enabled\n"
        "    1.2.840.10008.1.2.1      Explicit VR Little Endian\n"
        "    1.2.840.10008.1.2.4.100  MPEG2 Main Profile @ Main Level\n"
        "    1.2.840.10008.1.2.4.102  MPEG-4 AVC/H.264 High Profile / Level 4.1\n\n",
        "\nBlending Softcopy Presentation State Storage\n"
        "  UID          1.2.840.10008.5.1.4.1.1.11.4\n"
        "  Object type  CSPS\n"
        "  Template     Lossless\n"
        "  Offered      yes\n"
        "  Transfer syntaxes: 0 of 4 enabled\n\n",
        "\nRT Plan Storage\n  UID          1.2.840.10008.5.1.4.1.1.481.5\n"
        "  Object type  IMAGE\n  Template     (numbers)\n",
    };
    for (const char* expected : kExpected) {
        EXPECT_NE(sop.out.find(expected), std::string::npos) << expected << "\n--- in ---\n"
                                                             << sop.out;
    }
    const ToolRun missing = configctl(server + " sop Absent");
    EXPECT_EQ(missing.status, 3);  // not found
}

TEST(Configctl, OptionsAndHelp) {
    const ToolOptions options =
        ToolOptions::parse({"--server=10.0.0.1:81", "get", "--host", "Orvel1", "Doc", "--master"});
    EXPECT_EQ(options.server, "10.0.0.1:81");
    EXPECT_EQ(options.host, "Orvel1");
    EXPECT_EQ(options.command, "get");
    EXPECT_EQ(options.arguments, std::vector<std::string>{"Doc"});
    EXPECT_TRUE(options.viaMaster);
    EXPECT_THROW(ToolOptions::parse({}), std::invalid_argument);
    EXPECT_THROW(ToolOptions::parse({"hosts", "--module-type", "x"}), std::invalid_argument);
    const ToolRun help = configctl("--help");
    EXPECT_EQ(help.status, 0);
    EXPECT_NE(help.out.find("--server HOST:PORT"), std::string::npos);
}

}  // namespace
}  // namespace Configctl
