// The embedded directory store: items in memory, each mirrored durably by one file.
#include "Store/DirectoryStore.h"

#include <cstring>
#include <stdexcept>

#include "ItemFile.h"
#include "Quorvex/Host.h"
#include "Quorvex/Log.h"
#include "Quorvex/Machine.h"
#include "StoreFileName.h"

namespace Configuration {
namespace {

std::string toStd(const ACE_CString& text) {
    return std::string(text.c_str(), text.length());
}

ACE_CString toAce(const std::string& text) {
    return ACE_CString(text.data(), text.size());
}

bool holdsNul(const ACE_CString& text) {
    return std::memchr(text.c_str(), '\0', text.length()) != nullptr;
}

void validate(const ACE_CString& host, const ACE_CString& name) {
    if (host.length() == 0) {
        throw std::invalid_argument("DirectoryStore: the host name is empty");
    }
    if (holdsNul(host)) {
        throw std::invalid_argument("DirectoryStore: the host name holds a NUL character");
    }
    if (host == DirectoryStore::kAllHosts) {
        throw std::invalid_argument("DirectoryStore: \"*\" is not a host name");
    }
    if (name.length() == 0) {
        throw std::invalid_argument("DirectoryStore: the configuration name is empty");
    }
    if (holdsNul(name)) {
        throw std::invalid_argument("DirectoryStore: the configuration name holds a NUL character");
    }
}

std::string makeKey(const std::string& lowerCaseHost, const std::string& name) {
    return lowerCaseHost + std::string(1, '\0') + name;
}

}  // namespace

DirectoryStore::DirectoryStore(const ACE_CString& directory) : m_directory(toStd(directory)) {
    load();
}

void DirectoryStore::load() {
    for (const std::string& fileName : m_directory.entries()) {
        if (StoreFileName::isItemFile(fileName)) {
            loadItem(fileName);
        } else if (fileName == SiteRegistry::kFileName) {
            loadRegistry();
        }
    }
    QUORVEX_LOG(LM_INFO, "DirectoryStore: %d items in %s\n", static_cast<int>(m_items.size()),
                m_directory.path().c_str());
}

void DirectoryStore::loadItem(const std::string& fileName) {
    std::string content;
    ItemFile::Parsed parsed;
    if (!m_directory.readFile(fileName, content) || !ItemFile::parse(content, parsed)) {
        QUORVEX_LOG(LM_ERROR, "DirectoryStore: %s is not an item file; ignored\n",
                    fileName.c_str());
        return;
    }
    const std::string lower = Quorvex::HostKey(parsed.host);
    if (StoreFileName::item(lower, parsed.name) != fileName) {
        QUORVEX_LOG(LM_ERROR, "DirectoryStore: %s holds an item of another name; ignored\n",
                    fileName.c_str());
        return;
    }
    Entry entry;
    entry.item.host = toAce(parsed.host);
    entry.item.name = toAce(parsed.name);
    entry.item.lastModifiedMs = parsed.lastModifiedMs;
    entry.item.bytes =
        std::make_shared<const std::string>(content, parsed.dataOffset, parsed.dataSize);
    entry.fileName = fileName;
    const std::string key = makeKey(lower, parsed.name);
    m_fileOwners[fileName] = key;
    m_items[key] = std::move(entry);
}

void DirectoryStore::loadRegistry() {
    std::string content;
    if (!m_directory.readFile(SiteRegistry::kFileName, content) || !m_registry.parse(content)) {
        throw std::runtime_error("DirectoryStore: the registry file in " + m_directory.path() +
                                 " is damaged");
    }
}

std::int64_t DirectoryStore::nextTime() {
    const std::int64_t now = Quorvex::CurrentMachine().nowMilliseconds();
    std::int64_t last = m_lastIssuedMs.load();
    std::int64_t next;
    do {
        next = now > last ? now : last + 1;
    } while (!m_lastIssuedMs.compare_exchange_weak(last, next));
    return next;
}

std::int64_t DirectoryStore::store(const ACE_CString& host, const ACE_CString& name,
                                   const void* data, std::size_t size,
                                   std::int64_t lastModifiedMs) {
    validate(host, name);
    const std::string hostText = toStd(host);
    const std::string nameText = toStd(name);
    const std::string lower = Quorvex::HostKey(hostText);
    Entry entry;
    entry.fileName = StoreFileName::item(lower, nameText);
    entry.item.host = host;
    entry.item.name = name;
    entry.item.lastModifiedMs = lastModifiedMs == kNow ? nextTime() : lastModifiedMs;
    entry.item.bytes = std::make_shared<const std::string>(static_cast<const char*>(data), size);

    const std::string header =
        ItemFile::header(hostText, nameText, entry.item.lastModifiedMs, size);
    DurableDirectory::Prepared prepared =
        m_directory.prepare({{header.data(), header.size()}, {data, size}});
    const std::int64_t kept = entry.item.lastModifiedMs;
    std::uint64_t ticket = 0;
    commitItem(makeKey(lower, nameText), std::move(entry), prepared, ticket);
    m_directory.syncThrough(ticket);
    m_directory.recycle(prepared);
    return kept;
}

void DirectoryStore::commitItem(const std::string& key, Entry entry,
                                DurableDirectory::Prepared& prepared, std::uint64_t& ticket) {
    // The rename and the index change happen together, so memory and disk agree on which of
    // two concurrent stores of one item came last.
    std::unique_lock<std::shared_mutex> lock(m_itemsMutex);
    auto owner = m_fileOwners.find(entry.fileName);
    if (owner != m_fileOwners.end() && owner->second != key) {
        m_directory.discard(prepared);
        throw std::runtime_error(
            "DirectoryStore: the file name of this item is taken by another "
            "item with a very long name");
    }
    ticket = m_directory.commit(prepared, entry.fileName);
    m_fileOwners[entry.fileName] = key;
    m_items[key] = std::move(entry);
}

bool DirectoryStore::retrieve(const ACE_CString& host, const ACE_CString& name,
                              StoredItem& item) const {
    const std::string key = makeKey(Quorvex::HostKey(toStd(host)), toStd(name));
    std::shared_lock<std::shared_mutex> lock(m_itemsMutex);
    auto it = m_items.find(key);
    if (it == m_items.end()) {
        return false;
    }
    item = it->second.item;
    return true;
}

bool DirectoryStore::exists(const ACE_CString& host, const ACE_CString& name) const {
    const std::string key = makeKey(Quorvex::HostKey(toStd(host)), toStd(name));
    std::shared_lock<std::shared_mutex> lock(m_itemsMutex);
    return m_items.count(key) != 0;
}

bool DirectoryStore::remove(const ACE_CString& host, const ACE_CString& name) {
    const std::string key = makeKey(Quorvex::HostKey(toStd(host)), toStd(name));
    std::uint64_t ticket = 0;
    {
        std::unique_lock<std::shared_mutex> lock(m_itemsMutex);
        auto it = m_items.find(key);
        if (it == m_items.end()) {
            return false;
        }
        ticket = m_directory.remove(it->second.fileName);
        m_fileOwners.erase(it->second.fileName);
        m_items.erase(it);
    }
    m_directory.syncThrough(ticket);
    return true;
}

template <typename Visit>
std::size_t DirectoryStore::visitLocked(const ACE_CString& host, const Visit& visit) const {
    auto begin = m_items.begin();
    auto end = m_items.end();
    if (host != kAllHosts) {
        // Keys are the lower-case host, NUL, the name: the host's items lie between its key
        // followed by NUL and its key followed by the next byte.
        const std::string hostKey = Quorvex::HostKey(toStd(host));
        begin = m_items.lower_bound(hostKey + std::string(1, '\0'));
        end = m_items.lower_bound(hostKey + std::string(1, '\1'));
    }
    std::size_t count = 0;
    for (auto it = begin; it != end; ++it, ++count) {
        visit(it->second.item);
    }
    return count;
}

std::vector<StoredItem> DirectoryStore::list(const ACE_CString& host) const {
    std::vector<StoredItem> items;
    // Counted first so the copies are made once: StoredItem's strings copy on every move.
    std::shared_lock<std::shared_mutex> lock(m_itemsMutex);
    items.reserve(visitLocked(host, [](const StoredItem&) {}));
    visitLocked(host, [&items](const StoredItem& item) { items.push_back(item); });
    return items;
}

void DirectoryStore::read(
    const ACE_CString& host,
    const std::function<void(const std::vector<const StoredItem*>&)>& read) const {
    // One walk over the tree, whose nodes are scattered in memory; growing a vector of pointers
    // costs less than a second walk to count them.
    std::vector<const StoredItem*> items;
    std::shared_lock<std::shared_mutex> lock(m_itemsMutex);
    visitLocked(host, [&items](const StoredItem& item) { items.push_back(&item); });
    read(items);
}

std::size_t DirectoryStore::size() const {
    std::shared_lock<std::shared_mutex> lock(m_itemsMutex);
    return m_items.size();
}

void DirectoryStore::saveRegistry(const SiteRegistry& registry) {
    const std::string text = registry.serialize();
    m_directory.writeFile(SiteRegistry::kFileName, {{text.data(), text.size()}});
}

void DirectoryStore::registerService(const ACE_CString& host, const ACE_CString& service,
                                     const ACE_CString& connection) {
    validate(host, service);
    std::lock_guard<std::mutex> lock(m_registryMutex);
    SiteRegistry changed = m_registry;
    changed.registerService(ServiceRegistration{host, service, connection});
    saveRegistry(changed);
    m_registry = changed;
}

bool DirectoryStore::unregisterService(const ACE_CString& host, const ACE_CString& service) {
    std::lock_guard<std::mutex> lock(m_registryMutex);
    SiteRegistry changed = m_registry;
    if (!changed.unregisterService(host, service)) {
        return false;
    }
    saveRegistry(changed);
    m_registry = changed;
    return true;
}

std::vector<ServiceRegistration> DirectoryStore::services() const {
    std::lock_guard<std::mutex> lock(m_registryMutex);
    return m_registry.services();
}

void DirectoryStore::setSetting(const ACE_CString& key, const ACE_CString& value) {
    std::lock_guard<std::mutex> lock(m_registryMutex);
    SiteRegistry changed = m_registry;
    changed.setSetting(toStd(key), toStd(value));
    saveRegistry(changed);
    m_registry = changed;
}

bool DirectoryStore::setting(const ACE_CString& key, ACE_CString& value) const {
    std::lock_guard<std::mutex> lock(m_registryMutex);
    auto it = m_registry.settings().find(toStd(key));
    if (it == m_registry.settings().end()) {
        return false;
    }
    value = toAce(it->second);
    return true;
}

}  // namespace Configuration
