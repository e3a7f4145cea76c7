// Configuration::ConfigCacheItemInfo: what the repository knows of one cached document (the
// result of ConfigurationRepository::GetConfigCacheItemInfo). A plain value.
#pragma once

#include "Quorvex/BDateTime.h"

namespace Configuration {

struct ConfigCacheItemInfo {
    bool isLocal = false;  // per-machine document
    int version = 0;
    int isLocked = 0;
    BDateTime timestamp;  // when the cached copy was stored
};

}  // namespace Configuration
