// Configuration::ArchiveLocalNodeInfo: an archive node (the client node name under which the
// archive registers with Tivoli servers) and its settings per server. Element
// "ArchiveLocalNodeInfo"; keys in order: "ArchiveLocalNodeName" ("", required: a node without it
// is a read failure "Archive node name was not found.") and "TivoliNodesConfiguration" holding
// one "TivoliNodeInfo" per server, kept by server address in address order (a later item for the
// same server replaces an earlier one; an item that does not read complete is left out).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <map>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TivoliNodeInfo.h"

namespace Configuration {

class CONFIGURATION_API ArchiveLocalNodeInfo : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(ArchiveLocalNodeInfo);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "ArchiveLocalNodeInfo";
    // Server address to the node's settings for it.
    using NodeInfos = std::map<ACE_CString, TivoliNodeInfo>;

    // The node's name.
    const ACE_CString& getLocalNodeName() const { return m_name; }
    void setLocalNodeName(const ACE_CString& name) { m_name = name; }
    // The node's settings per server.
    const NodeInfos& getTivoliNodeInfos() const { return m_nodes; }
    void setTivoliNodeInfos(const NodeInfos& nodes) { m_nodes = nodes; }
    // The node's settings for server; throws ArchiveNotConfiguredException when there are none.
    const TivoliNodeInfo& getTivoliNodeInfo(const ACE_CString& server) const;
    // The settings of the smallest server address; throws ArchiveNotConfiguredException when the
    // node has none.
    const TivoliNodeInfo& getDefaultTivoliNodeInfo() const;

private:
    ACE_CString m_name;
    NodeInfos m_nodes;
};

}  // namespace Configuration
