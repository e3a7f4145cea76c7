// The values the user-workflow store hands out and takes in: nodes, users, contact names and
// preferences, and the fields of a record as a request carried them (name to text; a field that
// is absent was left out by the client). Plain values.
#pragma once

#include <cstdint>
#include <map>
#include <string>

namespace ConfigurationService {
namespace Workflow {

using Fields = std::map<std::string, std::string>;

enum NodeType { kFolder = 0, kItem = 1 };

struct Node {
    std::string id;
    std::string name;
    std::string userId;
    std::string parentId;  // empty for a root folder
    int type = kFolder;
    bool shared = false;
    std::string opaqueData;
    std::int64_t modifiedMs = 0;  // milliseconds since 1970 UTC
    int subFolders = 0;
    int subItems = 0;
};

struct User {
    std::string userId;
    std::string userName;
    std::string type;
    std::string inboxId;
    std::string masterFolderId;
    bool onCall = false;
    bool loggedIn = false;
};

struct ContactName {
    std::string familyName;
    std::string givenName;
    std::string middleName;
    std::string honorificPrefix;
    std::string honorificSuffix;
};

struct Preference {
    std::string userId;
    std::string path;
    std::string data;
};

// Limits on what users may create.
struct Limits {
    int maxFoldersPerUser = 1000;
    int maxItemsPerFolder = 50000;
};

}  // namespace Workflow
}  // namespace ConfigurationService
