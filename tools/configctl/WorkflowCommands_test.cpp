// configctl's read-only user-workflow commands against a real service: users with their log-in
// state, and a user's folder tree.
#include <gtest/gtest.h>
#include <sys/wait.h>

#include <cstdio>

#include "InProcessService.h"
#include "ToolRun.h"
#include "workflow/WorkflowStore.h"

namespace Configctl {
namespace {

using ConfigurationService::Workflow::Fields;

// What configctl prints for arguments.
std::string configctl(const std::string& arguments) {
    return Testing::configctl(arguments).out;
}

TEST(ConfigctlWorkflow, ListsUsersAndPrintsAFolderTree) {
    ServiceTesting::InProcessService service;
    auto& workflow = service.server().workflow();
    workflow.login({{"UserId", "alice"},
                    {"UserName", "Doe^Alice"},
                    {"Type", "Radiologist"},
                    {"OnCall", "true"}});
    workflow.login({{"UserId", "bob"}, {"Type", "Technologist"}});
    workflow.logout("bob");
    const std::string master = workflow.user("alice").masterFolderId;
    const auto cases = workflow.createNode(
        {{"UserId", "alice"}, {"ParentId", master}, {"Name", "Cases"}, {"Shared", "true"}});
    workflow.createNode({{"UserId", "alice"}, {"ParentId", cases.id}, {"Name", "Hard"}});
    for (const char* name : {"1", "2"}) {
        workflow.createNode(
            {{"UserId", "alice"}, {"ParentId", cases.id}, {"Name", name}, {"Type", "1"}});
    }
    const std::string server = "--server " + service.address();
    EXPECT_EQ(
        "alice\tRadiologist\tlogged in\ton call\tDoe^Alice\n"
        "bob\tTechnologist\tlogged out\t-\t\n",
        configctl(server + " users"));
    EXPECT_EQ("bob\tTechnologist\tlogged out\t-\t\n", configctl(server + " users Technologist"));
    const std::string tree = configctl(server + " folders alice");
    EXPECT_NE(std::string::npos, tree.find("Master folder " + master + "\n  Cases [" + cases.id +
                                           "] shared, 2 items\n    Hard ["))
        << tree;
    EXPECT_NE(std::string::npos, tree.find("], 0 items\n    (2 items)\n")) << tree;
    EXPECT_EQ(0u, configctl(server + " folders nobody").rfind("configctl: ", 0));
}

}  // namespace
}  // namespace Configctl
