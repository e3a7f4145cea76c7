// HttpConfigurationInvalidNodeIdException: raised when the service reports an unknown or removed
// node (its invalid-node-id error key). Adds no field to HttpConfigurationException (key and code
// are implied by the type); exists so that callers can catch it separately. A plain value.
#pragma once

#include "Configuration/Export.h"
#include "Configuration/HttpConfigurationException.h"

namespace Configuration {

class CONFIGURATION_API HttpConfigurationInvalidNodeIdException
    : public HttpConfigurationException {
public:
    // A message only.
    explicit HttpConfigurationInvalidNodeIdException(const ACE_CString& message);
    HttpConfigurationInvalidNodeIdException(const HttpConfigurationInvalidNodeIdException& other);
    HttpConfigurationInvalidNodeIdException& operator=(
        const HttpConfigurationInvalidNodeIdException& other);
    ~HttpConfigurationInvalidNodeIdException() override;
};

}  // namespace Configuration
