#include "repository/HttpServiceConnection.h"

#include <utility>

namespace Configuration {

HttpServiceConnection::HttpServiceConnection(const ACE_CString& server, bool useHttps)
    : m_client(server, true, useHttps) {}

void HttpServiceConnection::retrieve(const ACE_CString& host, const ACE_CString& name,
                                     Quorvex::ByteArray& data, std::size_t& length) {
    m_client.retrieve(host, name, data, length);
}

void HttpServiceConnection::store(const ACE_CString& host, const ACE_CString& name,
                                  const unsigned char* data, std::size_t length,
                                  const ACE_CString& lastModifiedTime) {
    m_client.store(host, name, data, length, lastModifiedTime);
}

void HttpServiceConnection::getTimeStamp(const ACE_CString& host, const ACE_CString& name,
                                         BDateTime& timestamp) {
    m_client.getTimeStamp(host, name, timestamp);
}

void HttpServiceConnection::listHosts(std::vector<ACE_CString>& hosts) {
    m_client.listHosts(hosts);
}

void HttpServiceConnection::listItems(const ACE_CString& host,
                                      std::vector<_HttpConfigurationItemInfo>& items) {
    m_client.listItems(host, items);
}

void HttpServiceConnection::registerService(const ACE_CString& host, const ACE_CString& service,
                                            const ACE_CString& connection) {
    m_client.registerService(host, service, connection);
}

void HttpServiceConnection::switchoverPersistent(const ACE_CString& persistentName) {
    m_client.switchoverPersistent(persistentName);
}

void HttpServiceConnection::enableMergeNetworkCapture(bool enable, const ACE_CString& host) {
    m_client.enableMergeNetworkCapture(enable, host);
}

void HttpServiceConnection::signalChanged() {
    m_client.signalChanged();
}

void HttpServiceConnection::signalRestart() {
    m_client.signalRestart();
}

void HttpServiceConnection::signalRefresh() {
    m_client.signalRefresh();
}

HttpServiceConnector::HttpServiceConnector(ServiceLocation location)
    : m_location(std::move(location)) {}

std::unique_ptr<ServiceConnection> HttpServiceConnector::connectLocal() const {
    return std::make_unique<HttpServiceConnection>(m_location.localServer, m_location.useHttps);
}

std::unique_ptr<ServiceConnection> HttpServiceConnector::connect(const ACE_CString& host) const {
    return std::make_unique<HttpServiceConnection>(m_location.serverFor(host), m_location.useHttps);
}

}  // namespace Configuration
