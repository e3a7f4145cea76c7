#include "LogCollector.h"

#include <ace/Log_Msg.h>
#include <ace/Log_Msg_Backend.h>
#include <ace/Log_Record.h>

namespace Configctl {

// Installed process-wide while the collector lives; remembers the backend it replaced.
class CollectingBackend : public ACE_Log_Msg_Backend {
public:
    explicit CollectingBackend(LogCollector& owner) : m_owner(owner) {}

    ACE_Log_Msg_Backend* previous = nullptr;

    int open(const ACE_TCHAR*) override { return 0; }
    int reset() override { return 0; }
    int close() override { return 0; }
    ssize_t log(ACE_Log_Record& record) override {
        std::string text = record.msg_data() != nullptr ? record.msg_data() : "";
        while (!text.empty() && (text.back() == '\n' || text.back() == '\r')) {
            text.pop_back();
        }
        m_owner.m_messages.push_back(text);
        return 0;
    }

private:
    LogCollector& m_owner;
};

namespace {
const unsigned long kTouchedFlags = ACE_Log_Msg::CUSTOM | ACE_Log_Msg::STDERR;
}  // namespace

LogCollector::LogCollector() {
    auto* backend = new CollectingBackend(*this);
    m_backend = backend;
    ACE_Log_Msg* log = ACE_Log_Msg::instance();
    m_savedFlags = log->flags();
    backend->previous = ACE_Log_Msg::msg_backend(backend);
    log->set_flags(ACE_Log_Msg::CUSTOM);
    log->clr_flags(ACE_Log_Msg::STDERR);
}

LogCollector::~LogCollector() {
    auto* backend = static_cast<CollectingBackend*>(m_backend);
    ACE_Log_Msg* log = ACE_Log_Msg::instance();
    log->clr_flags(kTouchedFlags & ~m_savedFlags);
    log->set_flags(kTouchedFlags & m_savedFlags);
    ACE_Log_Msg::msg_backend(backend->previous);
    delete backend;
}

std::vector<std::string> LogCollector::take() {
    std::vector<std::string> taken;
    taken.swap(m_messages);
    return taken;
}

}  // namespace Configctl
