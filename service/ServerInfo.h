// ServerInfo: the server-information element answered in "ServerInfoBlob": a tree "ServerInfo"
// with single-valued children "HostName", "MasterHostName", "IsMaster", "MasterAddress",
// "Version", "StoreDirectory", "ItemCount", "RegisteredServices", "StartTime",
// "UptimeSeconds" and "Port", written in the element tree's XML form. Stateless; thread-safe.
#pragma once

#include <string>

#include "ServiceContext.h"

namespace ConfigurationService {

class ServerInfo {
public:
    // The XML text of the element for this service (not yet escaped for the answer).
    static std::string describe(ServiceContext& context);
};

}  // namespace ConfigurationService
