// Parsing, authentication and error mapping around the user-workflow operations.
#include "workflow/WorkflowDispatcher.h"

#include "Quorvex/Log.h"
#include "workflow/WorkflowAnswers.h"

namespace ConfigurationService {
namespace Workflow {

WorkflowDispatcher::WorkflowDispatcher(WorkflowStore& store, const TicketCheck& tickets)
    : m_store(store), m_tickets(tickets) {
    addNodeOperations();
    addUserOperations();
}

Reply WorkflowDispatcher::dispatch(std::string& body, const std::vector<std::string>& cookieHeaders,
                                   const std::string& peer) const {
    if (!m_tickets.accepts(cookieHeaders)) {
        return Reply{403, WorkflowAnswers::error(WorkflowError(
                              403,
                              "access denied: the request does not carry this machine's service "
                              "ticket in cookie OrvelWebApplication"))};
    }
    WorkflowRequest request;
    Reply reply;
    try {
        request = WorkflowRequest::parse(body);
        reply = run(request);
    } catch (const WorkflowError& e) {
        reply = Reply{e.status(), WorkflowAnswers::error(e)};
    }
    QUORVEX_LOG(LM_DEBUG, "WorkflowDispatcher: %s from %s: %d, %d bytes\n",
                request.operation.c_str(), peer.c_str(), reply.status,
                static_cast<int>(reply.body.size()));
    return reply;
}

Reply WorkflowDispatcher::run(const WorkflowRequest& request) const {
    const auto operation = m_operations.find(request.operation);
    if (operation == m_operations.end()) {
        throw WorkflowError::bad("unknown operation \"" + request.operation + "\"");
    }
    try {
        return Reply{200, operation->second(request)};
    } catch (const WorkflowError&) {
        throw;
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR, "WorkflowDispatcher: %s failed: %s\n", request.operation.c_str(),
                    e.what());
        throw WorkflowError(500, "internal error: " + request.operation +
                                     " could not be carried out; see the service's log");
    }
}

}  // namespace Workflow
}  // namespace ConfigurationService
