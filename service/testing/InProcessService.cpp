// A configuration service on a thread of the test process.
#include "InProcessService.h"

#include <chrono>
#include <cstdlib>
#include <stdexcept>

namespace ServiceTesting {

InProcessService::InProcessService(ConfigurationService::ServiceOptions options)
    : m_ticket(m_scratch.path(), kTicket),
      m_storeDirectory(m_scratch.file("store")),
      m_eventDirectory(m_scratch.file("events")) {
    ::setenv("QUORVEX_EVENT_DIR", m_eventDirectory.c_str(), 1);
    options.port = 0;
    options.storeDirectory = m_storeDirectory;
    options.eventDirectory = m_eventDirectory;
    if (options.hostName.empty()) {
        options.hostName = "TestHost";
    }
    m_server.reset(new ConfigurationService::ConfigurationServer(options, kTicket));
    m_runner = std::thread([this] { m_server->run(); });
    for (int i = 0; i < 400 && !m_server->running(); ++i) {
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    }
    if (!m_server->running()) {
        m_server->stop();
        m_runner.join();
        throw std::runtime_error("InProcessService: the server did not start");
    }
}

InProcessService::~InProcessService() {
    m_server->stop();
    m_runner.join();
}

}  // namespace ServiceTesting
