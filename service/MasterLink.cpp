// Forwarding to the master's configuration service.
#include "MasterLink.h"

#include <stdexcept>

#include "Configuration/HttpConfigurationClient.h"
#include "TimeText.h"

namespace ConfigurationService {

MasterLink::MasterLink(const std::string& ownHostName, const std::string& address,
                       const std::string& knownName)
    : m_ownHostName(ownHostName), m_address(address), m_hostName(knownName) {}

std::string MasterLink::hostName() {
    if (isMaster()) {
        return m_ownHostName;
    }
    {
        std::lock_guard<std::mutex> lock(m_mutex);
        if (!m_hostName.empty()) {
            return m_hostName;
        }
    }
    // Asked without holding the lock: the client may take a while when the master is down.
    const Configuration::HttpConfigurationClient client(m_address.c_str(), true, false);
    if (client.hostName().length() == 0) {
        throw std::runtime_error("the master at " + m_address + " reported no host name");
    }
    std::lock_guard<std::mutex> lock(m_mutex);
    m_hostName = client.hostName().c_str();
    return m_hostName;
}

std::string MasterLink::knownHostName() const {
    if (isMaster()) {
        return m_ownHostName;
    }
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_hostName;
}

void MasterLink::store(const std::string& host, const std::string& name, const std::string& bytes,
                       std::int64_t lastModifiedMs) {
    const Configuration::HttpConfigurationClient client(m_address.c_str(), true, false);
    client.store(host.c_str(), name.c_str(), reinterpret_cast<const unsigned char*>(bytes.data()),
                 bytes.size(), TimeText::format(lastModifiedMs).c_str());
}

std::vector<Configuration::_HttpConfigurationItemInfo> MasterLink::listItems() const {
    const Configuration::HttpConfigurationClient client(m_address.c_str(), true, false);
    std::vector<Configuration::_HttpConfigurationItemInfo> items;
    client.listItems("*", items);
    return items;
}

std::string MasterLink::retrieve(const std::string& host, const std::string& name) const {
    const Configuration::HttpConfigurationClient client(m_address.c_str(), true, false);
    Quorvex::ByteArray bytes;
    std::size_t length = 0;
    client.retrieve(host.c_str(), name.c_str(), bytes, length);
    return std::string(reinterpret_cast<const char*>(bytes.get()), length);
}

std::vector<std::string> MasterLink::listHosts(const int* moduleType) const {
    const Configuration::HttpConfigurationClient client(m_address.c_str(), true, false);
    std::vector<ACE_CString> hosts;
    if (moduleType != nullptr) {
        client.listHostsByModuleType(*moduleType, hosts);
    } else {
        client.listHosts(hosts);
    }
    std::vector<std::string> names;
    for (const ACE_CString& host : hosts) {
        names.emplace_back(host.c_str(), host.length());
    }
    return names;
}

}  // namespace ConfigurationService
