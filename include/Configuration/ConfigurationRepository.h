// Configuration::ConfigurationRepository: the one object in a process through which configuration
// documents are read, written and kept fresh.
//
// Reads go to this machine's configuration service (the "virtual host"), writes to the master's.
// Documents read are cached; their timestamps are checked against the store at most once every
// five minutes for the whole repository (one shared check time), and every cached document is
// re-checked when the machine-wide change event "Global\QuorvexSlaveConfigurationChanged" fires.
// The event is delivered by ACE_Reactor::instance(): only processes that run that reactor's event
// loop refresh on change (the library starts no threads).
//
// Callers use instance() and the two typed calls:
//     OrvelSystemConfiguration system;
//     if (ConfigurationRepository::instance()->GetLatest(system) == 0) { ... }
//     ConfigurationRepository::instance()->Store(system);
// The repository owns its cached copies; the caller's documents stay the caller's. A document is
// cached as its element tree beside a typed copy per class, so classes that name the same
// document are all served from the cache. Every public call is thread-safe; the cache lock is
// never held across a request to a service, so a slow service delays only the calls that need
// it, and a cached read takes no lock at all (each thread keeps a view of the entries it has
// read, dropped at the next change of the cache). Remote failures never throw: they give -1 and a
// log line, and the caller's document keeps what it had.
#pragma once

#include <ace/Event_Handler.h>
#include <ace/SString.h>
#include <ace/Thread_Mutex.h>

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <map>
#include <memory>
#include <utility>
#include <vector>

#include "Configuration/ConfigCacheItemInfo.h"
#include "Configuration/ConfigDoc.h"
#include "Configuration/Export.h"
#include "Quorvex/BDateTime.h"
#include "Quorvex/auto_ptr.h"

namespace Common {
class NamedEvent;
}

namespace Configuration {

class CachedDocument;
class ServiceConnection;
class ServiceConnector;

class CONFIGURATION_API ConfigurationRepository : public ACE_Event_Handler {
public:
    // The process's repository, created on first use from the environment's service location
    // (Configuration/ServiceLocation.h). Throws when it cannot be created.
    static ConfigurationRepository* instance();

    // A repository over the given services (tests and embedding; most callers use instance()).
    // Learns the virtual host name from the local service and registers for the change event.
    explicit ConfigurationRepository(std::shared_ptr<ServiceConnector> connector);
    ~ConfigurationRepository() override;
    ConfigurationRepository(const ConfigurationRepository&) = delete;
    ConfigurationRepository& operator=(const ConfigurationRepository&) = delete;

    // Fills document with its latest stored state (from the cache when checked recently; force
    // checks the store now). 0 on success; -1 (logged) when it could not be read, the document
    // then keeping what it had.
    int GetLatest(ConfigDoc& document, bool force = false);
    // Stores document on the master's service (per-machine documents under this host) and keeps
    // it in the cache; its timestamp becomes now. 0 on success, -1 (logged) on failure.
    int Store(ConfigDoc& document);

    // The stored bytes and timestamp of path under host, from the local service.
    int Retrieve(const ACE_CString& host, const ACE_CString& path, Quorvex::ByteArray& bytes,
                 std::size_t& length, BDateTime& timestamp) const;
    // Stores bytes under host and path on the master's service.
    int Store(const ACE_CString& host, const ACE_CString& path, const unsigned char* bytes,
              std::size_t length, const BDateTime& timestamp);
    // The stored timestamp of path under host, from the local service.
    int GetConfigItemTimeStamp(const ACE_CString& host, const ACE_CString& path,
                               BDateTime& timestamp) const;
    // What the cache holds for path; -1 when it is not cached.
    int GetConfigCacheItemInfo(const ACE_CString& path, ConfigCacheItemInfo& info);
    // Checks every cached document against the store now.
    int RefreshCache();
    // Copies the master's documents that are missing or different into the local service.
    int CacheMasterWebToLocalWeb();

    // Sets the master host; an empty name makes this machine its own master.
    void SetMasterHostName(const ACE_CString& name);
    ACE_CString GetMasterHostName() const;
    // This machine's name as its configuration service reports it.
    ACE_CString GetVirtualHostName() const { return m_virtualHostName; }
    // Whether this machine is the master (host names compared without regard to case).
    bool IsMaster() const;

    // Tells every other host's service that the configuration changed.
    void SignalChanged();
    // Asks the local service to have the configuration refreshed.
    void SignalRefresh();
    // Asks the local service to have the services restarted.
    void SignalRestart();
    // Registers a service of this machine with the master.
    int RegisterService(const ACE_CString& serviceName, const ACE_CString& connectionString);
    // Accepted and ignored: returns 0 without a request.
    int UnregisterService(const ACE_CString& serviceName);
    // Every host the local service knows.
    int ListServers(std::vector<ACE_CString>& servers);
    // Makes the named storage the persistent one (on the master).
    int SwitchoverPersistent(const ACE_CString& persistentName);
    // Turns network capture merging on or off for this machine (on the master).
    int EnableMergeNetworkCapture(bool enable);
    // Not supported: logs and returns 0.
    int Remove(const ACE_CString& name, bool isLocal);
    // Not supported: leaves the list untouched.
    void List(std::vector<std::pair<ACE_CString, BDateTime>>& items) const;

    // The change event fired: reset it and refresh the cache.
    int handle_signal(int signum, siginfo_t* info = nullptr,
                      ucontext_t* context = nullptr) override;
    // The event's descriptor became readable (the reactor's call): as handle_signal.
    int handle_input(ACE_HANDLE handle) override;

private:
    void GetLatest_i(ConfigDoc& document, bool force);
    // Serves document from this thread's view of the cache without any lock; false when the view
    // is stale, lacks the document or its class, or the check time has passed.
    bool readFromView(ConfigDoc& document) const;
    // Puts the cache's current entry for path into this thread's view.
    void refreshView(const ACE_CString& path) const;
    // Sets the shared check time (cache lock held).
    void setNextCheck(const BDateTime& when);
    std::shared_ptr<const CachedDocument> fetch(
        const ACE_CString& host, const ConfigDoc& document,
        const std::shared_ptr<const CachedDocument>& cached);
    void keep(const ACE_CString& path, const std::shared_ptr<const CachedDocument>& expected,
              const std::shared_ptr<const CachedDocument>& entry);
    int ReadItem(const ACE_CString& name, ConfigDoc& document, Vesk::Element& tree);
    Quorvex::auto_ptr<Vesk::Element> WriteItem(const ACE_CString& name, ConfigDoc& document);
    int cacheItemInfo(const ACE_CString& path, ConfigCacheItemInfo& info) const;
    ACE_CString hostFor(const ConfigDoc& document) const;
    void openChangeEvent();
    void signalLocal(void (*call)(ServiceConnection&), const char* failure);

    // Path to its cached entry; entries are shared and never changed, only replaced.
    std::map<ACE_CString, std::shared_ptr<const CachedDocument>> m_cache;
    mutable ACE_Thread_Mutex m_cacheLock;
    ACE_CString m_virtualHostName;
    ACE_CString m_masterHostName;
    BDateTime m_nextCheck;
    // What a lock-free cached read looks at, on a cache line of its own that only changes of the
    // cache write: the cache's generation (bumped under the cache lock at every change) and
    // m_nextCheck in milliseconds. Each thread keeps its own view of the entries it has read,
    // valid while the generation is the one it was taken at.
    struct alignas(64) ReadState {
        std::atomic<std::uint64_t> generation{0};
        std::atomic<std::int64_t> nextCheckMs{0};
    } m_readState;
    const std::uint64_t m_id;  // tells this repository's thread views from another's
    std::unique_ptr<Common::NamedEvent> m_changeEvent;
    std::shared_ptr<ServiceConnector> m_connector;
    bool m_registered = false;
};

}  // namespace Configuration
