// MasterLink: this service's road to the master's configuration service. Without a master
// address this service is the master. The master's host name is the configured one or is asked
// from the master on first need and then kept. Writes are forwarded through the library's
// HttpConfigurationClient with the machine's service ticket. Thread-safe.
#pragma once

#include <cstdint>
#include <mutex>
#include <string>
#include <vector>

#include "Configuration/HttpConfigurationItemInfo.h"

namespace ConfigurationService {

class MasterLink {
public:
    // address: the master's "host:port", empty when this service is the master; knownName: the
    // master's host name when configured, else empty.
    MasterLink(const std::string& ownHostName, const std::string& address,
               const std::string& knownName);

    // Whether this service is the master.
    bool isMaster() const { return m_address.empty(); }
    // The master's service address ("" on the master).
    const std::string& address() const { return m_address; }
    // The master's host name (ours on the master); throws std::exception when the master cannot
    // be asked.
    std::string hostName();
    // The master's host name if already known, else empty; never contacts the master.
    std::string knownHostName() const;
    // Stores a document on the master with the given time; throws std::exception on failure.
    void store(const std::string& host, const std::string& name, const std::string& bytes,
               std::int64_t lastModifiedMs);
    // The master's items of every host; throws std::exception on failure.
    std::vector<Configuration::_HttpConfigurationItemInfo> listItems() const;
    // One document's bytes from the master; throws std::exception on failure.
    std::string retrieve(const std::string& host, const std::string& name) const;
    // The hosts the master knows (of one module type when moduleType is not null); throws
    // std::exception on failure.
    std::vector<std::string> listHosts(const int* moduleType) const;

private:
    const std::string m_ownHostName;
    const std::string m_address;
    mutable std::mutex m_mutex;
    std::string m_hostName;
};

}  // namespace ConfigurationService
