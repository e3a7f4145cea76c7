#include "Configuration/DMWLTarget.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void DMWLTarget::fields(Self& self, Io& io) {
    io("AeTitle", self.m_aeTitle);
    io("Port", self.m_port);
}

CONFIGURATION_DEFINE(DMWLTarget, "DMWLTarget", Fields::FailureForm::Failed)

}  // namespace Configuration
