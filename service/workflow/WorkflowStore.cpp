// The user-workflow store: the node tree and the exams in folders.
#include "workflow/WorkflowStore.h"

#include <strings.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <random>

namespace ConfigurationService {
namespace Workflow {
namespace {

constexpr int kMaxDepth = 100000;  // a parent chain longer than this is taken as broken

// Statements are cached by the address of their text, so every query is one string literal.
#define NODE_QUERY(tail)                                                                      \
    "SELECT id, name, user_id, COALESCE(parent_id, ''), type, shared, opaque, modified FROM " \
    "nodes " tail

// A node id: a random GUID text.
std::string newId() {
    thread_local std::mt19937_64 random{std::random_device{}()};
    const std::uint64_t high = random();
    const std::uint64_t low = random();
    char text[40];
    std::snprintf(text, sizeof text, "%08X-%04X-%04X-%04X-%012llX",
                  static_cast<unsigned>(high >> 32), static_cast<unsigned>((high >> 16) & 0xffff),
                  static_cast<unsigned>(0x4000 | (high & 0x0fff)),
                  static_cast<unsigned>(0x8000 | ((low >> 48) & 0x3fff)),
                  static_cast<unsigned long long>(low & 0xffffffffffffULL));
    return text;
}

Node nodeOf(const Statement& row) {
    Node node;
    node.id = row.text(0);
    node.name = row.text(1);
    node.userId = row.text(2);
    node.parentId = row.text(3);
    node.type = static_cast<int>(row.integer(4));
    node.shared = row.integer(5) != 0;
    node.opaqueData = row.text(6);
    node.modifiedMs = row.integer(7);
    return node;
}

int parseType(const std::string& text) {
    if (text == "0") {
        return kFolder;
    }
    if (text == "1") {
        return kItem;
    }
    throw WorkflowError::bad("a node type is 0 (folder) or 1 (item), not \"" + text + "\"");
}

std::string field(const Fields& record, const char* name) {
    const auto it = record.find(name);
    return it == record.end() ? std::string() : it->second;
}

}  // namespace

bool parseFlag(const std::string& name, const std::string& text) {
    if (strcasecmp(text.c_str(), "true") == 0 || text == "1") {
        return true;
    }
    if (strcasecmp(text.c_str(), "false") == 0 || text == "0") {
        return false;
    }
    throw WorkflowError::bad(name + " is true or false, not \"" + text + "\"");
}

WorkflowStore::WorkflowStore(const std::string& path, const Limits& limits)
    : m_db(path), m_limits(limits) {}

std::int64_t WorkflowStore::nextTime() {
    const auto now = std::chrono::duration_cast<std::chrono::milliseconds>(
                         std::chrono::system_clock::now().time_since_epoch())
                         .count();
    m_lastTime = std::max<std::int64_t>(now, m_lastTime + 1);
    return m_lastTime;
}

bool WorkflowStore::findNode(const std::string& id, Node& node) {
    Statement& query = m_db.prepare(NODE_QUERY("WHERE id = ?"));
    query.bind(1, id);
    const bool found = query.step();
    if (found) {
        node = nodeOf(query);
    }
    query.reset();
    return found;
}

Node WorkflowStore::existingNode(const std::string& id) {
    if (id.empty()) {
        throw WorkflowError::bad("the request names no node id");
    }
    Node node;
    if (!findNode(id, node)) {
        throw WorkflowError::invalidNode(id);
    }
    return node;
}

// Whether candidate is ancestorId or lies below it.
bool WorkflowStore::isBelow(const std::string& candidate, const std::string& ancestorId) {
    std::string at = candidate;
    for (int depth = 0; !at.empty() && depth < kMaxDepth; ++depth) {
        if (at == ancestorId) {
            return true;
        }
        Statement& up = m_db.prepare("SELECT COALESCE(parent_id, '') FROM nodes WHERE id = ?");
        up.bind(1, at);
        at = up.step() ? up.text(0) : std::string();
        up.reset();
    }
    return false;
}

// A node of type owned by userId may go under parentId (empty: a root folder).
void WorkflowStore::checkParent(const std::string& childId, int type, const std::string& parentId,
                                const std::string& userId) {
    if (parentId.empty()) {
        if (type != kFolder) {
            throw WorkflowError::bad("an item must be created in a folder");
        }
        return;
    }
    const Node parent = existingNode(parentId);
    if (parent.type != kFolder) {
        throw WorkflowError::bad("node \"" + parentId + "\" is an item; only folders hold nodes");
    }
    if (parent.userId != userId && !parent.shared) {
        throw WorkflowError::foreign(parentId);
    }
    if (!childId.empty() && isBelow(parentId, childId)) {
        throw WorkflowError::bad("node \"" + childId + "\" cannot move into itself or below");
    }
}

void WorkflowStore::checkLimits(int type, const std::string& userId, const std::string& parentId) {
    if (type == kFolder) {
        Statement& count =
            m_db.prepare("SELECT COUNT(*) FROM nodes WHERE user_id = ? AND type = 0");
        count.bind(1, userId).step();
        const std::int64_t folders = count.integer(0);
        count.reset();
        if (folders >= m_limits.maxFoldersPerUser) {
            throw WorkflowError(409,
                                "user \"" + userId + "\" has reached the limit of " +
                                    std::to_string(m_limits.maxFoldersPerUser) + " folders",
                                "", WorkflowError::kFolderLimitCode);
        }
        return;
    }
    Statement& count = m_db.prepare("SELECT COUNT(*) FROM nodes WHERE parent_id = ? AND type = 1");
    count.bind(1, parentId).step();
    const std::int64_t items = count.integer(0);
    count.reset();
    if (items >= m_limits.maxItemsPerFolder) {
        throw WorkflowError(409,
                            "folder \"" + parentId + "\" has reached the limit of " +
                                std::to_string(m_limits.maxItemsPerFolder) + " items",
                            "", WorkflowError::kItemLimitCode);
    }
}

void WorkflowStore::insertNode(const Node& node) {
    Statement& insert = m_db.prepare(
        "INSERT INTO nodes (id, name, user_id, parent_id, type, shared, opaque, modified) "
        "VALUES (?, ?, ?, NULLIF(?, ''), ?, ?, ?, ?)");
    insert.bind(1, node.id).bind(2, node.name).bind(3, node.userId).bind(4, node.parentId);
    insert.bind(5, std::int64_t{node.type}).bind(6, std::int64_t{node.shared});
    insert.bind(7, node.opaqueData).bind(8, node.modifiedMs).run();
    insert.reset();
}

Node WorkflowStore::createNode(const Fields& record) {
    Node node;
    node.userId = field(record, "UserId");
    if (node.userId.empty()) {
        throw WorkflowError::bad("a node needs a UserId");
    }
    node.name = field(record, "Name");
    node.parentId = field(record, "ParentId");
    node.type = parseType(record.count("Type") ? field(record, "Type") : "0");
    node.shared = record.count("Shared") != 0 && parseFlag("Shared", field(record, "Shared"));
    node.opaqueData = field(record, "OpaqueData");
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    checkParent("", node.type, node.parentId, node.userId);
    checkLimits(node.type, node.userId, node.parentId);
    node.id = newId();
    node.modifiedMs = nextTime();
    insertNode(node);
    transaction.commit();
    return node;
}

std::int64_t WorkflowStore::updateNode(const Fields& record) {
    const std::string id = field(record, "Id");
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    Node node = existingNode(id);
    const std::string requester = field(record, "UserId");
    if (!requester.empty() && requester != node.userId && !node.shared) {
        throw WorkflowError::foreign(id);
    }
    if (record.count("Type") && parseType(field(record, "Type")) != node.type) {
        throw WorkflowError::bad("the type of node \"" + id + "\" cannot change");
    }
    const std::string parentId = field(record, "ParentId");
    if (record.count("ParentId") && parentId != node.parentId) {
        checkParent(id, node.type, parentId, node.userId);
        if (node.type == kItem) {
            checkLimits(kItem, node.userId, parentId);
        }
        node.parentId = parentId;
    }
    if (record.count("Name")) {
        node.name = field(record, "Name");
    }
    if (record.count("Shared")) {
        node.shared = parseFlag("Shared", field(record, "Shared"));
    }
    if (record.count("OpaqueData")) {
        node.opaqueData = field(record, "OpaqueData");
    }
    node.modifiedMs = nextTime();
    Statement& update = m_db.prepare(
        "UPDATE nodes SET name = ?, parent_id = NULLIF(?, ''), shared = ?, opaque = ?, "
        "modified = ? WHERE id = ?");
    update.bind(1, node.name).bind(2, node.parentId).bind(3, std::int64_t{node.shared});
    update.bind(4, node.opaqueData).bind(5, node.modifiedMs).bind(6, id).run();
    update.reset();
    transaction.commit();
    return node.modifiedMs;
}

void WorkflowStore::deleteNode(const std::string& id, const std::string& userId,
                               const std::string& type) {
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    const Node node = existingNode(id);
    if (!type.empty() && parseType(type) != node.type) {
        throw WorkflowError::bad("node \"" + id + "\" is not of type " + type);
    }
    if (!userId.empty() && userId != node.userId && !node.shared) {
        throw WorkflowError::foreign(id);
    }
    Statement& remove = m_db.prepare("DELETE FROM nodes WHERE id = ?");
    remove.bind(1, id).run();
    remove.reset();
    transaction.commit();
}

void WorkflowStore::insertExam(const std::string& examKey, const std::string& folderId) {
    if (examKey.empty()) {
        throw WorkflowError::bad("an exam needs its examKey");
    }
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    if (existingNode(folderId).type != kFolder) {
        throw WorkflowError::bad("node \"" + folderId + "\" is an item; exams go into folders");
    }
    Statement& insert =
        m_db.prepare("INSERT OR IGNORE INTO exam_folders (exam_key, folder_id) VALUES (?, ?)");
    insert.bind(1, examKey).bind(2, folderId).run();
    insert.reset();
    transaction.commit();
}

void WorkflowStore::deleteExam(const std::string& examKey, const std::string& folderId) {
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    existingNode(folderId);
    Statement& remove =
        m_db.prepare("DELETE FROM exam_folders WHERE exam_key = ? AND folder_id = ?");
    remove.bind(1, examKey).bind(2, folderId).run();
    remove.reset();
    transaction.commit();
}

bool WorkflowStore::isProtectedExam(const std::string& examKey) {
    std::lock_guard<std::mutex> lock(m_mutex);
    Statement& query = m_db.prepare("SELECT 1 FROM exam_folders WHERE exam_key = ? LIMIT 1");
    const bool found = query.bind(1, examKey).step();
    query.reset();
    return found;
}

bool WorkflowStore::isValidChild(const std::string& id, const std::string& parentId,
                                 const std::string& type) {
    const int childType = parseType(type);
    std::lock_guard<std::mutex> lock(m_mutex);
    if (parentId.empty()) {
        return childType == kFolder;
    }
    const Node parent = existingNode(parentId);
    if (parent.type != kFolder) {
        return false;
    }
    Node child;
    if (id.empty() || !findNode(id, child)) {
        return true;
    }
    return child.type == childType && !isBelow(parentId, id);
}

void WorkflowStore::purgeFolder(const std::string& folderId, const std::string& itemsToRetain,
                                const std::string& userId) {
    char* end = nullptr;
    const long keep = std::strtol(itemsToRetain.c_str(), &end, 10);
    if (itemsToRetain.empty() || *end != '\0' || keep < 0) {
        throw WorkflowError::bad("itemsToRetain is a number of at least 0, not \"" + itemsToRetain +
                                 "\"");
    }
    std::lock_guard<std::mutex> lock(m_mutex);
    Transaction transaction(m_db);
    const Node folder = existingNode(folderId);
    if (folder.type != kFolder) {
        throw WorkflowError::bad("node \"" + folderId + "\" is an item, not a folder");
    }
    if (!userId.empty() && userId != folder.userId && !folder.shared) {
        throw WorkflowError::foreign(folderId);
    }
    Statement& purge = m_db.prepare(
        "DELETE FROM nodes WHERE parent_id = ?1 AND type = 1 AND id NOT IN ("
        "SELECT id FROM nodes WHERE parent_id = ?1 AND type = 1 "
        "ORDER BY modified DESC, rowid DESC LIMIT ?2)");
    purge.bind(1, folderId).bind(2, static_cast<std::int64_t>(keep)).run();
    purge.reset();
    transaction.commit();
}

void WorkflowStore::countChildren(Node& node) {
    Statement& count = m_db.prepare(
        "SELECT COALESCE(SUM(type = 0), 0), COALESCE(SUM(type = 1), 0) FROM nodes "
        "WHERE parent_id = ?");
    count.bind(1, node.id).step();
    node.subFolders = static_cast<int>(count.integer(0));
    node.subItems = static_cast<int>(count.integer(1));
    count.reset();
}

std::vector<Node> WorkflowStore::folderData(const std::string& folderId, std::int64_t sinceMs) {
    std::lock_guard<std::mutex> lock(m_mutex);
    if (existingNode(folderId).type != kFolder) {
        throw WorkflowError::bad("node \"" + folderId + "\" is an item, not a folder");
    }
    std::vector<Node> nodes;
    Statement& query =
        m_db.prepare(NODE_QUERY("WHERE parent_id = ? AND modified > ? ORDER BY modified, rowid"));
    query.bind(1, folderId).bind(2, sinceMs);
    while (query.step()) {
        nodes.push_back(nodeOf(query));
    }
    query.reset();
    for (Node& node : nodes) {
        if (node.type == kFolder) {
            countChildren(node);
        }
    }
    return nodes;
}

std::string WorkflowStore::addRootFolder(const std::string& userId, const std::string& name) {
    checkLimits(kFolder, userId, "");
    Node folder;
    folder.id = newId();
    folder.name = name;
    folder.userId = userId;
    folder.modifiedMs = nextTime();
    insertNode(folder);
    return folder.id;
}

// The user's root folders and the shared root folders of others; the caller holds the lock.
std::vector<Node> WorkflowStore::rootFolders(const std::string& userId) {
    Statement& query =
        m_db.prepare(NODE_QUERY("WHERE parent_id IS NULL AND (user_id = ?1 OR shared = 1) "
                                "ORDER BY user_id <> ?1, user_id, rowid"));
    query.bind(1, userId);
    std::vector<Node> roots;
    while (query.step()) {
        roots.push_back(nodeOf(query));
    }
    query.reset();
    for (Node& root : roots) {
        countChildren(root);
    }
    return roots;
}

std::string WorkflowStore::integrityCheck() {
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_db.integrityCheck();
}

}  // namespace Workflow
}  // namespace ConfigurationService
