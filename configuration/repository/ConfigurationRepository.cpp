// ConfigurationRepository: creation, the cache and the typed read and write of documents.
#include "Configuration/ConfigurationRepository.h"

#include <ace/Guard_T.h>
#include <ace/OS_NS_strings.h>
#include <ace/Object_Manager.h>
#include <ace/Reactor.h>

#include <atomic>
#include <stdexcept>

#include "Common/NamedEvent.h"
#include "Configuration/ServiceLocation.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "model/DocumentCodec.h"
#include "repository/HttpServiceConnection.h"
#include "repository/MasterSource.h"
#include "repository/StoreServiceConnection.h"

namespace Configuration {
namespace {

const char kChangeEventName[] = "Global\\QuorvexSlaveConfigurationChanged";

std::atomic<ConfigurationRepository*> s_instance{nullptr};

std::shared_ptr<ServiceConnector> connectorFromEnvironment() {
    ServiceLocation location = ServiceLocation::fromEnvironment();
    if (location.storeDirectory.length() > 0) {
        return std::make_shared<StoreServiceConnector>(location.storeDirectory);
    }
    return std::make_shared<HttpServiceConnector>(std::move(location));
}

}  // namespace

ConfigurationRepository* ConfigurationRepository::instance() {
    ConfigurationRepository* repository = s_instance.load(std::memory_order_acquire);
    if (repository != nullptr) {
        return repository;
    }
    ACE_Thread_Mutex* lock = nullptr;
    if (ACE_Object_Manager::get_singleton_lock(lock) != 0 || lock == nullptr) {
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
    : m_connector(std::move(connector)) {
    const ACE_CString localHost = Quorvex::GetHostName(false);
    if (localHost.length() == 0) {
        throw std::runtime_error("ConfigurationRepository::Unable to retrieve hostname");
    }
    m_virtualHostName = m_connector->connect(localHost)->hostName();
    m_masterHostName = m_virtualHostName;
    m_nextCheck = BDateTime::Now();
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
        ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
        ConfigDoc& latest = GetLatest_i(document, force);
        if (&latest != &document) {
            document.assignFrom(latest);
        }
        return 0;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR,
                    "ConfigurationRepository::GetLatest: Unable to read %s. Standard Exception: "
                    "%s\n",
                    document.path().c_str(), e.what());
        return -1;
    }
}

// Called with the cache lock held.
ConfigDoc& ConfigurationRepository::GetLatest_i(ConfigDoc& document, bool force) {
    const ACE_CString host = hostFor(document);
    const auto found = m_cache.find(document.path());
    if (found == m_cache.end()) {
        if (ReadItem(host, document) != 0) {
            throw std::runtime_error("ConfigurationRepository: Unable to read configuration");
        }
        m_cache.emplace(document.path(), std::unique_ptr<ConfigDoc>(document.clone()));
        return document;
    }
    ConfigDoc& cached = *found->second;
    const BDateTime now = BDateTime::Now();
    if (!force && !(now > m_nextCheck)) {
        return cached;
    }
    m_nextCheck = now + BTime(0, 5, 0);
    BDateTime stored;
    if (GetConfigItemTimeStamp(host, cached.path(), stored) != 0) {
        throw std::runtime_error("ConfigurationRepository: Unable to get timestamp");
    }
    if (stored != cached.timestamp()) {
        // Read into a copy, so that a failed read leaves the cached document whole.
        std::unique_ptr<ConfigDoc> fresh(cached.clone());
        if (ReadItem(host, *fresh) != 0) {
            throw std::runtime_error("ConfigurationRepository: Unable to read configuration");
        }
        fresh->timestamp(stored);
        cached.assignFrom(*fresh);
    }
    return cached;
}

int ConfigurationRepository::Store(ConfigDoc& document) {
    const ACE_CString host = document.isLocal() ? m_virtualHostName : GetMasterHostName();
    if (!WriteItem(host, document)) {
        return -1;
    }
    ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
    std::unique_ptr<ConfigDoc>& cached = m_cache[document.path()];
    cached.reset(document.clone());
    return 0;
}

int ConfigurationRepository::ReadItem(const ACE_CString& name, ConfigDoc& document) {
    try {
        return DocumentCodec::readItem(
            name, document,
            [this](const ACE_CString& host, const ACE_CString& path, Quorvex::ByteArray& bytes,
                   std::size_t& length, BDateTime& timestamp) {
                return Retrieve(host, path, bytes, length, timestamp);
            });
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
    if (found == m_cache.end()) {
        return -1;
    }
    const ConfigDoc& cached = *found->second;
    info.isLocal = cached.isLocal();
    info.version = cached.version();
    info.isLocked = cached.isLocked();
    info.timestamp = cached.timestamp();
    return 0;
}

int ConfigurationRepository::RefreshCache() {
    ACE_Guard<ACE_Thread_Mutex> guard(m_cacheLock);
    try {
        for (auto& entry : m_cache) {
            ConfigCacheItemInfo info;
            if (cacheItemInfo(entry.first, info) == 0) {
                GetLatest_i(*entry.second, true);
            }
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
