// The event-driven HTTP server: listening, accepting and the socket threads.
#include "HttpFront.h"

#include <atomic>
#include <boost/asio/executor_work_guard.hpp>
#include <boost/asio/io_context.hpp>
#include <boost/asio/ip/tcp.hpp>
#include <boost/asio/steady_timer.hpp>
#include <stdexcept>
#include <thread>
#include <vector>

#include "HttpConnection.h"
#include "Quorvex/Log.h"

namespace ConfigurationService {
namespace {

namespace net = boost::asio;
using net::ip::tcp;

constexpr int kListenBacklog = 1024;
constexpr int kAcceptBurst = 64;                       // connections taken from the backlog at once
constexpr std::chrono::milliseconds kAcceptPause{50};  // after running out of descriptors
// Free memory goes back to the system once large traffic has paused this long.
constexpr std::chrono::milliseconds kTrimAfterQuiet{200};

FrontLimits limitsOf(const ServiceOptions& options) {
    FrontLimits limits;
    limits.maxBodyBytes = options.maxBodyBytes;
    limits.keepAlive = std::chrono::seconds(options.keepAliveSeconds);
    limits.requestTimeout = std::chrono::seconds(options.requestTimeoutSeconds);
    return limits;
}

}  // namespace

struct HttpFront::State {
    State(const ServiceOptions& options, const TicketCheck& tickets, const Routes& routes)
        : peers(static_cast<std::size_t>(options.maxConnections),
                static_cast<std::size_t>(options.maxConnectionsPerPeer)),
          bodies(options.maxBodyMemory),
          io(makeContexts(options.ioThreads)),
          acceptor(*io.front()),
          pause(*io.front()),
          workers(static_cast<std::size_t>(options.threads)),
          trimmer(workers, kTrimAfterQuiet),
          context{limitsOf(options), tickets, routes, workers, peers, bodies, trimmer} {}

    static std::vector<std::unique_ptr<net::io_context>> makeContexts(int count);
    void listen(const ServiceOptions& options);
    void accept();
    void acceptWaiting();
    void admit(tcp::socket socket);
    static void serve(net::io_context& context);

    PeerLimiter peers;
    BodyBudget bodies;
    // One context per socket thread: a connection lives on one of them, so its handlers never
    // run at the same time and need no strand. The first one also accepts.
    std::vector<std::unique_ptr<net::io_context>> io;
    std::size_t next = 0;  // the context of the next connection (used by the accepting thread)
    // Keeps every socket thread running while its context has no connection.
    std::vector<net::executor_work_guard<net::io_context::executor_type>> busy;
    tcp::acceptor acceptor;
    net::steady_timer pause;
    net::thread_pool workers;  // declared after io: joined before io's pending work is dropped
    MemoryTrimmer trimmer;     // runs on workers
    FrontContext context;
    std::atomic<bool> running{false};
    int port = 0;
};

std::vector<std::unique_ptr<net::io_context>> HttpFront::State::makeContexts(int count) {
    std::vector<std::unique_ptr<net::io_context>> contexts;
    for (int i = 0; i < count; ++i) {
        contexts.emplace_back(new net::io_context(1));
    }
    return contexts;
}

void HttpFront::State::listen(const ServiceOptions& options) {
    boost::system::error_code error;
    const tcp::endpoint endpoint(net::ip::make_address(options.bindAddress, error),
                                 static_cast<unsigned short>(options.port));
    if (!error) {
        acceptor.open(endpoint.protocol(), error);
    }
    if (!error) {
        // SO_REUSEADDR only: SO_REUSEPORT would let a second instance share the port unnoticed.
        acceptor.set_option(tcp::acceptor::reuse_address(true), error);
        acceptor.bind(endpoint, error);
    }
    if (!error) {
        acceptor.listen(kListenBacklog, error);
    }
    if (!error) {
        acceptor.non_blocking(true, error);  // acceptWaiting() never blocks
    }
    if (!error) {
        port = acceptor.local_endpoint(error).port();
    }
    if (error) {
        throw std::runtime_error("cannot listen on " + options.bindAddress + ":" +
                                 std::to_string(options.port) + ": " + error.message());
    }
}

void HttpFront::State::accept() {
    acceptor.async_accept([this](boost::system::error_code error, tcp::socket socket) {
        if (!acceptor.is_open() || error == net::error::operation_aborted) {
            return;
        }
        if (!error) {
            admit(std::move(socket));
            acceptWaiting();
            accept();
            return;
        }
        QUORVEX_LOG(LM_WARNING, "HttpFront: accept failed: %s\n", error.message().c_str());
        pause.expires_after(kAcceptPause);
        pause.async_wait([this](boost::system::error_code) { accept(); });
    });
}

// Takes the connections already waiting in the backlog without another round through the loop.
void HttpFront::State::acceptWaiting() {
    for (int i = 0; i < kAcceptBurst; ++i) {
        boost::system::error_code error;
        tcp::socket socket(*io.front());
        acceptor.accept(socket, error);
        if (error) {
            return;
        }
        admit(std::move(socket));
    }
}

// Admits a new connection within the caps and hands it to the next socket thread; one over a
// cap is closed at once.
void HttpFront::State::admit(tcp::socket accepted) {
    boost::system::error_code error;
    const tcp::endpoint peer = accepted.remote_endpoint(error);
    if (error) {
        return;
    }
    const std::string address = peer.address().to_string();
    PeerLimiter::Slot slot = peers.admit(address);
    if (!slot) {
        QUORVEX_LOG(LM_DEBUG, "HttpFront: too many connections, closing one from %s\n",
                    address.c_str());
        return;
    }
    accepted.set_option(tcp::no_delay(true), error);
    net::io_context& home = *io[next];
    next = (next + 1) % io.size();
    const tcp protocol = peer.protocol();
    HttpConnection::Socket socket(home.get_executor(), protocol, accepted.release(error));
    if (error) {
        return;
    }
    std::make_shared<HttpConnection>(std::move(socket), address, std::move(slot), context)->start();
}

// Runs one socket loop; a failure escaping a handler is logged and the loop goes on.
void HttpFront::State::serve(net::io_context& context) {
    for (;;) {
        try {
            context.run();
            return;
        } catch (const std::exception& e) {
            QUORVEX_LOG(LM_ERROR, "HttpFront: %s\n", e.what());
        }
    }
}

HttpFront::HttpFront(const ServiceOptions& options, const TicketCheck& tickets,
                     const Routes& routes)
    : m_state(new State(options, tickets, routes)) {
    for (auto& context : m_state->io) {
        m_state->busy.push_back(net::make_work_guard(*context));
    }
    m_state->listen(options);
    m_state->accept();
}

HttpFront::~HttpFront() {
    stop();
    m_state->trimmer.cancel();
    m_state->workers.join();
}

int HttpFront::port() const {
    return m_state->port;
}

bool HttpFront::run() {
    m_state->running = true;
    std::vector<std::thread> others;
    for (std::size_t i = 1; i < m_state->io.size(); ++i) {
        others.emplace_back([this, i] { State::serve(*m_state->io[i]); });
    }
    State::serve(*m_state->io.front());
    for (std::thread& thread : others) {
        thread.join();
    }
    m_state->running = false;
    return true;
}

void HttpFront::stop() {
    for (auto& context : m_state->io) {
        context->stop();
    }
}

bool HttpFront::running() const {
    return m_state->running;
}

std::size_t HttpFront::openConnections() const {
    return m_state->peers.open();
}

}  // namespace ConfigurationService
