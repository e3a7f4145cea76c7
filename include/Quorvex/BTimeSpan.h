// BTimeSpan: the signed difference between two BDateTime values, in milliseconds. Value type.
#pragma once

#include <cstdint>

class BTimeSpan {
public:
    explicit BTimeSpan(std::int64_t milliseconds = 0) : m_ms(milliseconds) {}
    std::int64_t totalMilliseconds() const { return m_ms; }
    double totalSeconds() const { return static_cast<double>(m_ms) / 1000.0; }

    friend bool operator==(BTimeSpan a, BTimeSpan b) { return a.m_ms == b.m_ms; }
    friend bool operator!=(BTimeSpan a, BTimeSpan b) { return a.m_ms != b.m_ms; }
    friend bool operator<(BTimeSpan a, BTimeSpan b) { return a.m_ms < b.m_ms; }

private:
    std::int64_t m_ms;
};
