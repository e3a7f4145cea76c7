// PeerLimiter: counts the open connections of the HTTP front, in total and per peer address, and
// refuses a new one beyond either cap, so that one peer cannot take every socket of the service.
// A Slot holds one admitted connection and gives it back when destroyed. The limiter must
// outlive its slots. All calls are thread-safe.
#pragma once

#include <cstddef>
#include <map>
#include <mutex>
#include <string>

namespace ConfigurationService {

class PeerLimiter {
public:
    // One admitted connection; empty when refused. Movable, not copyable.
    class Slot {
    public:
        Slot() = default;
        Slot(Slot&& other) noexcept;
        Slot& operator=(Slot&& other) noexcept;
        Slot(const Slot&) = delete;
        Slot& operator=(const Slot&) = delete;
        ~Slot();

        // Whether the connection was admitted.
        explicit operator bool() const { return m_limiter != nullptr; }

    private:
        friend class PeerLimiter;
        Slot(PeerLimiter* limiter, std::string peer)
            : m_limiter(limiter), m_peer(std::move(peer)) {}
        void release();

        PeerLimiter* m_limiter = nullptr;
        std::string m_peer;
    };

    PeerLimiter(std::size_t maxTotal, std::size_t maxPerPeer)
        : m_maxTotal(maxTotal), m_maxPerPeer(maxPerPeer) {}
    PeerLimiter(const PeerLimiter&) = delete;
    PeerLimiter& operator=(const PeerLimiter&) = delete;

    // Admits a connection from peer (an address text), or returns an empty slot over a cap.
    Slot admit(const std::string& peer);
    // Connections open now.
    std::size_t open() const;

private:
    void release(const std::string& peer);

    const std::size_t m_maxTotal;
    const std::size_t m_maxPerPeer;
    mutable std::mutex m_mutex;
    std::size_t m_total = 0;
    std::map<std::string, std::size_t> m_perPeer;
};

}  // namespace ConfigurationService
