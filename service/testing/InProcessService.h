// InProcessService: a configuration service running inside the test process on 127.0.0.1 with an
// ephemeral port, a scratch store directory, its own change-event directory and a service
// ticket. Starts in the constructor (serving on a thread of its own) and stops in the
// destructor. Not thread-safe; one per test.
#pragma once

#include <memory>
#include <string>
#include <thread>

#include "ConfigurationServer.h"
#include "TicketFile.h"
#include "testing/ScratchDir.h"

namespace ServiceTesting {

class InProcessService {
public:
    static constexpr const char* kTicket = "test-ticket-4711";

    // options may preset anything but the port, the store and the event directory.
    explicit InProcessService(ConfigurationService::ServiceOptions options = {});
    ~InProcessService();
    InProcessService(const InProcessService&) = delete;
    InProcessService& operator=(const InProcessService&) = delete;

    int port() const { return m_server->port(); }
    // "127.0.0.1:<port>".
    std::string address() const { return "127.0.0.1:" + std::to_string(port()); }
    // The cookie header value that carries the ticket.
    static std::string ticketCookie() { return std::string("OrvelWebApplication=") + kTicket; }
    ConfigurationService::ConfigurationServer& server() { return *m_server; }
    const std::string& storeDirectory() const { return m_storeDirectory; }
    const std::string& eventDirectory() const { return m_eventDirectory; }

private:
    Quorvex::Testing::ScratchDir m_scratch;
    TicketFile m_ticket;
    std::string m_storeDirectory;
    std::string m_eventDirectory;
    std::unique_ptr<ConfigurationService::ConfigurationServer> m_server;
    std::thread m_runner;
};

}  // namespace ServiceTesting
