// configctl's user-workflow commands, read only: users and folders.
#include <set>
#include <string>

#include "Commands.h"
#include "Configuration/HttpConfigurationClient.h"
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

}  // namespace Configctl
