// Configuration::MSMQConfiguration: the message queues of one machine (per-machine document
// "Msmq", element "MSMQ"), and the static operations that build and parse queue names in direct
// format ("DIRECT=OS:" + host + "\private$\" + queue).
//
// Keys in order, with defaults (<host> is ConfigDoc::getLocalHostName()):
//   "LocalAdminQueue"            "DIRECT=OS:<host>\private$\quorvexadmin"
//   "LocalInboundQueue"          "DIRECT=OS:<host>\private$\quorvexin"
//   "LocalErrorQueue"            "DIRECT=OS:<host>\private$\quorvexerror"
//   "SendToLocalWorkListService" flag, false
//   "ResetQueueSecurity"         list of queue names (repeated children), empty
// The object is a plain value owned by its caller and not thread-safe; the static operations
// are thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API MSMQConfiguration : public TypedConfigDoc<MSMQConfiguration> {
    CONFIGURATION_CLASS(MSMQConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "MSMQ";

    // The per-machine document "Msmq" with the local host's queues.
    MSMQConfiguration();

    // "DIRECT=OS:" + host + "\private$\" + name.
    static ACE_CString BuildQueue(const ACE_CString& host, const ACE_CString& name);
    // The input queue "quorvexin" of host.
    static ACE_CString QuorvexInputQueueFromHost(const ACE_CString& host);
    // The work-list input queue "quorvexQueueMonitorIn" of host.
    static ACE_CString QuorvexWorkListInputQueueFromHost(const ACE_CString& host);
    // The normal-priority work-flow queue of this machine (short host name).
    static ACE_CString LocalQuorvexWorkFlowNormalPriorityQueueName();
    // The low-priority work-flow queue of this machine (short host name).
    static ACE_CString LocalQuorvexWorkFlowLowPriorityQueueName();
    // Splits a direct-format name at its first ':' and first '\' (which must follow the colon):
    // host is the text between them, name everything after the backslash. False (outputs
    // untouched) when the name has no such shape.
    static bool ParseDirectFormattedMSMQ(const ACE_CString& queue, ACE_CString& host,
                                         ACE_CString& name);
    // The host part of a direct-format name; "" when it is not one.
    static ACE_CString HostFromQueue(const ACE_CString& queue);

    // This machine's administration queue.
    const ACE_CString& getLocalAdminQueue() const { return m_adminQueue; }
    void setLocalAdminQueue(const ACE_CString& queue) { m_adminQueue = queue; }
    // This machine's inbound queue.
    const ACE_CString& getLocalInboundQueue() const { return m_inboundQueue; }
    void setLocalInboundQueue(const ACE_CString& queue) { m_inboundQueue = queue; }
    // This machine's error queue.
    const ACE_CString& getLocalErrorQueue() const { return m_errorQueue; }
    void setLocalErrorQueue(const ACE_CString& queue) { m_errorQueue = queue; }
    // Whether messages also go to this machine's work-list service.
    bool getSendToLocalWorkListService() const { return m_sendToWorkList; }
    void setSendToLocalWorkListService(bool send) { m_sendToWorkList = send; }
    // The queues whose security is reset when the machine starts.
    const std::vector<ACE_CString>& getResetQueueSecurity() const { return m_resetSecurity; }
    void setResetQueueSecurity(const std::vector<ACE_CString>& queues) { m_resetSecurity = queues; }

private:
    ACE_CString m_adminQueue;
    ACE_CString m_inboundQueue;
    ACE_CString m_errorQueue;
    bool m_sendToWorkList = false;
    std::vector<ACE_CString> m_resetSecurity;
};

}  // namespace Configuration
