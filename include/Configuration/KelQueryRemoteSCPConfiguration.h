// Configuration::KelQueryRemoteSCPConfiguration: one remote archive the query module queries and
// moves studies from.
//
// Element "KelQueryRemoteScp"; in order: the node (RemoteSCPConfiguration, child "RemoteScp":
// required, its absence is a logged read failure that ends the read), "MergeArkCompatibility"
// (flag, false), "Organization" (string, "NotSet"), "QueryModel" (int, 1; its text is converted
// like C's atoi, so a text that is not a number gives 0; its absence is a logged read failure).
// Plain value owned by its caller; not thread-safe.
#pragma once

#include <ace/SString.h>

#include "Configuration/ConfigurationClass.h"
#include "Configuration/RemoteSCPConfiguration.h"

namespace Configuration {

class CONFIGURATION_API KelQueryRemoteSCPConfiguration : public RemoteSCPConfiguration {
    CONFIGURATION_CLASS(KelQueryRemoteSCPConfiguration);

public:
    static constexpr const char WELL_KNOWN_NAME[] = "KelQueryRemoteScp";

    // Whether the archive needs the compatibility mode for older archives of the same make.
    bool getMergeArkCompatibility() const { return m_mergeArkCompatibility; }
    void setMergeArkCompatibility(bool compatible) { m_mergeArkCompatibility = compatible; }
    // The organisation the archive belongs to.
    const ACE_CString& getOrganization() const { return m_organization; }
    void setOrganization(const ACE_CString& organization) { m_organization = organization; }
    // The query model number (the query module's business).
    int getQueryModel() const { return m_queryModel; }
    void setQueryModel(int model) { m_queryModel = model; }

private:
    bool m_mergeArkCompatibility = false;
    ACE_CString m_organization = "NotSet";
    int m_queryModel = 1;
};

}  // namespace Configuration
