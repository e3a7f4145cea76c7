// Configuration::KelExportConfigurationAdapter: the export module's global settings for older
// callers: the same site-wide document "KelExport" as KelExportGlobalConfiguration, read and
// written by the global configuration it holds (its read failures are logged under that class's
// name). It holds nothing else.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/AnonParam.h"
#include "Configuration/ConfigurationClass.h"
#include "Configuration/KelExportGlobalConfiguration.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API KelExportConfigurationAdapter
    : public TypedConfigDoc<KelExportConfigurationAdapter> {
    CONFIGURATION_CLASS(KelExportConfigurationAdapter);

public:
    // The site-wide document "KelExport" with every value at its default.
    KelExportConfigurationAdapter();

    // How long a command's status is kept.
    unsigned short getCommandStatusLifetime() const { return m_global.getCommandStatusLifetime(); }
    void setCommandStatusLifetime(unsigned short value) {
        m_global.setCommandStatusLifetime(value);
    }
    // How often a failed export is retried (key "MaximumNumberOfRetries").
    unsigned short getMaxNumberOfRetries() const { return m_global.getMaximumNumberOfRetries(); }
    void setMaxNumberOfRetries(unsigned short value) { m_global.setMaximumNumberOfRetries(value); }
    // The delay between retries.
    unsigned short getRetryDelay() const { return m_global.getRetryDelay(); }
    void setRetryDelay(unsigned short value) { m_global.setRetryDelay(value); }
    // How often the servers poll for work.
    unsigned short getPollInterval() const { return m_global.getPollInterval(); }
    void setPollInterval(unsigned short value) { m_global.setPollInterval(value); }
    // How often the servers report their status.
    int getServiceStatusReportingFrequency() const {
        return m_global.getServiceStatusReportingFrequency();
    }
    void setServiceStatusReportingFrequency(int value) {
        m_global.setServiceStatusReportingFrequency(value);
    }
    // The OID of the authority issuing the citizen service number.
    ACE_CString getBsnIssuerId() const { return m_global.getBsnIssuerId(); }
    void setBsnIssuerId(ACE_CString oid) { m_global.setBsnIssuerId(oid); }
    // Whether the citizen service number is handled.
    bool getEnableBsn() const { return m_global.getEnableBsn(); }
    void setEnableBsn(bool enable) { m_global.setEnableBsn(enable); }
    // The anonymisation parameters, in stored order.
    const std::vector<AnonParam>& getAnonymizationParams() const {
        return m_global.getAnonymizationParams();
    }

private:
    KelExportGlobalConfiguration m_global;
};

}  // namespace Configuration
