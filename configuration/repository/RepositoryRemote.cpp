// ConfigurationRepository: the operations that are one request to one host's service. Each builds
// a fresh connection, so nothing is shared between threads; every failure becomes -1 and a log
// line.
#include <ace/Guard_T.h>

#include "Configuration/ConfigurationRepository.h"
#include "Quorvex/Log.h"
#include "repository/ServiceConnection.h"

namespace Configuration {
namespace {

// Runs call; a std::exception is logged at LM_ERROR with format (whose last %s is the
// exception's text, after the optional argument) and gives -1.
template <class Call>
int guarded(Call&& call, const char* format, const char* argument = nullptr) {
    try {
        call();
        return 0;
    } catch (const std::exception& e) {
        if (argument != nullptr) {
            QUORVEX_LOG(LM_ERROR, format, argument, e.what());
        } else {
            QUORVEX_LOG(LM_ERROR, format, e.what());
        }
        return -1;
    }
}

}  // namespace

int ConfigurationRepository::Retrieve(const ACE_CString& host, const ACE_CString& path,
                                      Quorvex::ByteArray& bytes, std::size_t& length,
                                      BDateTime& timestamp) const {
    if (GetConfigItemTimeStamp(host, path, timestamp) != 0) {
        return -1;
    }
    return guarded(
        [&] { m_connector->connect(m_virtualHostName)->retrieve(host, path, bytes, length); },
        "ConfigurationRepository::Retrieve: Unable to retrieve configuration via http. Standard "
        "Exception: %s\n");
}

int ConfigurationRepository::Store(const ACE_CString& host, const ACE_CString& path,
                                   const unsigned char* bytes, std::size_t length,
                                   const BDateTime&) {
    return guarded(
        [&] { m_connector->connect(GetMasterHostName())->store(host, path, bytes, length, ""); },
        "ConfigurationRepository::Store: Unable to send configuration via http. Standard "
        "Exception: %s\n");
}

int ConfigurationRepository::GetConfigItemTimeStamp(const ACE_CString& host,
                                                    const ACE_CString& path,
                                                    BDateTime& timestamp) const {
    return guarded(
        [&] { m_connector->connect(m_virtualHostName)->getTimeStamp(host, path, timestamp); },
        "ConfigurationRepository::GetConfigItemTimeStamp: Unable to connect to local "
        "configuration web service. Standard Exception: %s\n");
}

int ConfigurationRepository::RegisterService(const ACE_CString& serviceName,
                                             const ACE_CString& connectionString) {
    return guarded(
        [&] {
            m_connector->connect(GetMasterHostName())
                ->registerService(m_virtualHostName, serviceName, connectionString);
        },
        "ConfigurationRepository::RegisterService: Unable to register service %s via http. "
        "Standard Exception: %s\n",
        serviceName.c_str());
}

int ConfigurationRepository::UnregisterService(const ACE_CString&) {
    return 0;
}

int ConfigurationRepository::ListServers(std::vector<ACE_CString>& servers) {
    return guarded([&] { m_connector->connect(m_virtualHostName)->listHosts(servers); },
                   "ConfigurationRepository::ListServers: Unable to get the list of servers via "
                   "http. Standard Exception: %s\n");
}

int ConfigurationRepository::SwitchoverPersistent(const ACE_CString& persistentName) {
    return guarded(
        [&] { m_connector->connect(GetMasterHostName())->switchoverPersistent(persistentName); },
        "ConfigurationRepository::SwitchoverPersistent: Unable to switch over persistent via "
        "http. Standard Exception: %s\n");
}

int ConfigurationRepository::EnableMergeNetworkCapture(bool enable) {
    return guarded(
        [&] {
            m_connector->connect(GetMasterHostName())
                ->enableMergeNetworkCapture(enable, m_virtualHostName);
        },
        "ConfigurationRepository::EnableMergeNetworkCapture: Unable to enable/disable merge "
        "network capture via http. Standard Exception: %s\n");
}

int ConfigurationRepository::Remove(const ACE_CString&, bool) {
    QUORVEX_LOG(LM_INFO, "ConfigurationRepository::Remove: Not implemented\n");
    return 0;
}

void ConfigurationRepository::List(std::vector<std::pair<ACE_CString, BDateTime>>&) const {}

}  // namespace Configuration
