// ExampleSite: test data shared by configctl's suites: the names of the example site's DICOM and
// storage documents (examples/site/<name>.xml, stored as "BrimmetServer\<name>") and a small set of
// user-workflow users written straight into a running service's store. Header only.
#pragma once

#include <string>

#include "workflow/WorkflowStore.h"

namespace Configctl {
namespace Testing {

const char* const kDicomSiteDocuments[] = {
    "DicomScp",
    "Qrscp",
    "StorageCommit",
    "KelExport",
    "KelExportLocal",
    "KelExportRemoteConfigurations",
    "KelExportWebServiceLocal",
    "AutoExport",
    "KelQuery",
};

const char* const kStorageSiteDocuments[] = {"StrategyConfiguration", "Location", "MsmqCommon",
                                             "KelArchive"};

// The ids of alice's master folder and of its folder "Cases".
struct SampleFolders {
    std::string master;
    std::string cases;
};

// alice ("Doe^Alice \"Ali\"", radiologist, logged in, on call) with "Cases" (shared: the folder
// "Hard" and two items) in her master folder; bob (technologist) logged out.
inline SampleFolders addSampleUsers(ConfigurationService::Workflow::WorkflowStore& workflow) {
    workflow.login({{"UserId", "alice"},
                    {"UserName", "Doe^Alice \"Ali\""},
                    {"Type", "Radiologist"},
                    {"OnCall", "true"}});
    workflow.login({{"UserId", "bob"}, {"Type", "Technologist"}});
    workflow.logout("bob");
    SampleFolders folders{workflow.user("alice").masterFolderId, ""};
    folders.cases = workflow
                        .createNode({{"UserId", "alice"},
                                     {"ParentId", folders.master},
                                     {"Name", "Cases"},
                                     {"Shared", "true"}})
                        .id;
    workflow.createNode({{"UserId", "alice"}, {"ParentId", folders.cases}, {"Name", "Hard"}});
    for (const char* name : {"1", "2"}) {
        workflow.createNode(
            {{"UserId", "alice"}, {"ParentId", folders.cases}, {"Name", name}, {"Type", "1"}});
    }
    return folders;
}

}  // namespace Testing
}  // namespace Configctl
