// LogCapture: a custom ACE_Log_Msg backend that hands every record to the capture.
#include "LogCapture.h"

#include <ace/Log_Msg.h>
#include <ace/Log_Msg_Backend.h>
#include <ace/Log_Record.h>

#include <algorithm>

namespace Quorvex {
namespace Testing {
namespace {

// Installed process-wide while the capture lives; remembers the backend it replaced.
class CaptureBackend : public ACE_Log_Msg_Backend {
public:
    explicit CaptureBackend(LogCapture& owner) : previous(nullptr), m_owner(owner) {}

    ACE_Log_Msg_Backend* previous;

    int open(const ACE_TCHAR*) override { return 0; }
    int reset() override { return 0; }
    int close() override { return 0; }
    ssize_t log(ACE_Log_Record& record) override {
        const ACE_TCHAR* text = record.msg_data();
        m_owner.add(static_cast<ACE_Log_Priority>(record.type()), text != nullptr ? text : "");
        return 0;
    }

private:
    LogCapture& m_owner;
};

// The flags the capture changes and puts back.
const unsigned long kTouchedFlags = ACE_Log_Msg::CUSTOM | ACE_Log_Msg::STDERR;

}  // namespace

LogCapture::LogCapture(bool quiet) {
    auto* backend = new CaptureBackend(*this);
    m_backend = backend;
    ACE_Log_Msg* log = ACE_Log_Msg::instance();
    m_savedFlags = log->flags();
    backend->previous = ACE_Log_Msg::msg_backend(backend);
    log->set_flags(ACE_Log_Msg::CUSTOM);
    if (quiet) {
        log->clr_flags(ACE_Log_Msg::STDERR);
    }
}

LogCapture::~LogCapture() {
    auto* backend = static_cast<CaptureBackend*>(m_backend);
    ACE_Log_Msg* log = ACE_Log_Msg::instance();
    log->clr_flags(kTouchedFlags & ~m_savedFlags);
    log->set_flags(kTouchedFlags & m_savedFlags);
    // Swapping the backend takes ACE's logging lock, so no thread is still inside ours after it.
    ACE_Log_Msg::msg_backend(backend->previous);
    delete backend;
}

std::vector<LogCapture::Record> LogCapture::records() const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_records;
}

bool LogCapture::contains(const std::string& text) const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return std::any_of(m_records.begin(), m_records.end(),
                       [&](const Record& r) { return r.text == text; });
}

bool LogCapture::contains(ACE_Log_Priority priority, const std::string& text) const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return std::any_of(m_records.begin(), m_records.end(),
                       [&](const Record& r) { return r.priority == priority && r.text == text; });
}

bool LogCapture::containsFragment(const std::string& fragment) const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return std::any_of(m_records.begin(), m_records.end(),
                       [&](const Record& r) { return r.text.find(fragment) != std::string::npos; });
}

bool LogCapture::onlyStartsWith(const std::string& prefix) const {
    std::lock_guard<std::mutex> lock(m_mutex);
    return m_records.size() == 1 && m_records[0].text.rfind(prefix, 0) == 0;
}

void LogCapture::clear() {
    std::lock_guard<std::mutex> lock(m_mutex);
    m_records.clear();
}

void LogCapture::add(ACE_Log_Priority priority, const std::string& text) {
    std::lock_guard<std::mutex> lock(m_mutex);
    m_records.push_back(Record{priority, text});
}

}  // namespace Testing
}  // namespace Quorvex
