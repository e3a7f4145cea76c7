// Configuration::ArchiveNotConfiguredException: what the tape-archive look-ups throw when the
// archive configuration has no record for what was asked; what() is the message. A plain value.
#pragma once

#include <stdexcept>
#include <string>

#include "Configuration/Export.h"

namespace Configuration {

class CONFIGURATION_API ArchiveNotConfiguredException : public std::runtime_error {
public:
    explicit ArchiveNotConfiguredException(const std::string& message)
        : std::runtime_error(message) {}
};

}  // namespace Configuration
