// The library's user-workflow client against the real service: every Uwf operation end to end,
// the records as the service fills them, and each exception class reached through the service's
// own errors.
#include <gtest/gtest.h>

#include <functional>
#include <typeinfo>

#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/HttpConfigurationFolderLimitReachedException.h"
#include "Configuration/HttpConfigurationInvalidNodeIdException.h"
#include "Configuration/HttpConfigurationItemLimitReachedException.h"
#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "Configuration/HttpConfigurationTransportException.h"
#include "InProcessService.h"
#include "Quorvex/BDateTime.h"

namespace Configuration {
namespace {

using ServiceTesting::InProcessService;
using Nodes = std::vector<SmartPtr<UwfNodeData>>;

std::string str(const ACE_CString& text) {
    return std::string(text.c_str(), text.length());
}

ConfigurationService::ServiceOptions smallLimits() {
    ConfigurationService::ServiceOptions options;
    options.maxFoldersPerUser = 3;
    options.maxItemsPerFolder = 2;
    return options;
}

class WorkflowThroughService : public ::testing::Test {
protected:
    WorkflowThroughService()
        : service(smallLimits()), client(service.address().c_str(), true, false) {}

    SmartPtr<UwfUserData> user(const char* id, const char* name, const char* type) {
        auto record = UwfUserData::Create();
        record->UserId = id;
        record->UserName = name;
        record->Type = type;
        return record;
    }

    // Logs a user in; returns the user's record as the service keeps it.
    SmartPtr<UwfUserData> login(const char* id, const char* name, const char* type,
                                Nodes* roots = nullptr) {
        Nodes ignored;
        client.UwfLoginUser(*user(id, name, type), roots ? *roots : ignored);
        auto status = UwfUserData::Create();
        client.UwfGetUserStatus(id, *status);
        return status;
    }

    ACE_CString create(const char* userId, const ACE_CString& parent, UwfNodeData::NodeType type,
                       const char* name, BDateTime* modified = nullptr) {
        auto node = UwfNodeData::Create();
        node->UserId = userId;
        node->ParentId = parent;
        node->Type = type;
        node->Name = name;
        BDateTime time;
        const ACE_CString id = client.UwfCreateNode(*node, modified ? *modified : time);
        return id;
    }

    // The class of what call throws, and its message.
    static std::pair<std::string, std::string> failureOf(const std::function<void()>& call) {
        try {
            call();
        } catch (const HttpConfigurationException& e) {
            return {typeid(e).name(), str(e.Message())};
        }
        return {"none", ""};
    }

    InProcessService service;
    HttpConfigurationClient client;
};

TEST_F(WorkflowThroughService, UsersLogInAndOutWithTheirFoldersAndNames) {
    Nodes roots;
    auto alice = login("alice", "Doe^Alice^^Dr.", "Radiologist", &roots);
    ASSERT_EQ(2u, roots.size());
    EXPECT_EQ("Inbox", str(roots[0]->Name));
    EXPECT_EQ(str(alice->InboxId), str(roots[0]->Id));
    EXPECT_EQ(str(alice->MasterFolderId), str(roots[1]->Id));
    EXPECT_EQ(UwfNodeData::Folder, roots[1]->Type);
    EXPECT_TRUE(roots[0]->ModifiedDateTime.isValid());

    alice->OnCall = true;
    client.UwfUpdateUserStatus(*alice);
    login("m\xfcller", "M\xfcller^J\xf6rg", "Technologist");  // Latin-1, as the client keeps it

    std::vector<SmartPtr<UwfUserData>> users;
    client.UwfListUsers("Radiologist", true, users);
    ASSERT_EQ(1u, users.size());
    EXPECT_TRUE(users[0]->OnCall);
    client.UwfLogoutUser("m\xfcller");
    users.clear();
    client.UwfListUsers("", false, users);
    ASSERT_EQ(2u, users.size());
    EXPECT_EQ("m\xfcller", str(users[1]->UserId));
    EXPECT_EQ("M\xfcller^J\xf6rg", str(users[1]->UserName));
    users.clear();
    client.UwfListUsers("", true, users);
    EXPECT_EQ(1u, users.size());

    SmartPtr<UwfContactNameData> name;
    client.UwfGetContactNameData("alice", name);
    EXPECT_EQ("Doe", str(name->FamilyName));
    EXPECT_EQ("Alice", str(name->GivenName));
    EXPECT_EQ("Dr.", str(name->HonorificPrefix));
    client.UwfGetContactNameData("m\xfcller", name);
    EXPECT_EQ("J\xf6rg", str(name->GivenName));

    client.UwfDeleteUser("m\xfcller");
    auto gone = UwfUserData::Create();
    const auto failure = failureOf([&] { client.UwfGetUserStatus("m\xfcller", *gone); });
    EXPECT_EQ(typeid(HttpConfigurationException).name(), failure.first);
    EXPECT_NE(std::string::npos, failure.second.find("is not known")) << failure.second;
}

TEST_F(WorkflowThroughService, FoldersItemsExamsAndChangesSinceATime) {
    auto alice = login("alice", "A", "R");
    BDateTime created;
    const ACE_CString cases =
        create("alice", alice->MasterFolderId, UwfNodeData::Folder, "F\xe4lle", &created);
    const ACE_CString item = create("alice", cases, UwfNodeData::Item, "1");
    EXPECT_TRUE(created.isValid());

    auto change = UwfNodeData::Create();
    change->Id = item;
    change->Type = UwfNodeData::Item;  // records always carry their type and sharing flag
    change->Name = "first";
    change->OpaqueData = "<exam uid='1.2'/>";
    const BDateTime updated = client.UwfUpdateNode(*change);
    EXPECT_GT(updated, created);

    Nodes nodes;
    client.UwfGetFolderData(alice->MasterFolderId, BDateTime(), nodes);
    ASSERT_EQ(1u, nodes.size());
    EXPECT_EQ("F\xe4lle", str(nodes[0]->Name));  // Latin-1 there and back
    EXPECT_EQ(0, nodes[0]->SubFolders);
    EXPECT_EQ(1, nodes[0]->SubItems);
    nodes.clear();
    client.UwfGetFolderData(cases, created, nodes);  // changed after the folder was made
    ASSERT_EQ(1u, nodes.size());
    EXPECT_EQ("first", str(nodes[0]->Name));
    EXPECT_EQ("<exam uid='1.2'/>", str(nodes[0]->OpaqueData));
    EXPECT_EQ(updated, nodes[0]->ModifiedDateTime);
    nodes.clear();
    client.UwfGetFolderData(cases, updated, nodes);
    EXPECT_TRUE(nodes.empty());

    EXPECT_TRUE(client.UwfIsValidChild(item, alice->InboxId, UwfNodeData::Item));
    EXPECT_FALSE(client.UwfIsValidChild(alice->MasterFolderId, cases, UwfNodeData::Folder));
    EXPECT_FALSE(client.UwfIsValidChild("", item, UwfNodeData::Item));

    client.UwfInsertExamFolder("1.2.840.1", cases);
    EXPECT_TRUE(client.UwfIsProtectedExam("1.2.840.1"));
    client.UwfDeleteExamFolder("1.2.840.1", cases);
    EXPECT_FALSE(client.UwfIsProtectedExam("1.2.840.1"));
    client.UwfInsertExamFolder("1.2.840.1", cases);

    create("alice", cases, UwfNodeData::Item, "2");
    client.UwfPurgeFolder(cases, 1, "alice");
    nodes.clear();
    client.UwfGetFolderData(cases, BDateTime(), nodes);
    ASSERT_EQ(1u, nodes.size());
    EXPECT_EQ("2", str(nodes[0]->Name));

    client.UwfDeleteNode(cases, "alice", UwfNodeData::Folder);
    EXPECT_FALSE(client.UwfIsProtectedExam("1.2.840.1"));
}

TEST_F(WorkflowThroughService, PreferencesComeBackAsStored) {
    const char* const data = "<layout columns=\"2\">a &amp; b &lt; c</layout>";
    client.UwfStorePreference("alice", "viewer/layout", data);
    client.UwfStorePreference("bob", "viewer/layout", "plain");
    EXPECT_EQ(data, str(client.UwfRetrievePreference("alice", "viewer/layout")));
    const std::string all = str(client.UwfRetrieveAllPreferences("alice,bob"));
    EXPECT_EQ(0u, all.find("<Preferences><Preference><UserId>alice</UserId>")) << all;
    EXPECT_NE(std::string::npos,
              all.find("<Data>&lt;layout columns=\"2\"&gt;a &amp;amp; b &amp;lt; c&lt;/layout&gt;"
                       "</Data>"))
        << all;
}

TEST_F(WorkflowThroughService, EachExceptionClassComesFromTheServicesErrors) {
    auto alice = login("alice", "A", "R");  // the inbox and master folder: 2 of 3 folders
    const ACE_CString folder = create("alice", alice->InboxId, UwfNodeData::Folder, "f");
    create("alice", folder, UwfNodeData::Item, "1");
    create("alice", folder, UwfNodeData::Item, "2");
    const ACE_CString removed = create("alice", alice->InboxId, UwfNodeData::Item, "x");
    client.UwfDeleteNode(removed, "alice", UwfNodeData::Item);
    login("bob", "B", "R");

    auto update = UwfNodeData::Create();
    update->Id = removed;
    HttpConfigurationClient closed("127.0.0.1:1", "http:", "", "x", false, false);
    const std::pair<std::function<void()>, const char*> cases[] = {
        {[&] { client.UwfUpdateNode(*update); },
         typeid(HttpConfigurationInvalidNodeIdException).name()},
        {[&] { client.UwfDeleteNode(removed, "alice", UwfNodeData::Item); },
         typeid(HttpConfigurationInvalidNodeIdException).name()},
        {[&] { client.UwfRetrievePreference("alice", "absent"); },
         typeid(HttpConfigurationPathNotFoundException).name()},
        {[&] { create("alice", alice->InboxId, UwfNodeData::Folder, "4th"); },
         typeid(HttpConfigurationFolderLimitReachedException).name()},
        {[&] { create("alice", folder, UwfNodeData::Item, "3"); },
         typeid(HttpConfigurationItemLimitReachedException).name()},
        {[&] { create("bob", folder, UwfNodeData::Item, "foreign"); },
         typeid(HttpConfigurationException).name()},
        {[&] { closed.UwfLogoutUser("alice"); },
         typeid(HttpConfigurationTransportException).name()},
    };
    for (const auto& c : cases) {
        const auto failure = failureOf(c.first);
        EXPECT_EQ(c.second, failure.first) << failure.second;
        EXPECT_FALSE(failure.second.empty());
    }
    // Without the ticket nothing is answered.
    HttpConfigurationClient stranger(service.address().c_str(), false, false);
    const auto denied = failureOf([&] { stranger.UwfLogoutUser("alice"); });
    EXPECT_NE(std::string::npos, denied.second.find("access denied")) << denied.second;
}

}  // namespace
}  // namespace Configuration
