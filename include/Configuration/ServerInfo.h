// Configuration::ServerInfo: what a configuration service reports about itself (its server
// information, as OPS::LoadServerInfoDoc reads it).
//
// Element "ServerInfo": "HostName" (string: the service's host), "MasterHostName" (string: its
// master's host, as far as it knows it), "IsMaster" (flag), then, optional (absent: unchanged and
// still complete), "MasterAddress" (string: the master's service address, empty on the master),
// "Version" (string: the service's version), "StoreDirectory" (string), "ItemCount" (u32:
// documents in its store), "RegisteredServices" (u32), "StartTime" (date-time the service
// started), "UptimeSeconds" (u64), "Port" (u16). Everything is empty, false or 0 by default.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <cstdint>

#include "Configuration/ConfigurationClass.h"
#include "Quorvex/BDateTime.h"

namespace Configuration {

class CONFIGURATION_API ServerInfo : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ServerInfo);

public:
    // The service's host name.
    const ACE_CString& getHostName() const { return m_hostName; }
    void setHostName(const ACE_CString& value) { m_hostName = value; }
    // The master's host name, as the service knows it.
    const ACE_CString& getMasterHostName() const { return m_masterHostName; }
    void setMasterHostName(const ACE_CString& value) { m_masterHostName = value; }
    // Whether the service is the site's master.
    bool isMaster() const { return m_isMaster; }
    void setIsMaster(bool value) { m_isMaster = value; }
    // The master's service address; empty on the master itself.
    const ACE_CString& getMasterAddress() const { return m_masterAddress; }
    void setMasterAddress(const ACE_CString& value) { m_masterAddress = value; }
    // The service's version.
    const ACE_CString& getVersion() const { return m_version; }
    void setVersion(const ACE_CString& value) { m_version = value; }
    // The directory of the service's store.
    const ACE_CString& getStoreDirectory() const { return m_storeDirectory; }
    void setStoreDirectory(const ACE_CString& value) { m_storeDirectory = value; }
    // How many documents the store holds.
    unsigned int getItemCount() const { return m_itemCount; }
    void setItemCount(unsigned int value) { m_itemCount = value; }
    // How many services are registered with it.
    unsigned int getRegisteredServices() const { return m_registeredServices; }
    void setRegisteredServices(unsigned int value) { m_registeredServices = value; }
    // When the service started.
    const BDateTime& getStartTime() const { return m_startTime; }
    void setStartTime(const BDateTime& value) { m_startTime = value; }
    // Seconds the service has been running.
    std::uint64_t getUptimeSeconds() const { return m_uptimeSeconds; }
    void setUptimeSeconds(std::uint64_t value) { m_uptimeSeconds = value; }
    // The port the service listens on.
    unsigned short getPort() const { return m_port; }
    void setPort(unsigned short value) { m_port = value; }

private:
    ACE_CString m_hostName;
    ACE_CString m_masterHostName;
    bool m_isMaster = false;
    ACE_CString m_masterAddress;
    ACE_CString m_version;
    ACE_CString m_storeDirectory;
    unsigned int m_itemCount = 0;
    unsigned int m_registeredServices = 0;
    BDateTime m_startTime;
    std::uint64_t m_uptimeSeconds = 0;
    unsigned short m_port = 0;
};

}  // namespace Configuration
