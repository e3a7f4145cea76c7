// ConfigurationRepository: change signals and the copy of the master's documents to this host.
#include <ace/OS_NS_strings.h>

#include "Configuration/ConfigurationRepository.h"
#include "Quorvex/Log.h"
#include "Store/ItemDiff.h"
#include "repository/ServiceConnection.h"

namespace Configuration {
namespace {

bool sameHost(const ACE_CString& a, const ACE_CString& b) {
    return ACE_OS::strcasecmp(a.c_str(), b.c_str()) == 0;
}

}  // namespace

void ConfigurationRepository::SignalChanged() {
    std::vector<ACE_CString> hosts;
    ACE_CString localName;
    try {
        std::unique_ptr<ServiceConnection> local = m_connector->connect(m_virtualHostName);
        localName = local->hostName();
        local->listHosts(hosts);
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "ConfigurationRepository::SignalChanged: Unable to connect to local "
                    "configuration web service. Standard Exception: %s\n",
                    e.what());
        return;
    }
    for (const ACE_CString& host : hosts) {
        try {
            std::unique_ptr<ServiceConnection> remote = m_connector->connect(host);
            if (!sameHost(remote->hostName(), localName)) {
                QUORVEX_LOG(LM_DEBUG, "ConfigurationRepository::SignalChanged: Signaling host %s\n",
                            host.c_str());
                remote->signalChanged();
            }
        } catch (const std::exception& e) {
            QUORVEX_LOG(LM_DEBUG,
                        "ConfigurationRepository::SignalChanged: Unable to signal configuration "
                        "changed to host %s. Standard Exception: %s\n",
                        host.c_str(), e.what());
        }
    }
}

void ConfigurationRepository::signalLocal(void (*call)(ServiceConnection&), const char* failure) {
    try {
        call(*m_connector->connect(m_virtualHostName));
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR, failure, e.what());
    }
}

void ConfigurationRepository::SignalRefresh() {
    signalLocal([](ServiceConnection& c) { c.signalRefresh(); },
                "ConfigurationRepository::SignalRefresh: Unable to connect to local configuration "
                "web service. Standard Exception: %s\n");
}

void ConfigurationRepository::SignalRestart() {
    signalLocal([](ServiceConnection& c) { c.signalRestart(); },
                "ConfigurationRepository::SignalRestart: Unable to connect to local configuration "
                "web service. Standard Exception: %s\n");
}

int ConfigurationRepository::CacheMasterWebToLocalWeb() {
    std::vector<_HttpConfigurationItemInfo> missing;
    std::unique_ptr<ServiceConnection> master;
    std::unique_ptr<ServiceConnection> local;
    try {
        master = m_connector->connect(GetMasterHostName());
        local = m_connector->connect(m_virtualHostName);
        if (sameHost(master->hostName(), local->hostName())) {
            return 0;
        }
        std::vector<_HttpConfigurationItemInfo> masterItems;
        std::vector<_HttpConfigurationItemInfo> localItems;
        master->listItems("*", masterItems);
        local->listItems("*", localItems);
        missing = itemsMissingLocally(std::move(masterItems), std::move(localItems));
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR,
                    "ConfigurationRepository::CacheMasterWebToLocalWeb: Unable to list the "
                    "configurations. Standard Exception: %s\n",
                    e.what());
        return -1;
    }
    int result = 0;
    for (const _HttpConfigurationItemInfo& item : missing) {
        QUORVEX_LOG(LM_DEBUG,
                    "ConfigurationRepository::CacheMasterWebToLocalWeb: Retrieving config %s for "
                    "host %s from master\n",
                    item.configurationName.c_str(), item.host.c_str());
        try {
            Quorvex::ByteArray bytes;
            std::size_t length = 0;
            master->retrieve(item.host, item.configurationName, bytes, length);
            local->store(item.host, item.configurationName, bytes.get(), length,
                         item.lastModifiedTime);
        } catch (const std::exception& e) {
            // One item that cannot be copied does not stop the others; the result says so.
            QUORVEX_LOG(LM_ERROR,
                        "ConfigurationRepository::CacheMasterWebToLocalWeb: Unable to copy config "
                        "%s for host %s. Standard Exception: %s\n",
                        item.configurationName.c_str(), item.host.c_str(), e.what());
            result = -1;
        }
    }
    return result;
}

}  // namespace Configuration
