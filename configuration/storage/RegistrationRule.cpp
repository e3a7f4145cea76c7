#include "Configuration/RegistrationRule.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void RegistrationRule::fields(Self& self, Io& io) {
    io("AE_Title", self.m_key);
    io("CalyraNorm", self.m_norm);
    io("CalyraLow", self.m_low);
    io("Convertin", self.m_convertin);
    io("OtherQueue", self.m_other);
}

CONFIGURATION_DEFINE(RegistrationRule, RegistrationRule::WELL_KNOWN_NAME,
                     Fields::FailureForm::PartialDefaultsNoStop)

}  // namespace Configuration
