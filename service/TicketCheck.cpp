// Service-ticket check of incoming requests.
#include "TicketCheck.h"

#include <stdexcept>

#include "Client/ServiceTicketModule.h"

namespace ConfigurationService {
namespace {

std::string trim(const std::string& text) {
    const std::size_t first = text.find_first_not_of(" \t");
    if (first == std::string::npos) {
        return std::string();
    }
    return text.substr(first, text.find_last_not_of(" \t") - first + 1);
}

bool equalInConstantTime(const std::string& a, const std::string& b) {
    unsigned char difference = a.size() == b.size() ? 0 : 1;
    for (std::size_t i = 0; i < a.size(); ++i) {
        difference |= static_cast<unsigned char>(a[i] ^ b[i % (b.empty() ? 1 : b.size())]);
    }
    return difference == 0 && !b.empty();
}

}  // namespace

bool TicketCheck::cookieValue(const std::vector<std::string>& cookieHeaders,
                              const std::string& name, std::string& value) {
    for (const std::string& header : cookieHeaders) {
        std::size_t start = 0;
        while (start < header.size()) {
            std::size_t end = header.find(';', start);
            if (end == std::string::npos) {
                end = header.size();
            }
            const std::string pair = header.substr(start, end - start);
            const std::size_t equals = pair.find('=');
            if (equals != std::string::npos && trim(pair.substr(0, equals)) == name) {
                value = trim(pair.substr(equals + 1));
                return true;
            }
            start = end + 1;
        }
    }
    return false;
}

bool TicketCheck::accepts(const std::vector<std::string>& cookieHeaders) const {
    std::string presented;
    if (m_ticket.empty() || !cookieValue(cookieHeaders, kCookieName, presented)) {
        return false;
    }
    return equalInConstantTime(presented, m_ticket);
}

std::string TicketCheck::machineTicket() {
    ACE_CString ticket;
    if (Configuration::ServiceTicketModule::process().fetch(ticket) != 0 || ticket.length() == 0) {
        throw std::runtime_error(
            "this machine has no service ticket (the ServerInterop module "
            "found none)");
    }
    return std::string(ticket.c_str(), ticket.length());
}

}  // namespace ConfigurationService
