#include "Configuration/ArchiveNodeStackInfo.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void ArchiveNodeStackInfo::fields(Self& self, Io& io) {
    io("StackUid", self.m_stackUid);
    io("TivoliServer", self.m_server);
    io("ArchiveLocalNodeName", self.m_node);
    io("ArchiveFilespaceName", self.m_filespace);
}

CONFIGURATION_DEFINE(ArchiveNodeStackInfo, ArchiveNodeStackInfo::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

}  // namespace Configuration
