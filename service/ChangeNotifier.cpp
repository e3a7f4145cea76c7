// The machine's change event, set on "Changed", "Refresh" and "Restart".
#include "ChangeNotifier.h"

#include "Common/NamedEvent.h"
#include "Quorvex/Log.h"

namespace ConfigurationService {

ChangeNotifier::ChangeNotifier() : m_event(new Common::NamedEvent(kEventName)) {}

ChangeNotifier::~ChangeNotifier() = default;

bool ChangeNotifier::signal(const std::string& reason) {
    std::lock_guard<std::mutex> lock(m_mutex);
    if (m_event->set() != 0) {
        QUORVEX_LOG(LM_ERROR, "ChangeNotifier::signal: %m: cannot set %s (%s)\n",
                    m_event->path().c_str(), reason.c_str());
        return false;
    }
    QUORVEX_LOG(LM_DEBUG, "ChangeNotifier::signal: %s set (%s)\n", kEventName, reason.c_str());
    return true;
}

std::string ChangeNotifier::path() const {
    return m_event->path().c_str();
}

}  // namespace ConfigurationService
