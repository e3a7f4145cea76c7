// LogCapture: records every message logged through ACE_Log_Msg (any thread) while it lives, so a
// test can assert exact texts. Messages still reach stderr unless quiet is asked for. One capture
// at a time.
#pragma once

#include <ace/Log_Priority.h>

#include <mutex>
#include <string>
#include <vector>

namespace Quorvex {
namespace Testing {

class LogCapture {
public:
    struct Record {
        ACE_Log_Priority priority;
        std::string text;  // the formatted message, as logged (with its trailing newline)
    };

    explicit LogCapture(bool quiet = true);
    ~LogCapture();
    LogCapture(const LogCapture&) = delete;
    LogCapture& operator=(const LogCapture&) = delete;

    std::vector<Record> records() const;
    // Whether a message with exactly this text (and priority, when given) was logged.
    bool contains(const std::string& text) const;
    bool contains(ACE_Log_Priority priority, const std::string& text) const;
    // Whether any message contains the fragment.
    bool containsFragment(const std::string& fragment) const;
    // Whether exactly one message was logged, and its text starts with prefix.
    bool onlyStartsWith(const std::string& prefix) const;
    void clear();

    // Called by the backend.
    void add(ACE_Log_Priority priority, const std::string& text);

private:
    mutable std::mutex m_mutex;
    std::vector<Record> m_records;
    void* m_backend;
    unsigned long m_savedFlags;
};

}  // namespace Testing
}  // namespace Quorvex
