// Writing a private ticket file for tests.
#include "TicketFile.h"

#include <fcntl.h>
#include <unistd.h>

#include <cstdlib>
#include <stdexcept>

namespace ServiceTesting {

TicketFile::TicketFile(const std::string& directory, const std::string& ticket)
    : m_ticket(ticket), m_path(directory + "/service-ticket") {
    const int fd = ::open(m_path.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0600);
    if (fd < 0 ||
        ::write(fd, ticket.data(), ticket.size()) != static_cast<ssize_t>(ticket.size())) {
        throw std::runtime_error("TicketFile: cannot write " + m_path);
    }
    ::close(fd);
    ::setenv("QUORVEX_SERVICE_TICKET_FILE", m_path.c_str(), 1);
}

}  // namespace ServiceTesting
