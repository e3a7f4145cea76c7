#include "Quorvex/BDate.h"

#include <cstdio>
#include <tuple>

#include <date/date.h>

#include "DateTextScanner.h"

BDate::BDate(int year, int month, int day) {
    // Four-digit years only, so that every valid date has its text form.
    const bool fourDigits = year >= 0 && year <= 9999;
    const bool fieldsFit = month >= 1 && month <= 12 && day >= 1 && day <= 31;
    if (!fourDigits || !fieldsFit) {
        return;
    }
    const date::year_month_day ymd{date::year{year}, date::month{static_cast<unsigned>(month)},
                                   date::day{static_cast<unsigned>(day)}};
    if (!ymd.ok()) {
        return;
    }
    m_year = year;
    m_month = month;
    m_day = day;
    m_valid = true;
}

BDate::BDate(const ACE_CString& text) {
    Quorvex::DateText::Scanner scanner(text.c_str(), text.length());
    Quorvex::DateText::DateFields f;
    if (scanner.date(f) && scanner.atEnd()) {
        *this = BDate(f.year, f.month, f.day);
    }
}

ACE_CString BDate::ToString() const {
    if (!m_valid) {
        return ACE_CString();
    }
    char text[16];
    const int n = std::snprintf(text, sizeof text, "%04d-%02d-%02d", m_year, m_month, m_day);
    return ACE_CString(text, static_cast<ACE_CString::size_type>(n));
}

bool operator<(const BDate& a, const BDate& b) {
    return std::make_tuple(a.m_valid, a.m_year, a.m_month, a.m_day) <
           std::make_tuple(b.m_valid, b.m_year, b.m_month, b.m_day);
}
