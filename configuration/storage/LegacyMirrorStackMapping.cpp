#include "Configuration/LegacyMirrorStackMapping.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void LegacyMirrorStackMapping::fields(Self& self, Io& io) {
    io("MirrorMachineName", self.m_machine);
    io("OldMirrorStackGuid", self.m_oldGuid);
    io("NewMirrorStackGuid", self.m_newGuid);
}

CONFIGURATION_DEFINE(LegacyMirrorStackMapping, LegacyMirrorStackMapping::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

}  // namespace Configuration
