// ServiceConnection: what the repository asks of one host's configuration service, so that the
// same repository code runs over HTTP (HttpServiceConnection) or over a directory store in this
// process (StoreServiceConnection). Every failure is a std::exception. One connection is used by
// one thread; a connector is thread-safe.
#pragma once

#include <ace/SString.h>

#include <cstddef>
#include <memory>
#include <vector>

#include "Configuration/HttpConfigurationItemInfo.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/auto_ptr.h"

namespace Configuration {

class ServiceConnection {
public:
    virtual ~ServiceConnection() = default;
    // The service's own host name, as it reports it.
    virtual const ACE_CString& hostName() const = 0;
    virtual void retrieve(const ACE_CString& host, const ACE_CString& name,
                          Quorvex::ByteArray& data, std::size_t& length) = 0;
    virtual void store(const ACE_CString& host, const ACE_CString& name, const unsigned char* data,
                       std::size_t length, const ACE_CString& lastModifiedTime) = 0;
    virtual void getTimeStamp(const ACE_CString& host, const ACE_CString& name,
                              BDateTime& timestamp) = 0;
    virtual void listHosts(std::vector<ACE_CString>& hosts) = 0;
    virtual void listItems(const ACE_CString& host,
                           std::vector<_HttpConfigurationItemInfo>& items) = 0;
    virtual void registerService(const ACE_CString& host, const ACE_CString& service,
                                 const ACE_CString& connection) = 0;
    virtual void switchoverPersistent(const ACE_CString& persistentName) = 0;
    virtual void enableMergeNetworkCapture(bool enable, const ACE_CString& host) = 0;
    virtual void signalChanged() = 0;
    virtual void signalRestart() = 0;
    virtual void signalRefresh() = 0;
};

// Opens connections to the services of hosts.
class ServiceConnector {
public:
    virtual ~ServiceConnector() = default;
    // A connection to this machine's own service.
    virtual std::unique_ptr<ServiceConnection> connectLocal() const = 0;
    // A connection to host's service (this machine's own when host names it).
    virtual std::unique_ptr<ServiceConnection> connect(const ACE_CString& host) const = 0;
};

}  // namespace Configuration
