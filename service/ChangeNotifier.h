// ChangeNotifier: sets this machine's named change event "Global\QuorvexSlaveConfigurationChanged"
// so that every process on the machine refreshes its configuration. The event directory is
// $QUORVEX_EVENT_DIR as set when the notifier is created. Thread-safe.
#pragma once

#include <memory>
#include <mutex>
#include <string>

namespace Common {
class NamedEvent;
}

namespace ConfigurationService {

class ChangeNotifier {
public:
    static constexpr const char* kEventName = "Global\\QuorvexSlaveConfigurationChanged";

    // Opens the event; throws std::runtime_error when it cannot be opened.
    ChangeNotifier();
    ~ChangeNotifier();
    ChangeNotifier(const ChangeNotifier&) = delete;
    ChangeNotifier& operator=(const ChangeNotifier&) = delete;

    // Sets the event; false (after a log line) when that failed.
    bool signal(const std::string& reason);
    // The file that stands for the event.
    std::string path() const;

private:
    std::mutex m_mutex;
    std::unique_ptr<Common::NamedEvent> m_event;
};

}  // namespace ConfigurationService
