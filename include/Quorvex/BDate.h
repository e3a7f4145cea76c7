// BDate: a calendar date (proleptic Gregorian). Value type; thread-safe to copy.
// Text form "YYYY-MM-DD". The default and text that does not parse give an invalid date.
#pragma once

#include <ace/SString.h>

class BDate {
public:
    BDate() = default;
    BDate(int year, int month, int day);  // an impossible date is invalid
    explicit BDate(const ACE_CString& text);
    explicit BDate(const char* text) : BDate(ACE_CString(text)) {}

    bool isValid() const { return m_valid; }
    int year() const { return m_year; }
    int month() const { return m_month; }
    int day() const { return m_day; }
    // "YYYY-MM-DD", or the empty string for an invalid date.
    ACE_CString ToString() const;

    friend bool operator==(const BDate& a, const BDate& b) {
        return a.m_valid == b.m_valid && a.m_year == b.m_year && a.m_month == b.m_month &&
               a.m_day == b.m_day;
    }
    friend bool operator!=(const BDate& a, const BDate& b) { return !(a == b); }
    friend bool operator<(const BDate& a, const BDate& b);

private:
    int m_year = 0;
    int m_month = 0;
    int m_day = 0;
    bool m_valid = false;
};
