// Configuration::Strategy: a pluggable storage strategy: the library file to load and the
// interface and type inside it. Element "Strategy"; keys in order with defaults: "StrategyName"
// "", "StrategyEnabled" (32-bit flag) 0, "StrategyTypeName" "", "StrategyDllName" "",
// "StrategyInterface" "". Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"

namespace Configuration {

class CONFIGURATION_API Strategy : public virtual Vesk::Serializable {
    CONFIGURATION_CLASS(Strategy);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "Strategy";

    // The strategy's name.
    const ACE_CString& getStrategyName() const { return m_name; }
    void setStrategyName(const ACE_CString& name) { m_name = name; }
    // Whether the strategy is enabled (1) or not (0).
    int getStrategyEnabled() const { return m_enabled; }
    void setStrategyEnabled(int enabled) { m_enabled = enabled; }
    // The type implementing it.
    const ACE_CString& getStrategyTypeName() const { return m_typeName; }
    void setStrategyTypeName(const ACE_CString& name) { m_typeName = name; }
    // The library file holding the type.
    const ACE_CString& getStrategyDllName() const { return m_dllName; }
    void setStrategyDllName(const ACE_CString& name) { m_dllName = name; }
    // The interface the type implements.
    const ACE_CString& getStrategyInterface() const { return m_interface; }
    void setStrategyInterface(const ACE_CString& name) { m_interface = name; }

private:
    ACE_CString m_name;
    int m_enabled = 0;
    ACE_CString m_typeName;
    ACE_CString m_dllName;
    ACE_CString m_interface;
};

}  // namespace Configuration
