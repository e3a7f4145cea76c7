// DirectoryStore: the embedded configuration store kept in one directory. Items are keyed by
// (host, configuration name) and keep their bytes and last-modified time (milliseconds since
// 1970 UTC). Hosts compare without regard to case (an item lists with the host spelling of its
// last store); names compare exactly and may hold any byte but NUL, backslashes included. Also
// keeps the services that hosts registered and a few site settings.
//
// Every item is one file (see ItemFile, StoreFileName) written through DurableDirectory: a store
// returns only once the item is on disk, and a kill at any moment keeps every acknowledged store
// and never a torn item. The directory is locked ("___lock___") while the object lives, so two
// stores (or services) cannot share it. The items are held in memory as well, so reads do not
// touch the disk. All public calls are thread-safe; stores of different items run in parallel.
#pragma once

#include <ace/SString.h>

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <shared_mutex>
#include <string>
#include <unordered_map>
#include <vector>

#include "Store/DurableDirectory.h"
#include "Store/SiteRegistry.h"

namespace Configuration {

// One stored item; bytes is shared and never changes.
struct StoredItem {
    ACE_CString host;
    ACE_CString name;
    std::int64_t lastModifiedMs = 0;
    std::shared_ptr<const std::string> bytes;
};

class DirectoryStore {
public:
    static constexpr std::int64_t kNow = INT64_MIN;  // store(): take the current time
    static constexpr const char* kAllHosts = "*";

    // Opens (creating if needed) and locks the directory and loads its items. Throws
    // std::runtime_error when the directory cannot be used or is in use by another store.
    explicit DirectoryStore(const ACE_CString& directory);
    DirectoryStore(const DirectoryStore&) = delete;
    DirectoryStore& operator=(const DirectoryStore&) = delete;

    // The directory this store lives in.
    ACE_CString directory() const { return m_directory.path().c_str(); }

    // Stores an item durably and returns the last-modified time it keeps: lastModifiedMs when
    // given, else now (always later than every time this store handed out before). Throws
    // std::invalid_argument for an empty host or name, a NUL, or the host "*"; std::runtime_error
    // when the disk write fails (the previous item is then kept).
    std::int64_t store(const ACE_CString& host, const ACE_CString& name, const void* data,
                       std::size_t size, std::int64_t lastModifiedMs = kNow);
    // Copies the item into item; false when there is none.
    bool retrieve(const ACE_CString& host, const ACE_CString& name, StoredItem& item) const;
    // Whether the item exists.
    bool exists(const ACE_CString& host, const ACE_CString& name) const;
    // Removes the item durably; false when there was none.
    bool remove(const ACE_CString& host, const ACE_CString& name);
    // The items of host (kAllHosts: of every host), ordered by host and name.
    std::vector<StoredItem> list(const ACE_CString& host) const;
    // Calls read once with the items of host in list() order, without copying them, under the
    // read lock: read must be quick and must not call into the store.
    void read(const ACE_CString& host,
              const std::function<void(const std::vector<const StoredItem*>&)>& read) const;
    // How many items are stored.
    std::size_t size() const;

    // Registers (or re-registers) a service of a host, durably.
    void registerService(const ACE_CString& host, const ACE_CString& service,
                         const ACE_CString& connection);
    // Removes a registration durably; false when there was none.
    bool unregisterService(const ACE_CString& host, const ACE_CString& service);
    // Every registration.
    std::vector<ServiceRegistration> services() const;
    // Sets a named site setting durably.
    void setSetting(const ACE_CString& key, const ACE_CString& value);
    // Reads a named site setting; false when it was never set.
    bool setting(const ACE_CString& key, ACE_CString& value) const;

private:
    struct Entry {
        StoredItem item;
        std::string fileName;
    };

    void load();
    // visit on each item of host; the caller holds m_itemsMutex.
    template <typename Visit>
    std::size_t visitLocked(const ACE_CString& host, const Visit& visit) const;
    void loadItem(const std::string& fileName);
    void loadRegistry();
    std::int64_t nextTime();
    void commitItem(const std::string& key, Entry entry, DurableDirectory::Prepared& prepared,
                    std::uint64_t& ticket);
    void saveRegistry(const SiteRegistry& registry);

    DurableDirectory m_directory;
    mutable std::shared_mutex m_itemsMutex;  // guards m_items and m_fileOwners
    std::map<std::string, Entry> m_items;    // by key: lower-case host, NUL, name
    std::unordered_map<std::string, std::string> m_fileOwners;  // file name to key
    std::atomic<std::int64_t> m_lastIssuedMs{0};

    mutable std::mutex m_registryMutex;  // guards m_registry and orders its writes
    SiteRegistry m_registry;
};

}  // namespace Configuration
