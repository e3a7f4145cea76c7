// ExitStatus: configctl's exit statuses, one per kind of failure a script may want to tell apart,
// and the mapping from the exception a command ended with. Stateless; thread-safe.
#pragma once

#include <exception>

namespace Configctl {

enum ExitStatus : int {
    kExitOk = 0,
    kExitFailed = 1,        // any other failure
    kExitCheckFound = 2,    // check: the site has mistakes
    kExitNotFound = 3,      // the document or path does not exist
    kExitAccessDenied = 4,  // the service refused the ticket, or there is no usable ticket
    kExitUnreachable = 5,   // no answer from the service
    kExitBadInput = 6,      // bad options or arguments, an unreadable or malformed input file
};

// The exit status for a command that ended with this exception.
int exitStatusFor(const std::exception& error);

}  // namespace Configctl
