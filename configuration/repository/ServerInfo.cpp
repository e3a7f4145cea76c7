#include "Configuration/ServerInfo.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void ServerInfo::fields(Self& self, Io& io) {
    io("HostName", self.m_hostName);
    io("MasterHostName", self.m_masterHostName);
    io("IsMaster", self.m_isMaster);
    io("MasterAddress", Fields::optional(self.m_masterAddress));
    io("Version", Fields::optional(self.m_version));
    io("StoreDirectory", Fields::optional(self.m_storeDirectory));
    io("ItemCount", Fields::optional(self.m_itemCount));
    io("RegisteredServices", Fields::optional(self.m_registeredServices));
    io("StartTime", Fields::optional(self.m_startTime));
    io("UptimeSeconds", Fields::optional(self.m_uptimeSeconds));
    io("Port", Fields::optional(self.m_port));
}

CONFIGURATION_DEFINE(ServerInfo, "ServerInfo", Fields::FailureForm::Failed)

}  // namespace Configuration
