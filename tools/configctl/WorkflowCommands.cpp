// configctl's user-workflow commands, read only: users and folders.
#include <set>
#include <string>

#include "Commands.h"
#include "Configuration/HttpConfigurationClient.h"
#include "JsonText.h"
#include "Quorvex/BDateTime.h"

namespace Configctl {
namespace {

using Configuration::SmartPtr;
using Configuration::UwfNodeData;
using Configuration::UwfUserData;

constexpr int kMaxDepth = 64;  // deeper trees are cut off with "..."

}  // namespace

void Commands::users() {
    expectArguments(0, 1, "users [TYPE]");
    const ACE_CString type = m_options.arguments.empty() ? "" : m_options.arguments[0].c_str();
    std::vector<SmartPtr<UwfUserData>> all;
    std::vector<SmartPtr<UwfUserData>> loggedIn;
    client().UwfListUsers(type, false, all);
    client().UwfListUsers(type, true, loggedIn);
    std::set<std::string> in;
    for (const auto& user : loggedIn) {
        in.insert(user->UserId.c_str());
    }
    if (m_options.json) {
        JsonWriter json(m_out);
        json.beginArray();
        for (const auto& user : all) {
            json.beginObject().field("id", user->UserId).field("type", user->Type);
            json.field("loggedIn", in.count(user->UserId.c_str()) != 0);
            json.field("onCall", user->OnCall).field("name", user->UserName).endObject();
        }
        json.endArray();
        return;
    }
    for (const auto& user : all) {
        m_out << user->UserId.c_str() << "\t" << user->Type.c_str() << "\t"
              << (in.count(user->UserId.c_str()) ? "logged in" : "logged out") << "\t"
              << (user->OnCall ? "on call" : "-") << "\t" << user->UserName.c_str() << "\n";
    }
}

void Commands::folders() {
    expectArguments(1, 1, "folders USER");
    auto user = UwfUserData::Create();
    client().UwfGetUserStatus(m_options.arguments[0].c_str(), *user);
    if (m_options.json) {
        JsonWriter json(m_out);
        json.beginObject().field("user", user->UserId);
        for (const auto& root : {std::make_pair("inbox", user->InboxId),
                                 std::make_pair("masterFolder", user->MasterFolderId)}) {
            json.key(root.first);
            if (root.second.empty()) {
                json.null();
                continue;
            }
            json.beginObject().field("id", root.second);
            writeFolderJson(root.second, 1, json);
            json.endObject();
        }
        json.endObject();
        return;
    }
    for (const ACE_CString& root : {user->InboxId, user->MasterFolderId}) {
        if (root.empty()) {
            continue;
        }
        m_out << (&root == &user->InboxId ? "Inbox" : "Master folder") << " " << root.c_str()
              << "\n";
        printFolder(root, 1);
    }
}

void Commands::printFolder(const ACE_CString& folderId, int depth) {
    std::vector<SmartPtr<UwfNodeData>> nodes;
    client().UwfGetFolderData(folderId, BDateTime(), nodes);
    const std::string indent(static_cast<std::size_t>(depth) * 2, ' ');
    int items = 0;
    for (const auto& node : nodes) {
        if (node->Type != UwfNodeData::Folder) {
            ++items;
            continue;
        }
        m_out << indent << node->Name.c_str() << " [" << node->Id.c_str() << "]"
              << (node->Shared ? " shared" : "") << ", " << node->SubItems << " items\n";
        if (depth >= kMaxDepth) {
            m_out << indent << "  ...\n";
        } else {
            printFolder(node->Id, depth + 1);
        }
    }
    if (items > 0) {
        m_out << indent << "(" << items << " items)\n";
    }
}

// The members "items" (how many items the folder holds directly) and "folders" (its folders,
// each with name, id, shared, subItems and its own items and folders) of the open object.
void Commands::writeFolderJson(const ACE_CString& folderId, int depth, JsonWriter& json) {
    std::vector<SmartPtr<UwfNodeData>> nodes;
    client().UwfGetFolderData(folderId, BDateTime(), nodes);
    int items = 0;
    json.key("folders").beginArray();
    for (const auto& node : nodes) {
        if (node->Type != UwfNodeData::Folder) {
            ++items;
            continue;
        }
        json.beginObject().field("name", node->Name).field("id", node->Id);
        json.field("shared", node->Shared).field("subItems", node->SubItems);
        if (depth >= kMaxDepth) {
            json.field("truncated", true);
        } else {
            writeFolderJson(node->Id, depth + 1, json);
        }
        json.endObject();
    }
    json.endArray().field("items", items);
}

}  // namespace Configctl
