#include "Configuration/Strategy.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void Strategy::fields(Self& self, Io& io) {
    io("StrategyName", self.m_name);
    io("StrategyEnabled", self.m_enabled);
    io("StrategyTypeName", self.m_typeName);
    io("StrategyDllName", self.m_dllName);
    io("StrategyInterface", self.m_interface);
}

CONFIGURATION_DEFINE(Strategy, Strategy::WELL_KNOWN_NAME, Fields::FailureForm::Failed)

}  // namespace Configuration
