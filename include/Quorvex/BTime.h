// BTime: a time of day or a duration, with millisecond precision. Value type; thread-safe to copy.
// Text form "HH:MM:SS" with ".mmm" appended when the milliseconds are not zero; hours may exceed
// 23 for durations (at most nine hour digits). Text that does not parse gives an invalid value
// (isValid() false, zero length).
#pragma once

#include <ace/SString.h>

#include <cstdint>

class BTime {
public:
    BTime() = default;
    BTime(int hours, int minutes, int seconds, int milliseconds = 0);
    explicit BTime(const ACE_CString& text);
    explicit BTime(const char* text) : BTime(ACE_CString(text)) {}
    static BTime fromMilliseconds(std::int64_t ms);

    bool isValid() const { return m_valid; }
    std::int64_t totalMilliseconds() const { return m_ms; }
    int hours() const;
    int minutes() const;
    int seconds() const;
    int milliseconds() const;
    ACE_CString ToString() const;

    friend bool operator==(const BTime& a, const BTime& b) {
        return a.m_valid == b.m_valid && a.m_ms == b.m_ms;
    }
    friend bool operator!=(const BTime& a, const BTime& b) { return !(a == b); }
    friend bool operator<(const BTime& a, const BTime& b) { return a.m_ms < b.m_ms; }

private:
    std::int64_t m_ms = 0;
    bool m_valid = true;
};
