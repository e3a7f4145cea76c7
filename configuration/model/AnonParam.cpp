#include "Configuration/AnonParam.h"

#include "ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void AnonParam::fields(Self& self, Io& io) {
    io("Tag", self.m_tag);
    io("Value", self.m_value);
    io("Description", self.m_description);
}

CONFIGURATION_DEFINE(AnonParam, "AnonParam", Fields::FailureForm::Failed)

}  // namespace Configuration
