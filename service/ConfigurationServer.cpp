// One configuration-service instance: store, master link, change event and HTTP front.
#include "ConfigurationServer.h"

#include <stdexcept>

#include "HttpFront.h"
#include "Quorvex/Host.h"
#include "RequestDispatcher.h"
#include "TimeText.h"
#include "workflow/WorkflowDispatcher.h"

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
    m_workflow.reset(new Workflow::WorkflowStore(
        workflowDatabase(options),
        Workflow::Limits{options.maxFoldersPerUser, options.maxItemsPerFolder}));
    m_workflowDispatcher.reset(new Workflow::WorkflowDispatcher(*m_workflow, *m_tickets));
    m_routes.reset(new Routes());
    m_routes->add(RequestRouting::kServicePath, *m_dispatcher);
    m_routes->add(Workflow::WorkflowDispatcher::kPath, *m_workflowDispatcher);
    m_front.reset(new HttpFront(options, *m_tickets, *m_routes));
    m_port = m_front->port();
    m_context->port = m_port;
}

ConfigurationServer::~ConfigurationServer() = default;

std::string ConfigurationServer::workflowDatabase(const ServiceOptions& options) {
    if (!options.workflowDatabase.empty()) {
        return options.workflowDatabase;
    }
    std::string store = options.storeDirectory;
    while (store.size() > 1 && store.back() == '/') {
        store.pop_back();
    }
    return store + ".workflow.sqlite";
}

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
