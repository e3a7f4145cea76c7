// Configuration::StrategyConfiguration: the site-wide document "StrategyConfiguration" (element
// "StrategyConfiguration"): the storage strategies that exist and the storage stacks of the
// site; its one decision the rest of the library relies on is which stack is the active one.
//
// Keys in order: "AvailableStrategies" ("Strategy" items) and "AvailableStacks"
// ("StrategyStack" items), both empty by default. An item that does not read complete is left
// out (its neighbours are kept) and makes the read incomplete.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/Strategy.h"
#include "Configuration/StrategyStack.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API StrategyConfiguration : public TypedConfigDoc<StrategyConfiguration> {
    CONFIGURATION_CLASS(StrategyConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "StrategyConfiguration";

    // The site-wide document "StrategyConfiguration" with no strategy and no stack.
    StrategyConfiguration();

    // The strategies, in document order.
    const std::vector<Strategy>& getAvailableStrategies() const { return m_strategies; }
    void setAvailableStrategies(const std::vector<Strategy>& strategies) {
        m_strategies = strategies;
    }
    // The stacks, in document order.
    const std::vector<StrategyStack>& getAvailableStacks() const { return m_stacks; }
    void setAvailableStacks(const std::vector<StrategyStack>& stacks) { m_stacks = stacks; }

    // Copies the first stack whose active flag is exactly 1 to stack; logs critically when more
    // than one is active. False (stack untouched) when none is.
    bool TryGetActiveStack(StrategyStack& stack) const;
    // Whether stackUid is the active stack's UID ("" is, when no stack is active).
    bool IsActiveStack(ACE_CString stackUid) const;

private:
    std::vector<Strategy> m_strategies;
    std::vector<StrategyStack> m_stacks;
};

}  // namespace Configuration
