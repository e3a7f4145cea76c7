// The user-workflow operations of HttpConfigurationClient against a recording server: the exact
// request bodies and path, how answers are read, the texts of missing answer elements, and the
// service's errors as exception classes.
#include <gtest/gtest.h>

#include <functional>
#include <typeinfo>

#include "Configuration/HttpConfigurationFolderLimitReachedException.h"
#include "Configuration/HttpConfigurationInvalidNodeIdException.h"
#include "Configuration/HttpConfigurationItemLimitReachedException.h"
#include "Configuration/HttpConfigurationPathNotFoundException.h"
#include "Configuration/HttpConfigurationTransportException.h"
#include "Quorvex/BDateTime.h"
#include "client/HttpClientTestSupport.h"

namespace Configuration {
namespace {

using Testing::HttpClientTest;
using Testing::ScriptedResponse;

const char* const WORKFLOW_PATH = "/Sundrel/UserWorkflowService/UserWorkFlow.ashx";
const std::string NODE_NS = UwfNodeData::Namespace();
const std::string USER_NS = UwfUserData::Namespace();

std::string str(const ACE_CString& text) {
    return std::string(text.c_str(), text.length());
}

using Call = std::function<void(const HttpConfigurationClient&)>;

class HttpClientWorkflow : public HttpClientTest {
protected:
    void answerNext(const std::string& body) { server().enqueue(ScriptedResponse::Ok(body)); }

    const HttpConfigurationClient client = makeClient();  // every test's client

    // The message the last call posted, checking its path.
    std::string lastMessage() {
        const auto request = server().lastRequest();
        EXPECT_EQ(WORKFLOW_PATH, request.target);
        return request.body;
    }

    // What call throws: its type name and what() text ("" and "" when nothing).
    static std::pair<std::string, std::string> failureOf(const Call& call,
                                                         const HttpConfigurationClient& client) {
        try {
            call(client);
        } catch (const std::exception& e) {
            return {typeid(e).name(), e.what()};
        }
        return {"", ""};
    }
};

TEST_F(HttpClientWorkflow, EachOperationSendsItsExactMessage) {
    server().setDefault(ScriptedResponse::Ok(
        "<R><string>n9</string><lastModified>2010-03-04T05:06:07.0890000Z</lastModified>"
        "<dateTime>2010-03-04T05:06:07Z</dateTime><boolean>true</boolean><User></User>"
        "<RetrievePreferenceResponse><string>d</string></RetrievePreferenceResponse>"
        "<RetrievePreferencesResponse>p</RetrievePreferencesResponse></R>"));
    auto node = UwfNodeData::Create();
    node->Name = "Work & list";
    node->UserId = "u1";
    node->ParentId = "p1";
    auto user = UwfUserData::Create();
    user->UserId = "u1";
    user->OnCall = true;
    BDateTime modified;
    std::vector<SmartPtr<UwfNodeData>> nodes;
    std::vector<SmartPtr<UwfUserData>> users;
    SmartPtr<UwfContactNameData> contact;
    const std::string nodeRecord =
        "<Node><Name>Work &amp; list</Name><UserId>u1</UserId><ParentId>p1</ParentId>"
        "<Type>0</Type><Shared>false</Shared></Node>";
    const std::string userRecord = "<User><UserId>u1</UserId><OnCall>true</OnCall></User>";
    const std::pair<Call, std::string> cases[] = {
        {[&](auto& c) { c.UwfCreateNode(*node, modified); },
         "<CreateNode><node xmlns=\"" + NODE_NS + "\">" + nodeRecord + "</node></CreateNode>"},
        {[&](auto& c) { c.UwfUpdateNode(*node); },
         "<UpdateNode><node xmlns=\"" + NODE_NS + "\">" + nodeRecord + "</node></UpdateNode>"},
        {[](auto& c) { c.UwfDeleteNode("n1", "u1", UwfNodeData::Item); },
         "<DeleteNode><nodeId>n1</nodeId><userId>u1</userId><type>1</type></DeleteNode>"},
        {[](auto& c) { c.UwfDeleteNode("n1", "", UwfNodeData::Folder); },
         "<DeleteNode><nodeId>n1</nodeId><type>0</type></DeleteNode>"},
        {[](auto& c) { c.UwfInsertExamFolder("1.2.3", "f<1>"); },
         "<InsertExamFolder><examKey>1.2.3</examKey><folderId>f&lt;1&gt;</folderId>"
         "</InsertExamFolder>"},
        {[](auto& c) { c.UwfDeleteExamFolder("1.2.3", "f1"); },
         "<DeleteExamFolder><examKey>1.2.3</examKey><folderId>f1</folderId></DeleteExamFolder>"},
        {[](auto& c) { c.UwfIsProtectedExam("1.2.3"); },
         "<IsProtectedExam><examKey>1.2.3</examKey></IsProtectedExam>"},
        {[](auto& c) { c.UwfIsValidChild("", "p1", UwfNodeData::Item); },
         "<IsValidChild><parentId>p1</parentId><type>1</type></IsValidChild>"},
        {[](auto& c) { c.UwfPurgeFolder("f1", -3, "u1"); },
         "<PurgeFolder><folderId>f1</folderId><itemsToRetain>-3</itemsToRetain>"
         "<userId>u1</userId></PurgeFolder>"},
        {[&](auto& c) { c.UwfGetUserStatus("u1", *user); },
         "<GetUserStatus><userId>u1</userId></GetUserStatus>"},
        {[&](auto& c) { c.UwfUpdateUserStatus(*user); }, "<UpdateUserStatus><user xmlns=\"" +
                                                             USER_NS + "\">" + userRecord +
                                                             "</user></UpdateUserStatus>"},
        {[](auto& c) { c.UwfLogoutUser("u1"); }, "<Logout><userId>u1</userId></Logout>"},
        {[](auto& c) { c.UwfDeleteUser("u1"); }, "<DeleteUser><userId>u1</userId></DeleteUser>"},
        {[&](auto& c) { c.UwfGetContactNameData("u1", contact); },
         "<GetContactName><userId>u1</userId></GetContactName>"},
        {[](auto& c) { c.UwfStorePreference("u1", "a/b", "<x/>"); },
         "<StorePreference><userId>u1</userId><path>a/b</path><data>&lt;x/&gt;</data>"
         "</StorePreference>"},
        {[](auto& c) { c.UwfStorePreference("u1", "a/b", ""); },
         "<StorePreference><userId>u1</userId><path>a/b</path></StorePreference>"},
        {[](auto& c) { c.UwfRetrievePreference("u1", "a/b"); },
         "<RetrievePreference><userId>u1</userId><path>a/b</path></RetrievePreference>"},
        {[](auto& c) { c.UwfRetrieveAllPreferences("u1,u2"); },
         "<RetrievePreferences><userIds>u1,u2</userIds></RetrievePreferences>"},
        {[&](auto& c) { c.UwfGetFolderData("f1", BDateTime("2010-03-04T05:06:07.089"), nodes); },
         "<GetFolderData><folderId>f1</folderId>"
         "<modifiedSince>2010-03-04T05:06:07.0890000-00:00</modifiedSince></GetFolderData>"},
        {[&](auto& c) { c.UwfLoginUser(*user, nodes); },
         "<Login><user xmlns=\"" + USER_NS + "\">" + userRecord + "</user></Login>"},
        {[&](auto& c) { c.UwfListUsers("", false, users); },
         "<ListUsers><loggedInOnly>false</loggedInOnly></ListUsers>"},
        {[&](auto& c) { c.UwfListUsers("Radiologist", true, users); },
         "<ListUsers><type>Radiologist</type><loggedInOnly>true</loggedInOnly></ListUsers>"},
    };
    for (const auto& c : cases) {
        server().clearRequests();
        c.first(client);
        EXPECT_EQ("<Message>" + c.second + "</Message>", lastMessage());
    }
}

TEST_F(HttpClientWorkflow, AnswersAreReadFromTheirElements) {
    auto node = UwfNodeData::Create();
    BDateTime modified;
    answerNext(
        "<CreateNodeResponse><string>n&amp;1</string>"
        "<lastModified>2010-03-04T05:06:07.0890000-00:00</lastModified></CreateNodeResponse>");
    EXPECT_EQ("n&1", str(client.UwfCreateNode(*node, modified)));
    EXPECT_EQ(BDateTime("2010-03-04T05:06:07.089"), modified);

    answerNext(
        "<UpdateNodeResponse><dateTime>2011-01-02T03:04:05Z</dateTime></UpdateNodeResponse>");
    EXPECT_EQ(BDateTime("2011-01-02T03:04:05"), client.UwfUpdateNode(*node));

    answerNext(
        "<A><RetrievePreferenceResponse><string>v &amp;lt;</string>"
        "</RetrievePreferenceResponse></A>");
    EXPECT_EQ("v <", str(client.UwfRetrievePreference("u", "p")));  // cut twice, replaced twice

    answerNext("<RetrievePreferencesResponse>&lt;P/&gt;</RetrievePreferencesResponse>");
    EXPECT_EQ("<P/>", str(client.UwfRetrieveAllPreferences("u")));

    auto user = UwfUserData::Create();
    answerNext("<A><User><UserId>u1</UserId><OnCall>true</OnCall></User></A>");
    client.UwfGetUserStatus("u1", *user);
    EXPECT_EQ("u1", str(user->UserId));
    EXPECT_TRUE(user->OnCall);

    SmartPtr<UwfContactNameData> contact;
    answerNext("<A><ContactName><FamilyName>Doe</FamilyName></ContactName></A>");
    client.UwfGetContactNameData("u1", contact);
    ASSERT_TRUE(contact != nullptr);
    EXPECT_EQ("Doe", str(contact->FamilyName));
}

TEST_F(HttpClientWorkflow, RepeatedRecordsAreAppendedInOrder) {
    std::vector<SmartPtr<UwfNodeData>> nodes(1, UwfNodeData::Create());
    answerNext("<A><Node><Id>a</Id><SubItems>3</SubItems></Node><Node><Id>b</Id></Node></A>");
    client.UwfGetFolderData("f", BDateTime(), nodes);
    ASSERT_EQ(3u, nodes.size());
    EXPECT_EQ("a", str(nodes[1]->Id));
    EXPECT_EQ(3, nodes[1]->SubItems);
    EXPECT_EQ("b", str(nodes[2]->Id));
    EXPECT_EQ(0, nodes[2]->SubItems);

    auto user = UwfUserData::Create();
    nodes.clear();
    answerNext("<LoginResponse></LoginResponse>");
    client.UwfLoginUser(*user, nodes);
    EXPECT_TRUE(nodes.empty());

    std::vector<SmartPtr<UwfUserData>> users;
    answerNext("<A><User><UserId>x</UserId></User><User><UserId>y</UserId></User></A>");
    client.UwfListUsers("", false, users);
    ASSERT_EQ(2u, users.size());
    EXPECT_EQ("y", str(users[1]->UserId));
}

TEST_F(HttpClientWorkflow, BooleanAnswersAcceptOnlyTrueAndFalse) {
    const std::pair<std::string, std::string> cases[] = {
        {"<boolean>true</boolean>", "true"},
        {"<boolean>false</boolean>", "false"},
        {"<boolean>True</boolean>", "Unable to parse response"},
        {"<boolean>1</boolean>", "Unable to parse response"},
        {"<answer/>", "Unable to find response element"},
    };
    for (const auto& c : cases) {
        for (int operation = 0; operation < 2; ++operation) {
            answerNext("<A>" + c.first + "</A>");
            try {
                const bool result = operation == 0
                                        ? client.UwfIsProtectedExam("e")
                                        : client.UwfIsValidChild("i", "p", UwfNodeData::Folder);
                EXPECT_EQ(c.second, result ? "true" : "false") << c.first;
            } catch (const HttpConfigurationException& e) {
                EXPECT_EQ(c.second, str(e.Message())) << c.first;
            }
        }
    }
}

TEST_F(HttpClientWorkflow, MissingAnswerElementsHaveTheirTexts) {
    auto node = UwfNodeData::Create();
    auto user = UwfUserData::Create();
    BDateTime modified;
    const std::pair<Call, std::string> cases[] = {
        {[&](auto& c) { c.UwfCreateNode(*node, modified); }, "Unable to find response element"},
        {[&](auto& c) { c.UwfUpdateNode(*node); }, "Unable to find response element"},
        {[&](auto& c) { c.UwfGetUserStatus("u", *user); }, "Unable to parse response"},
        {[](auto& c) { c.UwfRetrievePreference("u", "p"); }, "Unable to find response element"},
        {[](auto& c) { c.UwfRetrieveAllPreferences("u"); }, "Unable to find response element"},
    };
    for (const auto& c : cases) {
        answerNext("<A><RetrievePreferenceResponse></RetrievePreferenceResponse></A>");
        const auto failure = failureOf(c.first, client);
        EXPECT_EQ(typeid(HttpConfigurationException).name(), failure.first);
        EXPECT_EQ("HttpConfigurationException: " + c.second, failure.second);
    }
    answerNext("<A><string>id</string></A>");
    EXPECT_EQ("HttpConfigurationException: Unable to find lastModified output parameter",
              failureOf([&](auto& c) { c.UwfCreateNode(*node, modified); }, client).second);
}

std::string errorBody(const std::string& key, const std::string& code) {
    return "<Error><ErrorKey>" + key + "</ErrorKey><ErrorCode>" + code +
           "</ErrorCode><ErrorMessage>m</ErrorMessage></Error>";
}

TEST_F(HttpClientWorkflow, ServiceErrorsBecomeTheirExceptionClasses) {
    const std::pair<ScriptedResponse, std::string> cases[] = {
        {ScriptedResponse::Status(404, errorBody("cf919ca8-84fe-4214-9343-c24f6e6b92b2", "")),
         typeid(HttpConfigurationInvalidNodeIdException).name()},
        {ScriptedResponse::Status(404, errorBody("AF901DEB-1F70-41cf-879D-6EFC19168686", "")),
         typeid(HttpConfigurationPathNotFoundException).name()},
        {ScriptedResponse::Status(409, errorBody("", "42794")),
         typeid(HttpConfigurationFolderLimitReachedException).name()},
        {ScriptedResponse::Status(409, errorBody("", "42795")),
         typeid(HttpConfigurationItemLimitReachedException).name()},
        {ScriptedResponse::Status(500, errorBody("k", "1")),
         typeid(HttpConfigurationException).name()},
        {ScriptedResponse::Close(), typeid(HttpConfigurationTransportException).name()},
    };
    for (const auto& c : cases) {
        server().enqueue(c.first);
        EXPECT_EQ(c.second, failureOf([](auto& cl) { cl.UwfLogoutUser("u"); }, client).first);
    }
}

}  // namespace
}  // namespace Configuration
