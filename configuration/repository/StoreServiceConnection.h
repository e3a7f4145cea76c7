// StoreServiceConnection: a ServiceConnection answered in this process by a DirectoryStore, for
// the embedded mode (one machine, no configuration service). The machine is its own master and
// the only host; the change signals set this machine's change event directly. The connector
// opens the store once (locking its directory for this process) and shares it.
#pragma once

#include <memory>

#include "Store/DirectoryStore.h"
#include "repository/ServiceConnection.h"

namespace Configuration {

class StoreServiceConnection : public ServiceConnection {
public:
    StoreServiceConnection(std::shared_ptr<DirectoryStore> store, const ACE_CString& hostName);

    const ACE_CString& hostName() const override { return m_hostName; }
    void retrieve(const ACE_CString& host, const ACE_CString& name, Quorvex::ByteArray& data,
                  std::size_t& length) override;
    void store(const ACE_CString& host, const ACE_CString& name, const unsigned char* data,
               std::size_t length, const ACE_CString& lastModifiedTime) override;
    void getTimeStamp(const ACE_CString& host, const ACE_CString& name,
                      BDateTime& timestamp) override;
    void listHosts(std::vector<ACE_CString>& hosts) override;
    void listItems(const ACE_CString& host,
                   std::vector<_HttpConfigurationItemInfo>& items) override;
    void registerService(const ACE_CString& host, const ACE_CString& service,
                         const ACE_CString& connection) override;
    void switchoverPersistent(const ACE_CString& persistentName) override;
    void enableMergeNetworkCapture(bool enable, const ACE_CString& host) override;
    void signalChanged() override;
    void signalRestart() override { signalChanged(); }
    void signalRefresh() override { signalChanged(); }

private:
    StoredItem find(const ACE_CString& host, const ACE_CString& name) const;

    std::shared_ptr<DirectoryStore> m_store;
    ACE_CString m_hostName;
};

class StoreServiceConnector : public ServiceConnector {
public:
    // Opens the store in directory; throws std::runtime_error when it cannot.
    explicit StoreServiceConnector(const ACE_CString& directory);
    std::unique_ptr<ServiceConnection> connectLocal() const override;
    std::unique_ptr<ServiceConnection> connect(const ACE_CString& host) const override;

private:
    std::shared_ptr<DirectoryStore> m_store;
    ACE_CString m_hostName;
};

}  // namespace Configuration
