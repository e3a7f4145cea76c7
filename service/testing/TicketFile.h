// TicketFile: a machine service ticket for tests: a private file in a scratch folder, named in
// $QUORVEX_SERVICE_TICKET_FILE for this process and the services it starts. Restores nothing
// (tests keep one per process). Not thread-safe.
#pragma once

#include <string>

namespace ServiceTesting {

class TicketFile {
public:
    // Writes ticket to a 0600 file under directory and points the environment at it.
    TicketFile(const std::string& directory, const std::string& ticket);

    const std::string& ticket() const { return m_ticket; }
    const std::string& path() const { return m_path; }

private:
    std::string m_ticket;
    std::string m_path;
};

}  // namespace ServiceTesting
