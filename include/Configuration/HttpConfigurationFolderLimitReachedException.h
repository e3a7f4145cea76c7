// HttpConfigurationFolderLimitReachedException: raised when the service refuses a folder beyond its
// limit (error code 42794). Adds no field to HttpConfigurationException (key and code are implied
// by the type); exists so that callers can catch it separately. A plain value.
#pragma once

#include "Configuration/Export.h"
#include "Configuration/HttpConfigurationException.h"

namespace Configuration {

class CONFIGURATION_API HttpConfigurationFolderLimitReachedException
    : public HttpConfigurationException {
public:
    // A message only.
    explicit HttpConfigurationFolderLimitReachedException(const ACE_CString& message);
    HttpConfigurationFolderLimitReachedException(
        const HttpConfigurationFolderLimitReachedException& other);
    HttpConfigurationFolderLimitReachedException& operator=(
        const HttpConfigurationFolderLimitReachedException& other);
    ~HttpConfigurationFolderLimitReachedException() override;
};

}  // namespace Configuration
