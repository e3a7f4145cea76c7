#include "DateTextScanner.h"

namespace Quorvex {
namespace DateText {

namespace {

bool isDigit(char c) {
    return c >= '0' && c <= '9';
}

}  // namespace

bool Scanner::digits(int minCount, int maxCount, std::int64_t& value) {
    value = 0;
    int count = 0;
    while (count < maxCount && m_p != m_end && isDigit(*m_p)) {
        value = value * 10 + (*m_p - '0');
        ++m_p;
        ++count;
    }
    return count >= minCount && (m_p == m_end || !isDigit(*m_p));
}

bool Scanner::digits(int count, int& value) {
    std::int64_t v = 0;
    if (!digits(count, count, v)) {
        return false;
    }
    value = static_cast<int>(v);
    return true;
}

bool Scanner::literal(char c) {
    if (m_p == m_end || *m_p != c) {
        return false;
    }
    ++m_p;
    return true;
}

bool Scanner::fraction(int& milliseconds) {
    milliseconds = 0;
    if (!literal('.')) {
        return true;
    }
    int count = 0;
    for (; m_p != m_end && isDigit(*m_p); ++m_p, ++count) {
        if (count < 3) {
            milliseconds = milliseconds * 10 + (*m_p - '0');
        }
    }
    for (int k = count; k < 3; ++k) {
        milliseconds *= 10;
    }
    return count > 0;
}

bool Scanner::date(DateFields& out) {
    return digits(4, out.year) && literal('-') && digits(2, out.month) && literal('-') &&
           digits(2, out.day);
}

bool Scanner::clock(int minHourDigits, int maxHourDigits, ClockFields& out) {
    return digits(minHourDigits, maxHourDigits, out.hours) && literal(':') &&
           digits(2, out.minutes) && out.minutes < 60 && literal(':') && digits(2, out.seconds) &&
           out.seconds < 60 && fraction(out.milliseconds);
}

bool Scanner::offset(int& minutes) {
    const bool negative = literal('-');
    if (!negative && !literal('+')) {
        return false;
    }
    int hours = 0;
    int mins = 0;
    if (!digits(2, hours) || hours >= 24 || !literal(':') || !digits(2, mins) || mins >= 60) {
        return false;
    }
    minutes = (negative ? -1 : 1) * (hours * 60 + mins);
    return true;
}

}  // namespace DateText
}  // namespace Quorvex
