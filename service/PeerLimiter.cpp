// Connection counts per peer address.
#include "PeerLimiter.h"

namespace ConfigurationService {

PeerLimiter::Slot::Slot(Slot&& other) noexcept
    : m_limiter(other.m_limiter), m_peer(std::move(other.m_peer)) {
    other.m_limiter = nullptr;
}

PeerLimiter::Slot& PeerLimiter::Slot::operator=(Slot&& other) noexcept {
    if (this != &other) {
        release();
        m_limiter = other.m_limiter;
        m_peer = std::move(other.m_peer);
        other.m_limiter = nullptr;
    }
    return *this;
}

PeerLimiter::Slot::~Slot() {
    release();
}

void PeerLimiter::Slot::release() {
    if (m_limiter != nullptr) {
        m_limiter->release(m_peer);
        m_limiter = nullptr;
    }
}

PeerLimiter::Slot PeerLimiter::admit(const std::string& peer) {
    std::lock_guard<std::mutex> lock(m_mutex);
    std::size_t& count = m_perPeer[peer];
    if (m_total >= m_maxTotal || count >= m_maxPerPeer) {
        if (count == 0) {
            m_perPeer.erase(peer);
        }
        return Slot();
    }
    ++count;
    ++m_total;
    return Slot(this, peer);
}

std::size_t PeerLimiter::open() const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_total;
}

void PeerLimiter::release(const std::string& peer) {
    std::lock_guard<std::mutex> lock(m_mutex);
    auto it = m_perPeer.find(peer);
    if (it != m_perPeer.end() && --it->second == 0) {
        m_perPeer.erase(it);
    }
    --m_total;
}

}  // namespace ConfigurationService
