#include "Store/ItemDiff.h"

#include <algorithm>
#include <iterator>
#include <string>

namespace Configuration {
namespace {

// Host, configuration name and last-modified time joined in that order.
std::string itemKey(const _HttpConfigurationItemInfo& item) {
    std::string key(item.host.c_str(), item.host.length());
    key.push_back('\0');
    key.append(item.configurationName.c_str(), item.configurationName.length());
    key.push_back('\0');
    key.append(item.lastModifiedTime.c_str(), item.lastModifiedTime.length());
    return key;
}

bool keyLess(const _HttpConfigurationItemInfo& a, const _HttpConfigurationItemInfo& b) {
    return itemKey(a) < itemKey(b);
}

}  // namespace

std::vector<_HttpConfigurationItemInfo> itemsMissingLocally(
    std::vector<_HttpConfigurationItemInfo> master, std::vector<_HttpConfigurationItemInfo> local) {
    std::sort(master.begin(), master.end(), keyLess);
    std::sort(local.begin(), local.end(), keyLess);
    std::vector<_HttpConfigurationItemInfo> missing;
    std::set_difference(master.begin(), master.end(), local.begin(), local.end(),
                        std::back_inserter(missing), keyLess);
    return missing;
}

}  // namespace Configuration
