// Configuration::KelExportGlobalConfiguration: the site-wide document "KelExport": settings every
// export server shares: lifetimes, retries and polling, the citizen service number (BSN), the
// anonymisation parameters and the database section.
//
// Element "KelExport"; keys in order, with defaults, all required: "CommandStatusLifetime" (24),
// "MaximumNumberOfRetries" (18), "RetryDelay" (10), "ExecutionTimeout" (120),
// "LifetimeBeforeArchive" (30), "LifetimeInArchiveBeforePurge" (90), "PollInterval" (20) (all
// unsigned short), "ServiceStatusReportingFrequency" (int, 6), "BsnIssuerId" (the OID of the
// Dutch BSN, "2.16.840.1.113883.2.4.6.3"), "EnableBsn" (false), "AnonymizationParams" (one
// "AnonParam" each; an incomplete one is dropped; the child's absence is a logged read failure
// that ends the read), "DatabaseConfiguration" (KelExportDatabaseConfiguration).
// The same stored document is read by KelExportConfigurationAdapter.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/AnonParam.h"
#include "Configuration/ConfigurationClass.h"
#include "Configuration/KelExportDatabaseConfiguration.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API KelExportGlobalConfiguration
    : public TypedConfigDoc<KelExportGlobalConfiguration> {
    CONFIGURATION_CLASS(KelExportGlobalConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "KelExport";

    // The site-wide document "KelExport" with every value at its default.
    KelExportGlobalConfiguration();

    // How long a command's status is kept.
    unsigned short getCommandStatusLifetime() const { return m_commandStatusLifetime; }
    void setCommandStatusLifetime(unsigned short value) { m_commandStatusLifetime = value; }
    // How often a failed export is retried.
    unsigned short getMaximumNumberOfRetries() const { return m_maximumNumberOfRetries; }
    void setMaximumNumberOfRetries(unsigned short value) { m_maximumNumberOfRetries = value; }
    // The delay between retries.
    unsigned short getRetryDelay() const { return m_retryDelay; }
    void setRetryDelay(unsigned short value) { m_retryDelay = value; }
    // How long one export may run.
    unsigned short getExecutionTimeout() const { return m_executionTimeout; }
    void setExecutionTimeout(unsigned short value) { m_executionTimeout = value; }
    // How long a finished command stays before it is archived.
    unsigned short getLifetimeBeforeArchive() const { return m_lifetimeBeforeArchive; }
    void setLifetimeBeforeArchive(unsigned short value) { m_lifetimeBeforeArchive = value; }
    // How long an archived command stays before it is purged.
    unsigned short getLifetimeInArchiveBeforePurge() const { return m_lifetimeInArchive; }
    void setLifetimeInArchiveBeforePurge(unsigned short value) { m_lifetimeInArchive = value; }
    // How often the servers poll for work.
    unsigned short getPollInterval() const { return m_pollInterval; }
    void setPollInterval(unsigned short value) { m_pollInterval = value; }
    // How often the servers report their status.
    int getServiceStatusReportingFrequency() const { return m_statusReportingFrequency; }
    void setServiceStatusReportingFrequency(int value) { m_statusReportingFrequency = value; }
    // The OID of the authority issuing the citizen service number.
    const ACE_CString& getBsnIssuerId() const { return m_bsnIssuerId; }
    void setBsnIssuerId(const ACE_CString& oid) { m_bsnIssuerId = oid; }
    // Whether the citizen service number is handled.
    bool getEnableBsn() const { return m_enableBsn; }
    void setEnableBsn(bool enable) { m_enableBsn = enable; }
    // The anonymisation parameters, in stored order.
    const std::vector<AnonParam>& getAnonymizationParams() const { return m_anonymizationParams; }
    void setAnonymizationParams(const std::vector<AnonParam>& params) {
        m_anonymizationParams = params;
    }
    // The database section.
    const KelExportDatabaseConfiguration& getDatabaseConfiguration() const { return m_database; }
    void setDatabaseConfiguration(const KelExportDatabaseConfiguration& database) {
        m_database = database;
    }

private:
    unsigned short m_commandStatusLifetime = 24;
    unsigned short m_maximumNumberOfRetries = 18;
    unsigned short m_retryDelay = 10;
    unsigned short m_executionTimeout = 120;
    unsigned short m_lifetimeBeforeArchive = 30;
    unsigned short m_lifetimeInArchive = 90;
    unsigned short m_pollInterval = 20;
    int m_statusReportingFrequency = 6;
    ACE_CString m_bsnIssuerId = "2.16.840.1.113883.2.4.6.3";
    bool m_enableBsn = false;
    std::vector<AnonParam> m_anonymizationParams;
    KelExportDatabaseConfiguration m_database;
};

}  // namespace Configuration
