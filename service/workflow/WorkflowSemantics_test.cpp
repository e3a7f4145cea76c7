// The user-workflow service's semantics, as a workstation sees them: scenarios of messages run
// through the dispatcher over a real database file, each step with the status and the answer
// text it must give. Ids the service hands out are captured from answers and used by later
// steps as {name}.
#include <gtest/gtest.h>

#include <map>
#include <set>
#include <string>
#include <thread>
#include <vector>

#include "testing/ScratchDir.h"
#include "workflow/WorkflowDispatcher.h"

namespace ConfigurationService {
namespace Workflow {
namespace {

const char* const kTicket = "ticket-1";
const std::string kInvalidNode = "<ErrorKey>CF919CA8-84FE-4214-9343-C24F6E6B92B2</ErrorKey>";
const std::string kPathNotFound = "<ErrorKey>AF901DEB-1F70-41cf-879D-6EFC19168686</ErrorKey>";

struct Step {
    std::string body;      // inside <Message>
    int status;            // expected HTTP status
    std::string expected;  // a text the answer holds ("" for none)
    std::string capture;   // "Tag=name": the text of <Tag> becomes {name}
};

std::string node(const std::string& user, const std::string& parent, int type,
                 const std::string& name = "n", const std::string& more = "") {
    return "<node><Node><Name>" + name + "</Name><UserId>" + user + "</UserId><ParentId>" + parent +
           "</ParentId><Type>" + std::to_string(type) + "</Type>" + more + "</Node></node>";
}

std::string create(const std::string& user, const std::string& parent, int type,
                   const std::string& name = "n") {
    return "<CreateNode>" + node(user, parent, type, name) + "</CreateNode>";
}

std::string login(const std::string& user, const std::string& name, const std::string& type) {
    return "<Login><user><User><UserId>" + user + "</UserId><UserName>" + name +
           "</UserName><Type>" + type + "</Type><OnCall>true</OnCall></User></user></Login>";
}

std::string validChild(const std::string& id, const std::string& parent, int type) {
    return "<IsValidChild><id>" + id + "</id><parentId>" + parent + "</parentId><type>" +
           std::to_string(type) + "</type></IsValidChild>";
}

class WorkflowSemantics : public ::testing::Test {
protected:
    explicit WorkflowSemantics(Limits limits = Limits())
        : m_store(m_scratch.file("workflow.sqlite"), limits),
          m_tickets(kTicket),
          m_dispatcher(m_store, m_tickets) {}

    Reply post(const std::string& message, const std::string& cookie) {
        std::string body = message;
        return m_dispatcher.dispatch(body, {cookie}, "test");
    }

    // Runs the steps in order; stops at the first that fails.
    void run(const std::vector<Step>& steps) {
        for (std::size_t i = 0; i < steps.size(); ++i) {
            const std::string body = "<Message>" + substitute(steps[i].body) + "</Message>";
            const Reply reply = post(body, std::string("OrvelWebApplication=") + kTicket);
            ASSERT_EQ(steps[i].status, reply.status) << "step " << i << ": " << body << "\n"
                                                     << reply.body;
            EXPECT_NE(std::string::npos, reply.body.find(substitute(steps[i].expected)))
                << "step " << i << ": " << body << "\n"
                << reply.body;
            capture(steps[i].capture, reply.body);
        }
    }

    std::string substitute(std::string text) const {
        for (const auto& value : m_values) {
            const std::string mark = "{" + value.first + "}";
            for (std::size_t at; (at = text.find(mark)) != std::string::npos;) {
                text.replace(at, mark.size(), value.second);
            }
        }
        return text;
    }

    void capture(const std::string& rule, const std::string& answer) {
        if (rule.empty()) {
            return;
        }
        const std::string tag = rule.substr(0, rule.find('='));
        const std::size_t start = answer.find("<" + tag + ">") + tag.size() + 2;
        m_values[rule.substr(rule.find('=') + 1)] =
            answer.substr(start, answer.find("</" + tag + ">", start) - start);
    }

    Quorvex::Testing::ScratchDir m_scratch;
    WorkflowStore m_store;
    TicketCheck m_tickets;
    WorkflowDispatcher m_dispatcher;
    std::map<std::string, std::string> m_values;
};

TEST_F(WorkflowSemantics, FoldersItemsAndTheirRules) {
    run({
        {login("alice", "Doe^Alice^M^Dr.^PhD", "Radiologist"), 200, "<Name>Inbox</Name>", ""},
        {"<GetUserStatus><userId>alice</userId></GetUserStatus>", 200, "<OnCall>true</OnCall>",
         "InboxId=inbox"},
        {"<GetUserStatus><userId>alice</userId></GetUserStatus>", 200, "", "MasterFolderId=master"},
        {login("alice", "Doe^Alice^M^Dr.^PhD", "Radiologist"), 200, "<Id>{inbox}</Id>", ""},
        {create("alice", "{master}", 0, "Cases"), 200, "<lastModified>", "string=cases"},
        {create("alice", "{cases}", 1, "i1"), 200, "", "string=item1"},
        {create("alice", "{cases}", 1, "i2"), 200, "", "string=item2"},
        {create("alice", "{cases}", 1, "i3"), 200, "", "string=item3"},
        // Where nodes may go.
        {create("alice", "", 1), 400, "an item must be created in a folder", ""},
        {create("alice", "nope", 0), 404, kInvalidNode, ""},
        {create("alice", "{item1}", 1), 400, "only folders hold nodes", ""},
        {create("", "{cases}", 1), 400, "a node needs a UserId", ""},
        {login("bob", "Roe^Bob", "Technologist"), 200, "", ""},
        {create("bob", "{cases}", 1), 403, "belongs to another user and is not shared", ""},
        {"<UpdateNode>" + node("alice", "{master}", 0, "Cases", "<Shared>true</Shared>") +
             "<Id>{cases}</Id></UpdateNode>",
         400, "names no node id", ""},  // the Id belongs inside the record
        {"<UpdateNode><node><Node><Id>{cases}</Id><UserId>alice</UserId><Shared>true</Shared>"
         "</Node></node></UpdateNode>",
         200, "<dateTime>", ""},
        {create("bob", "{cases}", 1, "b1"), 200, "", "string=bobItem"},
        // IsValidChild: cycles, wrong types, unknown parents.
        {validChild("{master}", "{cases}", 0), 200, "<boolean>false</boolean>", ""},
        {validChild("{cases}", "{cases}", 0), 200, "<boolean>false</boolean>", ""},
        {validChild("{cases}", "{item1}", 0), 200, "<boolean>false</boolean>", ""},
        {validChild("{item1}", "{inbox}", 0), 200, "<boolean>false</boolean>", ""},
        {validChild("{item1}", "{inbox}", 1), 200, "<boolean>true</boolean>", ""},
        {validChild("", "", 1), 200, "<boolean>false</boolean>", ""},
        {validChild("", "", 0), 200, "<boolean>true</boolean>", ""},
        {validChild("x", "nope", 0), 404, kInvalidNode, ""},
        {"<UpdateNode><node><Node><Id>{master}</Id><ParentId>{cases}</ParentId></Node></node>"
         "</UpdateNode>",
         400, "cannot move into itself or below", ""},
        {"<UpdateNode><node><Node><Id>{item1}</Id><Type>0</Type></Node></node></UpdateNode>", 400,
         "cannot change", ""},
        // Counts, exams, purge, delete.
        {"<GetFolderData><folderId>{master}</folderId></GetFolderData>", 200,
         "<Name>Cases</Name><UserId>alice</UserId><ParentId>{master}</ParentId><Type>0</Type>"
         "<Shared>true</Shared>",
         ""},
        {"<GetFolderData><folderId>{master}</folderId></GetFolderData>", 200,
         "<SubFolders>0</SubFolders><SubItems>4</SubItems>", ""},
        {"<InsertExamFolder><examKey>1.2.3</examKey><folderId>{cases}</folderId>"
         "</InsertExamFolder>",
         200, "", ""},
        {"<IsProtectedExam><examKey>1.2.3</examKey></IsProtectedExam>", 200,
         "<boolean>true</boolean>", ""},
        {"<IsProtectedExam><examKey>1.2.4</examKey></IsProtectedExam>", 200,
         "<boolean>false</boolean>", ""},
        {"<InsertExamFolder><examKey>1.2.3</examKey><folderId>{item1}</folderId>"
         "</InsertExamFolder>",
         400, "exams go into folders", ""},
        {"<PurgeFolder><folderId>{cases}</folderId><itemsToRetain>-1</itemsToRetain>"
         "</PurgeFolder>",
         400, "itemsToRetain", ""},
        {"<PurgeFolder><folderId>{cases}</folderId><itemsToRetain>2</itemsToRetain>"
         "<userId>alice</userId></PurgeFolder>",
         200, "", ""},
        {"<GetFolderData><folderId>{master}</folderId></GetFolderData>", 200,
         "<SubItems>2</SubItems>", ""},
        {"<GetFolderData><folderId>{cases}</folderId></GetFolderData>", 200, "<Id>{item3}</Id>",
         ""},
        {"<GetFolderData><folderId>{cases}</folderId></GetFolderData>", 200, "<Id>{bobItem}</Id>",
         ""},
        {"<DeleteNode><nodeId>{item1}</nodeId><type>1</type></DeleteNode>", 404, kInvalidNode, ""},
        {"<DeleteNode><nodeId>{cases}</nodeId><userId>alice</userId><type>1</type></DeleteNode>",
         400, "is not of type 1", ""},
        {"<DeleteNode><nodeId>{cases}</nodeId><userId>alice</userId><type>0</type></DeleteNode>",
         200, "", ""},
        {"<IsProtectedExam><examKey>1.2.3</examKey></IsProtectedExam>", 200,
         "<boolean>false</boolean>", ""},
        {"<GetFolderData><folderId>{cases}</folderId></GetFolderData>", 404, kInvalidNode, ""},
        {"<UpdateNode><node><Node><Id>{item3}</Id></Node></node></UpdateNode>", 404, kInvalidNode,
         ""},
        {"<GetFolderData><folderId>{master}</folderId></GetFolderData>", 200,
         "<GetFolderDataResponse></GetFolderDataResponse>", ""},
    });
}

TEST_F(WorkflowSemantics, UsersContactNamesAndPreferences) {
    run({
        {login("alice", "Doe^Alice^M^Dr.^PhD", "Radiologist"), 200, "", ""},
        {login("bob", "Bob Roe", "Technologist"), 200, "", ""},
        {login("carol", "Poe^Carol", "Radiologist"), 200, "", ""},
        {"<Logout><userId>carol</userId></Logout>", 200, "", ""},
        {"<ListUsers><type>Radiologist</type><loggedInOnly>true</loggedInOnly></ListUsers>", 200,
         "<ListUsersResponse><User><UserId>alice</UserId>", ""},
        {"<ListUsers><type>Radiologist</type><loggedInOnly>false</loggedInOnly></ListUsers>", 200,
         "</User><User><UserId>carol</UserId>", ""},
        {"<ListUsers><loggedInOnly>true</loggedInOnly></ListUsers>", 200,
         "</User><User><UserId>bob</UserId>", ""},
        {"<GetContactName><userId>alice</userId></GetContactName>", 200,
         "<FamilyName>Doe</FamilyName><GivenName>Alice</GivenName><MiddleName>M</MiddleName>"
         "<HonorificPrefix>Dr.</HonorificPrefix><HonorificSuffix>PhD</HonorificSuffix>",
         ""},
        {"<GetContactName><userId>bob</userId></GetContactName>", 200,
         "<FamilyName>Bob Roe</FamilyName><GivenName></GivenName>", ""},
        {"<UpdateUserStatus><user><User><UserId>bob</UserId><OnCall>true</OnCall></User></user>"
         "</UpdateUserStatus>",
         200, "", ""},
        {"<GetUserStatus><userId>bob</userId></GetUserStatus>", 200,
         "<UserName>Bob Roe</UserName><Type>Technologist</Type>", ""},
        {"<StorePreference><userId>alice</userId><path>ui/layout</path><data>&lt;a &amp; b&gt;"
         "</data></StorePreference>",
         200, "", ""},
        {"<StorePreference><userId>bob</userId><path>p</path><data>x</data></StorePreference>", 200,
         "", ""},
        {"<RetrievePreference><userId>alice</userId><path>ui/layout</path></RetrievePreference>",
         200, "<string>&amp;lt;a &amp;amp; b&amp;gt;</string>", ""},
        {"<RetrievePreference><userId>alice</userId><path>none</path></RetrievePreference>", 404,
         kPathNotFound, ""},
        {"<RetrievePreferences><userIds>alice, bob</userIds></RetrievePreferences>", 200,
         "&lt;Path&gt;ui/layout&lt;/Path&gt;&lt;Data&gt;&amp;lt;a &amp;amp; b&amp;gt;"
         "&lt;/Data&gt;&lt;/Preference&gt;&lt;Preference&gt;&lt;UserId&gt;bob",
         ""},
        {"<DeleteUser><userId>bob</userId></DeleteUser>", 200, "", ""},
        {"<GetUserStatus><userId>bob</userId></GetUserStatus>", 404, "\"bob\" is not known", ""},
        {"<RetrievePreference><userId>bob</userId><path>p</path></RetrievePreference>", 404,
         kPathNotFound, ""},
        {"<Logout><userId>nobody</userId></Logout>", 404, "is not known", ""},
        {"<DeleteUser><userId>nobody</userId></DeleteUser>", 404, "is not known", ""},
    });
}

TEST_F(WorkflowSemantics, MalformedMessagesAreRefusedClearly) {
    const std::pair<std::string, std::string> cases[] = {
        {"not xml", "not well-formed XML"},
        {"<Other><Logout/></Other>", "is a &lt;Message&gt; element"},
        {"<Message></Message>", "names no operation"},
        {"<Message><Explode/></Message>", "unknown operation \"Explode\""},
        // An operation named in Latin-1 is echoed as UTF-8, never as raw bytes.
        {"<Message><Expl\xf6"
         "de/></Message>",
         "unknown operation \"Expl\xc3\xb6"
         "de\""},
        {"<Message><ListUsers><loggedInOnly>maybe</loggedInOnly></ListUsers></Message>",
         "loggedInOnly is true or false"},
        {"<Message><GetFolderData><folderId>x</folderId><modifiedSince>soon</modifiedSince>"
         "</GetFolderData></Message>",
         "is no date and time"},
        {"<Message><Login><user><User><UserName>x</UserName></User></user></Login></Message>",
         "needs a UserId"},
        {"<Message>" + std::string(2000, '<') + "</Message>", "more than 1024 tags"},
    };
    for (const auto& c : cases) {
        const Reply reply = post(c.first, std::string("OrvelWebApplication=") + kTicket);
        EXPECT_EQ(400, reply.status) << c.first;
        EXPECT_NE(std::string::npos, reply.body.find(c.second)) << reply.body;
        EXPECT_NE(std::string::npos, reply.body.find("<ErrorOriginalStackTrace></")) << c.first;
    }
    for (const char* cookie : {"", "OrvelWebApplication=wrong"}) {
        const Reply reply = post("<Message><Logout><userId>a</userId></Logout></Message>", cookie);
        EXPECT_EQ(403, reply.status);
        EXPECT_NE(std::string::npos, reply.body.find("access denied")) << reply.body;
    }
}

// Names sent in the clients' Latin-1 are kept as UTF-8; UTF-8 stays as it is.
TEST_F(WorkflowSemantics, TextsAreKeptAsUtf8) {
    run({
        {login("m\xfcller", "M\xfcller^J\xf6rg", "R"), 200, "<UserId>m\xc3\xbcller</UserId>", ""},
        {login("\xc3\xa5sa", "\xc3\x85sa", "R"), 200, "<UserId>\xc3\xa5sa</UserId>", ""},
        {"<GetContactName><userId>m\xc3\xbcller</userId></GetContactName>", 200,
         "<FamilyName>M\xc3\xbcller</FamilyName><GivenName>J\xc3\xb6rg</GivenName>", ""},
    });
}

class WorkflowLimits : public WorkflowSemantics {
protected:
    WorkflowLimits() : WorkflowSemantics(Limits{3, 2}) {}
};

TEST_F(WorkflowLimits, FolderAndItemLimitsAnswerTheirCodes) {
    run({
        {login("alice", "A", "R"), 200, "", ""},  // the inbox and the master folder: 2 folders
        {"<GetUserStatus><userId>alice</userId></GetUserStatus>", 200, "", "InboxId=inbox"},
        {create("alice", "{inbox}", 0), 200, "", "string=third"},
        {create("alice", "{inbox}", 0), 409, "<ErrorCode>42794</ErrorCode>", ""},
        {create("alice", "{third}", 1), 200, "", "string=item1"},
        {create("alice", "{third}", 1), 200, "", ""},
        {create("alice", "{third}", 1), 409, "<ErrorCode>42795</ErrorCode>", ""},
        {"<UpdateNode><node><Node><Id>{item1}</Id><ParentId>{inbox}</ParentId></Node></node>"
         "</UpdateNode>",
         200, "", ""},
        {create("alice", "{third}", 1), 200, "", ""},
        {"<DeleteNode><nodeId>{third}</nodeId><type>0</type></DeleteNode>", 200, "", ""},
        {create("alice", "{inbox}", 0), 200, "", ""},
    });
}

// Workstations changing one node at once: every change is applied whole and gets its own, later
// time; nodes created at the same time all exist.
TEST_F(WorkflowSemantics, ConcurrentChangesAreEachAppliedInTurn) {
    run({{login("alice", "A", "R"), 200, "", ""},
         {"<GetUserStatus><userId>alice</userId></GetUserStatus>", 200, "", "InboxId=inbox"},
         {create("alice", "{inbox}", 0, "shared"), 200, "", "string=target"}});
    const std::string cookie = std::string("OrvelWebApplication=") + kTicket;
    constexpr int kThreads = 4;
    constexpr int kRounds = 25;
    std::vector<std::vector<std::string>> times(kThreads);
    std::vector<std::thread> threads;
    for (int t = 0; t < kThreads; ++t) {
        threads.emplace_back([&, t] {
            for (int i = 0; i < kRounds; ++i) {
                const std::string name = "w" + std::to_string(t) + "-" + std::to_string(i);
                Reply update = post(substitute("<Message><UpdateNode><node><Node><Id>{target}</Id>"
                                               "<Name>" +
                                               name +
                                               "</Name></Node></node>"
                                               "</UpdateNode></Message>"),
                                    cookie);
                const std::size_t at = update.body.find("<dateTime>");
                times[t].push_back(at == std::string::npos ? "" : update.body.substr(at, 40));
                post(substitute("<Message>" + create("alice", "{target}", 1, name) + "</Message>"),
                     cookie);
            }
        });
    }
    for (auto& thread : threads) {
        thread.join();
    }
    std::set<std::string> distinct;
    for (const auto& list : times) {
        for (std::size_t i = 0; i < list.size(); ++i) {
            ASSERT_FALSE(list[i].empty());
            EXPECT_TRUE(i == 0 || list[i - 1] < list[i]);
            distinct.insert(list[i]);
        }
    }
    EXPECT_EQ(static_cast<std::size_t>(kThreads * kRounds), distinct.size());
    const Reply data =
        post(substitute(
                 "<Message><GetFolderData><folderId>{inbox}</folderId></GetFolderData></Message>"),
             cookie);
    EXPECT_NE(std::string::npos,
              data.body.find("<SubItems>" + std::to_string(kThreads * kRounds) + "</SubItems>"))
        << data.body.substr(0, 600);
    EXPECT_EQ("ok", m_store.integrityCheck());
}

}  // namespace
}  // namespace Workflow
}  // namespace ConfigurationService
