// WorkflowError: a user-workflow request that cannot be carried out, with the HTTP status, the
// error key and the error code its answer carries (the client turns the invalid-node-id and
// path-not-found keys and the folder- and item-limit codes into their own exception classes).
// A plain exception value.
#pragma once

#include <stdexcept>
#include <string>

namespace ConfigurationService {
namespace Workflow {

class WorkflowError : public std::runtime_error {
public:
    static constexpr const char* kInvalidNodeIdKey = "CF919CA8-84FE-4214-9343-C24F6E6B92B2";
    static constexpr const char* kPathNotFoundKey = "AF901DEB-1F70-41cf-879D-6EFC19168686";
    static constexpr const char* kFolderLimitCode = "42794";
    static constexpr const char* kItemLimitCode = "42795";

    WorkflowError(int status, const std::string& message, const std::string& key = "",
                  const std::string& code = "")
        : std::runtime_error(message), m_status(status), m_key(key), m_code(code) {}

    int status() const { return m_status; }
    const std::string& key() const { return m_key; }
    const std::string& code() const { return m_code; }

    // A request that is malformed or asks for something impossible (400).
    static WorkflowError bad(const std::string& message) { return WorkflowError(400, message); }
    // A node that does not exist (any more).
    static WorkflowError invalidNode(const std::string& id) {
        return WorkflowError(404, "node \"" + id + "\" does not exist", kInvalidNodeIdKey);
    }
    // A preference path that holds nothing.
    static WorkflowError pathNotFound(const std::string& userId, const std::string& path) {
        return WorkflowError(404, "user \"" + userId + "\" has no preference \"" + path + "\"",
                             kPathNotFoundKey);
    }
    // A user the service does not know.
    static WorkflowError unknownUser(const std::string& userId) {
        return WorkflowError(404, "user \"" + userId + "\" is not known");
    }
    // A node of another user that is not shared.
    static WorkflowError foreign(const std::string& id) {
        return WorkflowError(403, "node \"" + id + "\" belongs to another user and is not shared");
    }

private:
    int m_status;
    std::string m_key;
    std::string m_code;
};

}  // namespace Workflow
}  // namespace ConfigurationService
