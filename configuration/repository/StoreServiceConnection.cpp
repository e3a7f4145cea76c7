#include "repository/StoreServiceConnection.h"

#include <cstring>
#include <stdexcept>
#include <string>

#include "Common/NamedEvent.h"
#include "Quorvex/Host.h"

namespace Configuration {
namespace {

const char kChangeEvent[] = "Global\\QuorvexSlaveConfigurationChanged";
const char kPersistentSetting[] = "PersistentStorage";

ACE_CString timeText(std::int64_t ms) {
    return BDateTime::fromMillisecondsSinceEpoch(ms).ToString();
}

}  // namespace

StoreServiceConnection::StoreServiceConnection(std::shared_ptr<DirectoryStore> store,
                                               const ACE_CString& hostName)
    : m_store(std::move(store)), m_hostName(hostName) {}

StoredItem StoreServiceConnection::find(const ACE_CString& host, const ACE_CString& name) const {
    StoredItem item;
    if (!m_store->retrieve(host, name, item)) {
        throw std::runtime_error(std::string("No configuration ") + name.c_str() + " for host " +
                                 host.c_str());
    }
    return item;
}

void StoreServiceConnection::retrieve(const ACE_CString& host, const ACE_CString& name,
                                      Quorvex::ByteArray& data, std::size_t& length) {
    const StoredItem item = find(host, name);
    length = item.bytes->size();
    data.reset(new unsigned char[length > 0 ? length : 1]);
    std::memcpy(data.get(), item.bytes->data(), length);
}

void StoreServiceConnection::store(const ACE_CString& host, const ACE_CString& name,
                                   const unsigned char* data, std::size_t length,
                                   const ACE_CString& lastModifiedTime) {
    std::int64_t ms = DirectoryStore::kNow;
    if (lastModifiedTime.length() > 0) {
        const BDateTime time(lastModifiedTime);
        if (!time.isValid()) {
            throw std::invalid_argument(std::string("Invalid last-modified time ") +
                                        lastModifiedTime.c_str());
        }
        ms = time.millisecondsSinceEpoch();
    }
    m_store->store(host, name, data, length, ms);
}

void StoreServiceConnection::getTimeStamp(const ACE_CString& host, const ACE_CString& name,
                                          BDateTime& timestamp) {
    timestamp = BDateTime::fromMillisecondsSinceEpoch(find(host, name).lastModifiedMs);
}

void StoreServiceConnection::listHosts(std::vector<ACE_CString>& hosts) {
    hosts.assign(1, m_hostName);
}

void StoreServiceConnection::listItems(const ACE_CString& host,
                                       std::vector<_HttpConfigurationItemInfo>& items) {
    items.clear();
    for (const StoredItem& item : m_store->list(host)) {
        items.push_back({item.host, item.name, timeText(item.lastModifiedMs)});
    }
}

void StoreServiceConnection::registerService(const ACE_CString& host, const ACE_CString& service,
                                             const ACE_CString& connection) {
    m_store->registerService(host, service, connection);
}

void StoreServiceConnection::switchoverPersistent(const ACE_CString& persistentName) {
    m_store->setSetting(kPersistentSetting, persistentName);
}

void StoreServiceConnection::enableMergeNetworkCapture(bool enable, const ACE_CString& host) {
    const std::string key = "MergeNetworkCapture:" + Quorvex::HostKey(host.c_str());
    m_store->setSetting(key.c_str(), enable ? "1" : "0");
}

void StoreServiceConnection::signalChanged() {
    Common::NamedEvent event(kChangeEvent);
    if (event.set() != 0) {
        throw std::runtime_error("Unable to set the configuration change event");
    }
}

StoreServiceConnector::StoreServiceConnector(const ACE_CString& directory)
    : m_store(std::make_shared<DirectoryStore>(directory)),
      m_hostName(Quorvex::GetHostName(false)) {}

std::unique_ptr<ServiceConnection> StoreServiceConnector::connectLocal() const {
    return std::make_unique<StoreServiceConnection>(m_store, m_hostName);
}

std::unique_ptr<ServiceConnection> StoreServiceConnector::connect(const ACE_CString&) const {
    return connectLocal();
}

}  // namespace Configuration
