#include "Configuration/ArchiveLocalNodeInfo.h"

#include "Configuration/ArchiveNotConfiguredException.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void ArchiveLocalNodeInfo::fields(Self& self, Io& io) {
    io("ArchiveLocalNodeName", self.m_name);
    io("TivoliNodesConfiguration",
       Fields::wrapped(TivoliNodeInfo::WELL_KNOWN_NAME, self.m_nodes, Fields::DropFailed,
                       &TivoliNodeInfo::getTivoliServer));
}

CONFIGURATION_DEFINE(ArchiveLocalNodeInfo, ArchiveLocalNodeInfo::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

const TivoliNodeInfo& ArchiveLocalNodeInfo::getTivoliNodeInfo(const ACE_CString& server) const {
    const auto it = m_nodes.find(server);
    if (it == m_nodes.end()) {
        throw ArchiveNotConfiguredException(
            std::string("Unable to find Tivoli node configuration for ") + server.c_str());
    }
    return it->second;
}

const TivoliNodeInfo& ArchiveLocalNodeInfo::getDefaultTivoliNodeInfo() const {
    if (m_nodes.empty()) {
        throw ArchiveNotConfiguredException("Unable to find Tivoli node configuration for default");
    }
    return m_nodes.begin()->second;
}

}  // namespace Configuration
