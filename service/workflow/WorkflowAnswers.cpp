// Answer texts of the user-workflow service.
#include "workflow/WorkflowAnswers.h"

#include <limits>

#include "Quorvex/BDateTime.h"

namespace ConfigurationService {
namespace Workflow {
namespace WorkflowAnswers {

std::string timeText(std::int64_t ms) {
    return std::string(BDateTime::fromMillisecondsSinceEpoch(ms).ToString().c_str()) + "0000Z";
}

std::int64_t parseTime(const std::string& text) {
    if (text.empty() || text.compare(0, 5, "0000-") == 0) {
        return std::numeric_limits<std::int64_t>::min();
    }
    const BDateTime time(text.c_str());
    if (!time.isValid()) {
        throw WorkflowError::bad("\"" + text + "\" is no date and time");
    }
    return time.millisecondsSinceEpoch();
}

void node(Answer& answer, const Node& node) {
    answer.open("Node");
    answer.element("Id", node.id);
    answer.element("Name", node.name);
    answer.element("UserId", node.userId);
    answer.element("ParentId", node.parentId);
    answer.element("Type", std::to_string(node.type));
    answer.element("Shared", node.shared ? "true" : "false");
    answer.element("ModifiedDateTime", timeText(node.modifiedMs));
    answer.element("SubFolders", std::to_string(node.subFolders));
    answer.element("SubItems", std::to_string(node.subItems));
    answer.element("OpaqueData", node.opaqueData);
    answer.close("Node");
}

void user(Answer& answer, const User& user) {
    answer.open("User");
    answer.element("UserId", user.userId);
    answer.element("UserName", user.userName);
    answer.element("Type", user.type);
    answer.element("InboxId", user.inboxId);
    answer.element("MasterFolderId", user.masterFolderId);
    answer.element("OnCall", user.onCall ? "true" : "false");
    answer.element("LoggedIn", user.loggedIn ? "true" : "false");
    answer.close("User");
}

void contactName(Answer& answer, const ContactName& name) {
    answer.open("ContactName");
    answer.element("FamilyName", name.familyName);
    answer.element("GivenName", name.givenName);
    answer.element("MiddleName", name.middleName);
    answer.element("HonorificPrefix", name.honorificPrefix);
    answer.element("HonorificSuffix", name.honorificSuffix);
    answer.close("ContactName");
}

std::string preferences(const std::vector<Preference>& preferences) {
    Answer inner("Preferences");
    for (const Preference& preference : preferences) {
        inner.open("Preference");
        inner.element("UserId", preference.userId);
        inner.element("Path", preference.path);
        inner.element("Data", preference.data);
        inner.close("Preference");
    }
    return "<RetrievePreferencesResponse>" + Answer::escape(inner.finish()) +
           "</RetrievePreferencesResponse>";
}

std::string error(const WorkflowError& failure) {
    Answer answer("ErrorResponse");
    answer.element("ErrorKey", failure.key());
    answer.element("ErrorCode", failure.code());
    answer.element("ErrorMessage", failure.what());
    answer.element("LocalizedErrorMessage", failure.what());
    answer.element("ErrorOriginalStackTrace", "");
    return answer.finish();
}

}  // namespace WorkflowAnswers
}  // namespace Workflow
}  // namespace ConfigurationService
