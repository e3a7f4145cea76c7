// Configuration::KelExportRemoteConfigurations: the site-wide document
// "KelExportRemoteConfigurations": the export destinations and which one receives studies for
// long-term storage.
//
// Element "KelExportRemoteConfigurations"; keys in order: "LongTermStorageDestination" (string,
// empty: the name of a destination), "KelExportRemoteSCPs" (one "KelExportRemoteScp" per
// destination; required: its absence is a logged read failure that keeps the list; a destination
// whose read is incomplete is dropped and makes the read incomplete).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include <vector>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/KelExportRemoteScp.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API KelExportRemoteConfigurations
    : public TypedConfigDoc<KelExportRemoteConfigurations> {
    CONFIGURATION_CLASS(KelExportRemoteConfigurations);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "KelExportRemoteConfigurations";

    // The site-wide document "KelExportRemoteConfigurations" with no destination.
    KelExportRemoteConfigurations();

    // The destination that receives studies for long-term storage (empty: none).
    const ACE_CString& getLongTermStorageDestination() const { return m_longTermStorage; }
    void setLongTermStorageDestination(const ACE_CString& name) { m_longTermStorage = name; }
    // The export destinations, in stored order.
    const std::vector<KelExportRemoteScp>& getRemoteScps() const { return m_destinations; }
    void setRemoteScps(const std::vector<KelExportRemoteScp>& destinations) {
        m_destinations = destinations;
    }

private:
    ACE_CString m_longTermStorage;
    std::vector<KelExportRemoteScp> m_destinations;
};

}  // namespace Configuration
