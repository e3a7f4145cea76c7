// The user-workflow operations: each reads its parameters, calls the store and writes its answer.
#include <sstream>

#include "workflow/WorkflowAnswers.h"
#include "workflow/WorkflowDispatcher.h"

namespace ConfigurationService {
namespace Workflow {
namespace {

std::string nodes(const char* root, const std::vector<Node>& list) {
    Answer answer(root);
    for (const Node& node : list) {
        WorkflowAnswers::node(answer, node);
    }
    return answer.finish();
}

std::string done(const WorkflowRequest& request) {
    return Answer(request.operation + "Response").finish();
}

std::string boolean(const char* root, bool value) {
    return Answer(root).element("boolean", value ? "true" : "false").finish();
}

// Ids separated by ",", ";" or white space.
std::vector<std::string> idList(const std::string& text) {
    std::vector<std::string> ids;
    std::string id;
    std::istringstream in(text);
    for (char c; in.get(c);) {
        if (c == ',' || c == ';' || c == ' ' || c == '\t' || c == '\n' || c == '\r') {
            if (!id.empty()) {
                ids.push_back(id);
            }
            id.clear();
        } else {
            id += c;
        }
    }
    if (!id.empty()) {
        ids.push_back(id);
    }
    return ids;
}

}  // namespace

void WorkflowDispatcher::addNodeOperations() {
    WorkflowStore& store = m_store;
    m_operations["CreateNode"] = [&store](const WorkflowRequest& r) {
        const Node node = store.createNode(r.record);
        return Answer("CreateNodeResponse")
            .element("string", node.id)
            .element("lastModified", WorkflowAnswers::timeText(node.modifiedMs))
            .finish();
    };
    m_operations["UpdateNode"] = [&store](const WorkflowRequest& r) {
        return Answer("UpdateNodeResponse")
            .element("dateTime", WorkflowAnswers::timeText(store.updateNode(r.record)))
            .finish();
    };
    m_operations["DeleteNode"] = [&store](const WorkflowRequest& r) {
        store.deleteNode(r.parameter("nodeId"), r.parameter("userId"), r.parameter("type"));
        return done(r);
    };
    m_operations["InsertExamFolder"] = [&store](const WorkflowRequest& r) {
        store.insertExam(r.parameter("examKey"), r.parameter("folderId"));
        return done(r);
    };
    m_operations["DeleteExamFolder"] = [&store](const WorkflowRequest& r) {
        store.deleteExam(r.parameter("examKey"), r.parameter("folderId"));
        return done(r);
    };
    m_operations["IsProtectedExam"] = [&store](const WorkflowRequest& r) {
        return boolean("IsProtectedExamResponse", store.isProtectedExam(r.parameter("examKey")));
    };
    m_operations["IsValidChild"] = [&store](const WorkflowRequest& r) {
        return boolean(
            "IsValidChildResponse",
            store.isValidChild(r.parameter("id"), r.parameter("parentId"), r.parameter("type")));
    };
    m_operations["PurgeFolder"] = [&store](const WorkflowRequest& r) {
        store.purgeFolder(r.parameter("folderId"), r.parameter("itemsToRetain"),
                          r.parameter("userId"));
        return done(r);
    };
    m_operations["GetFolderData"] = [&store](const WorkflowRequest& r) {
        return nodes("GetFolderDataResponse",
                     store.folderData(r.parameter("folderId"),
                                      WorkflowAnswers::parseTime(r.parameter("modifiedSince"))));
    };
}

void WorkflowDispatcher::addUserOperations() {
    WorkflowStore& store = m_store;
    m_operations["GetUserStatus"] = [&store](const WorkflowRequest& r) {
        Answer answer("GetUserStatusResponse");
        WorkflowAnswers::user(answer, store.user(r.parameter("userId")));
        return answer.finish();
    };
    m_operations["UpdateUserStatus"] = [&store](const WorkflowRequest& r) {
        store.updateUser(r.record);
        return done(r);
    };
    m_operations["Login"] = [&store](const WorkflowRequest& r) {
        return nodes("LoginResponse", store.login(r.record));
    };
    m_operations["Logout"] = [&store](const WorkflowRequest& r) {
        store.logout(r.parameter("userId"));
        return done(r);
    };
    m_operations["DeleteUser"] = [&store](const WorkflowRequest& r) {
        store.deleteUser(r.parameter("userId"));
        return done(r);
    };
    m_operations["ListUsers"] = [&store](const WorkflowRequest& r) {
        const std::string loggedIn = r.parameter("loggedInOnly");
        Answer answer("ListUsersResponse");
        for (const User& user : store.listUsers(
                 r.parameter("type"), !loggedIn.empty() && parseFlag("loggedInOnly", loggedIn))) {
            WorkflowAnswers::user(answer, user);
        }
        return answer.finish();
    };
    m_operations["GetContactName"] = [&store](const WorkflowRequest& r) {
        Answer answer("GetContactNameResponse");
        WorkflowAnswers::contactName(answer, store.contactName(r.parameter("userId")));
        return answer.finish();
    };
    m_operations["StorePreference"] = [&store](const WorkflowRequest& r) {
        store.storePreference(r.parameter("userId"), r.parameter("path"), r.parameter("data"));
        return done(r);
    };
    m_operations["RetrievePreference"] = [&store](const WorkflowRequest& r) {
        // The client cuts "string" out of the already unescaped text of the response element,
        // so the data is escaped twice.
        const std::string data = store.preference(r.parameter("userId"), r.parameter("path"));
        return Answer("RetrievePreferenceResponse")
            .element("string", Answer::escape(data))
            .finish();
    };
    m_operations["RetrievePreferences"] = [&store](const WorkflowRequest& r) {
        return WorkflowAnswers::preferences(store.preferences(idList(r.parameter("userIds"))));
    };
}

}  // namespace Workflow
}  // namespace ConfigurationService
