#include "Configuration/StrategyStack.h"

#include "model/ClassDefinition.h"

namespace Configuration {

template <class Self, class Io>
void StrategyStack::fields(Self& self, Io& io) {
    io("StackUid", self.m_uid);
    io("IsStackIncludedInStrategy", self.m_included);
    io("IsStackActive", self.m_active);
    io("IsStackRetired", self.m_retired);
    io("IsStackUnused", self.m_unused);
    io("SequenceNumber", self.m_sequence);
    io("StackActivatedDateTime", self.m_activated);
    io("StackRetiredDateTime", self.m_retiredAt);
}

CONFIGURATION_DEFINE(StrategyStack, StrategyStack::WELL_KNOWN_NAME, Fields::FailureForm::Failed)

}  // namespace Configuration
