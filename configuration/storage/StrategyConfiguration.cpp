#include "Configuration/StrategyConfiguration.h"

#include "Configuration/DocumentNames.h"
#include "Quorvex/Log.h"
#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void StrategyConfiguration::fields(Self& self, Io& io) {
    io("AvailableStrategies",
       Fields::wrapped(Strategy::WELL_KNOWN_NAME, self.m_strategies, Fields::DropFailed));
    io("AvailableStacks",
       Fields::wrapped(StrategyStack::WELL_KNOWN_NAME, self.m_stacks, Fields::DropFailed));
}

CONFIGURATION_DEFINE(StrategyConfiguration, StrategyConfiguration::WELL_KNOWN_NAME,
                     Fields::FailureForm::Failed)

StrategyConfiguration::StrategyConfiguration()
    : TypedConfigDoc(
          ConfigDoc::getConfigurationRegistryPath() + DocumentNames::kStrategyConfiguration,
          false) {}

bool StrategyConfiguration::TryGetActiveStack(StrategyStack& stack) const {
    const StrategyStack* first = nullptr;
    int active = 0;
    for (const StrategyStack& candidate : m_stacks) {
        if (candidate.getIsStackActive() == 1) {
            first = first == nullptr ? &candidate : first;
            ++active;
        }
    }
    if (active > 1) {
        QUORVEX_LOG(LM_CRITICAL,
                    "StrategyConfiguration::TryGetActiveStack: There are more than 1 active stacks "
                    "configured. Please diagnose and use OrvelWeb to reconcile which stack is the "
                    "correct active stack.\n");
    }
    if (first == nullptr) {
        return false;
    }
    stack = *first;
    return true;
}

bool StrategyConfiguration::IsActiveStack(ACE_CString stackUid) const {
    StrategyStack active;
    TryGetActiveStack(active);
    return active.getStackUid() == stackUid;
}

}  // namespace Configuration
