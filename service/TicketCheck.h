// TicketCheck: whether a request carries this machine's service ticket in its cookie
// "OrvelWebApplication". The ticket is compared in constant time and never logged. Immutable
// after construction; thread-safe.
#pragma once

#include <string>
#include <vector>

namespace ConfigurationService {

class TicketCheck {
public:
    static constexpr const char* kCookieName = "OrvelWebApplication";

    // Accepts requests that carry ticket (an empty ticket accepts none).
    explicit TicketCheck(std::string ticket) : m_ticket(std::move(ticket)) {}

    // Whether the "Cookie" header values carry the ticket.
    bool accepts(const std::vector<std::string>& cookieHeaders) const;
    // The value of a cookie in the header values; false when absent.
    static bool cookieValue(const std::vector<std::string>& cookieHeaders, const std::string& name,
                            std::string& value);

    // This machine's ticket from the ServerInterop module; throws std::runtime_error when the
    // module is missing or has none.
    static std::string machineTicket();

private:
    std::string m_ticket;
};

}  // namespace ConfigurationService
