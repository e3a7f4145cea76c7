// RequestDispatcher: answers one request body of the configuration service: parses it, checks
// the service ticket (all operations but "GetHostName" and "GetMasterHostName"), runs the
// operation named by the root element and turns every failure into a clear error answer (see
// docs/SERVICE_PROTOCOL.md). Logs each request at debug level without documents or tickets.
// Built once per service; dispatch() is thread-safe.
#pragma once

#include <string>
#include <vector>

#include "ItemOperations.h"
#include "Operations.h"
#include "Routes.h"
#include "ServiceContext.h"
#include "SiteOperations.h"
#include "TicketCheck.h"

namespace ConfigurationService {

class RequestDispatcher : public RouteHandler {
public:
    RequestDispatcher(ServiceContext& context, const TicketCheck& tickets);
    RequestDispatcher(const RequestDispatcher&) = delete;
    RequestDispatcher& operator=(const RequestDispatcher&) = delete;

    // The answer to body (which may be modified), sent with the given "Cookie" header values,
    // from peer (for the log).
    Reply dispatch(std::string& body, const std::vector<std::string>& cookieHeaders,
                   const std::string& peer) const override;
    // Whether the operation of body answers from memory at once (small reads).
    bool isQuick(const std::string& body) const override;

private:
    Reply run(const Operations::Entry& entry, const Request& request) const;

    const TicketCheck& m_tickets;
    ItemOperations m_items;
    SiteOperations m_site;
    Operations m_table;
};

}  // namespace ConfigurationService
