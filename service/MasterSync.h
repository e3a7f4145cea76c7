// MasterSync: brings a slave's store up to date with the master's: every item of the master that
// is missing here, or stored here with another last-modified time, is copied with the master's
// time (so the next run copies nothing). A slave runs it when it hears that the configuration
// changed, before it wakes the machine's processes, so that what they re-read is the new state.
// Thread-safe (a run holds its own lock so two runs don't copy twice).
#pragma once

#include <cstddef>
#include <mutex>

#include "ServiceContext.h"

namespace ConfigurationService {

class MasterSync {
public:
    explicit MasterSync(ServiceContext& context) : m_context(context) {}
    // Copies what changed; returns how many items were copied. Throws std::exception when the
    // master cannot be listed; an item that cannot be copied is logged and skipped.
    std::size_t run();

private:
    ServiceContext& m_context;
    std::mutex m_running;
};

}  // namespace ConfigurationService
