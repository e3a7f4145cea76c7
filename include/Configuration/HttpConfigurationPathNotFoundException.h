// HttpConfigurationPathNotFoundException: raised when the service reports that a path does not
// exist (its path-not-found error key). Adds no field to HttpConfigurationException (key and code
// are implied by the type); exists so that callers can catch it separately. A plain value.
#pragma once

#include "Configuration/Export.h"
#include "Configuration/HttpConfigurationException.h"

namespace Configuration {

class CONFIGURATION_API HttpConfigurationPathNotFoundException : public HttpConfigurationException {
public:
    // A message only.
    explicit HttpConfigurationPathNotFoundException(const ACE_CString& message);
    HttpConfigurationPathNotFoundException(const HttpConfigurationPathNotFoundException& other);
    HttpConfigurationPathNotFoundException& operator=(
        const HttpConfigurationPathNotFoundException& other);
    ~HttpConfigurationPathNotFoundException() override;
};

}  // namespace Configuration
