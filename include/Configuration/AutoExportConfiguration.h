// Configuration::AutoExportConfiguration: the site-wide document "AutoExport": the automatic
// export rules, the feature's switch and its retry settings.
//
// Element "AutoExport"; keys, read in this order: "AutoExportRules" (one "AutoExportRule" each;
// required: its absence is a logged read failure that ends the read; without a value the rules
// stay as they were; a rule whose read fails, one without a name for instance, is dropped and
// makes the read incomplete), "Enabled" (flag, false), "MaxRetries" (int, 5), "RetryDelay" (int,
// 10). Failures are logged as "AutoExportConfiguration::readVesk: Failed. Standard Exception:
// %s\n". Read-only: writeVesk throws std::exception
// ("AutoExportConfiguration::writeVesk - Class cannot be serialized.").
// Plain value owned by its caller; not thread-safe. The static members are thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/AutoExportRule.h"
#include "Configuration/ConfigurationClass.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API AutoExportConfiguration : public TypedConfigDoc<AutoExportConfiguration> {
    CONFIGURATION_CLASS(AutoExportConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "AutoExport";
    // Whether the automatic export feature is switched off in this build: it is not.
    static constexpr bool AUTOEXPORT_FEATURE_TURNED_OFF = false;

    // The site-wide document "AutoExport": disabled, 5 retries, retry delay 10, no rules.
    AutoExportConfiguration();

    // Whether the feature is switched off; always false.
    static bool IsAutoExportFeatureTurnedOff() { return AUTOEXPORT_FEATURE_TURNED_OFF; }

    // The rules, in stored order.
    const std::vector<AutoExportRule>& getRules() const { return m_rules; }
    void setRules(const std::vector<AutoExportRule>& rules) { m_rules = rules; }
    // Whether automatic export runs.
    bool getEnabled() const { return m_enabled; }
    void setEnabled(bool enabled) { m_enabled = enabled; }
    // How often a failed automatic export is retried.
    int getMaxRetries() const { return m_maxRetries; }
    void setMaxRetries(int count) { m_maxRetries = count; }
    // The delay between retries (the export server's unit).
    int getRetryDelay() const { return m_retryDelay; }
    void setRetryDelay(int delay) { m_retryDelay = delay; }

    // True when any rule, enabled or not, names that destination (case ignored).
    bool isDestinationUsed(const ACE_CString& name) const;
    // Removes every rule.
    void clear() { m_rules.clear(); }

private:
    std::vector<AutoExportRule> m_rules;
    bool m_enabled = false;
    int m_maxRetries = 5;
    int m_retryDelay = 10;
};

}  // namespace Configuration
