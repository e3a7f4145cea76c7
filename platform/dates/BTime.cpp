#include "Quorvex/BTime.h"

#include <chrono>
#include <cinttypes>
#include <cstdio>

#include <date/date.h>

#include "DateTextScanner.h"

namespace {

using Milliseconds = std::chrono::milliseconds;

// Hours have at most nine digits, so every valid value has a text form that reads back.
constexpr std::int64_t kMaxHours = 999999999;
constexpr std::int64_t kMaxMilliseconds = (kMaxHours + 1) * 3600000 - 1;

date::hh_mm_ss<Milliseconds> split(std::int64_t ms) {
    return date::hh_mm_ss<Milliseconds>{Milliseconds{ms}};
}

}  // namespace

BTime::BTime(int hours, int minutes, int seconds, int milliseconds) {
    const bool inRange = hours >= 0 && hours <= kMaxHours && minutes >= 0 && minutes < 60 &&
                         seconds >= 0 && seconds < 60 && milliseconds >= 0 && milliseconds < 1000;
    if (!inRange) {
        m_valid = false;
        return;
    }
    m_ms = std::chrono::duration_cast<Milliseconds>(std::chrono::hours{hours} +
                                                    std::chrono::minutes{minutes} +
                                                    std::chrono::seconds{seconds})
               .count() +
           milliseconds;
}

BTime::BTime(const ACE_CString& text) {
    Quorvex::DateText::Scanner scanner(text.c_str(), text.length());
    Quorvex::DateText::ClockFields f;
    if (!scanner.clock(2, 9, f) || !scanner.atEnd()) {
        m_valid = false;
        return;
    }
    *this = BTime(static_cast<int>(f.hours), f.minutes, f.seconds, f.milliseconds);
}

BTime BTime::fromMilliseconds(std::int64_t ms) {
    BTime t;
    if (ms < 0 || ms > kMaxMilliseconds) {
        t.m_valid = false;
    } else {
        t.m_ms = ms;
    }
    return t;
}

int BTime::hours() const {
    return static_cast<int>(split(m_ms).hours().count());
}

int BTime::minutes() const {
    return static_cast<int>(split(m_ms).minutes().count());
}

int BTime::seconds() const {
    return static_cast<int>(split(m_ms).seconds().count());
}

int BTime::milliseconds() const {
    return static_cast<int>(split(m_ms).subseconds().count());
}

ACE_CString BTime::ToString() const {
    if (!m_valid) {
        return ACE_CString();
    }
    const auto parts = split(m_ms);
    char text[40];
    int n = std::snprintf(text, sizeof text, "%02" PRId64 ":%02d:%02d",
                          static_cast<std::int64_t>(parts.hours().count()),
                          static_cast<int>(parts.minutes().count()),
                          static_cast<int>(parts.seconds().count()));
    if (parts.subseconds().count() != 0) {
        n += std::snprintf(text + n, sizeof text - n, ".%03d",
                           static_cast<int>(parts.subseconds().count()));
    }
    return ACE_CString(text, static_cast<ACE_CString::size_type>(n));
}
