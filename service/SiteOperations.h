// SiteOperations: the operations about this service and the site: "GetHostName",
// "GetMasterHostName", "GetServerInfo", "ListHosts", "ListHostsByModuleType", "RegisterService",
// "UnregisterService", "SwitchoverPersistent", "EnableMergeNetworkCapture", and the change
// signals "Changed", "Refresh" and "Restart", which set this machine's change event. On a slave,
// "Changed" first copies the master's changed documents here, and the host lists are the
// master's. Holds only a reference to the context; thread-safe.
#pragma once

#include <string>
#include <vector>

#include "MasterSync.h"
#include "Operations.h"
#include "ServiceContext.h"

namespace ConfigurationService {

class SiteOperations {
public:
    // Setting keys kept in the store's site settings.
    static constexpr const char* kPersistentSetting = "PersistentStorage";
    static constexpr const char* kCaptureSettingPrefix = "MergeNetworkCapture:";

    explicit SiteOperations(ServiceContext& context) : m_context(context), m_sync(context) {}
    // Adds the operations to the table.
    void registerInto(Operations& table);

    // The module type a connection string declares ("ModuleType=<n>" among its ';'-separated
    // parts), or 0.
    static int moduleTypeOf(const std::string& connectionString);

private:
    Reply hostName(const Request& request);
    Reply masterHostName(const Request& request);
    Reply serverInfo(const Request& request);
    Reply listHosts(const Request& request);
    Reply listHostsByModuleType(const Request& request);
    Reply registerService(const Request& request);
    Reply unregisterService(const Request& request);
    Reply switchoverPersistent(const Request& request);
    Reply enableMergeNetworkCapture(const Request& request);
    Reply changed(const Request& request);
    Reply signal(const Request& request);

    // The registered hosts (first spelling, registration order) whose services pass filter.
    template <class Filter>
    Reply hostList(const std::string& operation, Filter filter);
    // On a slave, the master's host list (the site's registrations live there); false, after a
    // log line, when the master cannot be asked.
    bool masterHosts(const int* moduleType, std::vector<std::string>& hosts);
    static Reply hostAnswer(const std::string& operation, const std::vector<std::string>& hosts);

    ServiceContext& m_context;
    MasterSync m_sync;
};

}  // namespace ConfigurationService
