// Parsing, authentication and error mapping around the operations.
#include "RequestDispatcher.h"

#include "Answer.h"
#include "Quorvex/Log.h"
#include "RequestRouting.h"

namespace ConfigurationService {
namespace {

// A one-line description of a request for the log: the operation and its names, never its
// document or ticket.
std::string describe(const Request& request) {
    std::string text = request.operation();
    for (const char* field :
         {"Host", "HostName", "ConfigurationName", "ServiceName", "FromServer"}) {
        if (request.has(field)) {
            text += std::string(" ") + field + "=" + request.optional(field);
        }
    }
    return text;
}

Reply failed(int status, const std::string& operation, const std::string& message,
             const std::string& key = std::string()) {
    return Reply{status, Answer::failure(operation, message, key)};
}

}  // namespace

RequestDispatcher::RequestDispatcher(ServiceContext& context, const TicketCheck& tickets)
    : m_tickets(tickets), m_items(context), m_site(context) {
    m_items.registerInto(m_table);
    m_site.registerInto(m_table);
}

Reply RequestDispatcher::dispatch(std::string& body, const std::vector<std::string>& cookieHeaders,
                                  const std::string& peer) const {
    Request request;
    try {
        request = Request::parse(body);
    } catch (const BadRequest& e) {
        QUORVEX_LOG(LM_DEBUG, "RequestDispatcher: bad request from %s: %s\n", peer.c_str(),
                    e.what());
        return failed(400, "", e.what());
    }
    const Operations::Entry* entry = m_table.find(request.operation());
    Reply reply;
    if (entry == nullptr) {
        reply = failed(400, "", "unknown operation \"" + request.operation() + "\"");
    } else if (entry->needsTicket && !m_tickets.accepts(cookieHeaders)) {
        reply = failed(403, request.operation(),
                       "access denied: the request does not carry this machine's service ticket "
                       "in cookie OrvelWebApplication");
    } else {
        reply = run(*entry, request);
    }
    QUORVEX_LOG(LM_DEBUG, "RequestDispatcher: %s from %s: %d, %d bytes\n",
                describe(request).c_str(), peer.c_str(), reply.status,
                static_cast<int>(reply.size()));
    return reply;
}

bool RequestDispatcher::isQuick(const std::string& body) const {
    return RequestRouting::isQuick(body);
}

Reply RequestDispatcher::run(const Operations::Entry& entry, const Request& request) const {
    const std::string& operation = request.operation();
    // Legacy clients judge the answer by its ReturnStatus only, so their failures come as 200.
    const auto status = [&entry](int wanted) { return entry.legacy ? 200 : wanted; };
    try {
        return entry.handler(request);
    } catch (const OperationFailed& e) {
        return failed(status(e.status()), operation, e.what(), e.errorKey());
    } catch (const BadRequest& e) {
        return failed(status(400), operation, e.what());
    } catch (const std::exception& e) {
        QUORVEX_LOG(LM_ERROR, "RequestDispatcher: %s failed: %s\n", operation.c_str(), e.what());
        return failed(status(500), operation, std::string("internal error: ") + e.what());
    }
}

}  // namespace ConfigurationService
