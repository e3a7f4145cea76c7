// configctl's read-only user-workflow commands against a real service: users with their log-in
// state, and a user's folder tree.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>

#include "ExampleSite.h"
#include "InProcessService.h"
#include "ToolRun.h"

namespace Configctl {
namespace {

// What configctl prints for arguments.
std::string configctl(const std::string& arguments) {
    return Testing::configctl(arguments).out;
}

TEST(ConfigctlWorkflow, ListsUsersAndPrintsAFolderTree) {
    ServiceTesting::InProcessService service;
    const Testing::SampleFolders folders = Testing::addSampleUsers(service.server().workflow());
    const std::string server = "--server " + service.address();
    EXPECT_EQ(
        "alice\tRadiologist\tlogged in\ton call\tDoe^Alice \"Ali\"\n"
        "bob\tTechnologist\tlogged out\t-\t\n",
        configctl(server + " users"));
    EXPECT_EQ("bob\tTechnologist\tlogged out\t-\t\n", configctl(server + " users Technologist"));
    const std::string tree = configctl(server + " folders alice");
    EXPECT_NE(std::string::npos, tree.find("Master folder " + folders.master + "\n  Cases [" +
                                           folders.cases + "] shared, 2 items\n    Hard ["))
        << tree;
    EXPECT_NE(std::string::npos, tree.find("], 0 items\n    (2 items)\n")) << tree;
    EXPECT_EQ(0u, configctl(server + " folders nobody").rfind("configctl: ", 0));
}

}  // namespace
}  // namespace Configctl
