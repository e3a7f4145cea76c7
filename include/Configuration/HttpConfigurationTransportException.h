// HttpConfigurationTransportException: raised when the request could not be sent, or no answer was
// received. Adds no field to HttpConfigurationException (key and code are implied by the type);
// exists so that callers can catch it separately. A plain value.
#pragma once

#include "Configuration/Export.h"
#include "Configuration/HttpConfigurationException.h"

namespace Configuration {

class CONFIGURATION_API HttpConfigurationTransportException : public HttpConfigurationException {
public:
    // A message only.
    explicit HttpConfigurationTransportException(const ACE_CString& message);
    HttpConfigurationTransportException(const HttpConfigurationTransportException& other);
    HttpConfigurationTransportException& operator=(
        const HttpConfigurationTransportException& other);
    ~HttpConfigurationTransportException() override;
};

}  // namespace Configuration
