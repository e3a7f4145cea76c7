// Configuration::KelExportDatabaseConfiguration: where the export module keeps its work queue:
// the database section, stored as its own site-wide document "DatabaseConfiguration" and held
// inside the export module's global document as the child "DatabaseConfiguration".
//
// Element "DatabaseConfiguration"; keys in order, all required: "Location" (string, "master": the
// host of the database server; "master" names the site's master machine, whatever its name),
// "DatabaseName" (string, "KelExport"), "ConnectionTimeout" (unsigned int, 15: seconds to open a
// connection), "CommandTimeout" (unsigned int, 30: seconds one statement may take). No
// credentials: the export servers connect with their service account.
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API KelExportDatabaseConfiguration
    : public TypedConfigDoc<KelExportDatabaseConfiguration> {
    CONFIGURATION_CLASS(KelExportDatabaseConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "DatabaseConfiguration";
    // The location that names the site's master machine.
    static constexpr const char MASTER_LOCATION[] = "master";

    // The site-wide document "DatabaseConfiguration" with every value at its default.
    KelExportDatabaseConfiguration();

    // The database server's host ("master": the site's master machine).
    const ACE_CString& getLocation() const { return m_location; }
    void setLocation(const ACE_CString& location) { m_location = location; }
    // The database's name.
    const ACE_CString& getDatabaseName() const { return m_databaseName; }
    void setDatabaseName(const ACE_CString& name) { m_databaseName = name; }
    // Seconds allowed to open a connection.
    unsigned int getConnectionTimeout() const { return m_connectionTimeout; }
    void setConnectionTimeout(unsigned int seconds) { m_connectionTimeout = seconds; }
    // Seconds one statement may take.
    unsigned int getCommandTimeout() const { return m_commandTimeout; }
    void setCommandTimeout(unsigned int seconds) { m_commandTimeout = seconds; }

private:
    ACE_CString m_location = MASTER_LOCATION;
    ACE_CString m_databaseName = "KelExport";
    unsigned int m_connectionTimeout = 15;
    unsigned int m_commandTimeout = 30;
};

}  // namespace Configuration
