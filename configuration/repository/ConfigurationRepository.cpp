// ConfigurationRepository: creation, the cache and the typed read and write of documents.
#include "Configuration/ConfigurationRepository.h"

#include <ace/Guard_T.h>
#include <ace/OS_NS_strings.h>
#include <ace/Object_Manager.h>
#include <ace/Reactor.h>

#include <atomic>
#include <limits>
#include <stdexcept>

#include "Common/NamedEvent.h"
#include "Configuration/ServiceLocation.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "model/DocumentCodec.h"
#include "repository/CachedDocument.h"
#include "repository/HttpServiceConnection.h"
#include "repository/MasterSource.h"
#include "repository/StoreServiceConnection.h"

namespace Configuration {
namespace {

const char kChangeEventName[] = "Global\\QuorvexSlaveConfigurationChanged";

std::atomic<ConfigurationRepository*> s_instance{nullptr};

std::atomic<std::uint64_t> s_nextRepositoryId{1};

// One thread's view of a repository's cache: the entries it has read, all taken while the
// cache's generation was the one recorded. A change of the cache makes the view stale; the
// thread drops it on its next read, so it keeps stale entries alive at most until then.
struct ThreadView {
    std::uint64_t repository = 0;
    std::uint64_t generation = 0;
    std::map<ACE_CString, std::shared_ptr<const CachedDocument>> entries;
};

ThreadView& threadView() {
    thread_local ThreadView view;
    return view;
}

std::shared_ptr<ServiceConnector> connectorFromEnvironment() {
    ServiceLocation location = ServiceLocation::fromEnvironment();
    if (location.storeDirectory.length() > 0) {
        return std::make_shared<StoreServiceConnector>(location.storeDirectory);
    }
    return std::make_shared<HttpServiceConnector>(std::move(location));
}

// The object manager's singleton lock. ACE keeps the lock it hands out in the pointer passed to
// it, so that pointer must be one for the whole process: a fresh null pointer per call would get
// a fresh mutex per call. The static's own initialisation is thread-safe.
ACE_Thread_Mutex* singletonLock() {
    static ACE_Thread_Mutex* const lock = [] {
        ACE_Thread_Mutex* acquired = nullptr;
        return ACE_Object_Manager::get_singleton_lock(acquired) == 0 ? acquired : nullptr;
    }();
    return lock;
}

}  // namespace

ConfigurationRepository* ConfigurationRepository::instance() {
    ConfigurationRepository* repository = s_instance.load(std::memory_order_acquire);
    if (repository != nullptr) {
        return repository;
    }
    ACE_Thread_Mutex* lock = singletonLock();
    if (lock == nullptr) {
        throw std::runtime_error("ConfigurationRepository::instance() lock acquire failed");
    }
    ACE_Guard<ACE_Thread_Mutex> guard(*lock);
    repository = s_instance.load(std::memory_order_relaxed);
    if (repository == nullptr) {
        auto created = std::make_unique<ConfigurationRepository>(connectorFromEnvironment());
        created->SetMasterHostName(machineMasterSource().masterHostName(*created));
        repository = created.release();
        s_instance.store(repository, std::memory_order_release);
    }
    return repository;
}

ConfigurationRepository::ConfigurationRepository(std::shared_ptr<ServiceConnector> connector)
    : m_id(s_nextRepositoryId.fetch_add(1)), m_connector(std::move(connector)) {
    const ACE_CString localHost = Quorvex::GetHostName(false);
    if (localHost.length() == 0) {
        throw std::runtime_error("ConfigurationRepository::Unable to retrieve hostname");
    }
    m_virtualHostName = m_connector->connect(localHost)->hostName();
    m_masterHostName = m_virtualHostName;
    setNextCheck(BDateTime::Now());
    openChangeEvent();
}

ConfigurationRepository::~ConfigurationRepository() {
    if (m_registered) {
        ACE_Reactor::instance()->remove_handler(
            m_changeEvent->handle(), ACE_Event_Handler::READ_MASK | ACE_Event_Handler::DONT_CALL);
    }
}

void ConfigurationRepository::openChangeEvent() {
    try {
        m_changeEvent = std::make_unique<Common::NamedEvent>(kChangeEventName);
        m_registered = ACE_Reactor::instance()->register_handler(m_changeEvent->handle(), this,
                                                                 ACE_Event_Handler::READ_MASK) == 0;
    } catch (const std::exception&) {
        m_registered = false;
    }
    if (!m_registered) {
        QUORVEX_LOG(LM_ERROR,
                    "%mUnable to register refresh event listener for the Configuration "
                    "Repository\n");
    }
}

// Called with the cache lock held.
ACE_CString ConfigurationRepository::hostFor(const ConfigDoc& document) const {
    return document.isLocal() ? m_virtualHostName : m_masterHostName;
}

int ConfigurationRepository::GetLatest(ConfigDoc& document, bool force) {
    try {
        GetLatest_i(document, force);
        return 0;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR,
                    "ConfigurationRepository::GetLatest: Unable to read %s. Standard Exception: "
                    "%s\n",
                    document.path().c_str(), e.what());
        return -1;
    }
}

// The cache lock is held only to look an entry up and to swap one in: the requests to the store
// run outside it, so a slow or dead service never stalls other threads' cached reads. A read that
// this thread's view can serve takes no lock at all, so cached readers never wait on each other.
void ConfigurationRepository::GetLatest_i(ConfigDoc& document, bool force) {
    if (!force && readFromView(document)) {
        return;
    }
    ACE_CString host;
    std::shared_ptr<const CachedDocument> entry;
    bool check = false;
    {
        ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
        host = hostFor(document);
        const auto found = m_cache.find(document.path());
        if (found != m_cache.end()) {
            entry = found->second;
            const BDateTime now = BDateTime::Now();
            check = force || now > m_nextCheck;
            if (check) {
                setNextCheck(now + BTime(0, 5, 0));
            }
        }
    }
    if (!entry || check) {
        auto fetched = fetch(host, document, entry);
        keep(document.path(), entry, fetched);
        entry = std::move(fetched);
    }
    const ConfigDoc* copy = entry->copyOf(document);
    if (copy == nullptr) {  // another class of the same document was read first
        auto wider = entry->withCopyOf(document);
        keep(document.path(), entry, wider);
        entry = std::move(wider);
        copy = entry->copyOf(document);
    }
    document.assignFrom(*copy);
    refreshView(document.path());
}

bool ConfigurationRepository::readFromView(ConfigDoc& document) const {
    const ThreadView& view = threadView();
    if (view.repository != m_id ||
        view.generation != m_readState.generation.load(std::memory_order_acquire) ||
        BDateTime::Now().millisecondsSinceEpoch() >
            m_readState.nextCheckMs.load(std::memory_order_relaxed)) {
        return false;
    }
    const auto found = view.entries.find(document.path());
    if (found == view.entries.end()) {
        return false;
    }
    const ConfigDoc* copy = found->second->copyOf(document);
    if (copy == nullptr) {
        return false;
    }
    document.assignFrom(*copy);
    return true;
}

void ConfigurationRepository::refreshView(const ACE_CString& path) const {
    ThreadView& view = threadView();
    ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
    const std::uint64_t generation = m_readState.generation.load(std::memory_order_relaxed);
    if (view.repository != m_id || view.generation != generation) {
        view.entries.clear();
        view.repository = m_id;
        view.generation = generation;
    }
    const auto found = m_cache.find(path);
    if (found != m_cache.end() && found->second) {
        view.entries[path] = found->second;
    }
}

// Called with the cache lock held. An invalid time is never passed, as before.
void ConfigurationRepository::setNextCheck(const BDateTime& when) {
    m_nextCheck = when;
    m_readState.nextCheckMs.store(
        when.isValid() ? when.millisecondsSinceEpoch() : std::numeric_limits<std::int64_t>::max(),
        std::memory_order_relaxed);
}

// The latest state of document's path as an entry: cached unchanged when the store's timestamp
// is the cached one, else read afresh into a copy, so that a failed read leaves both the cache
// and the caller's document whole.
std::shared_ptr<const CachedDocument> ConfigurationRepository::fetch(
    const ACE_CString& host, const ConfigDoc& document,
    const std::shared_ptr<const CachedDocument>& cached) {
    const ConfigDoc* base = &document;
    if (cached) {
        BDateTime stored;
        if (GetConfigItemTimeStamp(host, document.path(), stored) != 0) {
            throw std::runtime_error("ConfigurationRepository: Unable to get timestamp");
        }
        if (stored == cached->timestamp()) {
            return cached;
        }
        if (const ConfigDoc* copy = cached->copyOf(document)) {
            base = copy;
        }
    }
    std::unique_ptr<ConfigDoc> fresh(base->clone());
    auto tree = std::make_shared<Vesk::Element>(ACE_CString(), -1);
    if (ReadItem(host, *fresh, *tree) != 0) {
        throw std::runtime_error("ConfigurationRepository: Unable to read configuration");
    }
    return std::make_shared<const CachedDocument>(std::move(tree), *fresh);
}

// Puts entry in the cache in place of expected. When another thread has replaced expected in the
// meantime, its entry is at least as new and stays.
void ConfigurationRepository::keep(const ACE_CString& path,
                                   const std::shared_ptr<const CachedDocument>& expected,
                                   const std::shared_ptr<const CachedDocument>& entry) {
    ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
    std::shared_ptr<const CachedDocument>& slot = m_cache[path];
    if (slot == expected && slot != entry) {
        slot = entry;
        m_readState.generation.fetch_add(1, std::memory_order_release);
    }
}

int ConfigurationRepository::Store(ConfigDoc& document) {
    const ACE_CString host = document.isLocal() ? m_virtualHostName : GetMasterHostName();
    Quorvex::auto_ptr<Vesk::Element> tree;
    try {
        tree = WriteItem(host, document);
    } catch (const std::exception& e) {  // a read-only class refuses to be written
        QUORVEX_LOG(LM_ERROR,
                    "ConfigurationRepository::Store: Unable to write %s. Standard Exception: "
                    "%s\n",
                    document.path().c_str(), e.what());
        return -1;
    }
    if (!tree) {
        return -1;
    }
    auto entry = std::make_shared<const CachedDocument>(
        std::shared_ptr<const Vesk::Element>(tree.release()), document);
    ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
    m_cache[document.path()] = std::move(entry);
    m_readState.generation.fetch_add(1, std::memory_order_release);
    return 0;
}

int ConfigurationRepository::ReadItem(const ACE_CString& name, ConfigDoc& document,
                                      Vesk::Element& tree) {
    try {
        return DocumentCodec::readItem(
            name, document,
            [this](const ACE_CString& host, const ACE_CString& path, Quorvex::ByteArray& bytes,
                   std::size_t& length,
                   BDateTime& timestamp) { return Retrieve(host, path, bytes, length, timestamp); },
            &tree);
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR,
                    "ConfigurationRepository::ReadItem: Error reading configuration item %s. "
                    "Standard Exception: %s\n",
                    document.path().c_str(), e.what());
        return -1;
    }
}

Quorvex::auto_ptr<Vesk::Element> ConfigurationRepository::WriteItem(const ACE_CString& name,
                                                                    ConfigDoc& document) {
    return DocumentCodec::writeItem(
        name, document,
        [this](const ACE_CString& host, const ACE_CString& path, const unsigned char* bytes,
               std::size_t length,
               const BDateTime& timestamp) { return Store(host, path, bytes, length, timestamp); });
}

int ConfigurationRepository::GetConfigCacheItemInfo(const ACE_CString& path,
                                                    ConfigCacheItemInfo& info) {
    ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
    return cacheItemInfo(path, info);
}

int ConfigurationRepository::cacheItemInfo(const ACE_CString& path,
                                           ConfigCacheItemInfo& info) const {
    const auto found = m_cache.find(path);
    if (found == m_cache.end() || !found->second) {
        return -1;
    }
    const ConfigDoc& cached = found->second->any();
    info.isLocal = cached.isLocal();
    info.version = cached.version();
    info.isLocked = cached.isLocked();
    info.timestamp = cached.timestamp();
    return 0;
}

// Checks every cached document against the store, each outside the cache lock.
int ConfigurationRepository::RefreshCache() {
    std::vector<std::shared_ptr<const CachedDocument>> entries;
    {
        ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
        for (const auto& entry : m_cache) {
            if (entry.second) {
                entries.push_back(entry.second);
            }
        }
    }
    try {
        for (const auto& entry : entries) {
            std::unique_ptr<ConfigDoc> document(entry->any().clone());
            GetLatest_i(*document, true);
        }
        return 0;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_DEBUG,
                    "ConfigurationRepository::RefreshCache: Failed. Standard Exception: %s.\n",
                    e.what());
        return -1;
    }
}

void ConfigurationRepository::SetMasterHostName(const ACE_CString& name) {
    ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
    m_masterHostName = name.length() > 0 ? name : m_virtualHostName;
}

ACE_CString ConfigurationRepository::GetMasterHostName() const {
    ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
    return m_masterHostName;
}

bool ConfigurationRepository::IsMaster() const {
    const ACE_CString master = GetMasterHostName();
    return ACE_OS::strcasecmp(m_virtualHostName.c_str(), master.c_str()) == 0;
}

int ConfigurationRepository::handle_signal(int, siginfo_t*, ucontext_t*) {
    if (m_changeEvent) {
        m_changeEvent->reset();
    }
    RefreshCache();
    QUORVEX_LOG(
        LM_DEBUG,
        "ConfigurationRepository::handle_signal: Event QuorvexSlaveConfigurationChanged was "
        "received.\n");
    return 0;
}

int ConfigurationRepository::handle_input(ACE_HANDLE) {
    return handle_signal(0);
}

}  // namespace Configuration
