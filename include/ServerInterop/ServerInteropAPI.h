// ServerInterop::ServerInteropAPI: the companion module (libServerInterop.so) that hands out this
// machine's service ticket, the shared secret with which processes on this machine authenticate
// to the configuration service (cookie "OrvelWebApplication"). The configuration library loads the
// module with dlopen and calls GetQuorvexServiceTicket through its mangled name; the configuration
// service checks incoming tickets with the same function.
//
// The ticket is the content of a file readable only by its owner: /etc/quorvex/service-ticket, or
// the file named by the environment variable QUORVEX_SERVICE_TICKET_FILE (see
// docs/SERVICE_TICKET.md). The ticket is never logged. Thread-safe. A ticket read from a file that
// had not changed for a few seconds is kept in memory, and later calls only check (by stat) that
// the file is still that version: same inode, size, modification time, mode and owner; any
// change makes the next call read the file again.
#pragma once

#include <ace/SString.h>

namespace ServerInterop {

class __attribute__((visibility("default"))) ServerInteropAPI {
public:
    // Results of GetQuorvexServiceTicket.
    enum Result {
        TICKET_OK = 0,
        TICKET_FILE_MISSING = 1,     // no ticket file (a machine without a ticket)
        TICKET_FILE_INSECURE = 2,    // not a regular file, group/others have access, or wrong owner
        TICKET_FILE_UNREADABLE = 3,  // could not be read, or larger than MAX_TICKET_LENGTH
        TICKET_MALFORMED = 4,        // empty, or holds characters not allowed in a cookie value
    };
    static constexpr const char* DEFAULT_TICKET_FILE = "/etc/quorvex/service-ticket";
    static constexpr const char* TICKET_FILE_VARIABLE = "QUORVEX_SERVICE_TICKET_FILE";
    static constexpr unsigned MAX_TICKET_LENGTH = 4096;

    // Fills ticket with this machine's service ticket (trailing line breaks removed) and returns
    // TICKET_OK; any other result leaves ticket empty.
    static int GetQuorvexServiceTicket(ACE_String_Base<char>& ticket);
};

}  // namespace ServerInterop
