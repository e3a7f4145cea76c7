// Identity, registered hosts, site settings and change signals.
#include "SiteOperations.h"

#include <ace/OS_NS_strings.h>

#include <cstdlib>
#include <set>

#include "Answer.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "ServerInfo.h"

namespace ConfigurationService {
namespace {

bool parseInt(const std::string& text, int& value) {
    if (text.empty()) {
        return false;
    }
    char* end = nullptr;
    const long parsed = std::strtol(text.c_str(), &end, 10);
    if (end != text.c_str() + text.size() || parsed < -2147483647L - 1 || parsed > 2147483647L) {
        return false;
    }
    value = static_cast<int>(parsed);
    return true;
}

Reply done(const std::string& operation) {
    return Reply{200, Answer::success(operation).finish()};
}

}  // namespace

void SiteOperations::registerInto(Operations& table) {
    table.add(
        "GetHostName", [this](const Request& r) { return hostName(r); }, false);
    table.add(
        "GetMasterHostName", [this](const Request& r) { return masterHostName(r); }, false);
    table.add("GetServerInfo", [this](const Request& r) { return serverInfo(r); });
    table.add("ListHosts", [this](const Request& r) { return listHosts(r); });
    table.add("ListHostsByModuleType",
              [this](const Request& r) { return listHostsByModuleType(r); });
    table.add("RegisterService", [this](const Request& r) { return registerService(r); });
    table.add("UnregisterService", [this](const Request& r) { return unregisterService(r); });
    table.add("SwitchoverPersistent", [this](const Request& r) { return switchoverPersistent(r); });
    table.add("EnableMergeNetworkCapture",
              [this](const Request& r) { return enableMergeNetworkCapture(r); });
    table.add("Changed", [this](const Request& r) { return changed(r); });
    table.add("Refresh", [this](const Request& r) { return signal(r); });
    table.add("Restart", [this](const Request& r) { return signal(r); });
}

int SiteOperations::moduleTypeOf(const std::string& connectionString) {
    std::size_t start = 0;
    while (start <= connectionString.size()) {
        std::size_t end = connectionString.find(';', start);
        if (end == std::string::npos) {
            end = connectionString.size();
        }
        const std::string part = connectionString.substr(start, end - start);
        const std::size_t equals = part.find('=');
        int type = 0;
        if (equals != std::string::npos &&
            ACE_OS::strcasecmp(part.substr(0, equals).c_str(), "ModuleType") == 0 &&
            parseInt(part.substr(equals + 1), type)) {
            return type;
        }
        start = end + 1;
    }
    return 0;
}

Reply SiteOperations::hostName(const Request&) {
    return Reply{200,
                 Answer::success("GetHostName").element("HostName", m_context.hostName).finish()};
}

Reply SiteOperations::masterHostName(const Request&) {
    std::string name;
    try {
        name = m_context.master.hostName();
    } catch (const std::exception& e) {
        throw OperationFailed(std::string("the master's host name is not known: ") + e.what(), 502);
    }
    return Reply{200, Answer::success("GetMasterHostName").element("HostName", name).finish()};
}

Reply SiteOperations::serverInfo(const Request&) {
    return Reply{200, Answer::success("GetServerInfo")
                          .element("ServerInfoBlob", ServerInfo::describe(m_context))
                          .finish()};
}

template <class Filter>
Reply SiteOperations::hostList(const std::string& operation, Filter filter) {
    Answer answer = Answer::success(operation);
    std::set<std::string> seen;
    for (const Configuration::ServiceRegistration& r : m_context.store.services()) {
        if (filter(r) && seen.insert(Quorvex::HostKey(r.host.c_str())).second) {
            answer.element("HostName", r.host.c_str());
        }
    }
    return Reply{200, answer.finish()};
}

bool SiteOperations::masterHosts(const int* moduleType, std::vector<std::string>& hosts) {
    if (m_context.master.isMaster()) {
        return false;
    }
    try {
        hosts = m_context.master.listHosts(moduleType);
        return true;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR,
                    "SiteOperations: the master's host list is not available, answering from "
                    "this host's registrations: %s\n",
                    e.what());
        return false;
    }
}

Reply SiteOperations::hostAnswer(const std::string& operation,
                                 const std::vector<std::string>& hosts) {
    Answer answer = Answer::success(operation);
    for (const std::string& host : hosts) {
        answer.element("HostName", host);
    }
    return Reply{200, answer.finish()};
}

Reply SiteOperations::listHosts(const Request&) {
    std::vector<std::string> hosts;
    if (masterHosts(nullptr, hosts)) {
        return hostAnswer("ListHosts", hosts);
    }
    return hostList("ListHosts", [](const Configuration::ServiceRegistration&) { return true; });
}

Reply SiteOperations::listHostsByModuleType(const Request& request) {
    int type = 0;
    if (!parseInt(request.required("ModuleTypeFilter"), type)) {
        throw OperationFailed("ModuleTypeFilter is not a number");
    }
    std::vector<std::string> hosts;
    if (masterHosts(&type, hosts)) {
        return hostAnswer("ListHostsByModuleType", hosts);
    }
    return hostList("ListHostsByModuleType", [type](const Configuration::ServiceRegistration& r) {
        return moduleTypeOf(r.connection.c_str()) == type;
    });
}

Reply SiteOperations::registerService(const Request& request) {
    try {
        m_context.store.registerService(request.required("HostName").c_str(),
                                        request.required("ServiceName").c_str(),
                                        request.optional("ConnectionString").c_str());
    } catch (const std::invalid_argument& e) {
        throw OperationFailed(e.what());
    }
    return done("RegisterService");
}

Reply SiteOperations::unregisterService(const Request& request) {
    const std::string& host = request.required("HostName");
    const std::string& service = request.required("ServiceName");
    if (!m_context.store.unregisterService(host.c_str(), service.c_str())) {
        QUORVEX_LOG(LM_DEBUG, "SiteOperations::unregisterService: %s of %s was not registered\n",
                    service.c_str(), host.c_str());
    }
    return done("UnregisterService");
}

Reply SiteOperations::switchoverPersistent(const Request& request) {
    const std::string& target = request.required("Persistent");
    if (target.empty()) {
        throw OperationFailed("Persistent names no storage");
    }
    m_context.store.setSetting(kPersistentSetting, target.c_str());
    QUORVEX_LOG(LM_INFO, "SiteOperations: persistent storage switched over to %s\n",
                target.c_str());
    return done("SwitchoverPersistent");
}

Reply SiteOperations::enableMergeNetworkCapture(const Request& request) {
    const std::string& enable = request.required("Enable");
    const std::string& host = request.required("Host");
    if (enable != "1" && enable != "0") {
        throw OperationFailed("Enable is \"1\" or \"0\"");
    }
    if (host.empty()) {
        throw OperationFailed("Host names no host");
    }
    m_context.store.setSetting((kCaptureSettingPrefix + Quorvex::HostKey(host)).c_str(),
                               enable.c_str());
    return done("EnableMergeNetworkCapture");
}

Reply SiteOperations::changed(const Request& request) {
    const std::string sender = request.optional("FromServer");
    if (!sender.empty() && ACE_OS::strcasecmp(sender.c_str(), m_context.hostName.c_str()) != 0) {
        QUORVEX_LOG(LM_INFO, "SiteOperations: configuration changed on host %s\n", sender.c_str());
    }
    if (!m_context.master.isMaster()) {
        // The processes woken below re-read from this service: bring it up to date first.
        try {
            const std::size_t copied = m_sync.run();
            QUORVEX_LOG(LM_DEBUG, "SiteOperations: %d changed documents copied from the master\n",
                        static_cast<int>(copied));
        } catch (const std::exception& e) {
            QUORVEX_LOG(LM_ERROR,
                        "SiteOperations: the master's documents could not be copied: %s\n",
                        e.what());
        }
    }
    if (!m_context.changes.signal("Changed from " + (sender.empty() ? "?" : sender))) {
        throw OperationFailed("the change event could not be set", 500);
    }
    return done("Changed");
}

Reply SiteOperations::signal(const Request& request) {
    if (!m_context.changes.signal(request.operation())) {
        throw OperationFailed("the change event could not be set", 500);
    }
    return done(request.operation());
}

}  // namespace ConfigurationService
