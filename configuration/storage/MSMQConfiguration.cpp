#include "Configuration/MSMQConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "Quorvex/Host.h"
#include "model/ClassDefinition.h"

namespace Configuration {
namespace {

ACE_CString localQueue(const char* name) {
    return MSMQConfiguration::BuildQueue(ConfigDoc::getLocalHostName(), name);
}

}  // namespace

template <class Self, class Io>
void MSMQConfiguration::fields(Self& self, Io& io) {
    io("LocalAdminQueue", self.m_adminQueue);
    io("LocalInboundQueue", self.m_inboundQueue);
    io("LocalErrorQueue", self.m_errorQueue);
    io("SendToLocalWorkListService", self.m_sendToWorkList);
    io("ResetQueueSecurity", self.m_resetSecurity);
}

CONFIGURATION_DEFINE(MSMQConfiguration, MSMQConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

MSMQConfiguration::MSMQConfiguration()
    : TypedConfigDoc(ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kMsmq, true),
      m_adminQueue(localQueue("quorvexadmin")),
      m_inboundQueue(localQueue("quorvexin")),
      m_errorQueue(localQueue("quorvexerror")) {}

ACE_CString MSMQConfiguration::BuildQueue(const ACE_CString& host, const ACE_CString& name) {
    return "DIRECT=OS:" + host + "\\private$\\" + name;
}

ACE_CString MSMQConfiguration::QuorvexInputQueueFromHost(const ACE_CString& host) {
    return BuildQueue(host, "quorvexin");
}

ACE_CString MSMQConfiguration::QuorvexWorkListInputQueueFromHost(const ACE_CString& host) {
    return BuildQueue(host, "quorvexQueueMonitorIn");
}

ACE_CString MSMQConfiguration::LocalQuorvexWorkFlowNormalPriorityQueueName() {
    return BuildQueue(Quorvex::GetHostName(false), "quorvexWorkFlowNormal");
}

ACE_CString MSMQConfiguration::LocalQuorvexWorkFlowLowPriorityQueueName() {
    return BuildQueue(Quorvex::GetHostName(false), "quorvexWorkFlowLow");
}

bool MSMQConfiguration::ParseDirectFormattedMSMQ(const ACE_CString& queue, ACE_CString& host,
                                                 ACE_CString& name) {
    const ACE_CString::size_type colon = queue.find(':');
    const ACE_CString::size_type backslash = queue.find('\\');
    if (colon == ACE_CString::npos || backslash == ACE_CString::npos || backslash < colon) {
        return false;
    }
    host = queue.substring(colon + 1, backslash - colon - 1);
    name = queue.substring(backslash + 1);
    return true;
}

ACE_CString MSMQConfiguration::HostFromQueue(const ACE_CString& queue) {
    ACE_CString host;
    ACE_CString name;
    return ParseDirectFormattedMSMQ(queue, host, name) ? host : ACE_CString();
}

}  // namespace Configuration
