#include "Quorvex/BDateTime.h"

#include <chrono>
#include <cstdio>

#include <date/date.h>

#include "DateTextScanner.h"
#include "Quorvex/Machine.h"

namespace {

using Milliseconds = std::chrono::milliseconds;
using TimePoint = date::sys_time<Milliseconds>;

// Valid values lie in the years 0000-9999, so that every one has its four-digit text form.
std::int64_t firstMillisecond() {
    static const std::int64_t ms =
        TimePoint{date::sys_days{date::year{0} / 1 / 1}}.time_since_epoch().count();
    return ms;
}

std::int64_t lastMillisecond() {
    static const std::int64_t ms =
        TimePoint{date::sys_days{date::year{10000} / 1 / 1}}.time_since_epoch().count() - 1;
    return ms;
}

TimePoint toTimePoint(std::int64_t ms) {
    return TimePoint{Milliseconds{ms}};
}

// The milliseconds of a date at midnight, or false when the fields are no calendar date.
bool midnightOf(const BDate& d, std::int64_t& ms) {
    if (!d.isValid()) {
        return false;
    }
    const date::sys_days day{date::year{d.year()} / d.month() / d.day()};
    ms = TimePoint{day}.time_since_epoch().count();
    return true;
}

// t moved by sign times the duration; invalid when either is.
BDateTime shifted(const BDateTime& t, const BTime& duration, int sign) {
    if (!t.isValid() || !duration.isValid()) {
        return BDateTime();
    }
    return BDateTime::fromMillisecondsSinceEpoch(t.millisecondsSinceEpoch() +
                                                 sign * duration.totalMilliseconds());
}

}  // namespace

BDateTime BDateTime::fromMillisecondsSinceEpoch(std::int64_t ms) {
    BDateTime t;
    if (ms >= firstMillisecond() && ms <= lastMillisecond()) {
        t.m_ms = ms;
        t.m_valid = true;
    }
    return t;
}

BDateTime::BDateTime(const BDate& date, const BTime& timeOfDay) {
    std::int64_t midnight = 0;
    if (midnightOf(date, midnight) && timeOfDay.isValid()) {
        *this = fromMillisecondsSinceEpoch(midnight + timeOfDay.totalMilliseconds());
    }
}

BDateTime::BDateTime(const ACE_CString& text) {
    Quorvex::DateText::Scanner scanner(text.c_str(), text.length());
    Quorvex::DateText::DateFields d;
    Quorvex::DateText::ClockFields c;
    if (!scanner.date(d) || !(scanner.literal('T') || scanner.literal(' ')) ||
        !scanner.clock(2, 2, c) || c.hours >= 24) {
        return;
    }
    int offsetMinutes = 0;
    if (!scanner.literal('Z') && !scanner.atEnd() && !scanner.offset(offsetMinutes)) {
        return;
    }
    if (!scanner.atEnd()) {
        return;
    }
    // The text is local time at the offset; UTC is that time minus the offset.
    const BTime clock(static_cast<int>(c.hours), c.minutes, c.seconds, c.milliseconds);
    const BDateTime local(BDate(d.year, d.month, d.day), clock);
    if (local.isValid()) {
        *this = fromMillisecondsSinceEpoch(
            local.m_ms -
            std::chrono::duration_cast<Milliseconds>(std::chrono::minutes{offsetMinutes}).count());
    }
}

BDateTime BDateTime::Now() {
    return fromMillisecondsSinceEpoch(Quorvex::CurrentMachine().nowMilliseconds());
}

BDate BDateTime::date() const {
    if (!m_valid) {
        return BDate();
    }
    const date::year_month_day ymd{date::floor<date::days>(toTimePoint(m_ms))};
    return BDate(static_cast<int>(ymd.year()), static_cast<int>(static_cast<unsigned>(ymd.month())),
                 static_cast<int>(static_cast<unsigned>(ymd.day())));
}

BTime BDateTime::timeOfDay() const {
    if (!m_valid) {
        return BTime("");
    }
    const TimePoint t = toTimePoint(m_ms);
    return BTime::fromMilliseconds((t - date::floor<date::days>(t)).count());
}

ACE_CString BDateTime::ToString() const {
    if (!m_valid) {
        return ACE_CString();
    }
    const BDate d = date();
    const BTime t = timeOfDay();
    char text[32];
    const int n =
        std::snprintf(text, sizeof text, "%04d-%02d-%02dT%02d:%02d:%02d.%03d", d.year(), d.month(),
                      d.day(), t.hours(), t.minutes(), t.seconds(), t.milliseconds());
    return ACE_CString(text, static_cast<ACE_CString::size_type>(n));
}

BDateTime BDateTime::operator+(const BTime& duration) const {
    return shifted(*this, duration, 1);
}

BDateTime BDateTime::operator-(const BTime& duration) const {
    return shifted(*this, duration, -1);
}

BTimeSpan BDateTime::operator-(const BDateTime& other) const {
    if (!m_valid || !other.isValid()) {
        return BTimeSpan();
    }
    return BTimeSpan(m_ms - other.m_ms);
}
