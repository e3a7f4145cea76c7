// HttpFront: the HTTP/1.1 server of the configuration service, event-driven over Boost.Asio and
// Boost.Beast: a few socket threads run every connection (an idle or slow connection costs a
// socket and a small buffer, never a thread), a worker pool runs the operations that may block,
// and caps on connections per peer, request deadlines and a shared body budget keep slow or
// hostile peers from starving the others. Answers POST to each path of its Routes by handing the
// body to that path's handler. Owns its sockets and threads; the ticket check and the routes must
// outlive it. run() blocks the calling thread; stop(), running() and openConnections() are
// thread-safe.
#pragma once

#include <cstddef>
#include <memory>

#include "ServiceOptions.h"

namespace ConfigurationService {

class Routes;
class TicketCheck;

class HttpFront {
public:
    // Binds and listens on the options' address and port; throws std::runtime_error when it
    // cannot.
    HttpFront(const ServiceOptions& options, const TicketCheck& tickets, const Routes& routes);
    ~HttpFront();
    HttpFront(const HttpFront&) = delete;
    HttpFront& operator=(const HttpFront&) = delete;

    // The port it listens on.
    int port() const;
    // Serves until stop() on the calling thread and the other socket threads; true when it
    // stopped because it was asked to.
    bool run();
    // Stops serving; run() returns. May come before run().
    void stop();
    // Whether run() is serving.
    bool running() const;
    // Client connections open now.
    std::size_t openConnections() const;

private:
    struct State;
    std::unique_ptr<State> m_state;
};

}  // namespace ConfigurationService
