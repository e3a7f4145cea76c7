// _HttpConfigurationItemInfo: one entry of HttpConfigurationClient::listItems, as the
// configuration service listed it. A plain value.
#pragma once

#include <ace/SString.h>

namespace Configuration {

struct _HttpConfigurationItemInfo {
    ACE_CString host;
    ACE_CString configurationName;
    ACE_CString lastModifiedTime;  // the service's text, not converted
};

}  // namespace Configuration
