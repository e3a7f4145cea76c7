// ConfigurationServer: one configuration-service instance: its directory store, its road to the
// master, its change event, its user-workflow database and its HTTP front (HttpFront) that
// answers POST /Sundrel/ConfigurationService/ConfigurationService.ashx and
// /Sundrel/UserWorkflowService/UserWorkFlow.ashx. Owns everything it uses. run() blocks
// the calling thread; stop() may be called from any thread (for example a signal-watching one).
#pragma once

#include <cstddef>
#include <memory>
#include <string>

#include "RequestRouting.h"
#include "ServiceOptions.h"

namespace Configuration {
class DirectoryStore;
}

namespace ConfigurationService {

class ChangeNotifier;
class HttpFront;
class MasterLink;
class RequestDispatcher;
class Routes;
class TicketCheck;
struct ServiceContext;
namespace Workflow {
class WorkflowDispatcher;
class WorkflowStore;
}  // namespace Workflow

class ConfigurationServer {
public:
    static constexpr const char* kPath = RequestRouting::kServicePath;

    // Opens the store (locking its directory) and the change event and binds the listening
    // socket; requests carrying serviceTicket are accepted. Throws std::runtime_error on failure.
    ConfigurationServer(const ServiceOptions& options, const std::string& serviceTicket);
    ~ConfigurationServer();
    ConfigurationServer(const ConfigurationServer&) = delete;
    ConfigurationServer& operator=(const ConfigurationServer&) = delete;

    // The port it listens on.
    int port() const { return m_port; }
    // Serves requests until stop(); false when the server failed.
    bool run();
    // Stops serving; run() returns. Thread-safe.
    void stop();
    // Whether run() is serving.
    bool running() const;
    // The store (for tests and tools in the same process).
    Configuration::DirectoryStore& store() { return *m_store; }
    // The user-workflow state (for tests and tools in the same process).
    Workflow::WorkflowStore& workflow() { return *m_workflow; }
    // The user-workflow database of options: its own option or beside the store.
    static std::string workflowDatabase(const ServiceOptions& options);
    // Client connections open now.
    std::size_t openConnections() const;

private:
    std::unique_ptr<Configuration::DirectoryStore> m_store;
    std::unique_ptr<MasterLink> m_master;
    std::unique_ptr<ChangeNotifier> m_changes;
    std::unique_ptr<ServiceContext> m_context;
    std::unique_ptr<TicketCheck> m_tickets;
    std::unique_ptr<RequestDispatcher> m_dispatcher;
    std::unique_ptr<Workflow::WorkflowStore> m_workflow;
    std::unique_ptr<Workflow::WorkflowDispatcher> m_workflowDispatcher;
    std::unique_ptr<Routes> m_routes;
    std::unique_ptr<HttpFront> m_front;
    int m_port = 0;
};

}  // namespace ConfigurationService
