// One configuration-service instance: store, master link, change event and HTTP front.
#include "ConfigurationServer.h"

#include <stdexcept>

#include "HttpFront.h"
#include "Quorvex/Host.h"
#include "RequestDispatcher.h"
#include "TimeText.h"

namespace ConfigurationService {
namespace {

std::string ownHostName(const ServiceOptions& options) {
    if (!options.hostName.empty()) {
        return options.hostName;
    }
    const std::string name = Quorvex::GetHostName(false).c_str();
    if (name.empty()) {
        throw std::runtime_error("cannot find this machine's host name; give --host-name");
    }
    return name;
}

}  // namespace

ConfigurationServer::ConfigurationServer(const ServiceOptions& options,
                                         const std::string& serviceTicket)
    : m_store(new Configuration::DirectoryStore(options.storeDirectory.c_str())),
      m_changes(new ChangeNotifier()),
      m_tickets(new TicketCheck(serviceTicket)) {
    const std::string hostName = ownHostName(options);
    m_master.reset(new MasterLink(hostName, options.masterAddress, options.masterHostName));
    m_context.reset(new ServiceContext{*m_store, *m_master, *m_changes, hostName});
    m_context->startedMs = TimeText::now();
    m_dispatcher.reset(new RequestDispatcher(*m_context, *m_tickets));
    m_front.reset(new HttpFront(options, *m_tickets, *m_dispatcher));
    m_port = m_front->port();
    m_context->port = m_port;
}

ConfigurationServer::~ConfigurationServer() = default;

bool ConfigurationServer::run() {
    return m_front->run();
}

void ConfigurationServer::stop() {
    m_front->stop();
}

bool ConfigurationServer::running() const {
    return m_front->running();
}

std::size_t ConfigurationServer::openConnections() const {
    return m_front->openConnections();
}

}  // namespace ConfigurationService
