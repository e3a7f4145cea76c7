// Configuration::RegistrationRule: on which suite queues the studies of one sender are
// registered. Element "RegistrationRule"; keys in order with defaults: "AE_Title" "",
// "CalyraNorm" false, "CalyraLow" false, "Convertin" false (the suite's normal-priority,
// low-priority and conversion-in queues of MSMQCommonConfiguration), "OtherQueue" "" (a queue in
// direct format). Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API RegistrationRule : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(RegistrationRule);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "RegistrationRule";

    RegistrationRule() = default;
    // The rule of sender key with its queue selections.
    RegistrationRule(const ACE_CString& key, bool norm, bool low, bool convertin,
                     const ACE_CString& otherQueue)
        : m_key(key), m_norm(norm), m_low(low), m_convertin(convertin), m_other(otherQueue) {}

    // The sender's AE title.
    const ACE_CString& key() const { return m_key; }
    void key(const ACE_CString& key) { m_key = key; }
    // Whether studies are registered on the normal-priority suite queue.
    bool CalyraNormSelected() const { return m_norm; }
    void selectCalyraNorm(bool selected) { m_norm = selected; }
    // Whether studies are registered on the low-priority suite queue.
    bool CalyraLowSelected() const { return m_low; }
    void selectCalyraLow(bool selected) { m_low = selected; }
    // Whether studies are registered on the conversion-in queue.
    bool CalyraConvertinSelected() const { return m_convertin; }
    void selectCalyraConvertin(bool selected) { m_convertin = selected; }
    // A further queue studies are registered on ("" when none).
    const ACE_CString& otherQueue() const { return m_other; }
    void otherQueue(const ACE_CString& queue) { m_other = queue; }

private:
    ACE_CString m_key;
    bool m_norm = false;
    bool m_low = false;
    bool m_convertin = false;
    ACE_CString m_other;
};

}  // namespace Configuration
