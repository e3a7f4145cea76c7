#include "client/HostNameMap.h"

#include <ace/Guard_T.h>
#include <ace/Object_Manager.h>

#include <stdexcept>

namespace Configuration {

ACE_CString HttpConfigurationClient::HostNameMap::retrieve(const ACE_CString& server,
                                                           const Query& query,
                                                           const SendFunction& sendRequest) {
    ACE_CString name = find(server);  // first look-up without the lock
    if (!name.empty()) {
        return name;
    }
    ACE_Thread_Mutex* mutex = lock();
    if (mutex == nullptr) {
        throw std::runtime_error(query.lockFailure);
    }
    ACE_Guard<ACE_Thread_Mutex> guard(*mutex);
    if (!guard.locked()) {
        return ACE_CString();
    }
    name = find(server);
    if (!name.empty()) {
        return name;
    }
    const ACE_CString response = sendRequest(query.request);
    ACE_CString::size_type next = 0;
    if (!findElementText(ELEMENT_HOST_NAME, response, 0, name, next)) {
        throw std::runtime_error(query.missing);
    }
    store(server, name);  // an empty name is stored too, and asked for again next time
    return name;
}

ACE_CString HttpConfigurationClient::HostNameMap::find(const ACE_CString& server) const {
    const Snapshot* snapshot = m_current.load(std::memory_order_acquire);
    if (snapshot == nullptr) {
        return ACE_CString();
    }
    const auto found = snapshot->entries.find(server);
    return found == snapshot->entries.end() ? ACE_CString() : found->second;
}

void HttpConfigurationClient::HostNameMap::store(const ACE_CString& server,
                                                 const ACE_CString& name) {
    const Snapshot* current = m_current.load(std::memory_order_relaxed);
    // Copy on write: readers keep using the snapshot they loaded.
    auto* next =
        new Snapshot{current ? current->entries : std::map<ACE_CString, ACE_CString>(), current};
    next->entries[server] = name;
    m_current.store(next, std::memory_order_release);
}

ACE_Thread_Mutex* HttpConfigurationClient::HostNameMap::lock() {
    // ACE hands out the mutex lazily; asking once per map keeps its check-then-create unraced.
    std::call_once(m_lockOnce, [this] {
        ACE_Thread_Mutex* mutex = nullptr;
        if (ACE_Object_Manager::get_singleton_lock(mutex) == 0) {
            m_lock = mutex;
        }
    });
    return m_lock;
}

}  // namespace Configuration
