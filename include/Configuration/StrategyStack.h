// Configuration::StrategyStack: one storage stack of the site and its life-cycle flags (a new
// stack is unused until it is included, activated and later retired). Element "StrategyStack";
// keys in order with defaults: "StackUid" "" (GUID text), "IsStackIncludedInStrategy" 0,
// "IsStackActive" 0, "IsStackRetired" 0, "IsStackUnused" 1 (32-bit flags), "SequenceNumber" 0,
// "StackActivatedDateTime" "", "StackRetiredDateTime" "" (texts as the administration tool
// wrote them). Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API StrategyStack : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(StrategyStack);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "StrategyStack";

    // The stack's UID, which is also the host of its input queue.
    const ACE_CString& getStackUid() const { return m_uid; }
    void setStackUid(const ACE_CString& uid) { m_uid = uid; }
    // Whether the stack takes part in the strategy.
    int getStackIncludedInStrategy() const { return m_included; }
    void setStackIncludedInStrategy(int included) { m_included = included; }
    // Whether the stack is the active one (only exactly 1 counts).
    int getIsStackActive() const { return m_active; }
    void setIsStackActive(int active) { m_active = active; }
    // Whether the stack is retired.
    int getIsStackRetired() const { return m_retired; }
    void setIsStackRetired(int retired) { m_retired = retired; }
    // Whether the stack has never been used.
    int getIsStackUnused() const { return m_unused; }
    void setIsStackUnused(int unused) { m_unused = unused; }
    // The stack's place in the sequence of stacks.
    int getSequenceNumber() const { return m_sequence; }
    void setSequenceNumber(int sequence) { m_sequence = sequence; }
    // When the stack was activated, as text.
    const ACE_CString& getStackActivatedDateTime() const { return m_activated; }
    void setStackActivatedDateTime(const ACE_CString& when) { m_activated = when; }
    // When the stack was retired, as text.
    const ACE_CString& getStackRetiredDateTime() const { return m_retiredAt; }
    void setStackRetiredDateTime(const ACE_CString& when) { m_retiredAt = when; }

private:
    ACE_CString m_uid;
    int m_included = 0;
    int m_active = 0;
    int m_retired = 0;
    int m_unused = 1;
    int m_sequence = 0;
    ACE_CString m_activated;
    ACE_CString m_retiredAt;
};

}  // namespace Configuration
