// How a new process-wide repository learns the site's master configuration host. The repository
// layer only asks; the system layer answers from the machine's own system document
// (machineMasterSource, defined there), and a test may hand in another source.
// Implementations are called once, while instance() creates the repository, under its lock.
#pragma once

#include <ace/SString.h>

namespace Configuration {

class ConfigurationRepository;

class MasterSource {
public:
    virtual ~MasterSource() = default;
    // The master's host name read through repository, or empty when it cannot be learnt (the
    // machine is then its own master).
    virtual ACE_CString masterHostName(ConfigurationRepository& repository) const = 0;
};

// The machine's source: the master named by its system document.
const MasterSource& machineMasterSource();

}  // namespace Configuration
