// WorkflowStore: the state of the user-workflow service in its SQLite database: users with their
// log-in state and on-call flag, each user's tree of folders and items (a shared folder is
// visible to, and may be filled by, other users), exams kept in folders, contact names and
// preferences by user and path. Every change is one transaction, committed (and synchronised to
// disk) before the call returns; failures are WorkflowError with the answer's status, key and
// code.
//
// Concurrent changes of one node: the last writer wins, and every change gets a modification
// time strictly later than any before it in this store, so a workstation that asks for the
// nodes changed since its last look sees each change, the later one last. Nothing is merged.
//
// Owns its database connection; every call is serialised by one mutex, so all calls are
// thread-safe.
#pragma once

#include <cstdint>
#include <mutex>
#include <string>
#include <vector>

#include "workflow/Database.h"
#include "workflow/WorkflowError.h"
#include "workflow/WorkflowRecords.h"

namespace ConfigurationService {
namespace Workflow {

class WorkflowStore {
public:
    // Opens (creating and migrating) the database at path.
    WorkflowStore(const std::string& path, const Limits& limits);

    // Creates a node from record fields; sets its id and modification time.
    Node createNode(const Fields& record);
    // Changes the fields the record carries (Name, ParentId, Shared, OpaqueData); returns the
    // new modification time.
    std::int64_t updateNode(const Fields& record);
    // Deletes a node and everything under it.
    void deleteNode(const std::string& id, const std::string& userId, const std::string& type);
    // Puts an exam into a folder (again is no change).
    void insertExam(const std::string& examKey, const std::string& folderId);
    // Takes an exam out of a folder.
    void deleteExam(const std::string& examKey, const std::string& folderId);
    // Whether an exam is in any folder.
    bool isProtectedExam(const std::string& examKey);
    // Whether a node of type (and id, when it exists) may be placed under parentId.
    bool isValidChild(const std::string& id, const std::string& parentId, const std::string& type);
    // Keeps the newest itemsToRetain items directly in a folder and deletes the others.
    void purgeFolder(const std::string& folderId, const std::string& itemsToRetain,
                     const std::string& userId);
    // The nodes directly in a folder changed after sinceMs, with their counts, oldest first.
    std::vector<Node> folderData(const std::string& folderId, std::int64_t sinceMs);

    // A user's record.
    User user(const std::string& userId);
    // Stores the fields of a user record (creating the user).
    void updateUser(const Fields& record);
    // Logs a user in (creating the user, an inbox and a master folder when missing); returns
    // the user's root folders and other users' shared root folders.
    std::vector<Node> login(const Fields& record);
    // Logs a user out.
    void logout(const std::string& userId);
    // Deletes a user with the user's nodes, contact name and preferences.
    void deleteUser(const std::string& userId);
    // Every user of a type (all when empty), only logged-in ones if asked, by id.
    std::vector<User> listUsers(const std::string& type, bool loggedInOnly);
    // A user's contact name.
    ContactName contactName(const std::string& userId);
    // Stores a preference.
    void storePreference(const std::string& userId, const std::string& path,
                         const std::string& data);
    // A preference's data.
    std::string preference(const std::string& userId, const std::string& path);
    // The preferences of the users, by user and path.
    std::vector<Preference> preferences(const std::vector<std::string>& userIds);

    // What SQLite's integrity check reports ("ok" when sound).
    std::string integrityCheck();

private:
    bool findNode(const std::string& id, Node& node);
    Node existingNode(const std::string& id);
    void checkParent(const std::string& childId, int type, const std::string& parentId,
                     const std::string& userId);
    bool isBelow(const std::string& candidate, const std::string& ancestorId);
    void checkLimits(int type, const std::string& userId, const std::string& parentId);
    void insertNode(const Node& node);
    bool findUser(const std::string& userId, User& user);
    void storeUser(const User& user);
    std::string addRootFolder(const std::string& userId, const std::string& name);
    void countChildren(Node& node);
    std::vector<Node> rootFolders(const std::string& userId);
    std::int64_t nextTime();

    std::mutex m_mutex;
    Database m_db;
    Limits m_limits;
    std::int64_t m_lastTime = 0;
};

// "true"/"1" or "false"/"0" ignoring case; WorkflowError::bad otherwise.
bool parseFlag(const std::string& name, const std::string& text);

}  // namespace Workflow
}  // namespace ConfigurationService
