// Configuration::KelExportWebService: the site-wide document "KelExportWebServiceLocal": the
// export module's web-service consumer settings.
//
// Element "KelExportWebServiceLocal"; one key, required: "ConnectionTimeout" (unsigned int, 5).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include "Configuration/ConfigurationClass.h"
#include "Configuration/TypedConfigDoc.h"

namespace Configuration {

class CONFIGURATION_API KelExportWebService : public TypedConfigDoc<KelExportWebService> {
    CONFIGURATION_CLASS(KelExportWebService);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "KelExportWebServiceLocal";

    // The site-wide document "KelExportWebServiceLocal" with its default time-out.
    KelExportWebService();

    // How long a connection to the web service may take to open.
    unsigned int getConnectionTimeout() const { return m_connectionTimeout; }
    void setConnectionTimeout(unsigned int timeOut) { m_connectionTimeout = timeOut; }

private:
    unsigned int m_connectionTimeout = 5;
};

}  // namespace Configuration
