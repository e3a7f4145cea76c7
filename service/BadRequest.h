// BadRequest: a request body that is not a well-formed request; what() says why. A plain
// exception value.
#pragma once

#include <stdexcept>
#include <string>

namespace ConfigurationService {

class BadRequest : public std::runtime_error {
public:
    explicit BadRequest(const std::string& message) : std::runtime_error(message) {}
};

}  // namespace ConfigurationService
