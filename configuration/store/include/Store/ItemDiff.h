// The master's items that a local copy lacks: items missing locally, and items whose
// last-modified time differs. Items are compared by host, configuration name and last-modified
// text together (the key the copy keeps), so a copy that carries the master's time is never
// copied again. Pure function; thread-safe.
#pragma once

#include <vector>

#include "Configuration/HttpConfigurationItemInfo.h"

namespace Configuration {

std::vector<_HttpConfigurationItemInfo> itemsMissingLocally(
    std::vector<_HttpConfigurationItemInfo> master, std::vector<_HttpConfigurationItemInfo> local);

}  // namespace Configuration
