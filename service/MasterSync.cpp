#include "MasterSync.h"

#include "Quorvex/Log.h"
#include "Store/ItemDiff.h"
#include "TimeText.h"

namespace ConfigurationService {
namespace {

std::vector<Configuration::_HttpConfigurationItemInfo> localItems(
    const Configuration::DirectoryStore& store) {
    std::vector<Configuration::_HttpConfigurationItemInfo> items;
    for (const Configuration::StoredItem& item :
         store.list(Configuration::DirectoryStore::kAllHosts)) {
        items.push_back({item.host, item.name, TimeText::format(item.lastModifiedMs).c_str()});
    }
    return items;
}

}  // namespace

std::size_t MasterSync::run() {
    std::lock_guard<std::mutex> lock(m_running);
    const auto missing = Configuration::itemsMissingLocally(m_context.master.listItems(),
                                                            localItems(m_context.store));
    std::size_t copied = 0;
    for (const Configuration::_HttpConfigurationItemInfo& item : missing) {
        try {
            const std::string bytes =
                m_context.master.retrieve(item.host.c_str(), item.configurationName.c_str());
            m_context.store.store(item.host, item.configurationName, bytes.data(), bytes.size(),
                                  TimeText::parse(item.lastModifiedTime.c_str()));
            ++copied;
        } catch (const std::exception& e) {
            QUORVEX_LOG(LM_ERROR, "MasterSync::run: Unable to copy %s of host %s: %s\n",
                        item.configurationName.c_str(), item.host.c_str(), e.what());
        }
    }
    return copied;
}

}  // namespace ConfigurationService
