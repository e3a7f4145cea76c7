// Configuration::RemoteSCPConfiguration: the identity of a remote DICOM node, and the base of
// every remote-node class (export destinations, query archives, storage commitment nodes).
//
// Element "RemoteScp"; keys in order, all strings and required: "RemoteHostDescription" (empty),
// "RemoteDICOMSCPAETitle" (empty), "HostName" (empty), "Port" ("104": the remote port is kept as
// text, as configured). A derived class keeps these four keys in its own child "RemoteScp", one
// level below its own keys, read and written by this class's readVesk and writeVesk.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API RemoteSCPConfiguration : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(RemoteSCPConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "RemoteScp";

    // Free text naming the node for people (export destinations are named by it).
    const ACE_CString& getRemoteHostDescription() const { return m_description; }
    void setRemoteHostDescription(const ACE_CString& text) { m_description = text; }
    // The node's AE title.
    const ACE_CString& getAETitle() const { return m_aeTitle; }
    void setAETitle(const ACE_CString& title) { m_aeTitle = title; }
    // The node's host name or address.
    const ACE_CString& getHostName() const { return m_hostName; }
    void setHostName(const ACE_CString& name) { m_hostName = name; }
    // The node's port, as text.
    const ACE_CString& getPort() const { return m_port; }
    void setPort(const ACE_CString& port) { m_port = port; }

private:
    ACE_CString m_description;
    ACE_CString m_aeTitle;
    ACE_CString m_hostName;
    ACE_CString m_port = "104";
};

}  // namespace Configuration
