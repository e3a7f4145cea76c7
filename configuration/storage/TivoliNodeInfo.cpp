#include "Configuration/TivoliNodeInfo.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void TivoliNodeInfo::fields(Self& self, Io& io) {
    io("TivoliServer", self.m_server);
    io("TivoliServerBlockTransferSize", self.m_blockSize);
    io("NumberThreads", self.m_threads);
    io("TivoliSessionTimeout", self.m_sessionTimeout);
    io("UnarchivedStudiesPollingInterval", self.m_pollingInterval);
}

CONFIGURATION_DEFINE(TivoliNodeInfo, TivoliNodeInfo::WELL_KNOWN_NAME, Fields::FailureForm::Failed)

}  // namespace Configuration
