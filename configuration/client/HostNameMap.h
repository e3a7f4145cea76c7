// HttpConfigurationClient::HostNameMap: one process-wide cache from server to the host name that
// server reported. Entries are only ever added (never changed back or removed).
//
// retrieve() is the cached look-up of both caches: an unlocked first look-up, then under the map's
// process-wide mutex a second look-up and, when still absent, one request to the server.
//
// Thread-safety: find() takes no lock: it reads an immutable snapshot published through an atomic
// pointer, so the unlocked first look-up is free of data races. store() must be called with
// lock() held; it publishes a new snapshot. Old snapshots stay reachable from the newest one and
// live as long as the process, like the entries themselves.
#pragma once

#include <ace/SString.h>
#include <ace/Thread_Mutex.h>

#include <atomic>
#include <functional>
#include <map>
#include <mutex>

#include "Configuration/HttpConfigurationClient.h"

namespace Configuration {

class HttpConfigurationClient::HostNameMap {
public:
    // The request and failure texts of one cache.
    struct Query {
        const char* request;
        const char* lockFailure;
        const char* missing;
    };
    // Sends a legacy request body to the configuration service and returns its answer.
    using SendFunction = std::function<ACE_CString(const char* body)>;

    constexpr HostNameMap() = default;
    HostNameMap(const HostNameMap&) = delete;
    HostNameMap& operator=(const HostNameMap&) = delete;

    // The host name of server: cached, or asked for with query.request through sendRequest.
    // std::exception when the lock is unavailable or the answer has no "HostName"; an empty
    // string when the lock cannot be taken.
    ACE_CString retrieve(const ACE_CString& server, const Query& query,
                         const SendFunction& sendRequest);
    // The name cached for server; empty when there is none (or an empty answer was cached).
    ACE_CString find(const ACE_CString& server) const;
    // Remembers the name for server. The caller holds lock().
    void store(const ACE_CString& server, const ACE_CString& name);
    // This map's process-wide mutex from ACE's singleton-lock facility; null when unavailable.
    ACE_Thread_Mutex* lock();

private:
    struct Snapshot {
        std::map<ACE_CString, ACE_CString> entries;
        const Snapshot* previous;
    };

    std::atomic<const Snapshot*> m_current{nullptr};
    std::once_flag m_lockOnce;
    ACE_Thread_Mutex* m_lock = nullptr;
};

}  // namespace Configuration
