// HttpConfigurationItemLimitReachedException: raised when the service refuses an item beyond its
// limit (error code 42795). Adds no field to HttpConfigurationException (key and code are implied
// by the type); exists so that callers can catch it separately. A plain value.
#pragma once

#include "Configuration/Export.h"
#include "Configuration/HttpConfigurationException.h"

namespace Configuration {

class CONFIGURATION_API HttpConfigurationItemLimitReachedException
    : public HttpConfigurationException {
public:
    // A message only.
    explicit HttpConfigurationItemLimitReachedException(const ACE_CString& message);
    HttpConfigurationItemLimitReachedException(
        const HttpConfigurationItemLimitReachedException& other);
    HttpConfigurationItemLimitReachedException& operator=(
        const HttpConfigurationItemLimitReachedException& other);
    ~HttpConfigurationItemLimitReachedException() override;
};

}  // namespace Configuration
