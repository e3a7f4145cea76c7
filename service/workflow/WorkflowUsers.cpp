// The user-workflow store: users, log-in state, contact names and preferences.
#include <sstream>

#include "workflow/WorkflowStore.h"

namespace ConfigurationService {
namespace Workflow {
namespace {

#define USER_QUERY(tail)                                                                    \
    "SELECT user_id, user_name, type, inbox_id, master_folder_id, on_call, logged_in FROM " \
    "users " tail

User userOf(const Statement& row) {
    User user;
    user.userId = row.text(0);
    user.userName = row.text(1);
    user.type = row.text(2);
    user.inboxId = row.text(3);
    user.masterFolderId = row.text(4);
    user.onCall = row.integer(5) != 0;
    user.loggedIn = row.integer(6) != 0;
    return user;
}

// The parts of a name in the DICOM person-name order "Family^Given^Middle^Prefix^Suffix"; a
// name without "^" is all family name.
ContactName contactNameOf(const std::string& userName) {
    std::string parts[5];
    std::istringstream in(userName);
    for (std::string& part : parts) {
        if (!std::getline(in, part, '^')) {
            break;
        }
    }
    return ContactName{parts[0], parts[1], parts[2], parts[3], parts[4]};
}

// Applies the fields a user record carries.
void apply(const Fields& record, User& user) {
    const auto set = [&record](const char* name, std::string& value) {
        const auto it = record.find(name);
        if (it != record.end()) {
            value = it->second;
        }
    };
    set("UserName", user.userName);
    set("Type", user.type);
    set("InboxId", user.inboxId);
    set("MasterFolderId", user.masterFolderId);
    const auto onCall = record.find("OnCall");
    if (onCall != record.end()) {
        user.onCall = parseFlag("OnCall", onCall->second);
    }
}

std::string requiredUserId(const Fields& record) {
    const auto it = record.find("UserId");
    if (it == record.end() || it->second.empty()) {
        throw WorkflowError::bad("a user record needs a UserId");
    }
    return it->second;
}

}  // namespace

bool WorkflowStore::findUser(const std::string& userId, User& user) {
    Statement& query = m_db.prepare(USER_QUERY("WHERE user_id = ?"));
    const bool found = query.bind(1, userId).step();
    if (found) {
        user = userOf(query);
    }
    query.reset();
    return found;
}

// Writes the user and the contact name its name gives.
void WorkflowStore::storeUser(const User& user) {
    Statement& upsert = m_db.prepare(
        "INSERT INTO users (user_id, user_name, type, inbox_id, master_folder_id, on_call, "
        "logged_in) VALUES (?1, ?2, ?3, ?4, ?5, ?6, ?7) ON CONFLICT(user_id) DO UPDATE SET "
        "user_name = ?2, type = ?3, inbox_id = ?4, master_folder_id = ?5, on_call = ?6, "
        "logged_in = ?7");
    upsert.bind(1, user.userId).bind(2, user.userName).bind(3, user.type);
    upsert.bind(4, user.inboxId).bind(5, user.masterFolderId);
    upsert.bind(6, std::int64_t{user.onCall}).bind(7, std::int64_t{user.loggedIn}).run();
    upsert.reset();
    const ContactName name = contactNameOf(user.userName);
    Statement& contact = m_db.prepare(
        "INSERT OR REPLACE INTO contact_names (user_id, family_name, given_name, middle_name, "
        "honorific_prefix, honorific_suffix) VALUES (?, ?, ?, ?, ?, ?)");
    contact.bind(1, user.userId).bind(2, name.familyName).bind(3, name.givenName);
    contact.bind(4, name.middleName).bind(5, name.honorificPrefix);
    contact.bind(6, name.honorificSuffix).run();
    contact.reset();
}

User WorkflowStore::user(const std::string& userId) {
    std::lock_guard<std::mutex> lock(m_mutex);
    User user;
    if (!findUser(userId, user)) {
        throw WorkflowError::unknownUser(userId);
    }
    return user;
}

void WorkflowStore::updateUser(const Fields& record) {
    User user;
    user.userId = requiredUserId(record);
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    findUser(user.userId, user);
    apply(record, user);
    storeUser(user);
    transaction.commit();
}

std::vector<Node> WorkflowStore::login(const Fields& record) {
    User user;
    user.userId = requiredUserId(record);
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    findUser(user.userId, user);
    apply(record, user);
    Node existing;
    if (user.inboxId.empty() || !findNode(user.inboxId, existing)) {
        user.inboxId = addRootFolder(user.userId, "Inbox");
    }
    if (user.masterFolderId.empty() || !findNode(user.masterFolderId, existing)) {
        user.masterFolderId = addRootFolder(user.userId, "Folders");
    }
    user.loggedIn = true;
    storeUser(user);
    transaction.commit();
    return rootFolders(user.userId);
}

void WorkflowStore::logout(const std::string& userId) {
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    User user;
    if (!findUser(userId, user)) {
        throw WorkflowError::unknownUser(userId);
    }
    user.loggedIn = false;
    storeUser(user);
    transaction.commit();
}

void WorkflowStore::deleteUser(const std::string& userId) {
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    User user;
    if (!findUser(userId, user)) {
        throw WorkflowError::unknownUser(userId);
    }
    for (const char* sql :
         {"DELETE FROM nodes WHERE user_id = ?", "DELETE FROM users WHERE user_id = ?",
          "DELETE FROM contact_names WHERE user_id = ?",
          "DELETE FROM preferences WHERE user_id = ?"}) {
        Statement& remove = m_db.prepare(sql);
        remove.bind(1, userId).run();
        remove.reset();
    }
    transaction.commit();
}

std::vector<User> WorkflowStore::listUsers(const std::string& type, bool loggedInOnly) {
    std::lock_guard<std::mutex> lock(m_mutex);
    Statement& query = m_db.prepare(
        USER_QUERY("WHERE (?1 = '' OR type = ?1) AND (?2 = 0 OR logged_in = 1) ORDER BY user_id"));
    query.bind(1, type).bind(2, std::int64_t{loggedInOnly});
    std::vector<User> users;
    while (query.step()) {
        users.push_back(userOf(query));
    }
    query.reset();
    return users;
}

ContactName WorkflowStore::contactName(const std::string& userId) {
    std::lock_guard<std::mutex> lock(m_mutex);
    Statement& query = m_db.prepare(
        "SELECT family_name, given_name, middle_name, honorific_prefix, honorific_suffix "
        "FROM contact_names WHERE user_id = ?");
    if (!query.bind(1, userId).step()) {
        query.reset();
        throw WorkflowError::unknownUser(userId);
    }
    ContactName name{query.text(0), query.text(1), query.text(2), query.text(3), query.text(4)};
    query.reset();
    return name;
}

void WorkflowStore::storePreference(const std::string& userId, const std::string& path,
                                    const std::string& data) {
    if (userId.empty() || path.empty()) {
        throw WorkflowError::bad("a preference needs a userId and a path");
    }
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    Statement& upsert =
        m_db.prepare("INSERT OR REPLACE INTO preferences (user_id, path, data) VALUES (?, ?, ?)");
    upsert.bind(1, userId).bind(2, path).bind(3, data).run();
    upsert.reset();
    transaction.commit();
}

std::string WorkflowStore::preference(const std::string& userId, const std::string& path) {
    std::lock_guard<std::mutex> lock(m_mutex);
    Statement& query = m_db.prepare("SELECT data FROM preferences WHERE user_id = ? AND path = ?");
    if (!query.bind(1, userId).bind(2, path).step()) {
        query.reset();
        throw WorkflowError::pathNotFound(userId, path);
    }
    std::string data = query.text(0);
    query.reset();
    return data;
}

std::vector<Preference> WorkflowStore::preferences(const std::vector<std::string>& userIds) {
    std::lock_guard<std::mutex> lock(m_mutex);
    std::vector<Preference> found;
    for (const std::string& userId : userIds) {
        Statement& query =
            m_db.prepare("SELECT path, data FROM preferences WHERE user_id = ? ORDER BY path");
        query.bind(1, userId);
        while (query.step()) {
            found.push_back(Preference{userId, query.text(0), query.text(1)});
        }
        query.reset();
    }
    return found;
}

}  // namespace Workflow
}  // namespace ConfigurationService
