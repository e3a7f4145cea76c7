// Configuration::ArchiveNodeStackInfo: through which node, server and file space one storage
// stack is archived. Element "ArchiveNodeStackInfo"; keys in order, strings with default "":
// "StackUid", "TivoliServer", "ArchiveLocalNodeName", "ArchiveFilespaceName".
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API ArchiveNodeStackInfo : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ArchiveNodeStackInfo);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "ArchiveNodeStackInfo";

    // The storage stack archived.
    const ACE_CString& getStackUid() const { return m_stackUid; }
    void setStackUid(const ACE_CString& uid) { m_stackUid = uid; }
    // The address of the Tivoli server it is archived to.
    const ACE_CString& getTivoliServer() const { return m_server; }
    void setTivoliServer(const ACE_CString& server) { m_server = server; }
    // The archive node it is archived through.
    const ACE_CString& getLocalNodeName() const { return m_node; }
    void setLocalNodeName(const ACE_CString& node) { m_node = node; }
    // The file space on the server.
    const ACE_CString& getArchiveFilespaceName() const { return m_filespace; }
    void setArchiveFilespaceName(const ACE_CString& name) { m_filespace = name; }

private:
    ACE_CString m_stackUid;
    ACE_CString m_server;
    ACE_CString m_node;
    ACE_CString m_filespace;
};

}  // namespace Configuration
