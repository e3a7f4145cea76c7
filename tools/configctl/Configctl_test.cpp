// configctl end to end against a real service: exit codes, one-line errors, documents in and out.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>
#include <fstream>

#include "InProcessService.h"
#include "ToolOptions.h"

namespace Configctl {
namespace {

struct ToolRun {
    int status;
    std::string out;
};

// Runs configctl with arguments (shell-quoted by the caller); stderr joins stdout.
ToolRun configctl(const std::string& arguments) {
    const std::string command = std::string(CONFIGCTL_BINARY) + " " + arguments + " 2>&1";
    FILE* pipe = ::popen(command.c_str(), "r");
    ToolRun run{-1, ""};
    char buffer[4096];
    for (std::size_t got; (got = std::fread(buffer, 1, sizeof buffer, pipe)) > 0;) {
        run.out.append(buffer, got);
    }
    const int status = ::pclose(pipe);
    run.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    return run;
}

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

TEST(Configctl, FailuresExitNonZeroWithOneLine) {
    ServiceTesting::InProcessService service;
    const ToolRun missing = configctl("--server " + service.address() + " get Absent");
    EXPECT_EQ(missing.status, 1);
    EXPECT_EQ(missing.out.rfind("configctl: ", 0), 0u);
    EXPECT_EQ(missing.out.find('\n'), missing.out.size() - 1) << missing.out;
    EXPECT_EQ(configctl("--server " + service.address() + " put Doc /nonexistent.xml").status, 1);
    EXPECT_EQ(configctl("--frobnicate hosts").status, 1);
    EXPECT_EQ(configctl("--server 127.0.0.1:1 hosts").status, 1);
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
