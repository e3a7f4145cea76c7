#include "Configuration/TivoliServerInfo.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void TivoliServerInfo::fields(Self& self, Io& io) {
    io("TivoliStorageManagerServerAddress", self.m_address);
    io("TivoliStorageManagerServerPort", self.m_port);
    io("TivoliServerUserAccount", self.m_user);
    io("TivoliServerAccessPassword", self.m_password);
}

CONFIGURATION_DEFINE(TivoliServerInfo, TivoliServerInfo::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

}  // namespace Configuration
