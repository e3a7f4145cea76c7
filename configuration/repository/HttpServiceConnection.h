// HttpServiceConnection: a ServiceConnection over HttpConfigurationClient, and the connector that
// builds a fresh client for every connection from a ServiceLocation.
#pragma once

#include "Configuration/HttpConfigurationClient.h"
#include "Configuration/ServiceLocation.h"
#include "repository/ServiceConnection.h"

namespace Configuration {

class HttpServiceConnection : public ServiceConnection {
public:
    // Builds the client (which asks the server for its host names unless already known).
    HttpServiceConnection(const ACE_CString& server, bool useHttps);

    const ACE_CString& hostName() const override { return m_client.hostName(); }
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
    void signalRestart() override;
    void signalRefresh() override;

private:
    HttpConfigurationClient m_client;
};

class HttpServiceConnector : public ServiceConnector {
public:
    explicit HttpServiceConnector(ServiceLocation location);
    std::unique_ptr<ServiceConnection> connectLocal() const override;
    std::unique_ptr<ServiceConnection> connect(const ACE_CString& host) const override;

private:
    ServiceLocation m_location;
};

}  // namespace Configuration
