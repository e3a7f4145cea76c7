// BDateTime: a point in time, UTC, millisecond precision. Value type; thread-safe to copy.
//
// Text form (ToString): ISO 8601 "2010-03-04T05:06:07.089". The text constructor also accepts
// the configuration service's form with seven fraction digits and an offset
// ("2010-03-04T05:06:07.0890000-00:00", the offset applied), a trailing "Z", fewer fraction
// digits, and no fraction. Text that does not parse, and the default constructor, give the
// invalid value: isValid() false, equal to every other invalid value and earlier than every
// valid one. Valid values lie in the years 0000-9999 (so each has its text form); parsing,
// fromMillisecondsSinceEpoch and arithmetic that leave that range give the invalid value.
#pragma once

#include <ace/SString.h>

#include <cstdint>

#include "Quorvex/BDate.h"
#include "Quorvex/BTime.h"
#include "Quorvex/BTimeSpan.h"

class BDateTime {
public:
    BDateTime() = default;
    explicit BDateTime(const ACE_CString& text);
    explicit BDateTime(const char* text) : BDateTime(ACE_CString(text)) {}
    BDateTime(const BDate& date, const BTime& timeOfDay);
    static BDateTime fromMillisecondsSinceEpoch(std::int64_t ms);

    // The current time from the machine's clock (replaceable by tests, see Quorvex/Machine.h).
    static BDateTime Now();

    bool isValid() const { return m_valid; }
    std::int64_t millisecondsSinceEpoch() const { return m_ms; }
    BDate date() const;
    BTime timeOfDay() const;
    // "YYYY-MM-DDTHH:MM:SS.mmm", or the empty string for the invalid value.
    ACE_CString ToString() const;

    BDateTime operator+(const BTime& duration) const;
    BDateTime operator-(const BTime& duration) const;
    BTimeSpan operator-(const BDateTime& other) const;

    friend bool operator==(const BDateTime& a, const BDateTime& b) {
        return a.m_valid == b.m_valid && (!a.m_valid || a.m_ms == b.m_ms);
    }
    friend bool operator!=(const BDateTime& a, const BDateTime& b) { return !(a == b); }
    friend bool operator<(const BDateTime& a, const BDateTime& b) {
        if (a.m_valid != b.m_valid) {
            return !a.m_valid;
        }
        return a.m_valid && a.m_ms < b.m_ms;
    }
    friend bool operator>(const BDateTime& a, const BDateTime& b) { return b < a; }
    friend bool operator<=(const BDateTime& a, const BDateTime& b) { return !(b < a); }
    friend bool operator>=(const BDateTime& a, const BDateTime& b) { return !(a < b); }

private:
    std::int64_t m_ms = 0;
    bool m_valid = false;
};
