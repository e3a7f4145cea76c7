// FrontContext: what every connection of the HTTP front shares: the limits, the ticket check
// and the routes whose handlers answer bodies, the worker pool for operations that may block, and
// the connection and body-memory accounts, and the trim after large traffic. Owned by HttpFront,
// which outlives its connections. The members are thread-safe.
#pragma once

#include <boost/asio/thread_pool.hpp>
#include <chrono>
#include <cstddef>

#include "BodyBudget.h"
#include "MemoryTrimmer.h"
#include "PeerLimiter.h"
#include "Routes.h"
#include "TicketCheck.h"

namespace ConfigurationService {

struct FrontLimits {
    std::size_t maxBodyBytes = 0;
    std::chrono::seconds keepAlive{5};        // idle time between requests
    std::chrono::seconds requestTimeout{10};  // a whole head; bodies and answers get more by size
};

struct FrontContext {
    FrontLimits limits;
    const TicketCheck& tickets;
    const Routes& routes;
    boost::asio::thread_pool& workers;
    PeerLimiter& peers;
    BodyBudget& bodies;
    MemoryTrimmer& trimmer;
};

}  // namespace ConfigurationService
