// ServiceContext: what the operations of one service instance work with: its store, its road to
// the master, its change event and its facts. The objects are owned by whoever built the context
// (ConfigurationServer) and outlive every request. The members are thread-safe.
#pragma once

#include <chrono>
#include <string>

#include "ChangeNotifier.h"
#include "MasterLink.h"
#include "Store/DirectoryStore.h"

namespace ConfigurationService {

struct ServiceContext {
    Configuration::DirectoryStore& store;
    MasterLink& master;
    ChangeNotifier& changes;
    std::string hostName;  // this service's host name
    std::chrono::steady_clock::time_point started = std::chrono::steady_clock::now();
    std::int64_t startedMs = 0;  // start time, milliseconds since 1970 UTC
    int port = 0;                // the port it listens on, once known
};

}  // namespace ConfigurationService
