// WorkflowDispatcher: answers the bodies POSTed to the user-workflow path: parses the message,
// checks the service ticket (every operation needs it), runs the operation on the
// WorkflowStore and writes its answer (HTTP 200), or the error record with a non-200 status for
// a failure (see docs/SERVICE_PROTOCOL.md). No answer carries a stack trace or an internal
// detail beyond a one-line message. Logs each request at debug level without its data. Built
// once per service; dispatch() is thread-safe.
#pragma once

#include <functional>
#include <map>
#include <string>
#include <vector>

#include "Routes.h"
#include "TicketCheck.h"
#include "workflow/WorkflowRequest.h"
#include "workflow/WorkflowStore.h"

namespace ConfigurationService {
namespace Workflow {

class WorkflowDispatcher : public RouteHandler {
public:
    static constexpr const char* kPath = "/Sundrel/UserWorkflowService/UserWorkFlow.ashx";

    WorkflowDispatcher(WorkflowStore& store, const TicketCheck& tickets);

    // The answer to one message.
    Reply dispatch(std::string& body, const std::vector<std::string>& cookieHeaders,
                   const std::string& peer) const override;
    // Never: every operation waits for the database.
    bool isQuick(const std::string&) const override { return false; }

private:
    using Handler = std::function<std::string(const WorkflowRequest&)>;
    void addNodeOperations();
    void addUserOperations();
    Reply run(const WorkflowRequest& request) const;

    WorkflowStore& m_store;
    const TicketCheck& m_tickets;
    std::map<std::string, Handler> m_operations;
};

}  // namespace Workflow
}  // namespace ConfigurationService
